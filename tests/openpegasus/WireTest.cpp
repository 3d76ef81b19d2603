// A stock client against the CIM server and against `cimhost serve`: what it prints is the same.

#include <algorithm>

#include "ServerTest.h"
#include "tests/support/CimhostServer.h"

namespace {

struct RequestCase {
  const char* name;
  const char* command;
  std::string path;  // Behind the namespace's colon; empty for the namespace.
  std::vector<std::string> values = {};
};

// The servers' names, and reals, in one form; the order of the lines does not count.
std::vector<std::string> comparable(const std::string& text) {
  static const std::regex server("(^|[\n ,=\"])[A-Za-z0-9_.-]+(:[0-9]+)?/root/compare:");
  std::istringstream stream(plainReals(std::regex_replace(text, server, "$1")));
  std::vector<std::string> lines;
  for (std::string line; std::getline(stream, line);) lines.push_back(line);
  std::sort(lines.begin(), lines.end());
  return lines;
}

class Wire : public WithServer<testing::TestWithParam<RequestCase>> {
 protected:
  void SetUp() override {
    WithServer::SetUp();
    if (IsSkipped()) return;
    if (access("/usr/bin/wbemcli", X_OK) != 0) GTEST_SKIP() << "No server to compare with wbemcli";
    if (host_ != nullptr) return;
    const std::string home = Deployment::shared().cimhostHome().string();
    host_.reset(new CimhostServer(CIMHOST, home, {"--log", "/dev/null"}));
  }
  static void TearDownTestSuite() {
    host_.reset();
    Deployment::releaseShared();
  }

  static ProgramResult ask(int port) {
    const auto& [name, command, path, values] = GetParam();
    const std::string address = "http://localhost:" + std::to_string(port) + "/root/compare";
    return runProgram({"/usr/bin/timeout", "60", "/usr/bin/wbemcli", command,
                       address + (path.empty() ? "" : ":" + path)},
                      values);
  }

  static std::unique_ptr<CimhostServer> host_;
};

std::unique_ptr<CimhostServer> Wire::host_;

}  // namespace

TEST_P(Wire, BothAnswerAlike) {
  const ProgramResult server = ask(Deployment::shared().server().port());
  const ProgramResult host = ask(host_->port());
  EXPECT_EQ(host.code, server.code);
  EXPECT_EQ(comparable(host.out), comparable(server.out));
  EXPECT_EQ(host.err, server.err);
}

const std::string kPlain = R"(Cmp_Element.Name="plain",Number=1)";
const std::string kStored = R"(Cmp_Stored.Name="plain")";
const std::string kPart = R"(Cmp_Part.Name="part 2")";

// Without methods of instances and without createInstance: before these the client fetches the
// class, and takes every Key qualifier for a key, [Key(false)] too, which the server sends and the
// host does not.
const RequestCase kRequests[] = {
    {"EnumerateInstances", "ei", "Cmp_Element"},
    {"EnumerateBelow", "ei", "Cmp_Named"},
    {"EnumerateNoClass", "ei", "Cmp_Nothing"},
    {"Names", "ein", "Cmp_Element"},
    {"NamesOfAnAssociation", "ein", "Cmp_Owns"},
    {"Get", "gi", kPlain},
    {"GetSome", "gi", kPlain, {"U8,Texts"}},
    {"GetNone", "gi", R"(Cmp_Element.Name="x",Number=1)"},
    {"Modify", "mi", kStored, {"U8=7,Text=\"a b\",Flag=TRUE,R64=-2.5"}},
    {"GetModified", "gi", kStored},
    {"ModifyReadOnly", "mi", kPart, {"Owner=\"x\""}},
    {"GetProperty", "gp", kStored, {"Text"}},
    {"GetNoProperty", "gp", kStored, {"Nothing"}},
    {"SetProperty", "sp", kStored, {"S32=-5"}},
    {"GetSetProperty", "gi", kStored, {"S32"}},
    {"DeleteInstance", "di", kPart},
    {"Method", "cm", "Cmp_Element", {"Echo.In0=TRUE,In1=255,In2=-7,In7=\"a b\""}},
    {"Associators", "ai", kPart},
    {"AssociatorNames", "ain", kPart},
    {"ToOneClass", "ain", kPart, {"-arc", "Cmp_Broken"}},
    {"AssociatorsOfNoClass", "ain", R"(Cmp_Nothing.Name="x")"},
    {"References", "ri", kPart},
    {"ReferenceNames", "rin", kPart},
    {"Class", "gc", "Cmp_Element"},
    {"NoClass", "gc", "Cmp_Nothing"},
    {"Classes", "ec", "Cmp_Named"},
    {"AllClassNames", "ecn", ""}};
INSTANTIATE_TEST_SUITE_P(Requests, Wire, testing::ValuesIn(kRequests), kByName);
