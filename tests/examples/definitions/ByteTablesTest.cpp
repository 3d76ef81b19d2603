// The byte tables of docs/plugins.md, laid before the code that writes and reads such buffers.

#include <fstream>
#include <regex>
#include <sstream>

#include "tests/engine/RecorderTest.h"

namespace {

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

class ByteTables : public RecorderTest {
 protected:
  // What an execC function delivers that writes these bytes.
  std::string outputs(const std::string& bytes) {
    answer(bytes);
    Values result;
    function("execC").exec(Values(), result);
    return valueText(result);
  }

  const std::vector<std::string> tables_ = byteTables();
};

TEST_F(ByteTables, ShowWhatPluginsReadAndWrite) {
  ASSERT_EQ(tables_.size(), 6u);
  const ProviderDefFunction packer("f", functionTypeCode("getI"), nullptr);
  CallBuffer text, texts;
  char* end = packer.packS(text.begin(), text.end(), "abc");
  EXPECT_EQ(std::string(text.begin(), end), tables_[0]);
  end = packer.packAS(texts.begin(), texts.end(), {"a", "bc"});
  EXPECT_EQ(std::string(texts.begin(), end), tables_[1]);
  answer(tables_[2]);
  EXPECT_EQ(valueText(function("getAI").get()), "2 {7, -1}");
  answer(tables_[3]);
  EXPECT_EQ(valueText(function("getAS").get()), "3 {rw, sync}");
  EXPECT_EQ(outputs(tables_[4]), "1 ok; 0 5; ");
  EXPECT_EQ(outputs(tables_[5]), "1 ok; ");
}

}  // namespace
