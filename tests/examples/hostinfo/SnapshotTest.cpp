#include <atomic>
#include <climits>
#include <thread>

#include "tests/examples/hostinfo/FakeHost.h"

namespace {

TEST(Library, GivesNothingForAnIndexThatDoesNotExist) {
  HostinfoLibrary library;
  ASSERT_EQ(library.count("hostInit"), 0);
  const int last =
      std::max({library.count("hostFileSystemCount"), library.count("hostNetworkPortCount"),
                library.count("hostIPEndpointCount")});
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
    for (const char* name : {"hostFileSystemSizeKiB", "hostFileSystemFreeKiB"}) {
      EXPECT_EQ(library.longInteger(name, index), 0) << name;
    }
    EXPECT_EQ(library.bytes("hostFileSystemMountOptions", index).substr(0, 8),
              std::string("\3\0\0\0\0\0\0\0", 8));
    EXPECT_EQ(library.bytes("hostNetworkPortTraffic", index).substr(0, 8),
              std::string("\2\0\0\0\0\0\0\0", 8));
  }
}

TEST(Library, KeepsNothingWhenItIsClosed) {
  const FakeHost host;
  host.writeMounts("first / ext4 rw 0 0\n");
  EXPECT_EQ(HostinfoLibrary().count("hostFileSystemCount"), 1);
  EXPECT_EQ(HostinfoLibrary().text("hostFileSystemDevice", 0), "");
}

using Snapshot = FakeHostTest;

TEST_F(Snapshot, StaysUntilTheNextCount) {
  host_.writeMounts("first / ext4 rw 0 0\n");
  library_.count("hostInit");
  host_.writeMounts("second / ext4 rw 0 0\n");
  EXPECT_EQ(library_.text("hostFileSystemDevice", 0), "first");
  EXPECT_EQ(library_.count("hostFileSystemCount"), 1);
  EXPECT_EQ(library_.text("hostFileSystemDevice", 0), "second");
}

TEST_F(Snapshot, ManyThreadsLeaveNoneBehind) {
  host_.writeMounts("x / ext4 rw 0 0\n");
  for (int i = 0; i < 100; ++i) {
    std::thread([&] { EXPECT_EQ(library_.count("hostFileSystemCount"), 1); }).join();
  }
  // This thread has never counted: it reads the newest.
  EXPECT_EQ(library_.text("hostFileSystemDevice", 0), "x");
}

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

// Two states of the mount table that differ in every row; what one count saw must not mix them.
TEST_F(Snapshot, OfOneThreadIsNotMixedWithAnothers) {
  std::string states[2];
  for (int i = 0; i < 4; ++i) {
    const std::string directory = host_.makeDirectory("d" + std::to_string(i));
    states[0] += "even" + std::to_string(i) + " " + directory + " even rw 0 0\n";
    states[1] = "odd" + std::to_string(i) + " " + directory + " odd rw 0 0\n" + states[1];
  }
  host_.writeMounts(states[0]);
  std::atomic<int> torn{0};
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i) {
    threads.emplace_back([&] {
      for (int round = 0; round < 300; ++round) torn += countIsConsistent(library_) ? 0 : 1;
    });
  }
  for (int round = 0; round < 300; ++round) host_.writeMounts(states[round % 2]);
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(torn, 0);
}

}  // namespace
