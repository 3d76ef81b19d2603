#include <net/if.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <climits>
#include <cstdio>
#include <map>

#include "tests/examples/hostinfo/FakeHost.h"

using testing::ElementsAre;

namespace {

ifreq ask(unsigned long request, const std::string& name) {
  ifreq answer{};
  name.copy(answer.ifr_name, IFNAMSIZ - 1);
  const int socketNumber = socket(AF_INET, SOCK_DGRAM, 0);
  EXPECT_EQ(ioctl(socketNumber, request, &answer), 0) << name;
  close(socketNumber);
  return answer;
}

std::string hardwareAddress(const std::string& name) {
  const ifreq answer = ask(SIOCGIFHWADDR, name);
  std::string text;
  for (int i = 0; i < 6; ++i) {
    char byte[4];
    std::snprintf(byte, sizeof byte, i == 0 ? "%02x" : ":%02x",
                  static_cast<unsigned char>(answer.ifr_hwaddr.sa_data[i]));
    text += byte;
  }
  return text;
}

TEST(NetworkPorts, AreTheKernelsInItsOrder) {
  std::map<unsigned, std::string> byIndex;
  struct if_nameindex* all = if_nameindex();
  for (auto* each = all; each->if_name != nullptr; ++each) byIndex[each->if_index] = each->if_name;
  if_freenameindex(all);
  HostinfoLibrary library;
  ASSERT_EQ(library.count("hostNetworkPortCount"), static_cast<int>(byIndex.size()));
  int i = 0;
  for (const auto& [index, name] : byIndex) {
    SCOPED_TRACE(name);
    EXPECT_EQ(library.text("hostNetworkPortName", i), name);
    EXPECT_EQ(library.integer("hostNetworkPortMTU", i), ask(SIOCGIFMTU, name).ifr_mtu);
    EXPECT_EQ(library.integer("hostNetworkPortUp", i) != 0,
              (ask(SIOCGIFFLAGS, name).ifr_flags & IFF_UP) != 0);
    const std::string address = library.text("hostNetworkPortCurrentAddress", i++);
    // Those of tunnels are shorter or longer.
    EXPECT_TRUE(address.size() != 17 || address == hardwareAddress(name)) << address;
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
