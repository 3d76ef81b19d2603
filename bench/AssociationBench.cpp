// One source against 1,000 targets with an "equal" condition. The trace lines are written, to
// /dev/null: the time per pair is the benchmark's time divided by 1,000.

#include "association/ProviderDefAssociation.h"
#include "engine/Registry.h"

#include <benchmark/benchmark.h>
#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>

namespace {

constexpr int kTargets = 1000;

const char kAssociation[] =
    "<association name=\"Bench_Link\" namespace2=\"root/bench\" propertyname1=\"A\" "
    "propertyname2=\"B\">"
    "<classname name=\"Bench_A\"><propertyname name=\"Name\"/></classname>"
    "<classname name=\"Bench_B\"><propertyname name=\"Name\"/></classname>"
    "<condition><equal>0 0</equal></condition></association>";

// Standard output goes to /dev/null while the object lives.
class QuietOutput {
 public:
  QuietOutput() {
    std::fflush(stdout);
    saved_ = dup(STDOUT_FILENO);
    const int null = open("/dev/null", O_WRONLY);
    dup2(null, STDOUT_FILENO);
    close(null);
  }
  ~QuietOutput() {
    std::fflush(stdout);
    dup2(saved_, STDOUT_FILENO);
    close(saved_);
  }

 private:
  int saved_;
};

void associateStrings(benchmark::State& state) {
  int used = 0;
  const ProviderDefAssociation association(kAssociation, static_cast<int>(sizeof kAssociation - 1),
                                           &used, nullptr);
  std::vector<std::vector<ProviderDefValue>> targets;
  for (int i = 0; i < kTargets; ++i) {
    targets.push_back({ProviderDefValue("interface name " + std::to_string(i))});
  }
  const std::vector<ProviderDefValue> source = {ProviderDefValue("interface name 500")};
  size_t found = 0;
  {
    const QuietOutput quiet;
    for (auto _ : state) {
      found = association.getAssociation("Bench_A", 0, source, "Bench_B", targets).size();
    }
  }
  if (found != 1) state.SkipWithError("not exactly one target");
  state.SetItemsProcessed(state.iterations() * kTargets);
  state.counters["per_pair"] =
      benchmark::Counter(static_cast<double>(state.iterations()) * kTargets,
                         benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}
BENCHMARK(associateStrings)->Unit(benchmark::kMicrosecond);

}  // namespace
