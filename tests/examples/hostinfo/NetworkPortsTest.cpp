#include <ifaddrs.h>
#include <net/if.h>
#include <netpacket/packet.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <climits>
#include <cstdio>
#include <map>

#include "tests/examples/hostinfo/FakeHost.h"

using testing::ElementsAre;

namespace {

// Names by interface index, in that order.
std::vector<std::string> kernelNames() {
  std::map<unsigned, std::string> byIndex;
  struct if_nameindex* all = if_nameindex();
  for (struct if_nameindex* each = all; each->if_name != nullptr; ++each) {
    byIndex[each->if_index] = each->if_name;
  }
  if_freenameindex(all);
  std::vector<std::string> result;
  for (const auto& [index, name] : byIndex) result.push_back(name);
  return result;
}

ifreq ask(unsigned long request, const std::string& name) {
  ifreq answer{};
  name.copy(answer.ifr_name, IFNAMSIZ - 1);
  const int socketNumber = socket(AF_INET, SOCK_DGRAM, 0);
  EXPECT_EQ(ioctl(socketNumber, request, &answer), 0) << name;
  close(socketNumber);
  return answer;
}

std::map<std::string, std::string> linkAddresses() {
  std::map<std::string, std::string> result;
  ifaddrs* all = nullptr;
  EXPECT_EQ(getifaddrs(&all), 0);
  for (const ifaddrs* each = all; each != nullptr; each = each->ifa_next) {
    if (each->ifa_addr == nullptr || each->ifa_addr->sa_family != AF_PACKET) continue;
    sockaddr_ll link{};
    std::memcpy(&link, each->ifa_addr, sizeof link);
    std::string& text = result[each->ifa_name];
    for (int i = 0; i < link.sll_halen && i < 8; ++i) {
      char byte[4];
      std::snprintf(byte, sizeof byte, i == 0 ? "%02x" : ":%02x", link.sll_addr[i]);
      text += byte;
    }
  }
  freeifaddrs(all);
  return result;
}

TEST(NetworkPorts, AreTheKernelsInItsOrder) {
  HostinfoLibrary library;
  const auto addresses = linkAddresses();
  const auto names = library.textsOfAll("hostNetworkPortCount", "hostNetworkPortName");
  EXPECT_EQ(names, kernelNames());
  int i = 0;
  for (const std::string& name : names) {
    SCOPED_TRACE(name);
    EXPECT_EQ(library.integer("hostNetworkPortMTU", i), ask(SIOCGIFMTU, name).ifr_mtu);
    EXPECT_EQ(library.integer("hostNetworkPortUp", i) != 0,
              (ask(SIOCGIFFLAGS, name).ifr_flags & IFF_UP) != 0);
    EXPECT_EQ(library.text("hostNetworkPortCurrentAddress", i), addresses.at(name));
    EXPECT_EQ(library.integers("hostNetworkPortTraffic", i++).size(), 4u);
  }
}

class FakePorts : public FakeHostTest {
 protected:
  using Attributes = std::vector<std::pair<const char*, const char*>>;
  void add(const std::string& port, const Attributes& attributes) {
    for (const auto& [name, text] : attributes) {
      host_.write("/sys/class/net/" + port + "/" + name, text);
    }
  }
};

TEST_F(FakePorts, AreSortedByIndexAndSkipWhatIsNone) {
  add("zeta", {{"ifindex", "2\n"}});
  add("p\xFF%s", {{"ifindex", "10\n"}});
  add("nothing", {{"mtu", "1500\n"}});
  add("odd", {{"ifindex", "none\n"}});
  host_.write("/sys/class/net/bonding_masters", "bond0\n");
  EXPECT_THAT(library_.textsOfAll("hostNetworkPortCount", "hostNetworkPortName"),
              ElementsAre("zeta", "p\xEF\xBF\xBD%s"));
}

TEST_F(FakePorts, AnAddressThatWasSetIsNotPermanent) {
  const char* const kOwn = "02:00:00:00:00:01\n";
  add("real", {{"ifindex", "1\n"}, {"address", kOwn}, {"addr_assign_type", "0\n"}});
  add("made", {{"ifindex", "2\n"}, {"address", kOwn}, {"addr_assign_type", "3\n"}});
  add("mute", {{"ifindex", "3\n"}, {"address", kOwn}});
  add("zero",
      {{"ifindex", "4\n"}, {"address", "00:00:00:00:00:00\n"}, {"addr_assign_type", "0\n"}});
  EXPECT_THAT(library_.textsOfAll("hostNetworkPortCount", "hostNetworkPortPermanentAddress"),
              ElementsAre("02:00:00:00:00:01", "", "", ""));
  EXPECT_EQ(library_.text("hostNetworkPortCurrentAddress", 1), "02:00:00:00:00:01");
}

TEST_F(FakePorts, NumbersStayInTheRangeOfInt) {
  const std::pair<const char*, int> cases[] = {{"1000\n", 1000},
                                               {"1000", 1000},
                                               {"-1\n", 0},
                                               {"2147483647\n", INT_MAX},
                                               {"2147483648\n", INT_MAX},
                                               {"99999999999999999999999\n", INT_MAX},
                                               {"", 0},
                                               {"unknown\n", 0}};
  for (const auto& [text, expected] : cases) {
    add("p", {{"ifindex", "1\n"}, {"speed", text}, {"statistics/rx_packets", text}});
    ASSERT_EQ(library_.count("hostNetworkPortCount"), 1);
    EXPECT_EQ(library_.integer("hostNetworkPortSpeedMbps", 0), expected) << text;
    EXPECT_THAT(library_.integers("hostNetworkPortTraffic", 0), ElementsAre(0, 0, expected, 0));
  }
}

TEST_F(FakePorts, BytesAreToldInKiBAndFlagsInHexadecimal) {
  add("p", {{"ifindex", "1\n"},
            {"flags", "0x1043\n"},
            {"statistics/rx_bytes", "102400\n"},
            {"statistics/tx_bytes", "2047\n"}});
  add("q", {{"ifindex", "2\n"}, {"flags", "0x1042\n"}});
  ASSERT_EQ(library_.count("hostNetworkPortCount"), 2);
  EXPECT_EQ(library_.integer("hostNetworkPortUp", 0), 1);
  EXPECT_EQ(library_.integer("hostNetworkPortUp", 1), 0);
  EXPECT_EQ(library_.bytes("hostNetworkPortTraffic", 0).substr(0, 24),
            std::string("\2\0\0\0\4\0\0\0\0\0\0\0\x64\0\0\0\0\0\0\0\1\0\0\0", 24));
}

}  // namespace
