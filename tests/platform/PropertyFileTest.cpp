#include "platform/PropertyFile.h"

#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

using Vaneth::PropertyFile;
using Vaneth::PropertyFileError;

namespace {

const std::wstring kKey = L"Key";

PropertyFile fileOf(const char* name) {
  return PropertyFile(Vaneth::File::Path(name));
}

// The value of the key in a file of this text, or "none".
std::wstring valueIn(const std::string& text) {
  const TemporaryTree tree;
  TemporaryTree::write("f.ini", text);
  PropertyFile file = fileOf("f.ini");
  file.open(PropertyFile::kReadExisting);
  try {
    return file.getValue(kKey);
  } catch (const PropertyFileError&) {
    return L"none";
  }
}

}  // namespace

TEST(PropertyFile, FindsTheValueOfExactlyTheKey) {
  const std::pair<std::string, std::wstring> cases[] = {
      {"Key=9", L"9"},
      {"\t Key \t=  two words \r\n", L"two words"},
      {"Key=", L""},
      {"Key=a=b # c", L"a=b # c"},
      {"Key=1\nKey=2\n", L"2"},
      {"[Key=0]\n#Key=0\n;Key=0\n Key2=0\nkey=0\nKey\n=0\nKey=1\n#Key=0\n", L"1"},
      {"\xEF\xBB\xBFKey=1", L"1"},
      {"Key=\xC3\xA9\xF0\x9F\x98\x80", L"\u00e9\U0001F600"},
      {"Key=\xE9", L"\u00e9"},
      {std::string("\0junk\nKey=a\0b\n", 15), std::wstring(L"a\0b", 3)},
      {std::string(1000000, '=') + "\nKey=1", L"1"},
      {"", L"none"},
      {"key=1\n#Key=1\nMy Key=1\n[Key]\n=1\nKey", L"none"},
  };
  for (const auto& [text, value] : cases) EXPECT_EQ(valueIn(text), value) << text.substr(0, 80);
}

TEST(PropertyFile, OnlyOpensRegularFilesOfSensibleSize) {
  const TemporaryTree tree;
  std::filesystem::create_directory("directory");
  ASSERT_EQ(mkfifo("fifo", 0600), 0);
  TemporaryTree::write("huge", "Key=1\n" + std::string(1024 * 1024, '#'));
  for (const char* name : {"missing", "directory", "fifo", "huge", "/dev/zero"}) {
    PropertyFile file = fileOf(name);
    EXPECT_THROW(file.open(PropertyFile::kReadExisting), PropertyFileError) << name;
    EXPECT_THROW(file.getValue(kKey), PropertyFileError) << name;
  }
}

TEST(PropertyFile, ForgetsEverythingWhenClosedOrOpenedAgain) {
  const TemporaryTree tree;
  TemporaryTree::write("f.ini", "Key=1\n");
  PropertyFile file = fileOf("f.ini");
  EXPECT_THROW(file.open(PropertyFile::kReadExisting + 1), PropertyFileError);
  file.open(PropertyFile::kReadExisting);
  file.close();
  EXPECT_THROW(file.getValue(kKey), PropertyFileError);
  file.open(PropertyFile::kReadExisting);
  EXPECT_EQ(file.getValue(kKey), L"1");
  TemporaryTree::write("f.ini", "Other=1\n");
  file.open(PropertyFile::kReadExisting);
  EXPECT_THROW(file.getValue(kKey), PropertyFileError);
}
