// The hostinfo example through cimhost and the provider library: that every kind of value arrives.
// What the values are is compared with the system in tests/examples/hostinfo.

#include "tests/support/RunProgram.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

using nlohmann::json;

namespace {

ProgramResult cimhost(std::vector<std::string> arguments) {
  std::vector<std::string> all = {CIMHOST, "--home", HOMES "/hostinfo"};
  all.insert(all.end(), arguments.begin(), arguments.end());
  return runProgram(all);
}

json enumerate(const std::string& className) {
  const ProgramResult result = cimhost({"--format", "json", "enumerate", "root/host:" + className});
  EXPECT_EQ(result.code, 0) << result.err;
  return json::parse(result.out);
}

}  // namespace

// A definition whose function has another type than the property shows as 0 or empty.
TEST(HostInfo, EveryKindOfValueArrives) {
  for (const json& system : enumerate("Host_FileSystem")) {
    const json& properties = system.at("properties");
    EXPECT_EQ(system.at("path"), "root/host:Host_FileSystem.Name=\"" +
                                     properties.at("Name").get<std::string>() + "\"");
    EXPECT_GT(properties.at("SizeKiB").get<unsigned long long>(), 0u);
    EXPECT_TRUE(properties.at("PercentUsed").is_number());
    const json& options = properties.at("MountOptions");
    const std::string option = properties.at("ReadOnly").get<bool>() ? "ro" : "rw";
    EXPECT_NE(std::find(options.begin(), options.end(), option), options.end()) << options;
  }
  int position = 0;
  for (const json& port : enumerate("Host_NetworkPort")) {
    const json& properties = port.at("properties");
    EXPECT_EQ(properties.at("Label"), "port " + std::to_string(position++));
    EXPECT_GT(properties.at("MTU").get<unsigned>(), 0u);
    EXPECT_EQ(properties.at("Traffic").size(), 4u);
  }
  for (const json& endpoint : enumerate("Host_IPEndpoint")) {
    const json& properties = endpoint.at("properties");
    EXPECT_FALSE(properties.at("Address").get<std::string>().empty());
    EXPECT_GT(properties.at("PrefixLength").get<unsigned>(), 0u);
  }
  EXPECT_GT(position, 0);
}

TEST(HostInfo, GetAndNamesAgreeWithEnumerate) {
  const json ports = enumerate("Host_NetworkPort");
  const ProgramResult names = cimhost({"names", "root/host:Host_NetworkPort"});
  std::string expected;
  for (const json& port : ports) expected += port.at("path").get<std::string>() + "\n";
  EXPECT_EQ(names.out, expected);

  const std::string path = ports[0].at("path");
  const json port = json::parse(cimhost({"--format", "json", "get", path}).out);
  EXPECT_EQ(port.at("path"), path);
  EXPECT_EQ(port.at("properties").at("Name"), ports[0].at("properties").at("Name"));

  // The provider delivers nothing; the server's own handler makes that an error.
  const ProgramResult missing =
      cimhost({"get", "root/host:Host_NetworkPort.Name=\"no such port\""});
  EXPECT_EQ(missing.code, 11) << missing.out;
  EXPECT_NE(missing.err.find("Too few objects delivered."), std::string::npos) << missing.err;
}

TEST(HostInfo, TracesDoNotMixWithTheResults) {
  for (const char* format : {"table", "mof", "json"}) {
    const ProgramResult result =
        cimhost({"--format", format, "enumerate", "root/host:Host_PortEndpoint"});
    EXPECT_EQ(result.code, 0) << format << ": " << result.err;
    EXPECT_NE(result.out.find("Endpoint"), std::string::npos) << format;
    EXPECT_EQ(result.out.find("ProviderDef"), std::string::npos) << result.out;
  }
}
