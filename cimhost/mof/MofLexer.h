#pragma once

#include "cimhost/mof/MofSource.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace cimhost {

enum class MofTokenKind { end, name, alias, pragma, string, character, integer, real, punctuation };

/// One token. Which of the value fields holds something follows from the kind.
struct MofToken {
  MofTokenKind kind = MofTokenKind::end;
  std::size_t offset = 0;       ///< Of its first byte.
  std::string text;             ///< name; alias, without the '$'; string, decoded to UTF-8.
  bool negative = false;        ///< integer.
  std::uint64_t magnitude = 0;  ///< integer.
  double real = 0;              ///< real.
  std::uint16_t unit = 0;       ///< character: a UTF-16 code unit.
  char mark = 0;                ///< punctuation.
};

/// Splits a MOF text (DSP0004, annex A) into tokens, skipping white space and comments.
///
/// A name is any identifier: MOF has no reserved words where a name is expected, so which names are
/// keywords is the parser's business. Adjacent string literals are separate tokens.
class MofLexer {
 public:
  /// The source must outlive the lexer.
  explicit MofLexer(const MofSource& source);

  /// The next token, for ever `end` after the last. Throws MofError: not UTF-8, a NUL byte,
  /// unterminated or malformed tokens, names above 1024 bytes, integers above 64 bits.
  MofToken next();

 private:
  void skipBlanksAndComments();
  void skipLineComment();
  void skipBlockComment();
  void readName(MofToken& token);
  void readAlias(MofToken& token);
  void readPragma(MofToken& token);
  void readNumber(MofToken& token);
  void readString(MofToken& token);
  void readCharacter(MofToken& token);
  std::uint32_t readQuoted(std::size_t start, const char* what);
  std::uint32_t readEscape();
  std::uint32_t readHexEscape(std::size_t start);
  std::uint32_t takeCharacter();
  bool atEnd() const { return offset_ == source_.text.size(); }
  bool at(std::string_view prefix) const { return rest().substr(0, prefix.size()) == prefix; }
  std::string_view rest() const { return std::string_view(source_.text).substr(offset_); }
  [[noreturn]] void fail(std::size_t offset, const std::string& message) const;

  const MofSource& source_;
  std::size_t offset_ = 0;
};

}  // namespace cimhost
