// `cimhost serve` as people meet it: every command of a stock client, and what it prints.

#include <gmock/gmock.h>
#include <unistd.h>

#include <algorithm>
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
  const char* arguments;
  std::string out;         // S/ stands for the server's address and the namespace, H/ for its name.
  std::string error = "";  // Empty: success.
};

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

  void expect(const std::vector<Exchange>& exchanges) const {
    for (const Exchange& each : exchanges) {
      SCOPED_TRACE(each.arguments);
      const ProgramResult result = run(each.arguments);
      EXPECT_EQ(result.code, each.error.empty() ? 0 : kFailed);
      EXPECT_EQ(result.out, each.out);
      EXPECT_EQ(result.err, each.error.empty() ? "" : failure(each.error));
    }
  }

  TemporaryTree tree_;
  std::unique_ptr<CimhostServer> server_;
};

}  // namespace

TEST_F(Wbemcli, ReadsInstances) {
  expect({
      {"ei :Cmp_Element C16",
       "S/Cmp_Element.Name=\"plain\",Number=1 C16=A\n"
       "S/Cmp_Element.Name=\"a b,c=d.e:f\",Number=2 C16=\u00E4\n"
       "S/Cmp_Element.Name=\"<&>'\\\"\\\\\",Number=3 C16=\u20AC\n"
       "S/Cmp_Element.Name=\"\u00E4\u20AC\",Number=4 C16=~\n"
       "S/Cmp_SubElement.Name=\"plain\",Number=1 C16=A\n"
       "S/Cmp_SubElement.Name=\"a b,c=d.e:f\",Number=2 C16=\u00E4\n"},
      {"-nl gi ':Cmp_Element.Name=\"\u00E4\u20AC\",Number=4'",
       "S/Cmp_Element.Name=\"\u00E4\u20AC\",Number=\"4\"\n-Name=\"\u00E4\u20AC\"\n-Number=4\n"
       "-Label=\"element 3\"\n-Flag=TRUE\n-U8=135\n-S8=-121\n-U16=54919\n-S16=-10617\n"
       "-U32=1234567\n-S32=1234567\n-U64=1234567\n-S64=1234567\n-R32=1234567.0\n-R64=1234567.0\n"
       "-C16=~\n-Time=00000001020304.000005:000\n-Flags=TRUE,TRUE,TRUE\n-U8s=1,65,253\n"
       "-S16s=1,65,-3\n-U64s=1,65,18446744073709551613\n-R64s=1.0,65.0,-3.0\n"
       "-Texts=\"one\",\"\",\"<two> & \\\"three\\\"\"\n-Times=20260131120000.123456+060,"
       "00000001020304.000005:000,20260131******.******-300\n-NoText=\"\"\n\n"},
      {"-cte ei :Cmp_Empty", ""},
      {"ein :Cmp_Empty", ""},
      {"gi ':Cmp_Part.Name=\"part 4\"' Owner,Nothing",
       "S/Cmp_Part.Name=\"part 4\" Owner=\"<&>'\\\"\\\\\"\n"},
      {"gp ':Cmp_Part.Name=\"part 2\"' Owner", "a b,c=d.e:f\n"},
  });
}

TEST_F(Wbemcli, ReadsBackWhatItHasWritten) {
  expect({
      {"sp ':Cmp_Stored.Name=\"plain\"' S32=-2147483648", ""},
      // It sends the < as it is.
      {"sp ':Cmp_Stored.Name=\"plain\"' 'Text=\"a <b\"'", "",
       "Http Exception: HTTP response code said error"},
      {"sp ':Cmp_Stored.Name=\"plain\"' 'Text=\"\u00E4 b\"'", ""},
      {"sp ':Cmp_Stored.Name=\"plain\"' U8=256", "",
       "Cim: (13) CIM_ERR_TYPE_MISMATCH: parameter NewValue: \"256\" is out of range, 0 to 255"},
      {"mi ':Cmp_Stored.Name=\"plain\"' "
       "'U8=7,Flag=FALSE,R64=-2.0,Time=\"20260228235959.000000-480\",S32s=1,-2,3,Texts=\"x\",\"y "
       "z\"'",
       ""},
      {"mi ':Cmp_Stored.Name=\"plain\"' U8=seven", "",
       "Cim: (4) CIM_ERR_INVALID_PARAMETER: parameter ModifiedInstance: U8 (uint8): \"seven\" is "
       "not an integer"},
      {"gi ':Cmp_Stored.Name=\"plain\"'",
       "S/Cmp_Stored.Name=\"plain\" Name=\"plain\",Flag=FALSE,U8=7,S32=-2147483648,"
       "U64=18446744073709551615,R64=-2.0,Text=\"\u00E4 b\",Time=20260228235959.000000-480,"
       "S32s=1,-2,3,Texts=\"x\",\"y z\"\n"},
      // The others have kept their values.
      {"ei :Cmp_Stored S32,Texts",
       "S/Cmp_Stored.Name=\"plain\" S32=-2147483648,Texts=\"x\",\"y z\"\n"
       "S/Cmp_Stored.Name=\"a b,c=d.e:f\" S32=-1,Texts=\n"
       "S/Cmp_Stored.Name=\"<&>'\\\"\\\\\" S32=-1,Texts=\n"
       "S/Cmp_Stored.Name=\"\u00E4\u20AC\" S32=-1,Texts=\n"},
      // Without a <set>: tolerated, and left alone.
      {"mi ':Cmp_Part.Name=\"part 1\"' 'Owner=\"x\"'", ""},
      {"gp ':Cmp_Part.Name=\"part 1\"' Owner", "plain\n"},
  });
}

TEST_F(Wbemcli, CallsMethods) {
  // The plug-in gives back what comes in, in the order in which it was sent.
  expect({
      {"cm :Cmp_Element Echo.In0=TRUE,In1=255,In2=-7,In3=-2147483648",
       "S/Cmp_Element Echo: 4, Out0 (boolean): TRUE, Out1 (uint8): 255, Out2 (sint16): -7, "
       "Out3 (sint32): -2147483648\n"},
      {"cm :Cmp_Element Echo.In1=256", "",
       "Cim: (4) CIM_ERR_INVALID_PARAMETER: parameter In1: \"256\" is out of range, 0 to 255"},
      {"cm ':Cmp_Element.Name=\"a b,c=d.e:f\",Number=2' Which",
       "S/Cmp_Element.Name=\"a b,c=d.e:f\",Number=2 Which: 0, Index (uint32): 1, Name (string): a "
       "b,c=d.e:f\n"},
      {"cm :Cmp_Empty Nothing", "", "Cim: (17) CIM_ERR_METHOD_NOT_FOUND: Nothing"},
  });
}

TEST_F(Wbemcli, FollowsAssociations) {
  const std::string stored = "H/Cmp_Stored.Name=\"a b,c=d.e:f\"";
  const std::string broken = "H/Cmp_Broken.Name=\"part 2\"";
  expect({
      {"ain ':Cmp_Part.Name=\"part 2\"'", stored + "\n" + broken + "\n"},
      {"-ac Cmp_Owns ain ':Cmp_Part.Name=\"part 2\"'", stored + "\n"},
      {"-arc Cmp_Broken ain ':Cmp_Part.Name=\"part 2\"'", broken + "\n"},
      {"-ar Owned ain ':Cmp_Part.Name=\"part 2\"'", stored + "\n"},
      {"-arr Right ain ':Cmp_Part.Name=\"part 2\"'", broken + "\n"},
      {"ai ':Cmp_Part.Name=\"part 2\"' U64,Text",
       stored + " U64=18446744073709551615,Text=\"20260131120000.123456+060\"\n" + broken +
           " Text=\"fine\"\n"},
      {"ri ':Cmp_Part.Name=\"part 2\"'", ""},
      {"rin ':Cmp_Part.Name=\"part 2\"'", ""},
  });
  EXPECT_THAT(run("ei :Cmp_Owns").out,
              testing::HasSubstr("Owner=root/compare:Cmp_Stored.Name=\"<&>'\\\"\\\\\","
                                 "Owned=root/compare:Cmp_Part.Name=\"part 5\"\n"));
}

TEST_F(Wbemcli, ReadsClasses) {
  expect({
      {"gc :Cmp_Stored", "S/Cmp_Stored Name=,Flag=,U8=,S32=,U64=,R64=,Text=,Time=,S32s=,Texts=\n"},
      {"gcd :Cmp_Part",
       "\n<CLASS NAME=\"Cmp_Part\" SUPERCLASS=\"Cmp_Named\"><PROPERTY NAME=\"Name\" "
       "TYPE=\"string\"></PROPERTY><PROPERTY NAME=\"Owner\" TYPE=\"string\"></PROPERTY></CLASS>\n"
       "\n"},
      {"ecn :Cmp_Named",
       "S/Cmp_Part\nS/Cmp_Element\nS/Cmp_SubElement\nS/Cmp_Stored\nS/Cmp_Broken\n"
       "S/Cmp_NoFunction\nS/Cmp_Empty\nS/Cmp_NoLibrary\nS/Cmp_NotServed\n"},
      {"ec :Cmp_Part", ""},
  });
  const std::string all = run("ec :").out;
  EXPECT_EQ(std::count(all.begin(), all.end(), '\n'), 12) << all;
  EXPECT_THAT(all, testing::HasSubstr("S/Cmp_Owns Owner=,Owned=\nS/Cmp_Beside Left=,Right=\n"));
}

TEST_F(Wbemcli, IsToldWhatCannotBeDone) {
  const std::string refused = "Cim: (7) CIM_ERR_NOT_SUPPORTED: CommonProvider::deleteInstance";
  expect({
      {"ci ':Cmp_Part.Name=\"new\"' 'Name=\"new\"'", "", refused},
      {"di ':Cmp_Part.Name=\"part 2\"'", "", refused},
      {"dc :Cmp_Part", "", "Cim: (7) CIM_ERR_NOT_SUPPORTED: DeleteClass"},
      {"ei :Cmp_Nothing", "", "Cim: (5) CIM_ERR_INVALID_CLASS: Cmp_Nothing"},
      {"ain ':Cmp_Nothing.Name=\"x\"'", "", "Cim: (4) CIM_ERR_INVALID_PARAMETER: Cmp_Nothing"},
      {"gc :Cmp_Nothing", "", "Cim: (6) CIM_ERR_NOT_FOUND: Cmp_Nothing"},
      {"ei /root/nowhere:Cmp_Part", "", "Cim: (3) CIM_ERR_INVALID_NAMESPACE: root/nowhere"},
      {"gp ':Cmp_Part.Name=\"part 2\"' Nothing", "", "Cim: (12) CIM_ERR_NO_SUCH_PROPERTY: Nothing"},
      {"mi ':Cmp_Part.Name=\"part 9\"' 'Owner=\"x\"'", "",
       "Cim: (1) CIM_ERR_FAILED: Too few objects delivered."},
  });
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
