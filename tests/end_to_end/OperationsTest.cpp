// Every operation of the program with the real provider and the hostinfo example: that every kind
// of value arrives, and what a client changes, calls and follows. What the values are is compared
// with the system in tests/examples/hostinfo.

#include <gmock/gmock.h>

#include <nlohmann/json.hpp>

#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

using nlohmann::json;

namespace {

// The hostinfo home, with a place of its own for the notes that clients set.
class HostOperations : public testing::Test {
 protected:
  HostOperations() { setenv("HOSTINFO_STATE", tree_.logs().c_str(), 1); }
  ~HostOperations() override { unsetenv("HOSTINFO_STATE"); }

  static ProgramResult run(const std::vector<std::string>& arguments) {
    return runProgram({CIMHOST, "--home", HOMES "/hostinfo"}, arguments);
  }

  static json runJson(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), {"--format", "json"});
    const ProgramResult result = run(arguments);
    EXPECT_EQ(result.code, 0) << result.err;
    return json::parse(result.out, nullptr, false);
  }

  static json enumerate(const std::string& className) {
    return runJson({"enumerate", "root/host:" + className});
  }

  static std::string firstPath(const std::string& className) {
    const std::string names = run({"names", "root/host:" + className}).out;
    return names.substr(0, names.find('\n'));
  }

  TemporaryTree tree_;
};

std::string textOf(const json& instance, const char* property) {
  return instance.at("properties").at(property);
}

}  // namespace

// A definition whose function has another type than the property shows as 0 or empty.
TEST_F(HostOperations, EveryKindOfValueArrives) {
  EXPECT_EQ(run({"check"}).out, "4 definitions, 0 errors, 0 warnings\n");
  for (const std::string name : {"Host_FileSystem", "Host_NetworkPort", "Host_IPEndpoint"}) {
    const json instance = enumerate(name).at(0);
    const json cimClass = runJson({"class", "root/host:" + name});
    EXPECT_EQ(instance.at("properties").size(), cimClass.at("properties").size()) << name;
  }
  for (const json& system : enumerate("Host_FileSystem")) {
    const json& properties = system.at("properties");
    EXPECT_EQ(system.at("path"),
              "root/host:Host_FileSystem.Name=\"" + textOf(system, "Name") + "\"");
    EXPECT_GT(properties.at("SizeKiB").get<unsigned long long>(), 0u);
    EXPECT_TRUE(properties.at("PercentUsed").is_number());
    const auto options = properties.at("MountOptions").get<std::vector<std::string>>();
    EXPECT_THAT(options, testing::Contains(properties.at("ReadOnly").get<bool>() ? "ro" : "rw"));
  }
  std::string paths;
  int position = 0;
  for (const json& port : enumerate("Host_NetworkPort")) {
    EXPECT_EQ(textOf(port, "Label"), "port " + std::to_string(position++));
    EXPECT_GT(port.at("properties").at("MTU").get<unsigned>(), 0u);
    EXPECT_EQ(port.at("properties").at("Traffic").size(), 4u);
    paths += port.at("path").get<std::string>() + "\n";
  }
  EXPECT_EQ(run({"names", "root/host:Host_NetworkPort"}).out, paths);
  for (const json& endpoint : enumerate("Host_IPEndpoint")) {
    EXPECT_NE(textOf(endpoint, "Address"), "");
    EXPECT_GT(endpoint.at("properties").at("PrefixLength").get<unsigned>(), 0u);
  }
}

TEST_F(HostOperations, TracesDoNotMixWithTheResults) {
  for (const char* format : {"table", "mof", "json"}) {
    const ProgramResult result =
        run({"--format", format, "enumerate", "root/host:Host_PortEndpoint"});
    EXPECT_EQ(result.code, 0) << format << ": " << result.err;
    EXPECT_THAT(result.out, testing::HasSubstr("Endpoint")) << format;
    EXPECT_THAT(result.out, Not(testing::HasSubstr("ProviderDef"))) << format;
  }
}

TEST_F(HostOperations, ModifiedPropertyIsReadBackByAnotherProcess) {
  const std::string path = firstPath("Host_FileSystem");
  // A comma would separate elements of an array only.
  for (const std::string text : {"Ä \"team\" a,b %n", ""}) {
    const ProgramResult modified = run({"modify", path, "Owner=" + text});
    EXPECT_EQ(modified.code, 0) << modified.err;
    EXPECT_EQ(modified.out, "");
    EXPECT_EQ(textOf(runJson({"get", path}), "Owner"), text);
  }
}

TEST_F(HostOperations, MethodOfTheClassDeliversAnArray) {
  const json systems = enumerate("Host_FileSystem");
  const std::string type = textOf(systems.at(0), "FileSystemType");
  json ofType = json::array();
  for (const json& system : systems) {
    if (textOf(system, "FileSystemType") == type) ofType.push_back(textOf(system, "Name"));
  }
  const json first = json::array({textOf(systems.at(0), "Name")});
  const std::tuple<std::string, std::size_t, json> cases[] = {
      {"FileSystemType=" + type, ofType.size(), ofType}, {"Limit=1", systems.size(), first}};
  for (const auto& [input, count, names] : cases) {
    const json result = runJson({"invoke", "root/host:Host_FileSystem", "FindByType", input});
    EXPECT_EQ(result.at("returnValue"), names.size() < count ? 1 : 0);
    EXPECT_EQ(result.at("parameters").at("Count"), count);
    EXPECT_EQ(result.at("parameters").at("Names"), names);
  }
}

TEST_F(HostOperations, MethodOfAnInstanceRunsOnThatInstance) {
  for (const json& system : enumerate("Host_FileSystem")) {
    const json result = runJson({"invoke", system.at("path"), "CheckSpace", "NeededMiB=0"});
    EXPECT_EQ(result.at("returnValue"), 0);
    EXPECT_EQ(result.at("parameters").at("Name"), textOf(system, "Name"));
    EXPECT_EQ(result.at("parameters").at("Fits"), true);
  }
}

TEST_F(HostOperations, AssociationIsFollowedInBothDirections) {
  for (const json& endpoint : enumerate("Host_IPEndpoint")) {
    const std::string path = endpoint.at("path");
    const json ports = runJson({"associators", path});
    ASSERT_EQ(ports.size(), 1u) << path;
    EXPECT_EQ(textOf(ports[0], "Name"), textOf(endpoint, "PortName"));
    EXPECT_THAT("\n" + run({"associator-names", ports[0].at("path")}).out,
                testing::HasSubstr("\n" + path + "\n"));
  }
}
