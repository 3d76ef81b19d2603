// The manuals quote files and messages: what they show must be what there is.

#include <gmock/gmock.h>

#include <regex>

#include "definition/DefinitionFile.h"
#include "definition/ProviderDefXMLError.h"
#include "engine/Registry.h"
#include "tests/support/TemporaryTree.h"

namespace {

std::string fileText(const std::string& name) {
  const std::string text = TemporaryTree::read(std::string(PROJECT_FOLDER) + "/" + name);
  EXPECT_FALSE(text.empty()) << name;
  return text;
}

struct Quotation {
  bool whole;  // else some lines of the file
  std::string file, text;
};

// Code blocks that follow a line "<!-- file: NAME -->" or "<!-- part of file: NAME -->".
std::vector<Quotation> quotations(const std::string& document) {
  static const std::regex mark("<!-- (part of )?file: (\\S+) -->\\n```\\w*\\n");
  const std::string text = fileText(document);
  std::vector<Quotation> result;
  for (std::sregex_iterator i(text.begin(), text.end(), mark), end; i != end; ++i) {
    const auto begin = static_cast<std::size_t>(i->position() + i->length());
    result.push_back(
        {!(*i)[1].matched, (*i)[2], text.substr(begin, text.find("```", begin) - begin)});
  }
  return result;
}

class Documents : public testing::TestWithParam<const char*> {};

TEST_P(Documents, QuoteFilesAsTheyAre) {
  const auto found = quotations(GetParam());
  EXPECT_FALSE(found.empty());
  for (const Quotation& quotation : found) {
    const std::string file = fileText(quotation.file);
    if (quotation.whole) {
      EXPECT_EQ(quotation.text, file) << quotation.file;
    } else {
      EXPECT_THAT(file, testing::HasSubstr(quotation.text)) << quotation.file;
    }
  }
}

INSTANTIATE_TEST_SUITE_P(All, Documents,
                         testing::Values("docs/definition-files.md", "docs/plugins.md"),
                         [](const auto& testCase) {
                           return testCase.index == 0 ? "DefinitionFiles" : "Plugins";
                         });

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
  const std::string document = fileText("docs/definition-files.md");
  const std::string broken =
      std::regex_replace(fileText("examples/loadavg/loadavg.xml"),
                         std::regex("(name=\"Minutes\">)\\s*<get>"), "$1<constant type=\"int\">");
  EXPECT_THAT(document, testing::HasSubstr("XML syntax error: " + errorOf(broken)));
}

}  // namespace
