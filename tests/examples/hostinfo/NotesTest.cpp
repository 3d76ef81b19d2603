// Host_FileSystem.Owner: the property that clients set, and the file that keeps it.

#include <thread>

#include "tests/examples/hostinfo/FakeHost.h"

using namespace std::string_literals;
namespace fs = std::filesystem;

namespace {

class Notes : public FakeHostTest {
 protected:
  Notes() { setenv("HOSTINFO_STATE", state_.c_str(), 1); }
  ~Notes() override { unsetenv("HOSTINFO_STATE"); }

  /// Mounts these directories (as /proc/self/mounts writes them) and takes a snapshot.
  void mount(const std::vector<std::string>& directories) {
    std::string lines;
    for (const std::string& directory : directories) {
      lines += "x " + root_ + directory + " ext4 rw 0 0\n";
    }
    host_.writeMounts(lines);
    ASSERT_EQ(library_.count("hostFileSystemCount"), static_cast<int>(directories.size()));
  }
  int set(const std::string& text, int index) const {
    return library_.function<int(const char*, int)>("hostFileSystemSetOwner")(text.c_str(), index);
  }
  std::string get(int index) const { return library_.text("hostFileSystemOwner", index); }

  std::string file() const { return TemporaryTree::read(file_); }
  void writeFile(const std::string& text) const { TemporaryTree::write(file_, text); }

  const std::string state_ = host_.makeDirectory("state");
  const std::string file_ = state_ + "/hostinfo.notes";
  const std::string root_ = host_.makeDirectory("");
};

TEST_F(Notes, AreOneEscapedLineEach) {
  host_.makeDirectory("my disk");
  mount({"state", "my\\040disk"});
  EXPECT_EQ(get(0), "");
  EXPECT_EQ(set("Ann\\B\tC\nD \x7f\xC3\xA9", 1), 0);
  EXPECT_EQ(set("Bob", 0), 0);
  EXPECT_EQ(file(), root_ + "my\\040disk Ann\\134B\\011C\\012D\\040\\177\xC3\xA9\n" + root_ +
                        "state Bob\n");
  EXPECT_EQ(get(1), "Ann\\B\tC\nD \xEF\xBF\xBD\xC3\xA9"s.replace(10, 3, "\x7f"));
  EXPECT_EQ(get(0), "Bob");
  EXPECT_EQ(set("", 1), 0);
  EXPECT_EQ(file(), root_ + "state Bob\n");
}

// What XML cannot carry is one and the same in the names that clients see, but not here.
TEST_F(Notes, BelongToTheNameOnTheHost) {
  const std::vector<std::string> names = {"caf\xE9", "caf\xE8", "caf", "new\nline", "\\100"};
  for (const std::string& name : names) host_.makeDirectory(name);
  mount({"caf\xE9", "caf\xE8", "caf", "new\\012line", "\\134100"});
  for (int i = 0; i < 5; ++i) EXPECT_EQ(set("note %s" + std::to_string(i), i), 0);
  for (int i = 0; i < 5; ++i) EXPECT_EQ(get(i), "note %s" + std::to_string(i));
}

TEST_F(Notes, HaveAtMost1023Bytes) {
  mount({"state"});
  const std::string longest(1023, ' ');
  EXPECT_EQ(set(longest, 0), 0);
  EXPECT_EQ(set(longest + "x", 0), 1);
  EXPECT_EQ(set(std::string(1000000, 'x'), 0), 1);
  EXPECT_EQ(get(0), longest);
}

TEST_F(Notes, KeepTheLinesThatTheyDoNotUnderstand) {
  mount({"state"});
  const std::string others = "no blank\n\n x\n" + root_ + "state2 y\n" + root_ + "stat z\n";
  writeFile(others + root_ + "state bad \xFF\\777\\001\n" + others);
  EXPECT_EQ(get(0), "bad \xEF\xBF\xBD\\777\xEF\xBF\xBD");
  EXPECT_EQ(set("good", 0), 0);
  EXPECT_EQ(file(), others + others + root_ + "state good\n");
  const std::string longLines =
      std::string(20000, 'x') + root_ + "state y\n" + root_ + "state2 " + std::string(8191, 'z');
  writeFile(longLines);
  EXPECT_EQ(get(0), "");
  EXPECT_EQ(set("good", 0), 0);
  EXPECT_EQ(file(), longLines + "\n" + root_ + "state good\n");
  writeFile(root_ + "state " + std::string(20000, 'x'));
  EXPECT_EQ(get(0), std::string(1023, 'x'));
  EXPECT_EQ(set("good", 0), 0);
  EXPECT_EQ(file(), root_ + "state good\n");
}

TEST_F(Notes, AreBoundedInNumber) {
  mount({"state"});
  std::string others;
  for (int i = 0; i < 4095; ++i) others += "other" + std::to_string(i) + " x\n";
  writeFile(others + root_ + "state old\n");
  EXPECT_EQ(set("new", 0), 0);
  EXPECT_EQ(file(), others + root_ + "state new\n");
  writeFile(others + "one more\n");
  EXPECT_EQ(set("new", 0), 1);
  EXPECT_EQ(file(), others + "one more\n");
  EXPECT_EQ(set("", 0), 0);
}

TEST_F(Notes, AreNotTouchedWhenTheyCannotBeReplaced) {
  mount({"state"});
  EXPECT_EQ(set("kept", 0), 0);
  EXPECT_EQ(set("new", 1), 1) << "no such instance";
  EXPECT_EQ(set("new", -1), 1);
  setenv("HOSTINFO_STATE", (state_ + "/none").c_str(), 1);
  EXPECT_EQ(set("new", 0), 1);
  EXPECT_EQ(get(0), "");
  setenv("HOSTINFO_STATE", state_.c_str(), 1);
  fs::create_directories(file_ + ".new/busy");
  EXPECT_EQ(set("new", 0), 1);
  EXPECT_EQ(get(0), "kept");
  fs::remove(file_);
  fs::create_directory(file_);
  fs::remove_all(file_ + ".new");
  EXPECT_EQ(set("new", 0), 1) << "what cannot be read is not overwritten";
}

TEST_F(Notes, ALeftOverFileIsNotFollowed) {
  mount({"state"});
  TemporaryTree::write(state_ + "/victim", "precious");
  fs::create_symlink(state_ + "/victim", file_ + ".new");
  EXPECT_EQ(set("new", 0), 0);
  EXPECT_EQ(get(0), "new");
  EXPECT_EQ(fs::file_size(state_ + "/victim"), 8u);
}

TEST_F(Notes, NoneIsLostWhenManyAreSetAtOnce) {
  const std::vector<std::string> names = {"a", "b", "c", "d"};
  for (const std::string& name : names) host_.makeDirectory(name);
  mount(names);
  std::vector<std::thread> threads;
  for (int index = 0; index < 4; ++index) {
    threads.emplace_back([this, index] {
      library_.count("hostFileSystemCount");
      for (int i = 0; i < 50; ++i) {
        EXPECT_EQ(set(std::to_string(i), index), 0);
        EXPECT_EQ(get(index), std::to_string(i));
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  for (int index = 0; index < 4; ++index) EXPECT_EQ(get(index), "49");
}

}  // namespace
