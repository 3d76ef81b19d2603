#include <Pegasus/Common/String.h>

#include <sstream>
#include <tuple>
#include <utility>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

TEST(StringUtf8, DecodesAndEncodes) {
  const std::pair<const char*, std::u16string> cases[] = {
      {"abc", u"abc"},
      {"\xC2\x80", u"\x80"},
      {"\xDF\xBF", u"\u07FF"},
      {"\xE0\xA0\x80", u"\u0800"},
      {"\xE2\x82\xAC", u"\u20AC"},
      {"\xF0\x9F\xBF\xBF", u"\U0001FFFF"},
      {"\xF4\x8F\xBF\xBF", u"\U0010FFFF"},
      {"exactly8\xC3\xA9 and eight more", u"exactly8\u00E9 and eight more"},
  };
  for (const auto& [utf8, units] : cases) {
    const String str(utf8);
    EXPECT_EQ(text(str), utf8);
    ASSERT_EQ(str.size(), units.size()) << utf8;
    for (Uint32 i = 0; i <= units.size(); ++i) EXPECT_EQ(Uint16(str.getChar16Data()[i]), units[i]);
  }
}

TEST(StringUtf8, ReplacesWhatIsNoCharacter) {
  const char* const replaced = "\xEF\xBF\xBD";
  for (const char* none : {"\xEF\xBF\xBE", "\xEF\xBF\xBF", "\xED\xA0\x80", "\xED\xBF\xBF"}) {
    EXPECT_EQ(text(String(none)), replaced);
    EXPECT_EQ(text(String((std::string(none) + "x").c_str())), std::string(replaced) + "x");
  }
  EXPECT_EQ(text(String("\xED\xA0\xBD\xED\xB8\x80")), std::string(replaced) + replaced);
}

TEST(StringUtf8, EncodesHalfCharacters) {
  // Alone at the end the first half is nothing.
  const Char16 units[] = {Char16(0xDC00), Char16('a'), Char16(0xD800), Char16('b'), Char16(0xDBFF)};
  EXPECT_EQ(text(String(units, 5)),
            "\xED\xB0\x80"
            "a\xED\xA0\x80"
            "b");
  EXPECT_EQ(text(String(units + 4, 1)), "");
  EXPECT_EQ(text(String("\xC3\xA9").append(units[2])), "\xC3\xA9");
}

TEST(StringUtf8, RefusesMalformedText) {
  const std::pair<std::string, std::string> cases[] = {
      {"a\xE9z", "1 is not valid UTF-8 encoding: a 0xE9 0x7A"},
      {"ab\xFF", "2 is not valid UTF-8 encoding: ab 0xFF"},
      {"\xC0\x80", "0 is not valid UTF-8 encoding:  0xC0 0x80"},
      {"\x84\x80\x80\x80", "0 is not valid UTF-8 encoding:  0x84 0x80 0x80 0x80"},
      {"\xF0\x8F\xBF\xBF", "0 is not valid UTF-8 encoding:  0xF0 0x8F 0xBF 0xBF"},
      {"\xF4\x90\x80\x80", "0 is not valid UTF-8 encoding:  0xF4 0x90 0x80 0x80"},
      {"\xF8\x88\x80\x80\x80", "0 is not valid UTF-8 encoding:  0xF8 0x88 0x80 0x80 0x80"},
      {"\xC3\xA9\xE2\x82", "2 is not valid UTF-8 encoding: \xC3\xA9 0xE2 0x82"},
      {"123456789\xC3", "9 is not valid UTF-8 encoding: 123456789 0xC3"},
      // Forty bytes before and eleven from there on are shown.
      {"ab" + std::string(40, 'c') + "\xFF" + std::string(20, 'z'),
       "42 is not valid UTF-8 encoding: " + std::string(40, 'c') +
           " 0xFF 0x7A 0x7A 0x7A 0x7A 0x7A 0x7A 0x7A 0x7A 0x7A 0x7A"},
      {"\xC3\xA9" + std::string(39, 'c') + "\xFF",
       "0 is not valid UTF-8 encoding:  0xA9 0x63 0x63 0x63 0x63 0x63 0x63 0x63 0x63 0x63 0x63"},
  };
  for (const auto& [utf8, where] : cases) {
    EXPECT_EQ(thrownMessage<Exception>([given = utf8.c_str()] { String str(given); }),
              "The byte sequence starting at index " + where);
  }
}

TEST(String, RefusesNullPointers) {
  const char* const noText = nullptr;
  const Char16* const noUnits = nullptr;
  EXPECT_EQ(thrownMessage<Exception>([&] { String str(noText); }), "null pointer");
  EXPECT_EQ(thrownMessage<Exception>([&] { String str(noText, 3); }), "null pointer");
  EXPECT_EQ(thrownMessage<Exception>([&] { String().append(noUnits, 1); }), "null pointer");
  EXPECT_EQ(thrownMessage<Exception>([&] { (void)(String("a") == noText); }), "null pointer");
}

TEST(String, CopiesAreIndependent) {
  const String original("aBc");
  String appended(original), indexed(original), removed(original), cleared(original),
      lowered(original);
  appended.append(String("d"));
  indexed[1] = Char16('x');
  removed.remove(0, 1);
  cleared.clear();
  lowered.toLower();
  EXPECT_EQ(text(original) + " " + text(appended) + " " + text(indexed), "aBc aBcd axc");
  EXPECT_EQ(text(removed) + " " + text(cleared) + " " + text(lowered), "Bc  abc");
  String empty;
  empty[0] = Char16('x');  // the terminating unit of this object alone
  empty.append(Char16('y'));
  EXPECT_EQ(text(empty), "y");
  EXPECT_EQ(Uint16(String::EMPTY[0]) + String().size(), 0u);
}

TEST(String, SubStringAndFind) {
  const String hello("hello");
  EXPECT_EQ(text(hello.subString(1, 2)), "el");
  EXPECT_EQ(text(hello.subString(1, 99)), "ello");
  EXPECT_EQ(text(hello.subString(5)) + text(hello.subString(6)), "");
  EXPECT_EQ(hello.find('l'), 2u);
  EXPECT_EQ(hello.find(3, 'l'), 3u);
  EXPECT_EQ(hello.find("ll"), 2u);
  EXPECT_EQ(hello.find("hello!"), PEG_NOT_FOUND);
  EXPECT_EQ(hello.find(""), PEG_NOT_FOUND);
  EXPECT_EQ(hello.reverseFind('l'), 3u);
  EXPECT_EQ(hello.reverseFind('x'), PEG_NOT_FOUND);
  EXPECT_EQ(text(String(hello, 3)), "hel");
}

TEST(String, RefusesIndexesPastTheEnd) {
  String str("abc");
  EXPECT_EQ(Uint16(static_cast<const String&>(str)[3]), 0);
  EXPECT_THROW(str[4], IndexOutOfBoundsException);
  EXPECT_THROW(static_cast<const String&>(str)[4], IndexOutOfBoundsException);
  EXPECT_THROW(str.find(4, 'a'), IndexOutOfBoundsException);
  EXPECT_THROW(str.remove(1, 3), IndexOutOfBoundsException);
  EXPECT_THROW(String(str, 4), IndexOutOfBoundsException);
  str.remove(1);
  EXPECT_EQ(text(str), "a");
}

TEST(String, Compares) {
  const std::tuple<const char*, const char*, int, int> cases[] = {
      {"abc", "abc", 0, 0}, {"abc", "ABC", 1, 0}, {"abc", "abcd", -1, -1},
      {"b", "abc", 1, 1},   {"_", "A", 1, -1},    {"\xC3\x89", "\xC3\xA9", -1, -1},
  };
  const auto sign = [](int x) { return (x > 0) - (x < 0); };
  for (const auto& [left, right, order, orderNoCase] : cases) {
    SCOPED_TRACE(std::string(left) + " / " + right);
    const String a(left), b(right);
    EXPECT_EQ(sign(String::compare(a, b)), order);
    EXPECT_EQ(sign(String::compare(b, a)), -order);
    EXPECT_EQ(sign(String::compareNoCase(a, b)), orderNoCase);
    EXPECT_EQ(String::equalNoCase(a, b), orderNoCase == 0);
    EXPECT_TRUE((a == b) == (order == 0) && (a == right) == (order == 0));
    EXPECT_TRUE((a < b) == (order < 0) && (a >= b) == (order >= 0));
  }
  EXPECT_EQ(String::compare("abcX", "abcY", 3), 0);
  const String withNul("a\0b", 3);
  EXPECT_EQ(text(withNul), "a");
  EXPECT_FALSE(withNul == "a" || String::equal(withNul, String("a")));
}

TEST(String, Prints) {
  std::ostringstream out;
  out << String("a\xC3\xA9\xE2\x82\xAC");
  EXPECT_EQ(out.str(), "a\xE9\\x20AC");
}

TEST(String, HoldsLongText) {
  const std::string longText(3 << 20, 'n');
  String str(longText.c_str());
  EXPECT_EQ(str.size(), longText.size());
  str.append(String("\xE2\x82\xAC"));
  EXPECT_EQ(text(str), longText + "\xE2\x82\xAC");
  EXPECT_THROW(str.reserveCapacity(0xFFFFFFF0u), std::bad_alloc);
  EXPECT_EQ(str.size(), longText.size() + 1);
}

}  // namespace
