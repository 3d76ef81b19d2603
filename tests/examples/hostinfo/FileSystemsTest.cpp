#include <mntent.h>
#include <sys/statvfs.h>

#include <algorithm>
#include <climits>
#include <cmath>
#include <set>

#include "tests/examples/hostinfo/FakeHost.h"

using testing::ElementsAre;

namespace {

// What the C library's own reader of the mount table finds.
std::set<std::string> mountPointsWithBlocks() {
  std::set<std::string> result;
  FILE* file = setmntent("/proc/self/mounts", "r");
  while (const mntent* entry = getmntent(file)) {
    struct statvfs space {};
    const bool real = statvfs(entry->mnt_dir, &space) == 0 && space.f_blocks != 0;
    if (real && std::strcmp(entry->mnt_type, "autofs") != 0) result.insert(entry->mnt_dir);
  }
  endmntent(file);
  return result;
}

long kib(fsblkcnt_t blocks, const struct statvfs& space) {
  const long double value = std::floor(static_cast<long double>(blocks) * space.f_frsize / 1024);
  return static_cast<long>(std::min<long double>(value, LONG_MAX));
}

TEST(RealFileSystems, AreThoseOfTheMountTable) {
  HostinfoLibrary library;
  const auto names = library.textsOfAll("hostFileSystemCount", "hostFileSystemName");
  const std::set<std::string> distinct(names.begin(), names.end());
  EXPECT_EQ(distinct, mountPointsWithBlocks());
  EXPECT_EQ(distinct.size(), names.size());
}

TEST(RealFileSystems, HaveTheSizesThatStatvfsTells) {
  HostinfoLibrary library;
  const int count = library.count("hostFileSystemCount");
  ASSERT_GT(count, 0);
  for (int i = 0; i < count; ++i) {
    const std::string name = library.text("hostFileSystemName", i);
    SCOPED_TRACE(name);
    struct statvfs space {};
    ASSERT_EQ(statvfs(name.c_str(), &space), 0);
    EXPECT_EQ(library.longInteger("hostFileSystemSizeKiB", i), kib(space.f_blocks, space));
    const long free = library.longInteger("hostFileSystemFreeKiB", i);
    EXPECT_NEAR(static_cast<double>(free), static_cast<double>(kib(space.f_bavail, space)), 262144);
    const auto used = static_cast<double>(space.f_blocks - space.f_bfree);
    const double percent = 100 * used / (used + static_cast<double>(space.f_bavail));
    EXPECT_NEAR(library.integer("hostFileSystemPercentUsed", i), percent, 1.5);
    EXPECT_EQ(library.integer("hostFileSystemReadOnly", i) != 0, (space.f_flag & ST_RDONLY) != 0);
  }
}

using FileSystems = FakeHostTest;

TEST_F(FileSystems, AMountOverAnotherReplacesIt) {
  EXPECT_EQ(library_.count("hostFileSystemCount"), 0) << "no mount table";
  const std::string a = host_.makeDirectory("a");
  const std::string b = host_.makeDirectory("b");
  host_.writeMounts("/dev/one " + a + " ext4 rw 0 0\n/dev/two " + b + " xfs rw 0 0\n/dev/three " +
                    a + " vfat ro 0 0\n");
  EXPECT_THAT(library_.textsOfAll("hostFileSystemCount", "hostFileSystemName"), ElementsAre(b, a));
  EXPECT_EQ(library_.text("hostFileSystemDevice", 1), "/dev/three");
  EXPECT_EQ(library_.text("hostFileSystemType", 1), "vfat");
  EXPECT_EQ(library_.integer("hostFileSystemReadOnly", 0), 0);
  EXPECT_EQ(library_.integer("hostFileSystemReadOnly", 1), 1);
}

TEST_F(FileSystems, AreMeasuredUnderTheirRealNames) {
  const std::string root = host_.makeDirectory("");
  const std::tuple<const char*, const char*, const char*> cases[] = {
      {"my disk\t#1\\2", "my\\040disk\\011#1\\1342", "my disk\t#1\\2"},
      {"caf\xE9", "caf\xE9", "caf\xEF\xBF\xBD"}};  // no UTF-8
  for (const auto& [directory, inTable, told] : cases) {
    host_.makeDirectory(directory);
    host_.writeMounts("/dev/x " + root + inTable + " ext4 rw 0 0\n");
    EXPECT_THAT(library_.textsOfAll("hostFileSystemCount", "hostFileSystemName"),
                ElementsAre(root + told));
    EXPECT_GT(library_.longInteger("hostFileSystemSizeKiB", 0), 0);
  }
}

std::string repeated(const std::string& text, int times) {
  std::string result;
  for (int i = 0; i < times; ++i) result += text;
  return result;
}

TEST_F(FileSystems, LinesThatAreNoneDoNotHideTheOthers) {
  const std::string ignored[] = {"proc /proc proc rw 0 0\n",  // no blocks
                                 "map /tmp autofs rw 0 0\n", "x /no/such/directory ext4 rw 0 0\n",
                                 "\n", "        \n", "/dev/x\n", "/dev/x /tmp ext4\n",
                                 std::string("/dev/x\0 /tmp ext4 rw\n", 21),
                                 // "/" for the kernel, too long for a buffer
                                 "/dev/x " + repeated("/.", 600) + " ext4 rw 0 0\n",
                                 "/dev/x /tmp ext4 " + std::string(70000, 'o') + " 0 0\n"};
  for (const std::string& line : ignored) {
    host_.writeMounts(line + "good / ext4 rw 0 0\n");
    EXPECT_THAT(library_.textsOfAll("hostFileSystemCount", "hostFileSystemDevice"),
                ElementsAre("good"))
        << line.substr(0, 80);
  }
  host_.writeMounts("good / ext4 rw 0 0\ncut /tmp ext4 r");  // unfinished
  EXPECT_EQ(library_.count("hostFileSystemCount"), 1);
}

TEST_F(FileSystems, TextIsUtf8ThatXmlCanCarry) {
  const std::string bad = "\xEF\xBF\xBD";  // U+FFFD
  const std::pair<std::string, std::string> cases[] = {
      {"\\040\\134040\\", " \\040\\"},
      {"\\04\\08x\\400\\000", "\\04\\08x\\400\\000"},  // no escapes
      {"\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80", "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"},
      {"\\303\\251", "\xC3\xA9"},
      {"\xC3", bad},
      {"\xE2\x82z", bad + bad + "z"},
      {"\x80z", bad + "z"},
      {"\xC0\xAF", bad + bad},  // overlong
      {"\xE0\x80\xAF", bad + bad + bad},
      {"\xED\xA0\x80", bad + bad + bad},  // half a character
      {"\xF4\x90\x80\x80", bad + bad + bad + bad},
      {"a\\001b\\011c", "a" + bad + "b\tc"},
      {"\xEF\xBF\xBF", bad + bad + bad},
      {"%n%s%99999d", "%n%s%99999d"},
      {std::string(5000, 'x'), std::string(1023, 'x')},
      // Cut between characters; growing when it is cleaned.
      {"x" + repeated("\xE2\x82\xAC", 400), "x" + repeated("\xE2\x82\xAC", 340)},
      {std::string(1023, '\xFF'), repeated(bad, 341)},
  };
  for (const auto& [inFile, told] : cases) {
    host_.writeMounts(inFile + " / ext4 rw 0 0\n");
    ASSERT_EQ(library_.count("hostFileSystemCount"), 1);
    EXPECT_EQ(library_.text("hostFileSystemDevice", 0), told);
  }
}

class MountOptions : public FakeHostTest {
 protected:
  std::vector<std::string> textsFor(const std::string& options) {
    host_.writeMounts("x / ext4 " + options + " 0 0\n");
    EXPECT_EQ(library_.count("hostFileSystemCount"), 1);
    return library_.texts("hostFileSystemMountOptions", 0);
  }
};

TEST_F(MountOptions, OneThatDoesNotFitLeavesRoomForTheOthers) {
  EXPECT_THAT(textsFor("rw,nosuid,x=1"), ElementsAre("rw", "nosuid", "x=1"));
  EXPECT_THAT(textsFor(std::string(1007, 'l')), ElementsAre(std::string(1007, 'l')));
  EXPECT_THAT(textsFor(std::string(1008, 'l') + ",rw"), ElementsAre("rw"));
  EXPECT_THAT(textsFor("ro," + std::string(5000, 'l') + ",sync"), ElementsAre("ro", "sync"));
}

TEST_F(MountOptions, AreUnescapedAfterTheSplit) {
  EXPECT_THAT(textsFor("a\\054b,,c\\040d,ro\\040"), ElementsAre("a,b", "c d", "ro "));
  EXPECT_EQ(library_.integer("hostFileSystemReadOnly", 0), 0);
  EXPECT_THAT(textsFor(""), ElementsAre());
}

}  // namespace
