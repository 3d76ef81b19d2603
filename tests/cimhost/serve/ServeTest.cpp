// The program `cimhost serve` as a process: start, signals, reload, end.

#include "../../support/TemporaryTree.h"
#include "../http/HttpClient.h"

#include "cimhost/CommandLine.h"
#include "cimhost/serve/RequestGate.h"

#include <gmock/gmock.h>

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <spawn.h>
#include <sys/un.h>
#include <sys/wait.h>

#include <functional>
#include <sstream>
#include <thread>

extern char** environ;

namespace {

using namespace cimhost;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

std::string definitionsOf(const std::vector<std::string>& classes) {
  std::string text = "<plugin>";
  for (const std::string& name : classes) {
    text += "<class name=\"" + name +
            "\" namespace=\"root/test\"><instances><constant type=\"int\">1</constant></instances>"
            "</class>";
  }
  return text + "</plugin>";
}

std::string enumerate(const std::string& className) {
  const std::string body =
      "<?xml version=\"1.0\"?><CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
      "PROTOCOLVERSION=\"1.0\"><SIMPLEREQ><IMETHODCALL NAME=\"EnumerateInstances\">"
      "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"test\"/>"
      "</LOCALNAMESPACEPATH><IPARAMVALUE NAME=\"ClassName\"><CLASSNAME NAME=\"" +
      className + "\"/></IPARAMVALUE></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
  return "POST /cimom HTTP/1.1\r\nHost: x\r\nCIMOperation: MethodCall\r\nCIMMethod: "
         "EnumerateInstances\r\nCIMObject: root/test\r\nContent-Length: " +
         std::to_string(body.size()) + "\r\n\r\n" + body;
}

class ServeTest : public testing::Test {
 protected:
  ServeTest() {
    std::filesystem::create_directories(tree_.root() / "mof/root/test");
    write("mof/root/test/classes.mof",
          "class Test_Disk { [Key] string Name; };\nclass Test_Waits { [Key] string Name; };\n"
          "class Test_Prints { [Key] string Name; };\n");
    write("run/test.xml", definitionsOf({"Test_Disk", "Test_Waits", "Test_Prints"}));
    setenv("TEST_PROVIDER_TRACE", path("trace").c_str(), 1);
    setenv("TEST_PROVIDER_GO", path("go").c_str(), 1);
  }
  ~ServeTest() override {
    if (process_ > 0) {
      kill(process_, SIGKILL);
      waitpid(process_, nullptr, 0);
    }
    if (out_ >= 0) close(out_);
    for (const char* name : {"TEST_PROVIDER_TRACE", "TEST_PROVIDER_GO", "NOTIFY_SOCKET"}) {
      unsetenv(name);
    }
  }

  std::string path(const std::string& name) const { return (tree_.root() / name).string(); }
  void write(const std::string& name, const std::string& text) const {
    TemporaryTree::write(tree_.root() / name, text);
  }
  std::string read(const std::string& name) const {
    return TemporaryTree::read(tree_.root() / name);
  }

  /// Starts the program; its standard error goes to the file `log`.
  void start(std::vector<std::string> options = {}) {
    std::vector<std::string> all = {
        CIMHOST_FILE, "--home", tree_.root().string(), "--provider", TEST_PROVIDER_FILE, "serve",
        "--port",     "0"};
    all.insert(all.end(), options.begin(), options.end());
    std::vector<char*> argv;
    for (std::string& each : all) argv.push_back(each.data());
    argv.push_back(nullptr);
    int ends[2];
    ASSERT_EQ(pipe2(ends, O_CLOEXEC), 0);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, ends[1], STDOUT_FILENO);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, path("log").c_str(),
                                     O_WRONLY | O_CREAT | O_APPEND, 0600);
    ASSERT_EQ(posix_spawn(&process_, argv[0], &actions, nullptr, argv.data(), environ), 0);
    posix_spawn_file_actions_destroy(&actions);
    close(ends[1]);
    out_ = ends[0];
    readAddress();
  }

  /// Waits until a file of the home directory holds a text.
  void await(const std::string& file, const std::string& text) const {
    for (int i = 0; i < 2000 && read(file).find(text) == std::string::npos; ++i) usleep(10000);
    ASSERT_THAT(read(file), HasSubstr(text));
  }

  void signal(int number) const { kill(process_, number); }

  /// The exit code; 128 + signal when one ended it.
  int wait() {
    int status = 0;
    waitpid(process_, &status, 0);
    process_ = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  }

  std::string instancesOf(const std::string& className) const {
    return HttpClient(port_).ask(enumerate(className)).body;
  }

  /// All that standard output has got, once the process has ended.
  std::string restOfOutput() const {
    std::string text;
    char bytes[256];
    for (ssize_t got = 0; (got = ::read(out_, bytes, sizeof bytes)) > 0;) {
      text.append(bytes, static_cast<std::size_t>(got));
    }
    return text;
  }

  std::string address_;
  std::uint16_t port_ = 0;

 private:
  void readAddress() {
    char byte = 0;
    while (::read(out_, &byte, 1) == 1 && byte != '\n') address_ += byte;
    port_ = static_cast<std::uint16_t>(
        std::strtoul(address_.c_str() + address_.rfind(':') + 1, nullptr, 10));
  }

  TemporaryTree tree_;
  pid_t process_ = 0;
  int out_ = -1;
};

TEST_F(ServeTest, ServesUntilASignalAndTerminatesTheProvider) {
  start();
  EXPECT_THAT(address_, ContainsRegex("^cimhost: listening on http://127\\.0\\.0\\.1:[0-9]+$"));
  EXPECT_THAT(instancesOf("Test_Disk"), HasSubstr(">b</KEYVALUE>"));
  EXPECT_THAT(instancesOf("Test_Prints"), Not(HasSubstr("ERROR")));
  signal(SIGTERM);
  EXPECT_EQ(wait(), 0);
  EXPECT_EQ(read("trace"), "create\ninitialize\nterminate\n");
  // What the provider prints is not the server's.
  EXPECT_EQ(restOfOutput(), "");
  EXPECT_THAT(read("log"), HasSubstr("operation=EnumerateInstances "
                                     "target=root/test:Test_Disk http=200 cim=0 objects=2 "));
  EXPECT_THAT(read("log"), HasSubstr("stopped"));
}

TEST_F(ServeTest, ARunningRequestEndsFirst) {
  start();
  HttpClient client(port_);
  client.send(enumerate("Test_Waits"));
  await("trace", "waiting");
  signal(SIGINT);
  await("log", "shutting down");
  write("go", "");
  EXPECT_THAT(client.receive().body, HasSubstr("waited"));
  EXPECT_EQ(wait(), 0);
  EXPECT_EQ(read("trace"), "create\ninitialize\nwaiting\nterminate\n");
}

TEST_F(ServeTest, ASecondSignalEndsItAtOnce) {
  start();
  HttpClient client(port_);
  client.send(enumerate("Test_Waits"));
  await("trace", "waiting");
  signal(SIGTERM);
  await("log", "shutting down");
  signal(SIGTERM);
  EXPECT_EQ(wait(), 128 + SIGTERM);
}

TEST_F(ServeTest, ARequestThatNeverEndsKeepsItNot) {
  start({"--shutdown-timeout", "1"});
  HttpClient client(port_);
  client.send(enumerate("Test_Waits"));
  await("trace", "waiting");
  signal(SIGTERM);
  EXPECT_EQ(client.receive().status, 503);
  EXPECT_EQ(wait(), ExitCode::kHung);
}

TEST_F(ServeTest, ReloadsOnlyWhatIsRight) {
  start({"--log", path("requests")});
  write("run/new.xml", "<plugin><class></plugin>");
  signal(SIGHUP);
  await("requests", "reload failed");
  EXPECT_THAT(read("requests"), HasSubstr("\nrun/new.xml:1:"));
  EXPECT_THAT(instancesOf("Test_Disk"), HasSubstr(">b<"));
  EXPECT_EQ(read("trace"), "create\ninitialize\n");

  write("mof/root/test/new.mof", "class Test_BigDisk { [Key] string Name; };\n");
  write("run/new.xml", definitionsOf({"Test_BigDisk"}));
  EXPECT_THAT(instancesOf("Test_BigDisk"), HasSubstr("<ERROR CODE=\"5\""));
  std::filesystem::rename(path("requests"), path("requests.1"));
  signal(SIGHUP);
  await("requests", "reloaded");
  EXPECT_THAT(instancesOf("Test_BigDisk"), HasSubstr(">big<"));
  EXPECT_EQ(read("trace"), "create\ninitialize\nterminate\ncreate\ninitialize\n");
  signal(SIGTERM);
  EXPECT_EQ(wait(), 0);
}

TEST_F(ServeTest, ReloadWaitsForRunningRequests) {
  start();
  HttpClient client(port_);
  client.send(enumerate("Test_Waits"));
  await("trace", "waiting");
  signal(SIGHUP);
  write("go", "");
  EXPECT_THAT(client.receive().body, HasSubstr("waited"));
  await("log", "reloaded");
  EXPECT_EQ(read("trace"), "create\ninitialize\nwaiting\nterminate\ncreate\ninitialize\n");
}

TEST_F(ServeTest, MalformedFilesAreToldAndTheRestServes) {
  write("run/bad.xml", "<plugin>");
  start();
  EXPECT_THAT(read("log"), HasSubstr("run/bad.xml:1:"));
  EXPECT_THAT(instancesOf("Test_Disk"), HasSubstr(">a<"));
}

TEST_F(ServeTest, TheServiceManagerIsTold) {
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  path("notify").copy(address.sun_path, sizeof address.sun_path - 1);
  const int socket = ::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
  ASSERT_EQ(bind(socket, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
  setenv("NOTIFY_SOCKET", path("notify").c_str(), 1);
  start();
  const auto message = [socket] {
    pollfd entry{socket, POLLIN, 0};
    char bytes[256];
    const ssize_t got = poll(&entry, 1, 20000) > 0 ? recv(socket, bytes, sizeof bytes, 0) : 0;
    return std::string(bytes, static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
  };
  EXPECT_EQ(message(), "READY=1");
  signal(SIGHUP);
  EXPECT_THAT(message(), ContainsRegex("^RELOADING=1\nMONOTONIC_USEC=[0-9]+$"));
  EXPECT_EQ(message(), "READY=1");
  signal(SIGTERM);
  EXPECT_EQ(message(), "STOPPING=1");
  EXPECT_EQ(wait(), 0);
  close(socket);
}

TEST_F(ServeTest, WhatCannotStartSaysWhy) {
  const struct {
    std::vector<std::string> options;
    const char* problem;
  } cases[] = {
      {{"--users", "none"}, "none: no such file"},
      {{"--log", "/none/log"}, "/none/log: No such file"},
      {{"--tls-cert", "none", "--tls-key", "none"}, "none: no such file"},
      {{"--bind", "192.0.2.1", "--insecure"}, "cannot listen on 192.0.2.1 port 0"},
  };
  for (const auto& each : cases) {
    start(each.options);
    EXPECT_EQ(wait(), ExitCode::kCannotStart);
    EXPECT_THAT(read("log"), HasSubstr(std::string("cimhost: ")));
    EXPECT_THAT(read("log"), HasSubstr(each.problem));
  }
}

TEST(ServeCommandLine, OtherMachinesNeedTlsAndUsers) {
  const struct {
    std::vector<const char*> options;
    const char* problem;  // Empty: fine.
  } cases[] = {
      {{}, ""},
      {{"--bind", "127.0.0.2"}, ""},
      {{"--bind", "::1"}, ""},
      {{"--bind", "0.0.0.0"}, "it needs --tls-cert"},
      {{"--bind", "::"}, "it needs --tls-cert"},
      {{"--bind", "::ffff:127.0.0.1"}, "it needs --tls-cert"},
      {{"--bind", "0.0.0.0", "--insecure"}, ""},
      {{"--bind", "0.0.0.0", "--users", "u"}, "it needs --tls-cert"},
      {{"--bind", "0.0.0.0", "--tls-cert", "c", "--tls-key", "k"}, "it needs --tls-cert"},
      {{"--bind", "0.0.0.0", "--tls-cert", "c", "--tls-key", "k", "--users", "u"}, ""},
      {{"--tls-cert", "c"}, "go together"},
      {{"--bind", "localhost"}, "not an IPv4 or IPv6 address"},
      {{"--port", "65536"}, "--port"},
      {{"--threads", "0"}, "--threads"},
      {{"--idle-timeout", "0"}, "--idle-timeout"},
      {{"--max-request-size", "1"}, "--max-request-size"},
      {{"--max-request-size", "1048576"}, ""},
  };
  for (const auto& each : cases) {
    std::vector<const char*> argv = {"cimhost", "--home", "h", "serve"};
    argv.insert(argv.end(), each.options.begin(), each.options.end());
    std::ostringstream out;
    std::ostringstream error;
    int code = -1;
    const auto line =
        parseCommandLine(static_cast<int>(argv.size()), argv.data(), out, error, code);
    EXPECT_EQ(line.has_value(), *each.problem == '\0') << error.str();
    EXPECT_THAT(error.str(), HasSubstr(each.problem));
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
  EXPECT_EQ(inside, 0);
  gate.open();
  late.join();
  EXPECT_EQ(inside, 1);
}

}  // namespace
