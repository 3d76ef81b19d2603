// The program `cimhost serve` as a process: start, signals, reload, end.

#include "../../support/TemporaryTree.h"
#include "../http/HttpClient.h"

#include "cimhost/CommandLine.h"
#include "cimhost/serve/RequestGate.h"

#include <gmock/gmock.h>

#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/un.h>
#include <sys/wait.h>

#include <thread>

extern char** environ;

namespace {

using namespace cimhost;
using testing::HasSubstr;
using testing::MatchesRegex;
using testing::Not;

std::string enumerate(const std::string& className, const std::string& header = "") {
  const std::string body =
      "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='1' PROTOCOLVERSION='1.0'><SIMPLEREQ>"
      "<IMETHODCALL NAME='EnumerateInstances'><LOCALNAMESPACEPATH><NAMESPACE NAME='root'/>"
      "<NAMESPACE NAME='test'/></LOCALNAMESPACEPATH><IPARAMVALUE NAME='ClassName'><CLASSNAME "
      "NAME='" +
      className + "'/></IPARAMVALUE></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
  return "POST /cimom HTTP/1.1\r\nHost: x\r\nCIMOperation: MethodCall\r\nCIMMethod: "
         "EnumerateInstances\r\nCIMObject: root/test\r\n" +
         header + "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
}

// The name and the password: as a line of a users file, and as a request gives them.
const std::string kHash =
    ":$6$rounds=1000$saltsalt$LAV5VE5Y7w1d73x1mFNspYWUpazfmwv2SoepNXNKJ/"
    "otop/Zok96Hr8Q13LEv0DRY/x8v0/crpIjl8NJSAqXV/\n";
const std::string kAlice = "Authorization: Basic YWxpY2U6c2VjcmV0\r\n";
const std::string kBob = "Authorization: Basic Ym9iOnNlY3JldA==\r\n";

class ServeTest : public testing::Test {
 protected:
  ServeTest() {
    for (const char* name : {"Test_Disk", "Test_Waits", "Test_Prints"}) define(name);
    setenv("TEST_PROVIDER_TRACE", path("trace").c_str(), 1);
    setenv("TEST_PROVIDER_GO", path("go").c_str(), 1);
    setenv("TEST_PROVIDER_FAILS_ONCE", path("fails").c_str(), 1);
  }
  ~ServeTest() override {
    if (process_ > 0) {
      kill(process_, SIGKILL);
      waitpid(process_, nullptr, 0);
    }
    unsetenv("NOTIFY_SOCKET");
  }

  std::string path(const std::string& name) const { return (tree_.root() / name).string(); }
  void write(const std::string& name, const std::string& text) const {
    TemporaryTree::write(tree_.root() / name, text);
  }
  /// Declares and defines a class, in files of its name.
  void define(const std::string& name) const {
    write("mof/root/test/" + name + ".mof", "class " + name + " { [Key] string Name; };\n");
    write("run/" + name + ".xml", "<plugin><class name=\"" + name +
                                      "\" namespace=\"root/test\"><instances><constant "
                                      "type=\"int\">1</constant></instances></class></plugin>");
  }
  std::string read(const std::string& name) const {
    return TemporaryTree::read(tree_.root() / name);
  }

  /// Starts the program with `options`; what it prints goes to the files `out` and `log`.
  void start(const std::string& options) {
    const std::string command = "exec " CIMHOST_FILE " --home " + path(".") +
                                " --provider " TEST_PROVIDER_FILE " serve --port 0 " + options +
                                " >" + path("out") + " 2>>" + path("log");
    const char* const words[] = {"sh", "-c", command.c_str(), nullptr};
    char* const* const arguments = const_cast<char* const*>(words);
    ASSERT_EQ(posix_spawn(&process_, "/bin/sh", nullptr, nullptr, arguments, environ), 0);
  }

  void serve(const std::string& options = "") {
    start(options);
    await("out", "\n");
    const std::string address = read("out");
    port_ = static_cast<std::uint16_t>(std::stoi(address.substr(address.rfind(':') + 1)));
  }

  /// Waits until a file of the home directory holds a text.
  void await(const std::string& file, const std::string& text) const {
    for (int i = 0; i < 2000 && read(file).find(text) == std::string::npos; ++i) usleep(10000);
    ASSERT_THAT(read(file), HasSubstr(text));
  }

  /// As serve(), and a request runs until there is a file `go`.
  void serveARequest(const std::string& options = "") {
    serve(options);
    client_.emplace(port_).send(enumerate("Test_Waits"));
    await("trace", "waiting");
  }

  void signal(int number) const { kill(process_, number); }

  /// The exit code; 128 + signal when one ended it.
  int wait() {
    int status = 0;
    waitpid(process_, &status, 0);
    process_ = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  }

  std::string instancesOf(const std::string& className, const std::string& header = "") const {
    return HttpClient(port_).ask(enumerate(className, header)).body;
  }

  std::uint16_t port_ = 0;
  std::optional<HttpClient> client_;

 private:
  TemporaryTree tree_;
  pid_t process_ = 0;
};

// What of the files is right.
TEST_F(ServeTest, ServesUntilASignalAndTerminatesTheProvider) {
  write("run/bad.xml", "<plugin>");
  serve();
  EXPECT_THAT(read("log"), HasSubstr("run/bad.xml:1:"));
  EXPECT_THAT(instancesOf("Test_Disk"), HasSubstr(">b</KEYVALUE>"));
  EXPECT_THAT(instancesOf("Test_Prints"), Not(HasSubstr("ERROR")));
  signal(SIGTERM);
  EXPECT_EQ(wait(), 0);
  EXPECT_EQ(read("trace"), "create\ninitialize\nterminate\n");
  // What the provider prints is not the server's.
  EXPECT_THAT(read("out"), MatchesRegex("cimhost: listening on http://127\\.0\\.0\\.1:[0-9]+\n"));
  EXPECT_THAT(read("log"), HasSubstr("operation=EnumerateInstances "
                                     "target=root/test:Test_Disk http=200 cim=0 objects=2 "));
  EXPECT_THAT(read("log"), HasSubstr("stopped"));
}

TEST_F(ServeTest, ARunningRequestEndsFirst) {
  serveARequest();
  signal(SIGINT);
  await("log", "shutting down");
  write("go", "");
  EXPECT_THAT(client_->receive().body, HasSubstr("waited"));
  EXPECT_EQ(wait(), 0);
  EXPECT_EQ(read("trace"), "create\ninitialize\nwaiting\nterminate\n");
}

TEST_F(ServeTest, ASecondSignalEndsItAtOnce) {
  serveARequest();
  signal(SIGTERM);
  await("log", "shutting down");
  signal(SIGTERM);
  EXPECT_EQ(wait(), 128 + SIGTERM);
}

TEST_F(ServeTest, ARequestThatNeverEndsKeepsItNot) {
  serveARequest("--shutdown-timeout 1");
  signal(SIGTERM);
  EXPECT_EQ(client_->receive().status, 503);
  EXPECT_EQ(wait(), ExitCode::kHung);
}

// All or nothing: a file or a provider that fails leaves everything as it was.
TEST_F(ServeTest, ReloadsOnlyWhatIsRight) {
  const std::string started = "create\ninitialize\n";
  write("users", "alice" + kHash);
  serve("--log " + path("requests") + " --users " + path("users"));
  const auto expectTheOld = [&](const std::string& problem) {
    signal(SIGHUP);
    await("requests", problem);
    EXPECT_THAT(instancesOf("Test_Disk", kAlice), HasSubstr(">b<"));
    EXPECT_THAT(instancesOf("Test_BigDisk", kAlice), HasSubstr("<ERROR CODE=\"5\""));
    EXPECT_EQ(instancesOf("Test_Disk", kBob), "not authorized\n");
  };
  write("users", "bob" + kHash);
  define("Test_BigDisk");
  write("run/bad.xml", "<plugin><class></plugin>");
  expectTheOld("reload failed; what was served before goes on:\nrun/bad.xml:1:");
  write("run/bad.xml", "<plugin></plugin>");
  write("mof/root/test/bad.mof", "class Bad { [Key] string; };\n");
  expectTheOld("mof/root/test/bad.mof:1:");
  EXPECT_EQ(read("trace"), started);
  write("mof/root/test/bad.mof", "");
  write("fails", "");
  expectTheOld("no luck");
  EXPECT_EQ(read("trace"), started + "terminate\n" + started + "terminate\n" + started);
  std::filesystem::rename(path("requests"), path("requests.1"));
  signal(SIGHUP);
  await("requests", "reloaded");
  EXPECT_THAT(instancesOf("Test_BigDisk", kBob), HasSubstr(">big<"));
  EXPECT_EQ(instancesOf("Test_Disk", kAlice), "not authorized\n");
  signal(SIGTERM);
  EXPECT_EQ(wait(), 0);
}

TEST_F(ServeTest, ReloadWaitsForRunningRequests) {
  serveARequest();
  signal(SIGHUP);
  write("go", "");
  EXPECT_THAT(client_->receive().body, HasSubstr("waited"));
  await("log", "reloaded");
  EXPECT_EQ(read("trace"), "create\ninitialize\nwaiting\nterminate\ncreate\ninitialize\n");
}

TEST_F(ServeTest, TheServiceManagerIsTold) {
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  path("notify").copy(address.sun_path, sizeof address.sun_path - 1);
  const int socket = ::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
  ASSERT_EQ(bind(socket, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
  setenv("NOTIFY_SOCKET", path("notify").c_str(), 1);
  serve();
  const auto message = [socket] {
    pollfd entry{socket, POLLIN, 0};
    char bytes[256];
    const ssize_t got = poll(&entry, 1, 20000) > 0 ? recv(socket, bytes, sizeof bytes, 0) : 0;
    return std::string(bytes, static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
  };
  EXPECT_EQ(message(), "READY=1");
  signal(SIGHUP);
  EXPECT_THAT(message(), MatchesRegex("RELOADING=1\nMONOTONIC_USEC=[0-9]+"));
  EXPECT_EQ(message(), "READY=1");
  signal(SIGTERM);
  EXPECT_EQ(message(), "STOPPING=1");
  EXPECT_EQ(wait(), 0);
  close(socket);
}

TEST_F(ServeTest, WhatCannotStartSaysWhy) {
  const struct {
    const char *options, *problem;
  } cases[] = {
      {"--users none", "none: no such file"},
      {"--log /none/log", "/none/log: No such file"},
      {"--tls-cert none --tls-key none", "none: no such file"},
      {"--bind 192.0.2.1 --insecure", "cannot listen on 192.0.2.1 port 0"},
  };
  for (const auto& row : cases) {
    write("log", "");
    start(row.options);
    EXPECT_EQ(wait(), ExitCode::kCannotStart);
    EXPECT_THAT(read("log"), HasSubstr(row.problem));
  }
}

TEST(RequestGateTest, ClosingWaitsForThoseInsideAndHoldsTheOthers) {
  RequestGate gate;
  std::atomic<int> inside{0};
  {
    const RequestGate::Pass first(gate);
    const RequestGate::Pass second(gate);
    EXPECT_FALSE(gate.close(std::chrono::milliseconds(1)));
    const RequestGate::Pass third(gate);
  }
  ASSERT_TRUE(gate.close(std::chrono::seconds(20)));
  std::thread late([&] {
    const RequestGate::Pass pass(gate);
    ++inside;
  });
  std::this_thread::sleep_for(std::chrono::milliseconds(50));
  EXPECT_EQ(inside, 0);
  gate.open();
  late.join();
  EXPECT_EQ(inside, 1);
}

}  // namespace
