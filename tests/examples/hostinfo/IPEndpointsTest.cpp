#include <gmock/gmock.h>
#include <ifaddrs.h>
#include <netdb.h>
#include <netinet/in.h>

#include <bitset>
#include <set>

#include "tests/examples/hostinfo/HostinfoLibrary.h"

namespace {

struct Endpoint {
  std::string port, address;
  int prefix, protocol;
  bool operator<(const Endpoint& other) const {
    return std::tie(port, address, prefix, protocol) <
           std::tie(other.port, other.address, other.prefix, other.protocol);
  }
  bool operator==(const Endpoint& other) const { return !(*this < other) && !(other < *this); }
};

std::string numericText(const sockaddr* address, socklen_t size) {
  char text[NI_MAXHOST] = "";
  EXPECT_EQ(getnameinfo(address, size, text, sizeof text, nullptr, 0, NI_NUMERICHOST), 0);
  return std::string(text).substr(0, std::string(text).find('%'));  // without a zone
}

template <class Address>
Endpoint endpointOf(const ifaddrs& from, int protocol, std::size_t offset, std::size_t length) {
  Endpoint result{from.ifa_name, numericText(from.ifa_addr, sizeof(Address)), 0, protocol};
  result.port = result.port.substr(0, result.port.find(':'));
  for (std::size_t i = 0; i < length; ++i) {
    const char byte = reinterpret_cast<const char*>(from.ifa_netmask)[offset + i];
    result.prefix += static_cast<int>(std::bitset<8>(static_cast<unsigned char>(byte)).count());
  }
  return result;
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
