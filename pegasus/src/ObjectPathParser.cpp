#include "ObjectPathParser.h"

#include <algorithm>
#include <vector>

#include "HostName.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

int digitValue(Uint16 unit) {
  if (unit >= '0' && unit <= '9') return unit - '0';
  if (unit >= 'a' && unit <= 'f') return unit - 'a' + 10;
  if (unit >= 'A' && unit <= 'F') return unit - 'A' + 10;
  return 99;
}

bool parseMagnitude(const Char16* units, Uint32 size, Uint64& number) {
  const bool hexadecimal = size > 2 && units[0] == '0' && (units[1] == 'x' || units[1] == 'X');
  if (size == 0 || (units[0] == '0' && size > 1 && !hexadecimal)) return false;
  const unsigned base = hexadecimal ? 16 : 10;
  number = 0;
  for (Uint32 i = hexadecimal ? 2 : 0; i < size; ++i) {
    const auto digit = static_cast<unsigned>(digitValue(units[i]));
    if (digit >= base || number > (Uint64(-1) - digit) / base) return false;
    number = number * base + digit;
  }
  return true;
}

class Parser {
 public:
  Parser(const String& text, ObjectPathParts& parts, String* reason)
      : text_(text), parts_(parts), reason_(reason) {}

  bool parse() {
    if (!parseHost() || !parseNamespace()) return false;
    const Uint32 dot = text_.find(at_, '.');
    const String className = upTo(dot);
    if (!CIMName::legal(className)) return fail("class name ", className, " not a legal CIM name");
    parts_.className = className;
    while (at_ < text_.size()) {
      if (!parseKeyBinding()) return false;
    }
    for (const Reference& reference : references_) {
      parts_.keyBindings[reference.index].setValue(reference.text);
    }
    sortKeyBindings(parts_.keyBindings);
    return true;
  }

 private:
  struct Reference {
    Uint32 index;
    String text;
  };

  bool fail(const char* reason, const String& detail = String::EMPTY, const char* rest = "") {
    if (reason_) *reason_ = String(reason) + detail + String(rest);
    return false;
  }

  bool failPair(const char* reason, const String& detail = String::EMPTY) {
    return fail("invalid key-value pair, ", String(reason) + detail);
  }

  bool sees(Uint32 index, char c) const {
    return index < text_.size() && text_.getChar16Data()[index] == c;
  }

  // The text up to `end`, or all the rest; goes on behind the unit at `end`.
  String upTo(Uint32 end) {
    const Uint32 start = at_;
    const Uint32 stop = std::min(end, text_.size());
    at_ = std::min(stop + 1, text_.size());
    return text_.subString(start, stop - start);
  }

  bool parseHost() {
    if (!sees(0, '/') || !sees(1, '/')) return true;
    at_ = 2;
    const Uint32 slash = text_.find(at_, '/');
    if (slash == PEG_NOT_FOUND) return fail("missing slash after hostname");
    const String host = upTo(slash);
    if (!isLegalHost(host)) return fail("invalid hostname");
    parts_.host = host;
    return true;
  }

  bool parseNamespace() {
    const Uint32 colon = text_.find(at_, ':');
    if (colon == PEG_NOT_FOUND || colon > text_.find(at_, '.')) {
      return parts_.host.size() == 0 || fail("host specified, missing namespace");
    }
    const String name = upTo(colon);
    const bool hasSecondSlash = parts_.host.size() > 0 && name[0] == '/';
    if (hasSecondSlash || !CIMNamespaceName::legal(name)) return fail("invalid namespace name");
    parts_.nameSpace = name;
    return true;
  }

  bool parseKeyBinding() {
    const Uint32 equalSign = text_.find(at_, '=');
    if (equalSign == PEG_NOT_FOUND) return failPair("missing equal sign");
    const String name = upTo(equalSign);
    if (!CIMName::legal(name)) return failPair("invalid key name:", name);
    if (sees(at_, '"')) return parseQuoted(name);
    const bool isBoolean = sees(at_, 't') || sees(at_, 'T') || sees(at_, 'f') || sees(at_, 'F');
    const String value = upTo(text_.find(at_, ','));
    return isBoolean ? addBoolean(name, value) : addNumber(name, value);
  }

  bool addBoolean(const String& name, const String& value) {
    for (const char* keyword : {"TRUE", "FALSE"}) {
      if (String::equalNoCase(value, keyword)) return add(name, keyword, CIMKeyBinding::BOOLEAN);
    }
    return failPair("value should be TRUE or FALSE");
  }

  bool addNumber(const String& name, const String& value) {
    Sint64 number;
    Uint64 natural;
    if (value.size() > 0 && value[0] == '-') {
      if (!parseSigned(value, number)) return failPair("invalid negative number value ", value);
    } else if (!parseUnsigned(value, natural)) {
      return failPair("invalid number value ", value);
    }
    return add(name, value, CIMKeyBinding::NUMERIC);
  }

  bool parseQuoted(const String& name) {
    String value;
    ++at_;
    if (!unescape(value)) return false;
    addQuoted(name, value);
    if (at_ < text_.size() && !sees(at_++, ',')) {
      return failPair("next key-value pair has to start with comma");
    }
    return true;
  }

  // What reads as a path with keys is a reference.
  bool addQuoted(const String& name, const String& value) {
    ObjectPathParts reference;
    if (value.find(Char16('=')) != PEG_NOT_FOUND && parseObjectPath(value, reference) &&
        reference.keyBindings.size() > 0) {
      references_.push_back({parts_.keyBindings.size(), formatObjectPath(reference)});
      return add(name, value, CIMKeyBinding::REFERENCE);
    }
    return add(name, value, CIMKeyBinding::STRING);
  }

  // Reads up to and past the closing quote.
  bool unescape(String& value) {
    const Char16* const units = text_.getChar16Data();
    const Uint32 size = text_.size();
    for (Uint32 run = at_; at_ < size; ++at_) {
      const bool escape = units[at_] == '\\';
      if (!escape && units[at_] != '"') continue;
      value.append(units + run, at_ - run);
      if (!escape) return ++at_, true;
      ++at_;
      if (!sees(at_, '\\') && !sees(at_, '"')) return failPair("malformed value");
      run = at_;
    }
    return failPair("missing quote in key value");
  }

  bool add(const String& name, const String& value, CIMKeyBinding::Type type) {
    parts_.keyBindings.append(CIMKeyBinding(CIMName(name), value, type));
    return true;
  }

  const String text_;
  ObjectPathParts& parts_;
  String* const reason_;
  // References get their canonical form when the whole path has turned out to be one.
  std::vector<Reference> references_;
  Uint32 at_ = 0;
};

void appendEscaped(String& out, const String& value) {
  const Char16* const units = value.getChar16Data();
  Uint32 run = 0;
  for (Uint32 i = 0; i < value.size(); ++i) {
    if (units[i] != '\\' && units[i] != '"') continue;
    out.append(units + run, i - run).append(Char16('\\'));
    run = i;
  }
  out.append(units + run, value.size() - run);
}

void appendKeyBinding(String& out, const CIMKeyBinding& key) {
  const bool quoted =
      key.getType() == CIMKeyBinding::STRING || key.getType() == CIMKeyBinding::REFERENCE;
  out.append(key.getName().getString()).append(Char16('='));
  if (quoted) out.append(Char16('"'));
  appendEscaped(out, key.getValue());
  if (quoted) out.append(Char16('"'));
}

bool namesInOrder(const CIMKeyBinding& x, const CIMKeyBinding& y) {
  return String::compareNoCase(x.getName().getString(), y.getName().getString()) < 0;
}

}  // namespace

bool parseUnsigned(const String& text, Uint64& number) {
  return parseMagnitude(text.getChar16Data(), text.size(), number);
}

bool parseSigned(const String& text, Sint64& number) {
  const Char16* const units = text.getChar16Data();
  const bool negative = units[0] == '-';
  const Uint32 start = negative || units[0] == '+' ? 1 : 0;
  Uint64 magnitude;
  if (!parseMagnitude(units + start, text.size() - start, magnitude)) return false;
  constexpr Uint64 kLimit = Uint64(1) << 63;
  if (magnitude > kLimit || (magnitude == kLimit && !negative)) return false;
  number = Sint64(negative ? Uint64(0) - magnitude : magnitude);
  return true;
}

void sortKeyBindings(Array<CIMKeyBinding>& keyBindings) {
  const CIMKeyBinding* const keys = keyBindings.getData();
  if (std::is_sorted(keys, keys + keyBindings.size(), namesInOrder)) return;
  CIMKeyBinding* const own = &keyBindings[0];
  std::stable_sort(own, own + keyBindings.size(), namesInOrder);
}

bool parseObjectPath(const String& text, ObjectPathParts& parts, String* reason) {
  const Uint32 end = text.find(Char16(0));
  return Parser(end == PEG_NOT_FOUND ? text : text.subString(0, end), parts, reason).parse();
}

String formatObjectPath(const ObjectPathParts& parts) {
  String text;
  text.reserveCapacity(128);
  if (parts.host.size() > 0) text.append(String("//")).append(parts.host).append(Char16('/'));
  text.append(parts.nameSpace.getString());
  if (parts.host.size() > 0 || !parts.nameSpace.isNull()) text.append(Char16(':'));
  text.append(parts.className.getString());
  const Uint32 size = parts.keyBindings.size();
  const CIMKeyBinding* const keys = parts.keyBindings.getData();
  for (Uint32 i = 0; i < size; ++i) {
    text.append(Char16(i == 0 ? '.' : ','));
    appendKeyBinding(text, keys[i]);
  }
  return text;
}

bool identicalPaths(const ObjectPathParts& x, const ObjectPathParts& y) {
  const CIMKeyBinding* const keys = x.keyBindings.getData();
  return String::equalNoCase(x.host, y.host) && x.nameSpace == y.nameSpace &&
         x.className == y.className && x.keyBindings.size() == y.keyBindings.size() &&
         std::equal(keys, keys + x.keyBindings.size(), y.keyBindings.getData());
}

PEGASUS_NAMESPACE_END
