// Every operation of the program with the real provider, plug-in and definitions: what a client
// changes, calls and follows.

#include <gtest/gtest.h>

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

  static ProgramResult run(std::vector<std::string> arguments) {
    std::vector<std::string> all = {CIMHOST, "--home", HOMES "/hostinfo"};
    all.insert(all.end(), arguments.begin(), arguments.end());
    return runProgram(all);
  }

  static json runJson(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), {"--format", "json"});
    const ProgramResult result = run(std::move(arguments));
    EXPECT_EQ(result.code, 0) << result.err;
    return json::parse(result.out, nullptr, false);
  }

  static std::string firstPath(const std::string& className) {
    const std::string names = run({"names", "root/host:" + className}).out;
    return names.substr(0, names.find('\n'));
  }

  TemporaryTree tree_;
};

std::string owner(const json& instance) {
  return instance.at("properties").at("Owner");
}

}  // namespace

TEST_F(HostOperations, ModifiedPropertyIsReadBackByAnotherProcess) {
  const std::string path = firstPath("Host_FileSystem");
  ASSERT_FALSE(path.empty());
  for (const std::string text : {"Ä \"team\" a,b %n", ""}) {
    // A comma would separate elements of an array only.
    const ProgramResult modified = run({"modify", path, "Owner=" + text});
    EXPECT_EQ(modified.code, 0) << modified.err;
    EXPECT_EQ(modified.out, "");
    EXPECT_EQ(owner(runJson({"get", path})), text);
  }
}

TEST_F(HostOperations, MethodOfTheClassDeliversAnArray) {
  const json systems = runJson({"enumerate", "root/host:Host_FileSystem"});
  const std::string type = systems[0].at("properties").at("FileSystemType");
  json expected = json::array();
  for (const json& system : systems) {
    if (system.at("properties").at("FileSystemType") == type) {
      expected.push_back(system.at("properties").at("Name"));
    }
  }
  const json result =
      runJson({"invoke", "root/host:Host_FileSystem", "FindByType", "FileSystemType=" + type});
  EXPECT_EQ(result.at("returnValue"), 0);
  EXPECT_EQ(result.at("parameters").at("Count"), expected.size());
  EXPECT_EQ(result.at("parameters").at("Names"), expected);
}

TEST_F(HostOperations, MethodOfAnInstanceRunsOnThatInstance) {
  for (const json& system : runJson({"enumerate", "root/host:Host_FileSystem"})) {
    const json result = runJson({"invoke", system.at("path"), "CheckSpace", "NeededMiB=0"});
    EXPECT_EQ(result.at("returnValue"), 0);
    EXPECT_EQ(result.at("parameters").at("Name"), system.at("properties").at("Name"));
    EXPECT_EQ(result.at("parameters").at("Fits"), true);
  }
}

TEST_F(HostOperations, AssociationIsFollowedInBothDirections) {
  for (const json& endpoint : runJson({"enumerate", "root/host:Host_IPEndpoint"})) {
    const std::string endpointPath = endpoint.at("path");
    const json ports = runJson({"associators", endpointPath});
    ASSERT_EQ(ports.size(), 1u) << endpointPath;
    EXPECT_EQ(ports[0].at("properties").at("Name"), endpoint.at("properties").at("PortName"));
    const std::string back = run({"associator-names", ports[0].at("path")}).out;
    EXPECT_NE(("\n" + back).find("\n" + endpointPath + "\n"), std::string::npos) << back;
  }
}

TEST_F(HostOperations, RefusedAndEmptyAnswersAreToldApart) {
  const std::string port = firstPath("Host_NetworkPort");
  // The provider refuses references; clients see an empty answer, as from a server.
  EXPECT_EQ(run({"reference-names", port}).code, 0);
  EXPECT_EQ(run({"reference-names", port}).out, "");
  EXPECT_EQ(run({"associator-names", port, "--result-class", "Host_FileSystem"}).out, "");
  EXPECT_EQ(run({"associator-names", port, "--assoc-class", "NoSuchClass"}).code, 14);
  EXPECT_EQ(run({"associator-names", "root/host:NoSuchClass.Name=\"x\""}).code, 14);
}
