// enumerateInstances of 10,000 instances with ten properties of ten types, over loopback HTTP,
// first byte sent to last byte read: an OpenPegasus server with the generic provider and with one
// written by hand for the class, and `cimhost serve` with the generic one. Ratios hold within one
// run only.

#include <arpa/inet.h>
#include <benchmark/benchmark.h>
#include <netinet/in.h>
#include <sys/socket.h>

#include "tests/openpegasus/CimServer.h"
#include "tests/support/CimhostServer.h"
#include "tests/support/TemporaryTree.h"

namespace fs = std::filesystem;

namespace {

constexpr long kInstances = 10000;

struct PropertyRow {
  const char* declaration;
  const char* name;
  const char* function;
  const char* functionType;
};

constexpr PropertyRow kProperties[] = {
    {"[Key] string DeviceID", "DeviceID", "deviceText", "getSi"},
    {"[Key(false)] uint8 Percent", "Percent", "deviceNumber", "getIi"},
    {"[Key(false)] sint16 Offset", "Offset", "deviceNumber", "getIi"},
    {"[Key(false)] uint32 Number", "Number", "deviceNumber", "getIi"},
    {"[Key(false)] sint32 Balance", "Balance", "deviceNumber", "getIi"},
    {"[Key(false)] uint64 Size", "Size", "deviceLong", "getLi"},
    {"[Key(false)] boolean Ready", "Ready", "deviceNumber", "getIi"},
    {"[Key(false)] real64 Load", "Load", "deviceNumber", "getIi"},
    {"[Key(false)] datetime Since", "Since", "deviceTime", "getSi"},
    {"[Key(false)] string Labels[]", "Labels", "deviceTexts", "getASi"},
};

std::string declarations() {
  std::string text =
      "Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride);\n";
  for (const std::string name : {"Bench_Device", "Bench_HandWritten"}) {
    text += "class " + name + " {\n";
    for (const PropertyRow& row : kProperties) text += "  " + std::string(row.declaration) + ";\n";
    text += "};\n";
  }
  return text;
}

std::string definitions() {
  std::string text =
      "<plugin><module name=\"device\" path=\"short\"/>"
      "<class name=\"Bench_Device\" namespace=\"root/bench\"><instances><functioncall>"
      "<function name=\"deviceCount\" type=\"getI\"/></functioncall></instances>";
  for (const PropertyRow& row : kProperties) {
    text += "<property name=\"" + std::string(row.name) +
            "\"><get><functioncall><function name=\"" + row.function + "\" type=\"" +
            row.functionType + "\"/><argument type=\"index\"/></functioncall></get></property>";
  }
  return text + "</class></plugin>";
}

constexpr const char* kHandWritten = R"(
instance of PG_ProviderModule { Name = "HandWrittenModule"; Vendor = "bench"; Version = "1.0.0";
  InterfaceType = "C++Default"; InterfaceVersion = "2.9.0"; Location = "HandWritten"; };
instance of PG_Provider { ProviderModuleName = "HandWrittenModule"; Name = "HandWritten"; };
instance of PG_ProviderCapabilities { ProviderModuleName = "HandWrittenModule";
  ProviderName = "HandWritten"; CapabilityID = "1"; ClassName = "Bench_HandWritten";
  Namespaces = {"root/bench"}; ProviderType = {2}; SupportedProperties = NULL;
  SupportedMethods = NULL; };
)";

// Both servers, in directories of their own.
class Servers {
 public:
  Servers() : root_(temporary()) {
    writeHome(root_ / "cimhost");
    writeHome(root_ / "server");
    server_ = std::make_unique<CimServer>(root_ / "server", CimServer::Providers::inProcess);
    fs::create_symlink(HAND_WRITTEN, root_ / "server/pegasus/lib/libHandWritten.so");
    const std::string mof = (root_ / "cimhost/mof/root/bench/bench.mof").string();
    const ProgramResult registration =
        runProgram({CIMHOST, "--home", (root_ / "cimhost").string(), "registration"});
    TemporaryTree::write(root_ / "registration.mof", registration.out + kHandWritten);
    server_->mustRun("cimmof", {"-n", "root/bench", mof});
    server_->mustRun("cimmof", {"-n", "root/PG_InterOp", (root_ / "registration.mof").string()});
    host_ = std::make_unique<CimhostServer>(CIMHOST, (root_ / "cimhost").string(),
                                            std::vector<std::string>{"--log", "/dev/null"});
  }
  ~Servers() {
    host_.reset();
    server_.reset();
    fs::remove_all(root_);
  }

  int server() const { return server_->port(); }
  int host() const { return host_->port(); }

 private:
  static fs::path temporary() {
    std::string name = (fs::temp_directory_path() / "bench-XXXXXX").string();
    if (mkdtemp(name.data()) == nullptr) throw std::runtime_error("cannot make " + name);
    return name;
  }

  static void writeHome(const fs::path& home) {
    for (const char* folder : {"run", "lib", "logs", "mof/root/bench"}) {
      fs::create_directories(home / folder);
    }
    fs::create_symlink(DEVICE_PLUGIN, home / "lib/libdevice.so");
    TemporaryTree::write(home / "run/bench.xml", definitions());
    TemporaryTree::write(home / "mof/root/bench/bench.mof", declarations());
  }

  fs::path root_;
  std::unique_ptr<CimServer> server_;
  std::unique_ptr<CimhostServer> host_;
};

std::string request(const std::string& className) {
  const std::string body =
      "<?xml version=\"1.0\" encoding=\"utf-8\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
      "<MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLEREQ>"
      "<IMETHODCALL NAME=\"EnumerateInstances\"><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/>"
      "<NAMESPACE NAME=\"bench\"/></LOCALNAMESPACEPATH><IPARAMVALUE NAME=\"ClassName\">"
      "<CLASSNAME NAME=\"" +
      className + "\"/></IPARAMVALUE></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
  return "POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Type: application/xml\r\n"
         "CIMOperation: MethodCall\r\nCIMMethod: EnumerateInstances\r\n"
         "CIMObject: root%2Fbench\r\nContent-Length: " +
         std::to_string(body.size()) + "\r\n\r\n" + body;
}

// The whole reply, read up to the end tag of its document.
std::string ask(int port, const std::string& text) {
  const int client = socket(AF_INET, SOCK_STREAM, 0);
  sockaddr_in address{};
  address.sin_family = AF_INET;
  address.sin_port = htons(static_cast<uint16_t>(port));
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  std::string reply;
  if (connect(client, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0 &&
      send(client, text.data(), text.size(), 0) == static_cast<ssize_t>(text.size())) {
    static thread_local char buffer[1 << 16];
    ssize_t size;
    while ((size = recv(client, buffer, sizeof buffer, 0)) > 0) {
      reply.append(buffer, static_cast<std::size_t>(size));
      if (reply.find("</CIM>", reply.size() - std::min<std::size_t>(reply.size(), 64)) !=
          std::string::npos) {
        break;
      }
    }
  }
  close(client);
  return reply;
}

// A chunk may begin in the middle of a tag.
std::string withoutChunks(const std::string& reply) {
  auto at = reply.find("\r\n\r\n");
  if (at == std::string::npos) return {};
  at += 4;
  if (reply.find("chunked") > at) return reply.substr(at);
  std::string body;
  while (at < reply.size()) {
    const std::size_t size = std::strtoul(reply.c_str() + at, nullptr, 16);
    at = reply.find("\r\n", at);
    if (size == 0 || at == std::string::npos) break;
    body += reply.substr(at + 2, size);
    at += 2 + size + 2;
  }
  return body;
}

long countInstances(const std::string& answer) {
  const std::string reply = withoutChunks(answer);
  long count = 0;
  const std::string tag = "</VALUE.NAMEDINSTANCE>";
  for (auto at = reply.find(tag); at != std::string::npos; at = reply.find(tag, at + 1)) ++count;
  return count;
}

void enumerate(benchmark::State& state, int (Servers::*port)() const, const char* className) {
  const std::string reason = CimServer::whyUnavailable();
  if (!reason.empty()) {
    state.SkipWithError(reason.c_str());
    return;
  }
  static const Servers servers;
  const std::string text = request(className);
  std::string reply = ask((servers.*port)(), text);
  if (countInstances(reply) != kInstances) {
    state.SkipWithError("not all instances arrived");
    return;
  }
  for (auto _ : state) reply = ask((servers.*port)(), text);
  state.SetItemsProcessed(state.iterations() * kInstances);
  state.counters["bytes"] = static_cast<double>(reply.size());
}

}  // namespace

BENCHMARK_CAPTURE(enumerate, server_hand_written, &Servers::server, "Bench_HandWritten")
    ->UseRealTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(enumerate, server_generic, &Servers::server, "Bench_Device")
    ->UseRealTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(enumerate, cimhost_generic, &Servers::host, "Bench_Device")
    ->UseRealTime()
    ->Unit(benchmark::kMillisecond);
