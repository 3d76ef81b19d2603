#include <gmock/gmock.h>

#include <atomic>
#include <climits>
#include <thread>

#include "tests/examples/hostinfo/FakeHost.h"
#include "tests/examples/hostinfo/HostinfoLibrary.h"

using testing::IsEmpty;

namespace {

TEST(Snapshot, AnIndexThatDoesNotExistGivesNothing) {
  HostinfoLibrary library;
  ASSERT_EQ(library.count("hostInit"), 0);
  const int files = library.count("hostFileSystemCount");
  const int ports = library.count("hostNetworkPortCount");
  const int endpoints = library.count("hostIPEndpointCount");
  const int last = std::max({files, ports, endpoints});
  for (const int index : {INT_MIN, -1, last, last + 1, INT_MAX}) {
    SCOPED_TRACE(index);
    for (const char* name :
         {"hostFileSystemName", "hostFileSystemDevice", "hostFileSystemType", "hostNetworkPortName",
          "hostNetworkPortPermanentAddress", "hostNetworkPortCurrentAddress", "hostIPEndpointName",
          "hostIPEndpointAddress", "hostIPEndpointPortName"}) {
      EXPECT_EQ(library.text(name, index), "") << name;
    }
    for (const char* name : {"hostFileSystemPercentUsed", "hostFileSystemReadOnly",
                             "hostNetworkPortMTU", "hostNetworkPortUp", "hostNetworkPortSpeedMbps",
                             "hostIPEndpointPrefixLength", "hostIPEndpointProtocolIFType"}) {
      EXPECT_EQ(library.integer(name, index), 0) << name;
    }
    EXPECT_EQ(library.longInteger("hostFileSystemSizeKiB", index), 0);
    EXPECT_EQ(library.longInteger("hostFileSystemFreeKiB", index), 0);
    EXPECT_EQ(library.bytes("hostFileSystemMountOptions", index).substr(0, 8),
              std::string("\3\0\0\0\0\0\0\0", 8));
    EXPECT_EQ(library.bytes("hostNetworkPortTraffic", index).substr(0, 8),
              std::string("\2\0\0\0\0\0\0\0", 8));
  }
}

TEST(Snapshot, StaysUntilTheNextCount) {
  FakeHost host;
  host.writeMounts("first / ext4 rw 0 0\n");
  HostinfoLibrary library;
  EXPECT_EQ(library.text("hostFileSystemDevice", 0), "");
  library.count("hostInit");
  host.writeMounts("second / ext4 rw 0 0\n");
  EXPECT_EQ(library.text("hostFileSystemDevice", 0), "first");
  EXPECT_EQ(library.count("hostFileSystemCount"), 1);
  EXPECT_EQ(library.text("hostFileSystemDevice", 0), "second");
}

TEST(Snapshot, IsGoneWhenTheLibraryIsClosed) {
  FakeHost host;
  host.writeMounts("first / ext4 rw 0 0\n");
  { EXPECT_EQ(HostinfoLibrary().count("hostFileSystemCount"), 1); }
  HostinfoLibrary library;
  EXPECT_EQ(library.text("hostFileSystemDevice", 0), "");
}

TEST(Snapshot, ManyThreadsLeaveNoneBehind) {
  FakeHost host;
  host.writeMounts("x / ext4 rw 0 0\n");
  HostinfoLibrary library;
  for (int i = 0; i < 100; ++i) {
    std::thread([&] { EXPECT_EQ(library.count("hostFileSystemCount"), 1); }).join();
  }
  // This thread has never counted: it reads the newest.
  EXPECT_EQ(library.text("hostFileSystemDevice", 0), "x");
}

// Two states of the mount table that differ in every row; what one count saw must not mix them.
class MixingHost {
 public:
  MixingHost() {
    for (int i = 0; i < 4; ++i) {
      const std::string directory = host_.makeDirectory("d" + std::to_string(i));
      states_[0] += "even" + std::to_string(i) + " " + directory + " even rw 0 0\n";
      states_[1] = "odd" + std::to_string(i) + " " + directory + " odd rw 0 0\n" + states_[1];
    }
    change(0);
  }
  void change(int i) const { host_.writeMounts(states_[i % 2]); }

 private:
  FakeHost host_;
  std::string states_[2];
};

bool countIsConsistent(const HostinfoLibrary& library) {
  const int count = library.count("hostFileSystemCount");
  const std::string type = library.text("hostFileSystemType", 0);
  bool consistent = count == 4 && (type == "even" || type == "odd");
  for (int i = 0; i < count; ++i) {
    const int number = type == "even" ? i : count - 1 - i;
    consistent = consistent && library.text("hostFileSystemType", i) == type &&
                 library.text("hostFileSystemDevice", i) == type + std::to_string(number);
  }
  return consistent;
}

TEST(Snapshot, OfOneThreadIsNotMixedWithAnothers) {
  MixingHost host;
  HostinfoLibrary library;
  std::atomic<int> torn{0};
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i) {
    threads.emplace_back([&] {
      for (int round = 0; round < 300; ++round) torn += countIsConsistent(library) ? 0 : 1;
    });
  }
  for (int round = 0; round < 300; ++round) host.change(round);
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(torn, 0);
}

}  // namespace
