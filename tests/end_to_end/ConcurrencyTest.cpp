// Many clients at once, each with a connection that stays. COMMONPROVIDER_REQUESTS is how many
// requests each of them sends; 1000 belong to a run under the thread sanitizer.

#include <gmock/gmock.h>

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

const std::string kNamespace =
    "<LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE NAME='compare'/>"
    "</LOCALNAMESPACEPATH>";

std::string message(const std::string& method, const std::string& object, const std::string& call) {
  const std::string body =
      "<?xml version='1.0' encoding='utf-8'?>\n<CIM CIMVERSION='2.0' DTDVERSION='2.0'>"
      "<MESSAGE ID='1' PROTOCOLVERSION='1.0'><SIMPLEREQ>" +
      call + "</SIMPLEREQ></MESSAGE></CIM>";
  return "POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Type: application/xml\r\n"
         "CIMOperation: MethodCall\r\nCIMMethod: " +
         method + "\r\nCIMObject: " + object +
         "\r\nContent-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
}

std::string operation(const std::string& name, const std::string& parameters) {
  return message(name, "root%2Fcompare",
                 "<IMETHODCALL NAME='" + name + "'>" + kNamespace + parameters + "</IMETHODCALL>");
}

std::string parameter(const std::string& name, const std::string& content) {
  return "<IPARAMVALUE NAME='" + name + "'>" + content + "</IPARAMVALUE>";
}

std::string className(const std::string& name) {
  return parameter("ClassName", "<CLASSNAME NAME='" + name + "'/>");
}

std::string path(const std::string& className, const std::string& key) {
  return "<INSTANCENAME CLASSNAME='" + className + "'><KEYBINDING NAME='Name'><KEYVALUE>" + key +
         "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

struct Exchange {
  std::string request, expected;
};

// What a client asks in turn. It has one property of one of the four instances to itself, reads it
// right after it has written it, and begins elsewhere than the others.
Exchange exchange(std::size_t client, int number) {
  number += static_cast<int>(client);
  const int round = number / 9;
  const std::string value = std::to_string(round % 256);
  const std::string part = "part " + std::to_string(round % 6);
  const std::string property[] = {"S32", "U64", "U8", "Text"};
  const std::string place =
      parameter("InstanceName", path("Cmp_Stored", client % 2 == 0 ? "plain" : "a b,c=d.e:f")) +
      parameter("PropertyName", "<VALUE>" + property[client / 2] + "</VALUE>");
  switch (number % 9) {
    case 0:
      return {operation("EnumerateInstances", className("Cmp_Named")), "<VALUE>&lt;two&gt;"};
    case 1:
      return {operation("GetInstance", parameter("InstanceName", path("Cmp_Part", part))),
              "<VALUE>" + part + "</VALUE>"};
    case 2:
      return {message("Echo", "root%2Fcompare%3ACmp_Element",
                      "<METHODCALL NAME='Echo'><LOCALCLASSPATH>" + kNamespace +
                          "<CLASSNAME NAME='Cmp_Element'/></LOCALCLASSPATH>"
                          "<PARAMVALUE NAME='In0'><VALUE>TRUE</VALUE></PARAMVALUE>"
                          "<PARAMVALUE NAME='In1'><VALUE>" +
                          value + "</VALUE></PARAMVALUE></METHODCALL>"),
              "<VALUE>" + value + "</VALUE>"};
    case 3:
      return {operation("Associators", parameter("ObjectName", path("Cmp_Part", "part 2"))),
              "<INSTANCE CLASSNAME=\"Cmp_Stored\">"};
    case 4:
      return {operation("GetClass", className("Cmp_Element")), "<METHOD NAME=\"Echo\""};
    case 5:
      return {operation("EnumerateInstanceNames", className("Cmp_Element")),
              "<KEYVALUE VALUETYPE=\"numeric\">4</KEYVALUE>"};
    case 6:
      return {operation("GetInstance", parameter("InstanceName", path("Cmp_Part", "none"))),
              "<ERROR CODE=\"1\""};
    case 7:
      return {
          operation("SetProperty", place + parameter("NewValue", "<VALUE>" + value + "</VALUE>")),
          "\"SetProperty\">\n</IMETHODRESPONSE>"};
    default:
      return {operation("GetProperty", place), "<VALUE>" + value + "</VALUE>"};
  }
}

// What is wrong with the reply, or nothing.
std::string ask(HttpClient& client, const Exchange& exchange) {
  const HttpReply reply = client.ask(exchange.request);
  const bool found = reply.body.find(exchange.expected) != std::string::npos;
  if (reply.status == 200 && reply.complete && found) return {};
  return exchange.request + "\n" + std::to_string(reply.status) + "\n" + reply.body + "\n";
}

}  // namespace

// The definitions are read anew meanwhile. A report of the thread sanitizer is in the exit code.
TEST(Concurrency, ClientsDoNotDisturbEachOther) {
  const TemporaryTree tree;
  writeComparedHome(tree.root() / "home");
  CimhostServer server(CIMHOST, (tree.root() / "home").string(),
                       {"--threads", "8", "--log", (tree.root() / "log").string()});
  const char* const text = std::getenv("COMMONPROVIDER_REQUESTS");
  const int requests = text == nullptr ? 100 : std::atoi(text);
  std::atomic<int> done{0};
  std::vector<std::string> problems(kClients);
  std::vector<std::thread> clients;
  for (std::size_t number = 0; number < kClients; ++number) {
    clients.emplace_back([&, number] {
      HttpClient client(static_cast<std::uint16_t>(server.port()));
      std::string& problem = problems[number];
      for (int i = 0; i < requests && problem.empty(); ++i) {
        problem = ask(client, exchange(number, i));
        ++done;
      }
      done += problem.empty() ? 0 : requests;
    });
  }
  for (int reload = 1; reload <= kReloads; ++reload) {
    while (done < kClients * requests * reload / (kReloads + 1)) {
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    kill(server.process(), SIGHUP);
  }
  for (std::thread& client : clients) client.join();
  EXPECT_THAT(problems, testing::Each(""));
  EXPECT_EQ(server.stop(), 0);
  const std::string log = TemporaryTree::read(tree.root() / "log");
  EXPECT_THAT(log, testing::HasSubstr(" reloaded\n"));
  EXPECT_THAT(log, Not(testing::HasSubstr("failed")));
}
