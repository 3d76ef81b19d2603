#include "cimhost/xml/XmlReader.h"

#include "cimhost/xml/HttpError.h"

#include <expat.h>

#include <cstring>
#include <exception>
#include <memory>
#include <random>

namespace cimhost {

namespace {

bool isWhite(std::string_view text) {
  return text.find_first_not_of(" \t\r\n") == std::string_view::npos;
}

// Builds the tree from expat's events. The first violation of a rule is kept and the reading goes
// on, so that a text which is not even well-formed is reported as such; a limit stops it.
class TreeBuilder {
 public:
  TreeBuilder(XML_Parser parser, std::string_view roots) : parser_(parser), roots_(roots) {
    XML_SetUserData(parser, this);
    XML_SetElementHandler(parser, onStart, onEnd);
    XML_SetCharacterDataHandler(parser, onText);
    XML_SetStartDoctypeDeclHandler(parser, onDoctype);
  }

  // Throws what has stopped the reading, if anything did.
  XmlDocument take() {
    if (failure_ != nullptr) std::rethrow_exception(failure_);
    return std::move(document_);
  }

 private:
  static void onStart(void* self, const char* name, const char** attributes) {
    static_cast<TreeBuilder*>(self)->guarded(
        [&](TreeBuilder& builder) { builder.start(name, attributes); });
  }
  static void onEnd(void* self, const char*) {
    static_cast<TreeBuilder*>(self)->guarded([](TreeBuilder& builder) { builder.end(); });
  }
  static void onText(void* self, const char* text, int size) {
    static_cast<TreeBuilder*>(self)->guarded([&](TreeBuilder& builder) {
      builder.characters({text, static_cast<std::size_t>(size)});
    });
  }
  static void onDoctype(void* self, const char*, const char*, const char*, int) {
    static_cast<TreeBuilder*>(self)->guarded(
        [](TreeBuilder&) { throwNotValid("a document type declaration is not accepted"); });
  }

  // No exception passes through expat, which is C.
  template <class Action>
  void guarded(Action action) {
    if (failure_ != nullptr) return;
    try {
      action(*this);
    } catch (...) {
      failure_ = std::current_exception();
      XML_StopParser(parser_, XML_FALSE);
    }
  }

  void start(const char* name, const char** attributes) {
    if (++depth_ > XmlLimits::kDepth) throwNotValid("elements are nested too deeply");
    countPart();
    if (!document_.problem.empty()) return;
    const ElementRule* const rule = findElementRule(name);
    const std::string_view allowed = open_.empty() ? roots_ : open_.back()->rule->children;
    if (rule == nullptr || !hasWord(allowed, name)) {
      return violation(std::string(name) + " is not expected" +
                       (open_.empty() ? "" : " in " + std::string(open_.back()->name())));
    }
    push(*rule, attributes);
  }

  void countPart() {
    if (++parts_ > XmlLimits::kParts) throwNotValid("too many elements and attributes");
  }

  void push(const ElementRule& rule, const char** attributes) {
    XmlElement element;
    element.rule = &rule;
    const int count = XML_GetSpecifiedAttributeCount(parser_) / 2;
    if (count > XmlLimits::kAttributes) throwNotValid("too many attributes");
    element.attributes.reserve(static_cast<std::size_t>(count));
    for (; *attributes != nullptr; attributes += 2) {
      countPart();
      element.attributes.emplace_back(attributes[0], attributes[1]);
    }
    forEachWord(rule.attributes, [&](std::string_view each) {
      if (element.findAttribute(each) != nullptr) return;
      violation(std::string(rule.name) + " without " + std::string(each));
    });
    if (open_.empty()) {
      document_.root = std::move(element);
      open_.push_back(&document_.root);
    } else {
      // A sibling that is still referred to cannot move: only the last child is open.
      open_.back()->children.push_back(std::move(element));
      open_.push_back(&open_.back()->children.back());
    }
  }

  void end() {
    --depth_;
    if (document_.problem.empty()) open_.pop_back();
  }

  void characters(std::string_view text) {
    if (!document_.problem.empty() || open_.empty()) return;
    if (open_.back()->rule->holdsText()) {
      open_.back()->text += text;
    } else if (!isWhite(text)) {
      violation("text in " + std::string(open_.back()->name()));
    }
  }

  void violation(const std::string& problem) {
    if (document_.problem.empty()) document_.problem = problem;
  }

  XML_Parser parser_;
  std::string_view roots_;
  XmlDocument document_;
  std::vector<XmlElement*> open_;
  std::size_t depth_ = 0;
  std::size_t parts_ = 0;
  std::exception_ptr failure_;
};

using Parser = std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)>;

// Longer texts would leave a kept parser with as much memory.
constexpr std::size_t kLongestForKeptParser = 64U << 10U;

// Nobody can choose names that collide in a parser's tables without knowing it. Asking the system
// for another one takes longer than a small text.
unsigned long hashSalt() {
  static const unsigned long salt = [] {
    std::random_device source;
    return std::uniform_int_distribution<unsigned long>(1)(source);
  }();
  return salt;
}

Parser makeParser() {
  Parser parser(XML_ParserCreate(nullptr), &XML_ParserFree);
  if (parser == nullptr) throw std::bad_alloc();
  return parser;
}

// The thread's own, as new.
XML_Parser keptParser() {
  thread_local const Parser parser = makeParser();
  XML_ParserReset(parser.get(), nullptr);
  return parser.get();
}

std::string place(XML_Parser parser) {
  return "line " + std::to_string(XML_GetCurrentLineNumber(parser)) + ", column " +
         std::to_string(XML_GetCurrentColumnNumber(parser) + 1) + ": " +
         XML_ErrorString(XML_GetErrorCode(parser));
}

XmlDocument readWith(XML_Parser parser, std::string_view text, std::string_view roots) {
  XML_SetHashSalt(parser, hashSalt());
  TreeBuilder builder(parser, roots);
  const XML_Status status = XML_Parse(parser, text.data(), static_cast<int>(text.size()), XML_TRUE);
  XmlDocument document = builder.take();
  if (status != XML_STATUS_OK) {
    throw HttpError(400, "request-not-well-formed", place(parser));
  }
  return document;
}

}  // namespace

XmlDocument readXml(std::string_view text, std::string_view roots) {
  if (text.size() > XmlLimits::kBytes) throwNotValid("the text is too long");
  if (text.size() > kLongestForKeptParser) return readWith(makeParser().get(), text, roots);
  return readWith(keptParser(), text, roots);
}

}  // namespace cimhost
