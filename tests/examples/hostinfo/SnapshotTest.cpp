#include <climits>
#include <thread>

#include "tests/examples/hostinfo/FakeHost.h"

namespace {

TEST(Library, GivesNothingForAnIndexThatDoesNotExist) {
  HostinfoLibrary library;
  ASSERT_EQ(library.count("hostInit"), 0);
  for (const std::string name : {"FileSystem", "NetworkPort", "IPEndpoint"}) {
    const int last = library.count(("host" + name + "Count").c_str());
    for (const int index : {INT_MIN, -1, last, last + 1, INT_MAX}) {
      EXPECT_EQ(library.text(("host" + name + "Name").c_str(), index), "") << index;
    }
  }
  EXPECT_EQ(library.integer("hostFileSystemPercentUsed", -1), 0);
  EXPECT_EQ(library.longInteger("hostFileSystemSizeKiB", -1), 0);
  EXPECT_EQ(library.bytes("hostFileSystemMountOptions", -1).substr(0, 8),
            std::string("\3\0\0\0\0\0\0\0", 8));
  EXPECT_EQ(library.bytes("hostNetworkPortTraffic", -1).substr(0, 8),
            std::string("\2\0\0\0\0\0\0\0", 8));
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
  std::thread([&] { EXPECT_EQ(library_.count("hostFileSystemCount"), 1); }).join();
  EXPECT_EQ(library_.text("hostFileSystemDevice", 0), "first") << "of this thread";
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

}  // namespace
