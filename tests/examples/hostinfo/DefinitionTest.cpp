#include <gmock/gmock.h>

#include <fstream>
#include <iterator>
#include <map>
#include <regex>
#include <set>

#include "tests/examples/hostinfo/HostinfoLibrary.h"

namespace {

std::string fileText(const std::string& name) {
  std::ifstream file(std::string(HOSTINFO_SOURCE) + "/" + name);
  EXPECT_TRUE(file.good()) << name;
  return {std::istreambuf_iterator<char>(file), {}};
}

std::vector<std::smatch> matches(const std::string& text, const std::string& pattern) {
  static std::map<std::string, std::regex> compiled;
  const std::regex& regex = compiled.emplace(pattern, std::regex(pattern)).first->second;
  return {std::sregex_iterator(text.begin(), text.end(), regex), {}};
}

// The matches point into the text.
std::vector<std::smatch> matches(std::string&& text, const std::string& pattern) = delete;

using Features = std::map<std::string, std::set<std::string>>;  // class -> properties

Features definedProperties(const std::string& xml) {
  Features result;
  std::string current;
  for (const auto& match : matches(xml, "<(class|property) name=\"([^\"]*)\"")) {
    if (match[1] == "class") current = match[2];
    if (match[1] == "property") result[current].insert(match[2]);
  }
  return result;
}

// Properties that say Key in their own qualifier list, whatever its value.
Features declaredProperties(const std::string& mof) {
  Features result;
  std::string current;
  for (const auto& match :
       matches(mof, "class (\\w+) \\{|\\[Key\\b[^\\]]*\\]\\s*\\w+ (\\w+)[;\\[]")) {
    if (match[1].matched) current = match[1];
    if (match[2].matched) result[current].insert(match[2]);
  }
  return result;
}

TEST(Definition, NamesOnlyFunctionsThatTheLibraryExports) {
  HostinfoLibrary library;
  const std::string xml = fileText("hostinfo.xml");
  const auto functions = matches(xml, "<function name=\"([^\"]*)\" type=\"([^\"]*)\"");
  EXPECT_GT(functions.size(), 20u);
  for (const auto& match : functions) {
    EXPECT_NE(library.function<void()>(match[1].str().c_str()), nullptr) << match[1];
  }
}

// Without Static a method fails; In and Out of every parameter must be written out.
TEST(Definition, MethodsAreDeclaredAsTheProviderNeedsThem) {
  const std::string xml = fileText("hostinfo.xml");
  const std::string mof = fileText("hostinfo.mof");
  std::set<std::string> defined, declared;
  for (const auto& match : matches(xml, "<method name=\"([^\"]*)\"")) {
    defined.insert(match[1]);
  }
  for (const auto& match : matches(mof, "\\[Static\\b[^\\]]*\\]\\s*\\w+ (\\w+)\\([\\s\\S]*?\\);")) {
    declared.insert(match[1]);
    const std::string parameters = match[0].str();
    EXPECT_EQ(matches(parameters, "\\]\\s*\\w+ \\w+(\\[\\])?(,|\\);)").size(),
              matches(parameters, "\\[In(\\(false\\))?, Out(\\(false\\))?,").size());
  }
  EXPECT_EQ(defined.size(), 2u);
  EXPECT_EQ(declared, defined);
}

TEST(Definition, FillsEveryDeclaredPropertyAndNoOther) {
  const Features defined = definedProperties(fileText("hostinfo.xml"));
  EXPECT_EQ(defined.size(), 3u);
  EXPECT_EQ(defined, declaredProperties(fileText("hostinfo.mof")));
}

}  // namespace
