// Many clients at once, each with a connection that stays. COMMONPROVIDER_REQUESTS is how many
// requests each of them sends; 1000 belong to a run under the thread sanitizer.

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>
#include <vector>

#include "tests/cimhost/http/HttpClient.h"
#include "tests/compared/ComparedClasses.h"
#include "tests/support/CimhostServer.h"
#include "tests/support/TemporaryTree.h"

namespace {

constexpr int kClients = 8;
constexpr int kReloads = 5;

int requestsOfAClient() {
  const char* const text = std::getenv("COMMONPROVIDER_REQUESTS");
  return text == nullptr ? 100 : std::atoi(text);
}

const std::string kNamespace =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"compare\"/>"
    "</LOCALNAMESPACEPATH>";

std::string message(const std::string& method, const std::string& object, const std::string& call) {
  const std::string body =
      "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">"
      "<MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLEREQ>" +
      call + "</SIMPLEREQ></MESSAGE></CIM>";
  return "POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Type: application/xml\r\n"
         "CIMOperation: MethodCall\r\nCIMMethod: " +
         method + "\r\nCIMObject: " + object +
         "\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
}

std::string operation(const std::string& name, const std::string& parameters) {
  return message(
      name, "root%2Fcompare",
      "<IMETHODCALL NAME=\"" + name + "\">" + kNamespace + parameters + "</IMETHODCALL>");
}

std::string parameter(const std::string& name, const std::string& content) {
  return "<IPARAMVALUE NAME=\"" + name + "\">" + content + "</IPARAMVALUE>";
}

std::string className(const std::string& name) {
  return parameter("ClassName", "<CLASSNAME NAME=\"" + name + "\"/>");
}

std::string path(const std::string& className, const std::string& key) {
  return "<INSTANCENAME CLASSNAME=\"" + className + "\"><KEYBINDING NAME=\"Name\"><KEYVALUE>" +
         key + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

std::string echo(int number) {
  return message("Echo", "root%2Fcompare%3ACmp_Element",
                 "<METHODCALL NAME=\"Echo\"><LOCALCLASSPATH>" + kNamespace +
                     "<CLASSNAME NAME=\"Cmp_Element\"/></LOCALCLASSPATH><PARAMVALUE NAME=\"In0\">"
                     "<VALUE>TRUE</VALUE></PARAMVALUE><PARAMVALUE NAME=\"In1\"><VALUE>" +
                     std::to_string(number % 256) + "</VALUE></PARAMVALUE></METHODCALL>");
}

// A client has one property of one of the four instances to itself.
struct Place {
  explicit Place(std::size_t client)
      : instance(path("Cmp_Stored", client % 2 == 0 ? "plain" : "a b,c=d.e:f")),
        property(std::vector<std::string>{"S32", "U64", "U8", "Text"}[client / 2]) {}

  std::string read() const {
    return operation("GetProperty",
                     parameter("InstanceName", instance) +
                         parameter("PropertyName", "<VALUE>" + property + "</VALUE>"));
  }
  std::string write(const std::string& value) const {
    return operation("SetProperty",
                     parameter("InstanceName", instance) +
                         parameter("PropertyName", "<VALUE>" + property + "</VALUE>") +
                         parameter("NewValue", "<VALUE>" + value + "</VALUE>"));
  }

  std::string instance;
  std::string property;
};

class Client {
 public:
  Client(int port, std::size_t number) : http_(static_cast<std::uint16_t>(port)), place_(number) {}

  /// Request number `round`; what is wrong with the reply, or nothing.
  std::string round(int round) {
    const std::string value = std::to_string(round % 256);
    switch (round % 8) {
      case 0: {
        const std::string written =
            ask(place_.write(value), "\"SetProperty\">\n</IMETHODRESPONSE>");
        return written + ask(place_.read(), "<VALUE>" + value + "</VALUE>");
      }
      case 1:
        return ask(operation("EnumerateInstances", className("Cmp_Named")), "<VALUE>&lt;two&gt;");
      case 2:
        return ask(operation("GetInstance",
                             parameter("InstanceName",
                                       path("Cmp_Part", "part " + std::to_string(round % 6)))),
                   "<VALUE>part " + std::to_string(round % 6) + "</VALUE>");
      case 3:
        return ask(echo(round), "<VALUE>" + value + "</VALUE>");
      case 4:
        return ask(operation("Associators", parameter("ObjectName", path("Cmp_Part", "part 2"))),
                   "<INSTANCE CLASSNAME=\"Cmp_Stored\">");
      case 5:
        return ask(operation("GetClass", className("Cmp_Element")), "<METHOD NAME=\"Echo\"");
      case 6:
        return ask(operation("EnumerateInstanceNames", className("Cmp_Element")),
                   "<KEYVALUE VALUETYPE=\"numeric\">4</KEYVALUE>");
      default:
        return ask(operation("GetInstance", parameter("InstanceName", path("Cmp_Part", "none"))),
                   "<ERROR CODE=\"1\"");
    }
  }

 private:
  std::string ask(const std::string& request, const std::string& expected) {
    const HttpReply reply = http_.ask(request);
    if (reply.status == 200 && reply.complete && reply.body.find(expected) != std::string::npos) {
      return {};
    }
    return request + "\n" + std::to_string(reply.status) + "\n" + reply.body + "\n";
  }

  HttpClient http_;
  Place place_;
};

}  // namespace

// The definitions are read anew meanwhile. A report of the thread sanitizer is in the exit code.
TEST(Concurrency, ClientsDoNotDisturbEachOther) {
  const TemporaryTree tree;
  writeComparedHome(tree.root() / "home");
  CimhostServer server(CIMHOST, (tree.root() / "home").string(),
                       {"--threads", "8", "--log", (tree.root() / "log").string()});
  const int rounds = requestsOfAClient();
  std::atomic<int> done{0};
  std::vector<std::string> problems(kClients);
  std::vector<std::thread> clients;
  for (std::size_t number = 0; number < kClients; ++number) {
    clients.emplace_back([&, number] {
      Client client(server.port(), number);
      std::string& problem = problems[number];
      for (int round = 0; round < rounds && problem.empty(); ++round) {
        problem = client.round(round + static_cast<int>(number));
        ++done;
      }
      done += problem.empty() ? 0 : rounds;
    });
  }
  for (int reload = 1; reload <= kReloads; ++reload) {
    while (done < kClients * rounds * reload / (kReloads + 1)) {
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    kill(server.process(), SIGHUP);
  }
  for (std::thread& client : clients) client.join();
  for (const std::string& problem : problems) EXPECT_EQ(problem, "");
  EXPECT_EQ(server.stop(), 0);
  const std::string log = TemporaryTree::read(tree.root() / "log");
  EXPECT_NE(log.find(" reloaded\n"), std::string::npos);
  EXPECT_EQ(log.find("failed"), std::string::npos);
}
