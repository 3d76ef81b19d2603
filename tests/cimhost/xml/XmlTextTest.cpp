#include "cimhost/Text.h"
#include "cimhost/output/XmlText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace cimhost {
namespace {

using namespace Pegasus;

std::string escaped(const std::vector<int>& units) {
  Array<Char16> text;
  for (const int unit : units) text.append(Char16(static_cast<Uint16>(unit)));
  XmlBuffer out;
  out.appendText(String(text.getData(), text.size()));
  return std::string(out.view());
}

TEST(XmlText, WhatXmlHasNoFormForIsReplaced) {
  for (const int unit :
       {0x0, 0x1, 0x8, 0xB, 0xC, 0xE, 0x1F, 0xD800, 0xDBFF, 0xDC00, 0xDFFF, 0xFFFE, 0xFFFF}) {
    EXPECT_EQ(escaped({'a', unit, 'b'}), "a\uFFFDb") << unit;
  }
  EXPECT_EQ(escaped({0xDC00, 0xD800}), "\uFFFD\uFFFD");
  EXPECT_EQ(escaped({'\t', '\n', '\r', 0x7F, 0x80, 0x7FF, 0x800, 0xFFFD}),
            "\t\n\r\x7F\xC2\x80\u07FF\u0800\uFFFD");
  EXPECT_EQ(escaped({0xD800, 0xDC00, 0xDBFF, 0xDFFF}), "\U00010000\U0010FFFF");
  XmlBuffer out;
  out.appendText(std::string_view("a\xFF\x01<\xC3\xA9", 6));
  EXPECT_EQ(out.view(), "a\uFFFD\uFFFD&lt;\xC3\xA9");
}

// Pairs and entities across the border of a block.
TEST(XmlText, LongTextsAreWhole) {
  std::string text(4095, 'x');
  for (int i = 0; i < 5000; ++i) text += "\U0001F600\"";
  std::string expected = text;
  for (std::size_t at = 0; (at = expected.find('"', at)) != std::string::npos;) {
    expected.replace(at, 1, "&quot;");
  }
  XmlBuffer out;
  out.append("<");
  out.appendText(fromUtf8(text));
  EXPECT_EQ(out.view(), "<" + expected);
}

// A chain of instances that refer to each other does not exhaust the stack.
TEST(XmlText, EmbeddedInstancesAreCutOff) {
  CIMInstance inner(CIMName("A"));
  for (int i = 0; i < 100; ++i) {
    CIMInstance outer(CIMName("A"));
    outer.addProperty(CIMProperty(CIMName("P"), CIMValue(inner)));
    inner = outer;
  }
  XmlBuffer out;
  appendInstance(out, inner);
  int count = 0;
  for (std::size_t at = 0; (at = out.view().find("/INSTANCE", at) + 1) != 0;) ++count;
  EXPECT_EQ(count, 17);
}

}  // namespace
}  // namespace cimhost
