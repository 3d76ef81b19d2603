// The byte tables of docs/plugins.md, laid before the code that writes and reads such buffers.

#include <gmock/gmock.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <regex>
#include <sstream>

#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefModule.h"

using testing::ElementsAre;
using testing::SizeIs;

namespace {

using Values = std::vector<ProviderDefValue>;

// One line of a table, " 8  61 62 63 00   a b c NUL", put at its place.
void addLine(const std::string& line, std::string& bytes) {
  static const std::regex form("^ *(\\d+)  ((?:[0-9A-F]{2} ?)+)(?:  .*)?$");
  std::smatch match;
  if (!std::regex_match(line, match, form)) return;
  std::size_t at = std::stoul(match[1]);
  std::istringstream numbers(match[2]);
  for (std::string number; numbers >> number; ++at) {
    bytes.resize(std::max(bytes.size(), at + 1), '\0');
    bytes[at] = static_cast<char>(std::stoi(number, nullptr, 16));
  }
}

// The tables in document order.
std::vector<std::string> byteTables() {
  std::ifstream file(std::string(PROJECT_FOLDER) + "/docs/plugins.md");
  std::vector<std::string> result;
  bool inBlock = false;
  std::string bytes;
  for (std::string line; std::getline(file, line);) {
    if (line.rfind("```", 0) == 0) {
      if (inBlock && !bytes.empty()) result.push_back(bytes);
      bytes.clear();
      inBlock = !inBlock;
    } else if (inBlock) {
      addLine(line, bytes);
    }
  }
  return result;
}

class ByteTables : public testing::Test {
 protected:
  ByteTables() { module_.reset(new ProviderDefModule(text_.data(), size(), &consumed_)); }

  int size() const { return static_cast<int>(text_.size()); }

  // What an execC function delivers that writes these bytes.
  Values outputs(const std::string& bytes) {
    const auto file =
        std::filesystem::temp_directory_path() / ("bytes-" + std::to_string(getpid()) + ".bin");
    std::ofstream(file, std::ios::binary) << bytes;
    Values result;
    ProviderDefFunction function("bytesOfFile", functionTypeCode("execCw"), module_.get());
    EXPECT_EQ(function.exec(ProviderDefValue(file.string()), Values(), result),
              static_cast<int>(bytes.size()));
    std::filesystem::remove(file);
    return result;
  }

  const std::string text_ = "<module name='" BYTES_PLUGIN "'/>";
  int consumed_ = 0;
  std::unique_ptr<ProviderDefModule> module_;
  const std::vector<std::string> tables_ = byteTables();
  const ProviderDefFunction function_{"f", functionTypeCode("getI"), nullptr};
};

TEST_F(ByteTables, ShowWhatAPluginReads) {
  ASSERT_THAT(tables_, SizeIs(6));
  CallBuffer text, texts;
  char* end = function_.packS(text.begin(), text.end(), "abc");
  EXPECT_EQ(std::string(text.begin(), end), tables_[0]);
  end = function_.packAS(texts.begin(), texts.end(), {"a", "bc"});
  EXPECT_EQ(std::string(texts.begin(), end), tables_[1]);
}

TEST_F(ByteTables, ShowArraysThatArrive) {
  ASSERT_THAT(tables_, SizeIs(6));
  EXPECT_THAT(function_.makeAI(tables_[2].data(), nullptr, tables_[2].data() + tables_[2].size()),
              ElementsAre(7, -1));
  EXPECT_THAT(function_.makeAS(tables_[3].data(), nullptr, tables_[3].data() + tables_[3].size()),
              ElementsAre("rw", "sync"));
}

TEST_F(ByteTables, ShowListsThatArrive) {
  ASSERT_THAT(tables_, SizeIs(6));
  const Values both = outputs(tables_[4]);
  ASSERT_THAT(both, SizeIs(2));
  EXPECT_EQ(both[0].getStringValue(), "ok");
  EXPECT_EQ(both[1].getType(), ProviderDefValue::kInteger);
  EXPECT_EQ(both[1].getIntValue(), 5);
  const Values one = outputs(tables_[5]);
  ASSERT_THAT(one, SizeIs(1));
  EXPECT_EQ(one[0].getStringValue(), "ok");
}

}  // namespace
