#include "platform/StringConverters.h"

#include <Pegasus/Common/Exception.h>

#include <gtest/gtest.h>

using namespace Vaneth;

TEST(StringConverters, ReadUtf8ElseLatin1) {
  const std::pair<std::string, std::wstring> cases[] = {
      {"", L""},
      {std::string("a\0b", 3), std::wstring(L"a\0b", 3)},
      {"\xC2\x80\xDF\xBF", L"\u0080\u07ff"},
      {"\xE0\xA0\x80\xEF\xBF\xBF", L"\u0800\xffff"},
      {"\xF0\x90\x80\x80\xF4\x8F\xBF\xBF", L"\U00010000\U0010FFFF"},
      // Not UTF-8: a lone or cut-off byte, too long a form, beyond the last code point.
      {"\x80", L"\x80"},
      {"a\xE2\x82", L"a\xe2\x82"},
      {"\xC0\x80", L"\xc0\x80"},
      {"\xE0\x9F\xBF", L"\xe0\x9f\xbf"},
      {"\xF0\x8F\xBF\xBF", L"\xf0\x8f\xbf\xbf"},
      {"\xF4\x90\x80\x80", L"\xf4\x90\x80\x80"},
      {"\xC3\xA9\xE9", L"\xc3\xa9\xe9"},
  };
  for (const auto& [narrow, wide] : cases) EXPECT_EQ(make_wstring(narrow), wide) << narrow;
}

TEST(StringConverters, WriteUtf8) {
  const std::pair<std::wstring, std::string> cases[] = {
      {L"a\u00e9\u20ac\U0001F600", "a\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80"},
      {std::wstring(L"a\0b", 3), std::string("a\0b", 3)},
      {std::wstring(1, static_cast<wchar_t>(0x110000)), "\xEF\xBF\xBD"},
      {std::wstring(1, static_cast<wchar_t>(-1)), "\xEF\xBF\xBD"},
  };
  for (const auto& [wide, narrow] : cases) EXPECT_EQ(make_string(wide), narrow);
}

TEST(StringConverters, CarryServerTextBothWays) {
  for (const std::string& text :
       {std::string(), std::string("caf\xC3\xA9 \xE2\x82\xAC \xF0\x9F\x98\x80"),
        std::string("a\0b", 3)}) {
    EXPECT_EQ(make_string(make_String(text)), text);
  }
  EXPECT_EQ(make_String("\xF0\x9F\x98\x80").size(), 2u) << "a pair of UTF-16 units";
  for (const char* text : {"\xE9", "\xC3", "\xF4\x90\x80\x80"}) {
    EXPECT_THROW(make_String(text), Pegasus::Exception) << text;
  }
}
