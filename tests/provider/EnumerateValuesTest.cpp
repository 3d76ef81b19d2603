// What a plug-in's answer becomes in a property, for every CIM type.

#include <climits>

#include "ProviderTest.h"

using namespace Pegasus;

namespace {

struct ScalarCase {
  CIMType type;
  std::string definition;
  int number;         ///< The answer of number().
  const char* text;   ///< The answer of leftText().
  std::string value;  ///< Of the property; the key's text too, unless `key` gives another.
  CIMKeyBinding::Type keyType;
  const char* key = nullptr;
};

std::ostream& operator<<(std::ostream& out, const ScalarCase& given) {
  return out << cimTypeToString(given.type) << " of " << given.number << " '" << given.text << "'";
}

const long kWide = sizeof(long) == 8 ? LONG_MIN : -5;

class ScalarProperty : public ProviderTest, public testing::WithParamInterface<ScalarCase> {};

TEST_P(ScalarProperty, HasTheValueAndItsKeyBinding) {
  const ScalarCase& given = GetParam();
  setTable(state->left, {given.text});
  state->numbers[0] = given.number;
  state->wide = kWide;
  host.add(makeClass("T_Value", {declared("P", given.type, Key::kYes)}));
  start(definedClass("T_Value", constant("int", "1"), property("P", given.definition)));
  Array<CIMInstance> instances = enumerate("root/t:T_Value").instances;
  ASSERT_EQ(instances.size(), 1u);
  EXPECT_EQ(textOf(CIMValue(instances[0].getProperty(0).getValue())),
            std::string(cimTypeToString(given.type)) + " " + given.value);
  const Array<CIMKeyBinding> keys = instances[0].getPath().getKeyBindings();
  ASSERT_EQ(keys.size(), 1u);
  EXPECT_EQ(keys[0].getType(), given.keyType);
  EXPECT_EQ(textOf(keys[0].getValue()), given.key == nullptr ? given.value : given.key);
}

const std::string kNumber = call("number", "getIi");
const std::string kLong = call("wide", "getLi");
const std::string kText = call("leftText", "getSi");
constexpr auto kNumeric = CIMKeyBinding::NUMERIC;

INSTANTIATE_TEST_SUITE_P(
    Numbers, ScalarProperty,
    testing::Values(ScalarCase{CIMTYPE_BOOLEAN, kNumber, -2, "", "TRUE", CIMKeyBinding::BOOLEAN},
                    ScalarCase{CIMTYPE_BOOLEAN, kNumber, 0, "", "FALSE", CIMKeyBinding::BOOLEAN},
                    ScalarCase{CIMTYPE_UINT8, kNumber, 511, "", "255", kNumeric},
                    ScalarCase{CIMTYPE_SINT8, kNumber, 255, "", "-1", kNumeric},
                    ScalarCase{CIMTYPE_UINT16, kNumber, -1, "", "65535", kNumeric},
                    ScalarCase{CIMTYPE_SINT16, kNumber, 0x18000, "", "-32768", kNumeric},
                    ScalarCase{CIMTYPE_UINT32, kNumber, -1, "", "4294967295", kNumeric},
                    ScalarCase{CIMTYPE_SINT32, kNumber, INT_MIN, "", "-2147483648", kNumeric},
                    ScalarCase{CIMTYPE_UINT64, kNumber, -1, "", "18446744073709551615", kNumeric},
                    ScalarCase{CIMTYPE_UINT64, kLong, 0, "",
                               std::to_string(static_cast<unsigned long long>(kWide)), kNumeric},
                    ScalarCase{CIMTYPE_SINT64, kLong, 0, "", std::to_string(kWide), kNumeric},
                    // Only 64-bit properties read a long.
                    ScalarCase{CIMTYPE_SINT32, kLong, 0, "", "0", kNumeric},
                    ScalarCase{CIMTYPE_REAL32, kNumber, 3, "", "3.0000000000000000e+00", kNumeric},
                    ScalarCase{CIMTYPE_REAL64, kNumber, -2, "", "-2.0000000000000000e+00",
                               kNumeric},
                    ScalarCase{CIMTYPE_CHAR16, kNumber, 0x10041, "", "A", CIMKeyBinding::STRING},
                    // A boolean constant has no integer.
                    ScalarCase{CIMTYPE_BOOLEAN, constant("boolean", "true"), 0, "", "FALSE",
                               CIMKeyBinding::BOOLEAN}));

INSTANTIATE_TEST_SUITE_P(
    Texts, ScalarProperty,
    testing::Values(ScalarCase{CIMTYPE_STRING, kText, 0, "\xc3\xa9 %s\"", "\xc3\xa9 %s\"",
                               CIMKeyBinding::STRING},
                    ScalarCase{CIMTYPE_STRING, kNumber, 5, "", "", CIMKeyBinding::STRING},
                    ScalarCase{CIMTYPE_DATETIME, kText, 0, "20260101120000.000000-000",
                               "20260101120000.000000+000", CIMKeyBinding::STRING},
                    ScalarCase{CIMTYPE_REFERENCE, kText, 0, "root/t:B.z=1,a=\"x\"",
                               "root/t:B.a=\"x\",z=1", CIMKeyBinding::REFERENCE}));

struct ArrayCase {
  CIMType type;
  const char* value;
};

std::ostream& operator<<(std::ostream& out, const ArrayCase& given) {
  return out << cimTypeToString(given.type);
}

class ArrayProperty : public ProviderTest, public testing::WithParamInterface<ArrayCase> {};

TEST_P(ArrayProperty, HasEveryElement) {
  const ArrayCase& given = GetParam();
  const bool isDate = given.type == CIMTYPE_DATETIME;
  setTable(state->left, {isDate ? "20260101120000.000000+060" : "a b",
                         isDate ? "00000001000000.000000:000" : "", isDate ? nullptr : "c"});
  if (isDate) state->left.count = 2;
  state->numbers[0] = 65;
  state->numbers[1] = -1;
  state->numbersCount = 2;
  host.add(makeClass("T_Value", {declared("P", given.type, Key::kNo, true)}));
  const bool isText = isDate || given.type == CIMTYPE_STRING;
  start(definedClass("T_Value", constant("int", "1"),
                     property("P", isText ? call("texts", "getASi") : call("numbers", "getAIi"))));
  EXPECT_THAT(enumerate("root/t:T_Value").events,
              ElementsAre("processing",
                          "root/t:T_Value {P=" + std::string(cimTypeToString(given.type)) + "[] " +
                              given.value + "}",
                          "complete"));
}

// No property can be an array of references.
INSTANTIATE_TEST_SUITE_P(
    Types, ArrayProperty,
    testing::Values(
        ArrayCase{CIMTYPE_BOOLEAN, "TRUE TRUE "}, ArrayCase{CIMTYPE_UINT8, "65 255 "},
        ArrayCase{CIMTYPE_SINT8, "65 -1 "}, ArrayCase{CIMTYPE_UINT16, "65 65535 "},
        ArrayCase{CIMTYPE_SINT16, "65 -1 "}, ArrayCase{CIMTYPE_UINT32, "65 4294967295 "},
        ArrayCase{CIMTYPE_SINT32, "65 -1 "}, ArrayCase{CIMTYPE_UINT64, "65 18446744073709551615 "},
        ArrayCase{CIMTYPE_SINT64, "65 -1 "},
        ArrayCase{CIMTYPE_REAL32, "6.5000000000000000e+01 -1.0000000000000000e+00 "},
        ArrayCase{CIMTYPE_REAL64, "6.5000000000000000e+01 -1.0000000000000000e+00 "},
        ArrayCase{CIMTYPE_CHAR16, "A \xef\xbf\xbf "}, ArrayCase{CIMTYPE_STRING, "a b  c "},
        ArrayCase{CIMTYPE_DATETIME, "20260101120000.000000+060 00000001000000.000000:000 "}));

}  // namespace
