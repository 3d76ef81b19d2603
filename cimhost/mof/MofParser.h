#pragma once

#include "cimhost/mof/MofDeclarations.h"
#include "cimhost/mof/MofLexer.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace cimhost {

/// Reads the declarations of one MOF text, one at a time (DSP0004, annex A).
///
/// Knows the grammar only: no name is looked up and no value is checked against its type. Nothing
/// in this grammar nests, so there is no recursion. Memory for one declaration is bounded.
class MofParser {
 public:
  explicit MofParser(MofSourcePtr source);

  /// The next class, qualifier or directive; nothing at the end of the text. Instances are checked
  /// for form and skipped. Throws MofError; after that the parser is of no further use.
  std::optional<MofDeclaration> next();

  const MofSource& source() const { return *source_; }

 private:
  MofPragma parsePragma();
  MofQualifierDeclaration parseQualifierDeclaration();
  void parseQualifierScopeOrFlavor(MofQualifierDeclaration& declaration);
  std::optional<MofDeclaration> parseClassOrInstance();
  MofClassDeclaration parseClass(std::vector<MofQualifier> qualifiers);
  void skipInstance();
  MofFeature parseFeature();
  std::vector<MofElement> parseParameters();
  void parseTypeAndName(MofElement& element, const char* what);
  void parseArray(MofElement& element);
  std::vector<MofQualifier> parseQualifierList();
  MofQualifier parseQualifier();
  void parseFlavor(std::vector<MofFlavor>& flavors);
  MofInitializer parseInitializer();
  void parseBraces(MofInitializer& initializer);
  MofLiteral parseLiteral();
  std::string parseStrings();
  void skipAlias();

  void advance();
  bool at(char mark) const;
  bool atKeyword(std::string_view keyword) const;
  bool accept(char mark);
  bool acceptKeyword(std::string_view keyword);
  void expect(char mark);
  void expectKeyword(std::string_view keyword);
  MofName expectName(const char* what);
  void countNode();
  [[noreturn]] void failExpecting(const std::string& what) const;
  [[noreturn]] void fail(std::size_t offset, const std::string& message) const;

  MofSourcePtr source_;
  MofLexer lexer_;
  MofToken current_;
  bool started_ = false;
  std::size_t nodes_ = 0;  // Of the declaration being read.
};

}  // namespace cimhost
