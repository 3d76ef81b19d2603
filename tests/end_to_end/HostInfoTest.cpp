// The hostinfo example through cimhost and the provider library, against what the operating system
// says by other routes.

#include "tests/support/RunProgram.h"

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <ifaddrs.h>
#include <mntent.h>
#include <net/if.h>
#include <sys/statvfs.h>
#include <nlohmann/json.hpp>

#include <cstdio>
#include <map>
#include <set>

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

std::string text(const json& instance, const char* property) {
  return instance.at("properties").at(property).get<std::string>();
}

std::multiset<std::string> sortedTexts(const json& instances, const char* property) {
  std::multiset<std::string> all;
  for (const json& instance : instances) all.insert(text(instance, property));
  return all;
}

// Address families 4 and 6 of every interface: "name:address".
std::multiset<std::string> systemEndpoints() {
  std::multiset<std::string> all;
  ifaddrs* list = nullptr;
  EXPECT_EQ(getifaddrs(&list), 0);
  for (const ifaddrs* entry = list; entry != nullptr; entry = entry->ifa_next) {
    char address[INET6_ADDRSTRLEN] = "";
    if (entry->ifa_addr == nullptr) continue;
    if (entry->ifa_addr->sa_family == AF_INET) {
      const auto* inet = reinterpret_cast<const sockaddr_in*>(entry->ifa_addr);
      inet_ntop(AF_INET, &inet->sin_addr, address, sizeof address);
    } else if (entry->ifa_addr->sa_family == AF_INET6) {
      const auto* inet = reinterpret_cast<const sockaddr_in6*>(entry->ifa_addr);
      inet_ntop(AF_INET6, &inet->sin6_addr, address, sizeof address);
    } else {
      continue;
    }
    all.insert(std::string(entry->ifa_name) + ":" + address);
  }
  freeifaddrs(list);
  return all;
}

}  // namespace

TEST(HostInfo, FileSystemsAreThoseOfTheSystem) {
  std::map<std::string, std::string> types;  // the last one mounted at a point wins
  std::FILE* mounts = setmntent("/proc/self/mounts", "r");
  ASSERT_NE(mounts, nullptr);
  while (const mntent* entry = getmntent(mounts)) types[entry->mnt_dir] = entry->mnt_type;
  endmntent(mounts);

  const json instances = enumerate("Host_FileSystem");
  ASSERT_FALSE(instances.empty());
  for (const json& instance : instances) {
    const std::string name = text(instance, "Name");
    SCOPED_TRACE(name);
    struct statvfs status {};
    ASSERT_EQ(statvfs(name.c_str(), &status), 0);
    EXPECT_EQ(text(instance, "FileSystemType"), types[name]);
    const unsigned long long kib =
        static_cast<unsigned long long>(status.f_blocks) * status.f_frsize / 1024;
    if (sizeof(long) == 8 || kib < 0x7FFFFFFF) {
      EXPECT_EQ(instance.at("properties").at("SizeKiB").get<unsigned long long>(), kib);
    }
    const double used = 100.0 * static_cast<double>(status.f_blocks - status.f_bfree) /
                        static_cast<double>(status.f_blocks - status.f_bfree + status.f_bavail);
    EXPECT_NEAR(instance.at("properties").at("PercentUsed").get<int>(), used, 2.0);
    EXPECT_EQ(instance.at("properties").at("ReadOnly").get<bool>(),
              (status.f_flag & ST_RDONLY) != 0);
    EXPECT_EQ(instance.at("path").get<std::string>(),
              "root/host:Host_FileSystem.Name=\"" + name + "\"");
  }
}

TEST(HostInfo, PortsAreTheInterfacesOfTheSystem) {
  std::set<std::string> names;
  struct if_nameindex* interfaces = if_nameindex();
  ASSERT_NE(interfaces, nullptr);
  for (auto* entry = interfaces; entry->if_index != 0; ++entry) names.insert(entry->if_name);
  if_freenameindex(interfaces);

  const json instances = enumerate("Host_NetworkPort");
  EXPECT_EQ(instances.size(), names.size());
  int position = 0;
  for (const json& instance : instances) {
    const std::string name = text(instance, "Name");
    SCOPED_TRACE(name);
    EXPECT_EQ(names.count(name), 1u);
    // An index string: the constant, a blank and the instance's index.
    EXPECT_EQ(text(instance, "Label"), "port " + std::to_string(position++));
    std::ifstream mtu("/sys/class/net/" + name + "/mtu");
    unsigned expected = 0;
    if (mtu >> expected) {
      EXPECT_EQ(instance.at("properties").at("MTU").get<unsigned>(), expected);
    }
    EXPECT_TRUE(instance.at("properties").at("Traffic").is_array());
  }
}

TEST(HostInfo, EndpointsAndTheirPortsAreThoseOfTheSystem) {
  const std::multiset<std::string> expected = systemEndpoints();
  EXPECT_EQ(sortedTexts(enumerate("Host_IPEndpoint"), "Name"), expected);

  std::multiset<std::string> linked;
  for (const json& instance : enumerate("Host_PortEndpoint")) {
    const auto key = [&](const char* property) {
      const std::string path = text(instance, property);
      const size_t from = path.find("Name=\"") + 6;
      return path.substr(from, path.rfind('"') - from);
    };
    const std::string endpoint = key("Endpoint");
    EXPECT_EQ(endpoint.compare(0, key("Port").size() + 1, key("Port") + ":"), 0) << instance;
    linked.insert(endpoint);
  }
  EXPECT_EQ(linked, expected);
}

TEST(HostInfo, GetAndNamesAgreeWithEnumerate) {
  const json ports = enumerate("Host_NetworkPort");
  const ProgramResult names = cimhost({"names", "root/host:Host_NetworkPort"});
  std::string expected;
  for (const json& port : ports) expected += port.at("path").get<std::string>() + "\n";
  EXPECT_EQ(names.out, expected);

  const std::string path = ports[0].at("path");
  const ProgramResult got = cimhost({"--format", "json", "get", path});
  EXPECT_EQ(got.code, 0) << got.err;
  const json port = json::parse(got.out);
  EXPECT_EQ(port.at("path"), path);
  EXPECT_EQ(port.at("properties").at("Name"), ports[0].at("properties").at("Name"));

  // The provider delivers nothing; the server's own handler makes that an error.
  const ProgramResult missing =
      cimhost({"get", "root/host:Host_NetworkPort.Name=\"no such port\""});
  EXPECT_EQ(missing.code, 11) << missing.out;
  EXPECT_NE(missing.err.find("Too few objects delivered."), std::string::npos) << missing.err;
}

TEST(HostInfo, EveryFormatShowsTheClassAndItsInstances) {
  for (const char* format : {"table", "mof", "json"}) {
    for (const char* command : {"enumerate", "class"}) {
      const ProgramResult result =
          cimhost({"--format", format, command, "root/host:Host_PortEndpoint"});
      EXPECT_EQ(result.code, 0) << format << " " << command << ": " << result.err;
      EXPECT_NE(result.out.find("Endpoint"), std::string::npos) << format << " " << command;
      // The provider's traces must not mix with the results.
      EXPECT_EQ(result.out.find("ProviderDef"), std::string::npos) << result.out;
    }
  }
}
