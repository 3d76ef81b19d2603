#include "cimhost/output/XmlText.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>
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

constexpr const char* kReplacement = "\xEF\xBF\xBD";

TEST(XmlText, WhatXmlHasNoFormForIsReplaced) {
  for (const int unit :
       {0x0, 0x1, 0x8, 0xB, 0xC, 0xE, 0x1F, 0xD800, 0xDBFF, 0xDC00, 0xDFFF, 0xFFFE, 0xFFFF}) {
    EXPECT_EQ(escaped({'a', unit, 'b'}), std::string("a") + kReplacement + "b") << unit;
  }
  EXPECT_EQ(escaped({0xDC00, 0xD800}), std::string(kReplacement) + kReplacement);
  EXPECT_EQ(escaped({'\t', '\n', '\r', 0x7F, 0x80, 0x7FF, 0x800, 0xFFFD}),
            "\t\n\r\x7F\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBD");
  EXPECT_EQ(escaped({0xD800, 0xDC00, 0xDBFF, 0xDFFF}), "\xF0\x90\x80\x80\xF4\x8F\xBF\xBF");
  XmlBuffer out;
  out.appendText(std::string_view("a\xFF\x01<\xC3\xA9", 6));
  EXPECT_EQ(out.view(), std::string("a") + kReplacement + kReplacement + "&lt;\xC3\xA9");
}

// Pairs and entities across the border of a block.
TEST(XmlText, LongTextsAreWhole) {
  std::string expected(4095, 'x');
  Array<Char16> units;
  for (int i = 0; i < 4095; ++i) units.append(Char16('x'));
  for (int i = 0; i < 5000; ++i) {
    units.append(Char16(0xD83D));
    units.append(Char16(0xDE00));
    units.append(Char16('"'));
    expected += "\xF0\x9F\x98\x80&quot;";
  }
  XmlBuffer out;
  out.append("<");
  out.appendText(String(units.getData(), units.size()));
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

TEST(XmlText, ClassesWithMethods) {
  CIMClass declaration(CIMName("A"));
  CIMMethod method(CIMName("M"), CIMTYPE_BOOLEAN);
  method.addParameter(CIMParameter(CIMName("a"), CIMTYPE_UINT8, true, 3));
  method.addParameter(CIMParameter(CIMName("r"), CIMTYPE_REFERENCE, true, 0, CIMName("B")));
  declaration.addMethod(method);
  CIMProperty property(CIMName("d"), CIMValue(Uint8(5)));
  property.addQualifier(CIMQualifier(CIMName("KEY"), CIMValue(false)));
  declaration.addProperty(property);
  XmlBuffer out;
  appendClass(out, declaration);
  EXPECT_EQ(out.view(),
            "<CLASS NAME=\"A\"><PROPERTY NAME=\"d\" TYPE=\"uint8\"><VALUE>5</VALUE></PROPERTY>"
            "<METHOD NAME=\"M\" TYPE=\"boolean\"><PARAMETER.ARRAY NAME=\"a\" TYPE=\"uint8\" "
            "ARRAYSIZE=\"3\"></PARAMETER.ARRAY><PARAMETER.REFARRAY NAME=\"r\" "
            "REFERENCECLASS=\"B\"></PARAMETER.REFARRAY></METHOD></CLASS>");
}

}  // namespace
}  // namespace cimhost
