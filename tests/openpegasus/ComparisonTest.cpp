// Every operation by the CIM server's own client against the server, and by the one-shot commands
// against the embedded host: the same instances, paths, values and error codes.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <regex>

#include "Deployment.h"
#include "PlainReals.h"

namespace {

// How the two programs write results, made comparable.
enum class Form { instances, paths, result, none };

struct OperationCase {
  const char* name;
  Form form;
  int expected;  // How many instances or lines; below 0 a failure with that CIM status code.
  std::vector<std::string> cimcli;
  std::vector<std::string> cimhost;
};

std::string replaceAll(const std::string& text, const char* pattern, const char* replacement) {
  return std::regex_replace(text, std::regex(pattern), replacement);
}

// The client writes empty arrays as nothing and characters without quotes.
std::string plainValues(const std::string& text) {
  return replaceAll(replaceAll(plainReals(text), "= ;", "= {};"), "= '([^']+)';", "= $1;");
}

// One element for each instance; white space and the comments with paths do not count.
std::vector<std::string> instances(const std::string& text) {
  std::string flat = replaceAll(text, "(^|\n)//[^\n]*", "");
  flat = plainValues(replaceAll(replaceAll(flat, "\\s+", " "), "; ", ";"));
  std::vector<std::string> found;
  const std::string start = "instance of ";
  for (auto at = flat.find(start); at != std::string::npos;) {
    const auto next = flat.find(start, at + 1);
    found.push_back(replaceAll(flat.substr(at, next - at), "^ | $", ""));
    at = next;
  }
  std::sort(found.begin(), found.end());
  return found;
}

// One element for each line; host and namespace are left out where they lead a line.
std::vector<std::string> lines(const std::string& text) {
  std::vector<std::string> found;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) {
    line = replaceAll(line, "^(//[^/]*/)?(root/compare:)?|^\\d+ associatorNames$", "");
    if (!line.empty()) found.push_back(line);
  }
  std::sort(found.begin(), found.end());
  return found;
}

// One element for the result and for each parameter: NAME=VALUE, without any quotes and braces.
std::vector<std::string> results(const std::string& text) {
  std::string flat = replaceAll(plainValues(text), "Return Value= ", "ReturnValue=");
  flat = replaceAll(replaceAll(flat, " = ", "="), "=null|=NULL", "=");
  return lines(replaceAll(replaceAll(flat, "[{}\"]| ?;?(?=\n)", ""), ", ", " "));
}

// CIM status codes: 0, or what the programs tell of a failure.
int cimcliStatus(const ProgramResult& result) {
  std::smatch match;
  const std::string text = result.out + result.err;
  if (std::regex_search(text, match, std::regex("Code= (\\d+)"))) return std::stoi(match[1]);
  return result.code == 0 ? 0 : -result.code;
}

int cimhostStatus(const ProgramResult& result) {
  return result.code >= 10 ? result.code - 10 : -result.code;
}

template <class Base>
class WithServer : public Base {
 protected:
  void SetUp() override {
    const std::string reason = CimServer::whyUnavailable();
    if (!reason.empty()) GTEST_SKIP() << "No server to compare with: " << reason;
  }
};

using Comparison = WithServer<testing::TestWithParam<OperationCase>>;
using Differences = WithServer<testing::Test>;

}  // namespace

TEST_P(Comparison, BothAnswerAlike) {
  const OperationCase& given = GetParam();
  const ProgramResult server = Deployment::shared().cimcli(given.cimcli);
  std::vector<std::string> arguments = given.cimhost;
  if (given.form != Form::paths) {
    arguments.insert(arguments.begin(), {"--format", "mof"});
  }
  const ProgramResult host = Deployment::shared().cimhost(arguments);
  const int status = given.expected < 0 ? -given.expected : 0;
  EXPECT_EQ(cimcliStatus(server), status) << server.out << server.err;
  EXPECT_EQ(cimhostStatus(host), status) << host.out << host.err;
  if (status != 0 || given.form == Form::none) return;
  const auto parts = given.form == Form::instances ? instances
                     : given.form == Form::result  ? results
                                                   : lines;
  EXPECT_THAT(parts(server.out), testing::SizeIs(given.expected));
  EXPECT_EQ(parts(host.out), parts(server.out));
}

constexpr Form kInstances = Form::instances;
constexpr Form kPaths = Form::paths;

const std::string kOdd = R"(Cmp_Element.Name="<&>'\"\\",Number=3)";
const std::string kSecond = R"(Cmp_Element.Name="a b,c=d.e:f",Number=2)";
const std::string kPlain = R"(Cmp_Element.Name="plain",Number=1)";

std::string at(const std::string& path) {
  return "root/compare:" + path;
}

INSTANTIATE_TEST_SUITE_P(
    Instances, Comparison,
    testing::ValuesIn(std::vector<OperationCase>{
        {"AllTypes", kInstances, 6, {"ei", "Cmp_Element", "-di"}, {"enumerate", at("Cmp_Element")}},
        {"Shallow",
         kInstances,
         6,
         {"ei", "Cmp_Element"},
         {"enumerate", at("Cmp_Element"), "--no-deep"}},
        {"BelowAnAbstractClass",
         kInstances,
         21,
         {"ei", "Cmp_Named", "-di"},
         {"enumerate", at("Cmp_Named")}},
        {"PropertyList",
         kInstances,
         6,
         {"ei", "Cmp_Element", "-pl", "u8,Texts,NoSuchProperty"},
         {"enumerate", at("Cmp_Element"), "--property", "u8", "--property", "Texts", "--property",
          "NoSuchProperty"}},
        {"InstancesThatCannotBeBuilt",
         kInstances,
         3,
         {"ei", "Cmp_Broken"},
         {"enumerate", at("Cmp_Broken")}},
        {"NoInstances", kInstances, 0, {"ei", "Cmp_Empty"}, {"enumerate", at("Cmp_Empty")}},
        {"NoFunction",
         kInstances,
         0,
         {"ei", "Cmp_NoFunction"},
         {"enumerate", at("Cmp_NoFunction")}},
        {"NoLibrary", kInstances, 2, {"ei", "Cmp_NoLibrary"}, {"enumerate", at("Cmp_NoLibrary")}},
        {"NotServed", kInstances, 0, {"ei", "Cmp_NotServed"}, {"enumerate", at("Cmp_NotServed")}},
        {"NoSuchClass", kInstances, -5, {"ei", "Cmp_Nothing"}, {"enumerate", at("Cmp_Nothing")}},
        {"Names", kPaths, 6, {"ni", "Cmp_Element"}, {"names", at("Cmp_Element")}},
        {"NamesOfAnAssociation", kPaths, 6, {"ni", "Cmp_Owns"}, {"names", at("Cmp_Owns")}},
        {"AnAssociation", kInstances, 6, {"ei", "Cmp_Owns"}, {"enumerate", at("Cmp_Owns")}},
        {"One", kInstances, 1, {"gi", kPlain}, {"get", at(kPlain)}},
        {"KeysInAnotherOrder",
         kInstances,
         1,
         {"gi", R"(cmp_element.number=1,NAME="plain")"},
         {"get", at(R"(cmp_element.number=1,NAME="plain")")}},
        {"KeyWithQuotes", kInstances, 1, {"gi", kOdd}, {"get", at(kOdd)}},
        {"KeyBeyondAscii",
         kInstances,
         1,
         {"gi", "Cmp_Element.Name=\"ä€\",Number=4"},
         {"get", at("Cmp_Element.Name=\"ä€\",Number=4")}},
        {"NumberAsHexadecimal",
         kInstances,
         1,
         {"gi", R"(Cmp_Element.Name="plain",Number=0x1)"},
         {"get", at(R"(Cmp_Element.Name="plain",Number=0x1)")}},
        {"ListOfOne",
         kInstances,
         1,
         {"gi", kPlain, "-pl", "S8"},
         {"get", at(kPlain), "--property", "S8"}},
        {"NoSuchInstance",
         kInstances,
         -1,
         {"gi", R"(Cmp_Element.Name="plain",Number=9)"},
         {"get", at(R"(Cmp_Element.Name="plain",Number=9)")}},
        {"NoSuchKey",
         kInstances,
         -1,
         {"gi", R"(Cmp_Element.Title="plain")"},
         {"get", at(R"(Cmp_Element.Title="plain")")}},
        {"InstanceOfNoClass",
         kInstances,
         -5,
         {"gi", R"(Cmp_Nothing.Name="x")"},
         {"get", at(R"(Cmp_Nothing.Name="x")")}},
    }),
    [](const auto& given) { return given.param.name; });

std::vector<OperationCase> changes() {
  const std::string path = R"(Cmp_Stored.Name="plain")";
  std::vector<OperationCase> cases;
  const auto change = [&](const char* name, const std::vector<std::string>& assignments) {
    OperationCase both{name, Form::none, 0, {"mi", path}, {"modify", at(path)}};
    both.cimcli.insert(both.cimcli.end(), assignments.begin(), assignments.end());
    both.cimhost.insert(both.cimhost.end(), assignments.begin(), assignments.end());
    cases.push_back(both);
    cases.push_back({"Read", kInstances, 1, {"gi", path}, {"get", at(path)}});
  };
  change("Numbers", {"Flag=TRUE", "U8=255", "S32=-2147483648", "U64=7", "R64=-2.9"});
  change("Texts", {"Text=a b", "Time=20260131120000.123456+060"});
  change("Arrays", {"S32s=1,-2,3", "Texts=a,b"});
  change("ReadOnlyIsPassedOver", {"Text=kept"});
  return cases;
}

INSTANTIATE_TEST_SUITE_P(Changes, Comparison, testing::ValuesIn(changes()), [](const auto& given) {
  return std::to_string(given.index) + given.param.name;
});

const std::string kPart = R"(Cmp_Part.Name="part 2")";
const std::string kOwner = R"(Cmp_Stored.Name="a b,c=d.e:f")";

INSTANTIATE_TEST_SUITE_P(
    Associations, Comparison,
    testing::ValuesIn(std::vector<OperationCase>{
        {"OfOneSide", kInstances, 2, {"a", kOwner}, {"associators", at(kOwner)}},
        {"OfTheOtherInTwoClasses", kInstances, 2, {"a", kPart}, {"associators", at(kPart)}},
        {"Names", kPaths, 2, {"an", kPart}, {"associator-names", at(kPart)}},
        {"AlongOneClass",
         kPaths,
         1,
         {"an", kPart, "-ac", "cmp_owns"},
         {"associator-names", at(kPart), "--assoc-class", "cmp_owns"}},
        {"ToOneClass",
         kPaths,
         1,
         {"an", kPart, "-rc", "Cmp_Broken"},
         {"associator-names", at(kPart), "--result-class", "Cmp_Broken"}},
        {"ToASuperclass",
         kPaths,
         0,
         {"an", kPart, "-rc", "Cmp_Named"},
         {"associator-names", at(kPart), "--result-class", "Cmp_Named"}},
        {"AlongNoSuchClass",
         kPaths,
         -4,
         {"an", kPart, "-ac", "Cmp_Nothing"},
         {"associator-names", at(kPart), "--assoc-class", "Cmp_Nothing"}},
        {"OfAnInstanceThatIsNot",
         kPaths,
         0,
         {"an", R"(Cmp_Part.Name="x")"},
         {"associator-names", at(R"(Cmp_Part.Name="x")")}},
        {"OfAClassInNone", kPaths, 0, {"an", kPlain}, {"associator-names", at(kPlain)}},
        {"OfNoSuchClass",
         kPaths,
         -4,
         {"an", R"(Cmp_Nothing.Name="x")"},
         {"associator-names", at(R"(Cmp_Nothing.Name="x")")}},
        {"References", kInstances, 0, {"r", kPart}, {"references", at(kPart)}},
        {"ReferenceNames", kPaths, 0, {"rn", kPart}, {"reference-names", at(kPart)}},
    }),
    [](const auto& given) { return given.param.name; });

INSTANTIATE_TEST_SUITE_P(
    MethodsAndClasses, Comparison,
    testing::ValuesIn(std::vector<OperationCase>{
        {"Echo",
         Form::result,
         11,
         {"im", "Cmp_Element", "Echo", "In0=TRUE", "In1=255", "In2=-7", "In3=-2147483648", "In4=9",
          "In5=-2.5", "In6=20260131120000.123456+060", "In7=a & b", "In8=1,65535", "In9=x,y"},
         {"invoke", at("Cmp_Element"), "Echo", "In0=TRUE", "In1=255", "In2=-7", "In3=-2147483648",
          "In4=9", "In5=-2.5", "In6=20260131120000.123456+060", "In7=a & b", "In8=1,65535",
          "In9=x,y"}},
        {"SomeInputs",
         Form::result,
         3,
         {"im", "Cmp_Element", "Echo", "In1=5", "In2=6"},
         {"invoke", at("Cmp_Element"), "Echo", "In1=5", "In2=6"}},
        {"OfAnInstance",
         Form::result,
         3,
         {"im", kSecond, "Which"},
         {"invoke", at(kSecond), "Which"}},
        {"OfAnInstanceThatIsNot",
         Form::result,
         3,
         {"im", R"(Cmp_Element.Name="x",Number=9)", "Which"},
         {"invoke", at(R"(Cmp_Element.Name="x",Number=9)"), "Which"}},
        {"WithoutAFunction",
         Form::result,
         1,
         {"im", "Cmp_Element", "NoFunction"},
         {"invoke", at("Cmp_Element"), "NoFunction"}},
        {"WithoutADefinition",
         Form::result,
         1,
         {"im", "Cmp_Element", "NotServed"},
         {"invoke", at("Cmp_Element"), "NotServed"}},
        {"WithoutStatic",
         Form::result,
         -1,
         {"im", "Cmp_Element", "NoStatic"},
         {"invoke", at("Cmp_Element"), "NoStatic"}},
        {"OfNoClass",
         Form::result,
         -6,
         {"im", "Cmp_Nothing", "Echo"},
         {"invoke", at("Cmp_Nothing"), "Echo"}},
        {"Class", Form::none, 0, {"gc", "Cmp_Element"}, {"class", at("Cmp_Element")}},
        {"NoClass", Form::none, -6, {"gc", "Cmp_Nothing"}, {"class", at("Cmp_Nothing")}},
        {"ClassesBelow", kPaths, 8, {"nc", "Cmp_Named"}, {"classes", at("Cmp_Named"), "--no-deep"}},
        {"ClassesBelowNone", kPaths, -5, {"nc", "Cmp_Nothing"}, {"classes", at("Cmp_Nothing")}},
    }),
    [](const auto& given) { return given.param.name; });

// The server leaves roles to the provider, which does not look at them; the host keeps to DSP0200.
TEST_F(Differences, OnlyTheHostFiltersByRole) {
  for (const char* option : {"-ar", "-rr"}) {
    EXPECT_THAT(lines(Deployment::shared().cimcli({"an", kPart, option, "Owned"}).out),
                testing::SizeIs(2));
  }
  const auto found = [](const char* option, const char* role) {
    return lines(Deployment::shared().cimhost({"associator-names", at(kPart), option, role}).out);
  };
  EXPECT_THAT(found("--role", "Owned"), testing::ElementsAre(kOwner));
  EXPECT_THAT(found("--result-role", "Right"), testing::ElementsAre(R"(Cmp_Broken.Name="part 2")"));
  EXPECT_THAT(found("--role", "Nobody"), testing::IsEmpty());
}
