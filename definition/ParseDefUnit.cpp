#include "definition/ParseDefUnit.h"

#include "diagnostics/debug.h"

#include <array>
#include <cstring>

namespace {

constexpr std::array<bool, 256> makeSpaces() {
  std::array<bool, 256> spaces{};
  for (size_t c = 0; c < spaces.size(); ++c) {
    spaces[c] = c <= 0x20 || (c >= 0x7F && c <= 0xA0) || c == 0xFF;
  }
  return spaces;
}

constexpr auto kSpaces = makeSpaces();

}  // namespace

bool isSpace(unsigned char character) {
  return kSpaces[character];
}

/// The tokenizer's states; the numbers appear in the trace.
enum State {
  kBefore = 0,
  kInText = 1,
  kAfterOpen = 2,  // just after "<", or after "</" and white space
  kInName = 3,
  kBetweenAttributes = 4,
  kInAttribute = 5,
  kAfterAttribute = 6,
  kAfterEquals = 7,
  kDoubleQuoted = 8,
  kSingleQuoted = 9,
  kAfterSlash = 10,
  kDone = 99
};

/// The state machine. Every state takes a run of characters at once; with tracing, each character
/// is noted with its state before it is handled. The trace is a template argument, so that reading
/// without it does not pay for it.
template <bool kTracing>
class UnitScanner {
 public:
  UnitScanner(ParseDefUnit& unit, const char* text, int length)
      : unit_(unit), position_(text), begin_(text), end_(text + length) {}

  void run() {
    while (state_ != kDone && position_ != end_) step();
    if (state_ == kDone) return;
    // Cut off by the end of the text: keep what there is.
    unit_.length_ = static_cast<int>(end_ - begin_);
    if (state_ == kInText) finishText();
    if (state_ == kInName) unit_.name_.assign(token_, end_);
  }

 private:
  void step() {
    switch (state_) {
      case kBefore:
        skipSpaces();
        if (more()) startUnit();
        break;
      case kInText:
        takeUntil('<');
        if (more()) {
          trace();
          unit_.length_ = static_cast<int>(position_ - begin_);
          finishText();
          state_ = kDone;
        }
        break;
      case kAfterOpen:
        skipSpaces();
        if (more()) startTag();
        break;
      case kInName:
        takeName();
        break;
      case kBetweenAttributes:
        skipSpaces();
        if (more()) startAttribute();
        break;
      case kInAttribute:
        while (more() && !isSpace(current()) && *position_ != '=') take();
        if (more()) {
          attributeEnd_ = position_;
          takeInto(*position_ == '=' ? kAfterEquals : kAfterAttribute);
        }
        break;
      case kAfterAttribute:
        takeUntil('=');
        if (more()) takeInto(kAfterEquals);
        break;
      case kAfterEquals:
        while (more() && *position_ != '"' && *position_ != '\'') take();
        if (more()) {
          takeInto(*position_ == '"' ? kDoubleQuoted : kSingleQuoted);
          token_ = position_;
        }
        break;
      case kDoubleQuoted:
      case kSingleQuoted:
        takeUntil(state_ == kDoubleQuoted ? '"' : '\'');
        if (more()) storeAttribute();
        break;
      default:  // kAfterSlash
        takeUntil('>');
        if (more()) finishTag();
        break;
    }
  }

  bool more() const { return position_ != end_; }
  unsigned char current() const { return static_cast<unsigned char>(*position_); }

  void trace() const {
    if (kTracing) debugFormat(9, "state %d, char %c\n", state_, *position_);
  }

  void take() {
    trace();
    ++position_;
  }

  void takeInto(State next) {
    take();
    state_ = next;
  }

  void skipSpaces() {
    while (more() && isSpace(current())) take();
  }

  void takeUntil(char stop) {
    if (kTracing) {
      while (more() && *position_ != stop) take();
      return;
    }
    const void* found = std::memchr(position_, stop, static_cast<size_t>(end_ - position_));
    position_ = found != nullptr ? static_cast<const char*>(found) : end_;
  }

  void startUnit() {
    if (*position_ == '<') {
      unit_.kind_ = ParseDefUnit::kTag;
      takeInto(kAfterOpen);
    } else {
      token_ = position_;
      takeInto(kInText);
    }
  }

  void startTag() {
    if (*position_ == '/') {
      unit_.isEnd_ = true;
      takeInto(kInName);
      token_ = position_;
      return;
    }
    unit_.isStart_ = !unit_.isEnd_;
    token_ = position_;
    takeInto(kInName);
  }

  void takeName() {
    while (more() && !isSpace(current()) && *position_ != '/' && *position_ != '>') take();
    if (!more()) return;
    if (isSpace(current()) && position_ == token_ && !unit_.isStart_) {
      takeInto(kAfterOpen);  // "</ name": the name is still to come
      return;
    }
    const char stop = *position_;
    trace();
    finishName();
    if (stop == '>') {
      finishTagHere();
    } else {
      ++position_;
      unit_.isEnd_ = unit_.isEnd_ || stop == '/';
      state_ = stop == '/' ? kAfterSlash : kBetweenAttributes;
    }
  }

  void finishName() {
    unit_.name_.assign(token_, position_);
    if (kTracing) debugFormat(9, "element %s\n", unit_.name_.c_str());
  }

  void startAttribute() {
    if (*position_ == '/') {
      unit_.isEnd_ = true;
      takeInto(kAfterSlash);
    } else if (*position_ == '>') {
      finishTag();
    } else {
      attribute_ = position_;
      takeInto(kInAttribute);
    }
  }

  void storeAttribute() {
    trace();
    if (unit_.attributes_.empty()) unit_.attributes_.reserve(2);
    const auto& stored = unit_.attributes_.emplace_back(std::string(attribute_, attributeEnd_),
                                                        std::string(token_, position_));
    if (kTracing) {
      debugFormat(9, "Attribute: %s=%s\n", stored.first.c_str(), stored.second.c_str());
    }
    ++position_;
    state_ = kBetweenAttributes;
  }

  void finishTag() {
    trace();
    finishTagHere();
  }

  void finishTagHere() {
    ++position_;
    unit_.length_ = static_cast<int>(position_ - begin_);
    state_ = kDone;
  }

  // The text begins with a character that is no white space.
  void finishText() {
    const char* last = position_;
    while (last != token_ && isSpace(static_cast<unsigned char>(last[-1]))) --last;
    unit_.name_.assign(token_, last);
    if (kTracing) debugFormat(9, "CDATA %s\n", unit_.name_.c_str());
  }

  ParseDefUnit& unit_;
  State state_ = kBefore;
  const char* position_;
  const char* const begin_;
  const char* const end_;
  const char* token_ = nullptr;      // start of the name, text or value that is being read
  const char* attribute_ = nullptr;  // the name of the attribute that is being read
  const char* attributeEnd_ = nullptr;
};

ParseDefUnit::ParseDefUnit(const char* text, int length) {
  parse(text, length);
}

void ParseDefUnit::parse(const char* text, int length) {
  kind_ = kText;
  name_.clear();
  attributes_.clear();
  isStart_ = false;
  isEnd_ = false;
  length_ = 0;
  const bool tracing = debugEnabled(9);
  if (tracing) debugFormat(9, "Enter ParseDefUnit length=%d\n", length);
  if (length < 1) return;
  if (tracing) {
    UnitScanner<true>(*this, text, length).run();
  } else {
    UnitScanner<false>(*this, text, length).run();
  }
}
