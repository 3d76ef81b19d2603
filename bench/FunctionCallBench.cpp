// A plug-in call through the engine against the direct call of the same symbol.

#include "engine/ProviderDefFunctionCall.h"
#include "engine/Registry.h"

#include <benchmark/benchmark.h>
#include <dlfcn.h>

namespace {

void directCall(benchmark::State& state) {
  void* library = dlopen(BENCH_PLUGIN, RTLD_NOW);
  const auto function = reinterpret_cast<int (*)(int)>(dlsym(library, "benchNumber"));
  int index = 0;
  for (auto _ : state) benchmark::DoNotOptimize(function(index++));
  dlclose(library);
}
BENCHMARK(directCall);

void callThroughEngine(benchmark::State& state, const char* name, const char* type) {
  ProviderDefModule* module =
      registerModule(std::make_unique<ProviderDefModule>(BENCH_PLUGIN, false));
  ProviderDefFunction* function =
      registerFunction(std::make_unique<ProviderDefFunction>(name, functionTypeCode(type), module));
  const ProviderDefFunctionCall call(function, {ProviderDefArgument(ProviderDefArgument::kIndex)});
  int index = 0;
  for (auto _ : state) benchmark::DoNotOptimize(call.getValue(index++ & 1023));
  releaseFunctions();
  releaseModules();
}
BENCHMARK_CAPTURE(callThroughEngine, getIi, "benchNumber", "getIi");
BENCHMARK_CAPTURE(callThroughEngine, getLi, "benchLong", "getLi");
BENCHMARK_CAPTURE(callThroughEngine, getSi, "benchText", "getSi");
BENCHMARK_CAPTURE(callThroughEngine, getAIi, "benchNumbers", "getAIi");
BENCHMARK_CAPTURE(callThroughEngine, getASi, "benchTexts", "getASi");

}  // namespace
