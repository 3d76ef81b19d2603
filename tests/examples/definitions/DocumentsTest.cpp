// The manuals quote files, messages, bytes and commands: what they show must be what there is.

#include <gmock/gmock.h>

#include <regex>

#include "definition/DefinitionFile.h"
#include "definition/ProviderDefXMLError.h"
#include "engine/Registry.h"
#include "tests/engine/RecorderTest.h"
#include "tests/support/RunProgram.h"
#include "tests/support/TemporaryTree.h"

namespace {

using testing::HasSubstr;

std::string fileText(const std::string& name) {
  const std::string text = TemporaryTree::read(std::string(PROJECT_FOLDER) + "/" + name);
  EXPECT_FALSE(text.empty()) << name;
  return text;
}

// What lies between lines of ```; `before` is the line above them.
struct CodeBlock {
  std::string section, before, text;
};

std::vector<CodeBlock> codeBlocks(const std::string& document) {
  std::istringstream lines(fileText(document));
  std::vector<CodeBlock> blocks;
  std::string section, before;
  bool inBlock = false;
  for (std::string line; std::getline(lines, line); before = line) {
    if (line.rfind("## ", 0) == 0) section = line.substr(3);
    if (line.rfind("```", 0) == 0) {
      inBlock = !inBlock;
      if (inBlock) blocks.push_back({section, before, ""});
    } else if (inBlock) {
      blocks.back().text += line + "\n";
    }
  }
  return blocks;
}

TEST(Documents, QuoteFilesAsTheyAre) {
  for (const std::string document : {"docs/definition-files.md", "docs/plugins.md"}) {
    static const std::regex mark("<!-- (part of )?file: (\\S+) -->");
    int quotations = 0;
    for (const CodeBlock& block : codeBlocks(document)) {
      std::smatch match;
      if (!std::regex_match(block.before, match, mark)) continue;
      ++quotations;
      const std::string file = fileText(match[2]);
      EXPECT_THAT(file, HasSubstr(block.text)) << match[2];
      EXPECT_TRUE(match[1].matched || file == block.text) << match[2];
    }
    EXPECT_GT(quotations, 0) << document;
  }
}

std::string errorOf(const std::string& definitions) {
  std::string message = "none";
  try {
    definition::readText(definitions);
  } catch (const ProviderDefXMLError& error) {
    message = error.getMessage();
  }
  releaseFunctions();
  releaseModules();
  return message;
}

TEST(ErrorTable, ShowsWhatEachTextGives) {
  static const std::regex row("\\n\\| `([^`]*)` \\| `(<plugin>[^`]*)` \\|");
  const std::string text = fileText("docs/definition-files.md");
  int rows = 0;
  for (std::sregex_iterator i(text.begin(), text.end(), row), end; i != end; ++i, ++rows) {
    const std::string message = errorOf((*i)[2]);
    EXPECT_EQ(message.substr(0, message.find('\n')), (*i)[1]) << (*i)[2];
  }
  EXPECT_GT(rows, 20);
}

TEST(ErrorTable, TheSampleLogIsReal) {
  const std::string broken =
      std::regex_replace(fileText("examples/loadavg/loadavg.xml"),
                         std::regex("(name=\"Minutes\">)\\s*<get>"), "$1<constant type=\"int\">");
  EXPECT_THAT(fileText("docs/definition-files.md"),
              HasSubstr("XML syntax error: " + errorOf(broken)));
}

// The bytes of lines like " 8  61 62 63 00   a b c NUL", which begin with their place.
std::string bytesOf(const std::string& table) {
  static const std::regex form(" *(\\d+)  ((?:[0-9A-F]{2} ?)+)(?:  .*)?");
  std::string bytes;
  std::istringstream lines(table);
  std::smatch match;
  for (std::string line; std::getline(lines, line);) {
    if (!std::regex_match(line, match, form)) continue;
    bytes.resize(std::max(bytes.size(), std::size_t{std::stoul(match[1])}), '\0');
    std::istringstream numbers(match[2]);
    for (std::string number; numbers >> number;) {
      bytes += static_cast<char>(std::stoi(number, nullptr, 16));
    }
  }
  return bytes;
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
};

TEST_F(ByteTables, ShowWhatPluginsReadAndWrite) {
  std::vector<std::string> tables;
  for (const CodeBlock& block : codeBlocks("docs/plugins.md")) {
    const std::string bytes = bytesOf(block.text);
    if (!bytes.empty()) tables.push_back(bytes);
  }
  ASSERT_EQ(tables.size(), 6u);
  const ProviderDefFunction packer("f", functionTypeCode("getI"), nullptr);
  CallBuffer text, texts;
  char* end = packer.packS(text.begin(), text.end(), "abc");
  EXPECT_EQ(std::string(text.begin(), end), tables[0]);
  end = packer.packAS(texts.begin(), texts.end(), {"a", "bc"});
  EXPECT_EQ(std::string(texts.begin(), end), tables[1]);
  answer(tables[2]);
  EXPECT_EQ(valueText(function("getAI").get()), "2 {7, -1}");
  answer(tables[3]);
  EXPECT_EQ(valueText(function("getAS").get()), "3 {rw, sync}");
  EXPECT_EQ(outputs(tables[4]), "1 ok; 0 5; ");
  EXPECT_EQ(outputs(tables[5]), "1 ok; ");
}

// The commands are run as they are printed.
TEST(Walkthrough, ServesTheClassAndItsMethod) {
  const TemporaryTree tree;  // The working directory stands for the root of the source tree.
  for (const char* folder : {"examples", "plugin-sdk"}) {
    std::filesystem::create_directory_symlink(std::string(PROJECT_FOLDER) + "/" + folder, folder);
  }
  std::string script =
      "set -e\ncc() { " C_COMPILER " \"$@\"; }\ncimhost() { " CIMHOST " \"$@\"; }\n";
  static const std::regex command("(^|\n)((cc|cimhost|cp|mkdir|mv) [^\n]*)");
  for (const CodeBlock& block : codeBlocks("docs/plugins.md")) {
    if (block.section != "A plug-in from nothing to a served class") continue;
    const std::string& text = block.text;
    for (std::sregex_iterator i(text.begin(), text.end(), command), end; i != end; ++i) {
      script += (*i)[2].str() + "\n";
    }
  }
  script += "cimhost --home home/loadavg check\n";
  const ProgramResult result = runProgram({"/bin/sh", "-c", script});
  EXPECT_EQ(result.code, 0) << script << result.err;
  EXPECT_EQ(result.err, "");
  EXPECT_THAT(result.out, testing::ContainsRegex("last 15 min +15 +[0-9]+ +span 2\n"));
  EXPECT_THAT(result.out, testing::ContainsRegex("\\(return value\\) +0\nNames +[{]"));
  EXPECT_THAT(result.out, HasSubstr("0 errors, 0 warnings"));
}

}  // namespace
