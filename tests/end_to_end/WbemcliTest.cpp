// `cimhost serve` as people meet it: every command of a stock client, and what it prints.

#include <gmock/gmock.h>
#include <unistd.h>

#include <memory>
#include <regex>
#include <tuple>

#include "tests/compared/ComparedClasses.h"
#include "tests/support/CimhostServer.h"
#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

namespace {

constexpr const char* kClient = "/usr/bin/wbemcli";

// The client prints nothing else when it fails, and its exit code tells no failures apart.
constexpr int kFailed = 16;
std::string failure(const std::string& text) {
  return "*\n* " + std::string(kClient) + ": " + text + "\n*\n";
}

// Arguments as one text, values in single quotes; `:Class` is one of the served namespace.
std::vector<std::string> words(const std::string& text) {
  static const std::regex word("'([^']*)'|([^ ]+)");
  std::vector<std::string> all;
  for (std::sregex_iterator match(text.begin(), text.end(), word), end; match != end; ++match) {
    all.push_back((*match)[1].matched ? (*match)[1] : (*match)[2]);
  }
  return all;
}

struct Exchange {
  std::string arguments, out, error;
};

std::vector<Exchange> transcript() {
  std::istringstream lines(TemporaryTree::read(TRANSCRIPT));
  std::vector<Exchange> exchanges;
  for (std::string line; std::getline(lines, line);) {
    if (line.rfind("$ wbemcli ", 0) == 0) {
      exchanges.push_back({line.substr(10), "", ""});
    } else if (line.rfind("! ", 0) == 0) {
      exchanges.back().error = line.substr(2);
    } else if (line.rfind("# ", 0) != 0) {
      exchanges.back().out += line + "\n";
    }
  }
  return exchanges;
}

class Wbemcli : public testing::Test {
 protected:
  void SetUp() override {
    if (access(kClient, X_OK) != 0) GTEST_SKIP() << "wbemcli (sblim-wbemcli) is not installed";
    setenv("no_proxy", "127.0.0.1", 1);
    writeComparedHome(tree_.root() / "compare");
    serve();
  }

  // What a sanitizer has seen is in the exit code.
  void TearDown() override { EXPECT_EQ(server_ == nullptr ? 0 : server_->stop(), 0); }

  void serve(std::vector<std::string> options = {}) {
    options.insert(options.end(), {"--log", (tree_.root() / "log").string()});
    server_ =
        std::make_unique<CimhostServer>(CIMHOST, (tree_.root() / "compare").string(), options);
  }

  ProgramResult run(const std::string& arguments, const std::string& before = "http://") const {
    const std::string address = "127.0.0.1:" + std::to_string(server_->port());
    std::vector<std::string> command = {"/usr/bin/timeout", "60", kClient};
    for (std::string& word : words(arguments)) {
      if (word[0] == ':') word = "/root/compare" + (word == ":" ? "" : word);
      if (word.rfind("/root/", 0) == 0) word = before + address + word;
      command.push_back(word);
    }
    ProgramResult result = runProgram(command);
    char host[256] = "";
    gethostname(host, sizeof host);
    const auto shorten = [&](const std::string& name, const char* letter) {
      result.out = std::regex_replace(result.out, std::regex(name + "/root/compare:"), letter);
    };
    shorten(address, "S/");
    shorten(host, "H/");
    return result;
  }

  TemporaryTree tree_;
  std::unique_ptr<CimhostServer> server_;
};

}  // namespace

TEST_F(Wbemcli, PrintsWhatTheTranscriptShows) {
  const std::vector<Exchange> exchanges = transcript();
  EXPECT_GT(exchanges.size(), 50u);
  for (const auto& [arguments, out, error] : exchanges) {
    SCOPED_TRACE(arguments);
    const ProgramResult result = run(arguments);
    EXPECT_EQ(result.code, error.empty() ? 0 : kFailed);
    EXPECT_EQ(result.out, out);
    EXPECT_EQ(result.err, error.empty() ? "" : failure(error));
  }
}

TEST_F(Wbemcli, SeesAReplyAsItIsOnTheWire) {
  EXPECT_THAT(
      run("-dx gi ':Cmp_Part.Name=\"part 5\"' Owner").err,
      testing::HasSubstr(
          "From server: Content-Type: application/xml; charset=\"utf-8\"\n"
          "From server: CIMOperation: MethodResponse\n"
          "From server: Content-Length: 402\n"
          "From server: <?xml version=\"1.0\" encoding=\"utf-8\" ?>\n"
          "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n"
          "<MESSAGE ID=\"4711\" PROTOCOLVERSION=\"1.0\">\n<SIMPLERSP>\n"
          "<IMETHODRESPONSE NAME=\"GetInstance\">\n<IRETURNVALUE>\n"
          "<INSTANCE CLASSNAME=\"Cmp_Part\"><PROPERTY NAME=\"Owner\" TYPE=\"string\" "
          "CLASSORIGIN=\"Cmp_Part\"><VALUE>&lt;&amp;&gt;'&quot;\\</VALUE></PROPERTY></INSTANCE>\n"
          "</IRETURNVALUE>\n</IMETHODRESPONSE>\n</SIMPLERSP>\n</MESSAGE>\n</CIM>\n"));
}

TEST_F(Wbemcli, ShowsItsPasswordOnceItTrustsTheCertificate) {
  const std::string folder = tree_.root().string();
  ASSERT_EQ(runProgram({"/usr/bin/openssl", "req", "-x509", "-newkey", "rsa:2048", "-nodes",
                        "-subj", "/CN=localhost", "-addext", "subjectAltName=IP:127.0.0.1",
                        "-keyout", folder + "/key", "-out", folder + "/certificate"})
                .code,
            0);
  // SHA-512 crypt of "secret".
  TemporaryTree::write(folder + "/users",
                       "anna:$6$saltsalt$TVLlQcbpFVof5W3Yz4DTP6gRstiNuHwwTt6GLc1E5n0U"
                       "0aDehy0S5knV8wiOQSpT0Y77vwPZN.Pq.H91p5hVO1\n");
  serve({"--bind", "0.0.0.0", "--users", folder + "/users", "--tls-cert", folder + "/certificate",
         "--tls-key", folder + "/key"});
  const std::string trusting = "-cacert " + folder + "/certificate ecn :Cmp_Element";
  EXPECT_EQ(run(trusting, "https://anna:secret@").out, "S/Cmp_SubElement\n");
  const std::tuple<std::string, const char*, const char*> refused[] = {
      {"ecn :Cmp_Element", "anna:secret@", "SSL peer certificate or SSH remote key was not OK"},
      {trusting, "", "Username/password required."},
      {trusting, "anna:wrong@", "Invalid username/password."},
      {trusting, "bert:secret@", "Invalid username/password."}};
  for (const auto& [command, user, message] : refused) {
    const ProgramResult result = run(command, std::string("https://") + user);
    EXPECT_EQ(result.code, kFailed) << user;
    EXPECT_EQ(result.err, failure(std::string("Http Exception: ") + message)) << user;
  }
}
