// EnumerateInstances of 10,000 instances with ten properties through the operations of cimhost: to
// a sink that counts, and to CIM-XML. The difference is what the text costs.

#include "bench/BenchDevice.h"
#include "cimhost/EmbeddedCimom.h"
#include "cimhost/xml/CimXmlService.h"

#include <Pegasus/Provider/CIMOMHandle.h>

#include <benchmark/benchmark.h>

#include <memory>

using namespace Pegasus;
using namespace bench;

namespace {

constexpr std::size_t kInstances = 10000;

class ServedDevice {
 public:
  ServedDevice() {
    repository.addNamespace(nameSpace);
    repository.addClass(nameSpace, benchClass());
    served.add({nameSpace, CIMName("Bench_Device"), false, false, "bench.xml", {}});
    setEmbeddedHost(&cimom);
    handle_ = std::make_unique<CIMOMHandle>();
    provider.load(COMMONPROVIDER_LIBRARY, "CommonProvider", *handle_);
  }
  ~ServedDevice() {
    provider.unload();
    setEmbeddedHost(nullptr);
  }

  const CIMNamespaceName nameSpace{"root/bench"};
  cimhost::ClassRepository repository;
  cimhost::ServedClasses served;
  cimhost::ProviderLibrary provider;
  cimhost::Operations operations{repository, served, provider};
  cimhost::EmbeddedCimom cimom{repository, operations};

 private:
  WorkingDirectory directory_{"benchManyCount"};
  std::unique_ptr<CIMOMHandle> handle_;
};

struct CountingSink final : cimhost::InstanceSink {
  bool deliverInstance(const CIMInstance&) override {
    ++count;
    return true;
  }
  std::size_t count = 0;
};

struct EnumerateMessage final : cimhost::CimXmlRequest {
  std::optional<std::string> header(std::string_view name) const override {
    if (name == "CIMOperation") return "MethodCall";
    if (name == "CIMMethod") return "EnumerateInstances";
    if (name == "CIMObject") return "root/bench";
    return std::nullopt;
  }
  std::string_view body() const override {
    return "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\">"
           "<SIMPLEREQ><IMETHODCALL NAME=\"EnumerateInstances\"><LOCALNAMESPACEPATH><NAMESPACE "
           "NAME=\"root\"/><NAMESPACE NAME=\"bench\"/></LOCALNAMESPACEPATH><IPARAMVALUE "
           "NAME=\"ClassName\"><CLASSNAME NAME=\"Bench_Device\"/></IPARAMVALUE><IPARAMVALUE "
           "NAME=\"LocalOnly\"><VALUE>FALSE</VALUE></IPARAMVALUE></IMETHODCALL></SIMPLEREQ>"
           "</MESSAGE></CIM>";
  }
  std::string_view user() const override { return {}; }
};

struct DiscardedReply final : cimhost::ReplyStream {
  void begin(int, const cimhost::HttpHeaders&) override {}
  bool write(std::string_view bytes) override {
    size += bytes.size();
    return true;
  }
  void abort() override {}
  std::size_t size = 0;
};

void finish(benchmark::State& state, std::size_t count) {
  if (count != kInstances) state.SkipWithError("not the instances expected");
  state.SetItemsProcessed(state.iterations() * static_cast<int64_t>(kInstances));
}

void enumerateOperations(benchmark::State& state) {
  const ServedDevice device;
  std::size_t count = 0;
  for (auto _ : state) {
    CountingSink sink;
    device.operations.enumerateInstances(OperationContext(),
                                         {device.nameSpace, CIMName("Bench_Device"), {}}, sink);
    count = sink.count;
  }
  finish(state, count);
}
BENCHMARK(enumerateOperations)->Unit(benchmark::kMillisecond);

void enumerateCimXml(benchmark::State& state) {
  const ServedDevice device;
  const cimhost::CimXmlService service(device.operations, device.repository);
  DiscardedReply reply;
  std::size_t count = 0;
  for (auto _ : state) {
    reply.size = 0;
    count = service.answer(EnumerateMessage(), reply).objects;
  }
  state.counters["bytes/instance"] = static_cast<double>(reply.size) / kInstances;
  finish(state, count);
}
BENCHMARK(enumerateCimXml)->Unit(benchmark::kMillisecond);

}  // namespace
