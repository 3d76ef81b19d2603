// Every operation by the CIM server's own client against the server, and by the one-shot commands
// against the embedded host: the same instances, paths, values and error codes.

#include <algorithm>

#include "ServerTest.h"

namespace {

// How the two programs write results, made comparable.
enum class Form { instances, paths, result, none };

struct OperationCase {
  const char* name;
  Form form;
  int expected;  // How many instances or lines; below 0 a failure with that CIM status code.
  std::string object;
  std::string cimcli, cimhost;  // The command and its options, which go behind the object.
  std::string both = "";        // What goes to both behind these, with | between.
};

using Words = std::vector<std::string>;

Words split(const std::string& text, char separator) {
  Words words;
  std::istringstream stream(text);
  for (std::string word; std::getline(stream, word, separator);) words.push_back(word);
  return words;
}

Words wordsOf(const std::string& command, const std::string& object, const std::string& both) {
  Words words = split(command, ' ');
  words.insert(words.begin() + 1, object);
  for (const std::string& word : split(both, '|')) words.push_back(word);
  return words;
}

std::string replaceAll(const std::string& text, const char* pattern, const char* replacement) {
  return std::regex_replace(text, std::regex(pattern), replacement);
}

// The client writes empty arrays as nothing and characters without quotes.
std::string plainValues(const std::string& text) {
  return replaceAll(replaceAll(plainReals(text), "= ;", "= {};"), "= '([^']+)';", "= $1;");
}

// One element for each instance; white space and the comments with paths do not count.
Words instances(const std::string& text) {
  std::string flat = replaceAll(text, "(^|\n)//[^\n]*", "");
  flat = plainValues(replaceAll(replaceAll(flat, "\\s+", " "), "; ", ";"));
  Words found;
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
Words lines(const std::string& text) {
  Words found;
  for (std::string line : split(text, '\n')) {
    line = replaceAll(line, "^(//[^/]*/)?(root/compare:)?|^\\d+ associatorNames$", "");
    if (!line.empty()) found.push_back(line);
  }
  std::sort(found.begin(), found.end());
  return found;
}

// One element for the result and for each parameter: NAME=VALUE, without any quotes and braces.
Words results(const std::string& text) {
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

using Comparison = WithServer<testing::TestWithParam<OperationCase>>;
using Differences = WithServer<testing::Test>;

}  // namespace

TEST_P(Comparison, BothAnswerAlike) {
  const auto& [name, form, expected, object, cimcli, cimhost, both] = GetParam();
  const ProgramResult server = Deployment::shared().cimcli(wordsOf(cimcli, object, both));
  Words arguments = wordsOf(cimhost, "root/compare:" + object, both);
  if (form != Form::paths) arguments.insert(arguments.begin(), {"--format", "mof"});
  const ProgramResult host = Deployment::shared().cimhost(arguments);
  const int status = std::max(0, -expected);
  EXPECT_EQ(cimcliStatus(server), status) << server.out << server.err;
  EXPECT_EQ(cimhostStatus(host), status) << host.out << host.err;
  if (status != 0 || form == Form::none) return;
  const auto parts = form == Form::instances ? instances : form == Form::result ? results : lines;
  EXPECT_THAT(parts(server.out), testing::SizeIs(expected));
  EXPECT_EQ(parts(host.out), parts(server.out));
}

constexpr Form kInstances = Form::instances;
constexpr Form kPaths = Form::paths;
constexpr Form kResult = Form::result;

const std::string kElement = "Cmp_Element";
const std::string kPlain = R"(Cmp_Element.Name="plain",Number=1)";
const std::string kSecond = R"(Cmp_Element.Name="a b,c=d.e:f",Number=2)";
const std::string kMissing = R"(Cmp_Element.Name="plain",Number=9)";
const std::string kNoClass = R"(Cmp_Nothing.Name="x")";
const std::string kPart = R"(Cmp_Part.Name="part 2")";
const std::string kOwner = R"(Cmp_Stored.Name="a b,c=d.e:f")";
const std::string kStored = R"(Cmp_Stored.Name="plain")";

const OperationCase kInstanceCases[] = {
    {"AllTypes", kInstances, 6, kElement, "ei -di", "enumerate"},
    {"Shallow", kInstances, 6, kElement, "ei", "enumerate --no-deep"},
    {"BelowAnAbstractClass", kInstances, 21, "Cmp_Named", "ei -di", "enumerate"},
    {"PropertyList", kInstances, 6, kElement, "ei -pl u8,Texts,NoSuchProperty",
     "enumerate --property u8 --property Texts --property NoSuchProperty"},
    {"InstancesThatCannotBeBuilt", kInstances, 3, "Cmp_Broken", "ei", "enumerate"},
    {"NoInstances", kInstances, 0, "Cmp_Empty", "ei", "enumerate"},
    {"NoFunction", kInstances, 0, "Cmp_NoFunction", "ei", "enumerate"},
    {"NoLibrary", kInstances, 2, "Cmp_NoLibrary", "ei", "enumerate"},
    {"NotServed", kInstances, 0, "Cmp_NotServed", "ei", "enumerate"},
    {"NoSuchClass", kInstances, -5, "Cmp_Nothing", "ei", "enumerate"},
    {"Names", kPaths, 6, kElement, "ni", "names"},
    {"NamesOfAnAssociation", kPaths, 6, "Cmp_Owns", "ni", "names"},
    {"AnAssociation", kInstances, 6, "Cmp_Owns", "ei", "enumerate"},
    {"KeysInAnotherOrder", kInstances, 1, R"(cmp_element.number=1,NAME="plain")", "gi", "get"},
    {"KeyWithQuotes", kInstances, 1, R"(Cmp_Element.Name="<&>'\"\\",Number=3)", "gi", "get"},
    {"KeyBeyondAscii", kInstances, 1, R"(Cmp_Element.Name="ä€",Number=4)", "gi", "get"},
    {"Hexadecimal", kInstances, 1, R"(Cmp_Element.Name="plain",Number=0x1)", "gi", "get"},
    {"ListOfOne", kInstances, 1, kPlain, "gi -pl S8", "get --property S8"},
    {"NoSuchInstance", kInstances, -1, kMissing, "gi", "get"},
    {"NoSuchKey", kInstances, -1, R"(Cmp_Element.Title="plain")", "gi", "get"},
    {"InstanceOfNoClass", kInstances, -5, kNoClass, "gi", "get"}};
INSTANTIATE_TEST_SUITE_P(Instances, Comparison, testing::ValuesIn(kInstanceCases), kByName);

const OperationCase kChanges[] = {
    {"Numbers", Form::none, 0, kStored, "mi", "modify",
     "Flag=TRUE|U8=255|S32=-2147483648|U64=7|R64=-2.9"},
    {"ReadNumbers", kInstances, 1, kStored, "gi", "get"},
    {"Texts", Form::none, 0, kStored, "mi", "modify",
     "Text=a b|Time=20260131120000.123456+060|S32s=1,-2,3|Texts=a,b"},
    {"ReadTexts", kInstances, 1, kStored, "gi", "get"},
    {"ReadOnlyIsPassedOver", Form::none, 0, kPart, "mi", "modify", "Owner=kept"},
    {"ReadAsBefore", kInstances, 1, kPart, "gi", "get"}};
INSTANTIATE_TEST_SUITE_P(Changes, Comparison, testing::ValuesIn(kChanges), [](const auto& given) {
  return std::to_string(given.index) + given.param.name;  // The order counts.
});

const OperationCase kAssociations[] = {
    {"OfOneSide", kInstances, 2, kOwner, "a", "associators"},
    {"OfTheOtherInTwoClasses", kInstances, 2, kPart, "a", "associators"},
    {"Names", kPaths, 2, kPart, "an", "associator-names"},
    {"Along", kPaths, 1, kPart, "an -ac cmp_owns", "associator-names --assoc-class cmp_owns"},
    {"To", kPaths, 1, kPart, "an -rc Cmp_Broken", "associator-names --result-class Cmp_Broken"},
    {"ToASuperclass", kPaths, 0, kPart, "an -rc Cmp_Named",
     "associator-names --result-class Cmp_Named"},
    {"AlongNoSuchClass", kPaths, -4, kPart, "an -ac Cmp_Nothing",
     "associator-names --assoc-class Cmp_Nothing"},
    {"OfAnInstanceThatIsNot", kPaths, 0, R"(Cmp_Part.Name="x")", "an", "associator-names"},
    {"OfAClassInNone", kPaths, 0, kPlain, "an", "associator-names"},
    {"OfNoSuchClass", kPaths, -4, kNoClass, "an", "associator-names"},
    {"References", kInstances, 0, kPart, "r", "references"},
    {"ReferenceNames", kPaths, 0, kPart, "rn", "reference-names"}};
INSTANTIATE_TEST_SUITE_P(Associations, Comparison, testing::ValuesIn(kAssociations), kByName);

const OperationCase kMethodsAndClasses[] = {
    {"Echo", kResult, 11, kElement, "im", "invoke",
     "Echo|In0=TRUE|In1=255|In2=-7|In3=-2147483648|In4=9|In5=-2.5|In6=20260131120000.123456+060|"
     "In7=a & b|In8=1,65535|In9=x,y"},
    {"SomeInputs", kResult, 3, kElement, "im", "invoke", "Echo|In1=5|In2=6"},
    {"OfAnInstance", kResult, 3, kSecond, "im", "invoke", "Which"},
    {"OfAnInstanceThatIsNot", kResult, 3, kMissing, "im", "invoke", "Which"},
    {"WithoutAFunction", kResult, 1, kElement, "im", "invoke", "NoFunction"},
    {"WithoutADefinition", kResult, 1, kElement, "im", "invoke", "NotServed"},
    {"WithoutStatic", kResult, -1, kElement, "im", "invoke", "NoStatic"},
    {"OfNoClass", kResult, -6, "Cmp_Nothing", "im", "invoke", "Echo"},
    {"Class", Form::none, 0, kElement, "gc", "class"},
    {"NoClass", Form::none, -6, "Cmp_Nothing", "gc", "class"},
    {"ClassesBelow", kPaths, 8, "Cmp_Named", "nc", "classes --no-deep"},
    {"ClassesBelowNone", kPaths, -5, "Cmp_Nothing", "nc", "classes"}};
INSTANTIATE_TEST_SUITE_P(Others, Comparison, testing::ValuesIn(kMethodsAndClasses), kByName);

// The server leaves roles to the provider, which does not look at them; the host keeps to DSP0200.
TEST_F(Differences, OnlyTheHostFiltersByRole) {
  for (const char* option : {"-ar", "-rr"}) {
    EXPECT_THAT(lines(Deployment::shared().cimcli({"an", kPart, option, "Owned"}).out),
                testing::SizeIs(2));
  }
  const std::string part = "root/compare:" + kPart;
  const auto found = [&](const char* option, const char* role) {
    return lines(Deployment::shared().cimhost({"associator-names", part, option, role}).out);
  };
  EXPECT_THAT(found("--role", "Owned"), testing::ElementsAre(kOwner));
  EXPECT_THAT(found("--result-role", "Right"), testing::ElementsAre(R"(Cmp_Broken.Name="part 2")"));
  EXPECT_THAT(found("--role", "Nobody"), testing::IsEmpty());
}
