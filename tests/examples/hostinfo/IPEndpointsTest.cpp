#include <gmock/gmock.h>
#include <ifaddrs.h>
#include <netdb.h>
#include <netinet/in.h>

#include <bitset>
#include <set>

#include "tests/examples/hostinfo/HostinfoLibrary.h"

namespace {

// Port, address, prefix length, and 4 or 6.
using Endpoint = std::tuple<std::string, std::string, int, int>;

template <class Address>
Endpoint endpointOf(const ifaddrs& from, int protocol, std::size_t offset, std::size_t length) {
  char address[NI_MAXHOST] = "";
  EXPECT_EQ(getnameinfo(from.ifa_addr, sizeof(Address), address, sizeof address, nullptr, 0,
                        NI_NUMERICHOST),
            0);
  address[std::strcspn(address, "%")] = '\0';  // without a zone
  std::size_t prefix = 0;
  for (std::size_t i = offset; i < offset + length; ++i) {
    prefix += std::bitset<8>(reinterpret_cast<const unsigned char*>(from.ifa_netmask)[i]).count();
  }
  const std::string name = from.ifa_name;
  return {name.substr(0, name.find(':')), address, static_cast<int>(prefix), protocol};
}

std::set<Endpoint> kernelEndpoints() {
  std::set<Endpoint> result;
  ifaddrs* all = nullptr;
  EXPECT_EQ(getifaddrs(&all), 0);
  for (const ifaddrs* each = all; each != nullptr; each = each->ifa_next) {
    const int family = each->ifa_addr != nullptr ? each->ifa_addr->sa_family : AF_UNSPEC;
    if (family == AF_INET) {
      result.insert(endpointOf<sockaddr_in>(*each, 4, offsetof(sockaddr_in, sin_addr), 4));
    } else if (family == AF_INET6) {
      result.insert(endpointOf<sockaddr_in6>(*each, 6, offsetof(sockaddr_in6, sin6_addr), 16));
    }
  }
  freeifaddrs(all);
  return result;
}

TEST(IPEndpoints, AreTheAddressesOfTheInterfaces) {
  HostinfoLibrary library;
  std::set<Endpoint> told;
  std::set<std::string> names;
  const int count = library.count("hostIPEndpointCount");
  for (int i = 0; i < count; ++i) {
    const std::string port = library.text("hostIPEndpointPortName", i);
    const std::string address = library.text("hostIPEndpointAddress", i);
    told.insert({port, address, library.integer("hostIPEndpointPrefixLength", i),
                 library.integer("hostIPEndpointProtocolIFType", i)});
    const std::string name = library.text("hostIPEndpointName", i);
    EXPECT_EQ(name.rfind(port + ":" + address, 0), 0u) << name;
    EXPECT_TRUE(names.insert(name).second) << name;
  }
  EXPECT_FALSE(told.empty());
  EXPECT_EQ(told, kernelEndpoints());
}

}  // namespace
