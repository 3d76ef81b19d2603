#include <gmock/gmock.h>

#include "tests/examples/definitions/ExampleHome.h"

namespace {

struct PropertyCase {
  const char* name;
  const char* className;
  const char* property;
  ProviderDefValue::Type type;
};

class HostinfoProperties : public testing::TestWithParam<PropertyCase> {
 protected:
  ExampleHome home_{"hostinfo"};
};

// A value of another type would show as 0 or empty in the CIM property.
TEST_P(HostinfoProperties, HaveTheTypeThatTheDeclarationNeeds) {
  const auto values = ExampleHome::values(GetParam().className, GetParam().property);
  EXPECT_FALSE(values.empty());
  for (const ProviderDefValue& value : values) EXPECT_EQ(value.getType(), GetParam().type);
}

INSTANTIATE_TEST_SUITE_P(
    All, HostinfoProperties,
    testing::Values(
        PropertyCase{"Text", "Host_FileSystem", "Name", ProviderDefValue::kString},
        PropertyCase{"Long", "Host_FileSystem", "SizeKiB", ProviderDefValue::kLong},
        PropertyCase{"Number", "Host_FileSystem", "PercentUsed", ProviderDefValue::kInteger},
        PropertyCase{"YesNo", "Host_FileSystem", "ReadOnly", ProviderDefValue::kInteger},
        PropertyCase{"Texts", "Host_FileSystem", "MountOptions", ProviderDefValue::kStringArray},
        PropertyCase{"Note", "Host_FileSystem", "Owner", ProviderDefValue::kString},
        PropertyCase{"Constant", "Host_FileSystem", "CreationClassName", ProviderDefValue::kString},
        PropertyCase{"IndexString", "Host_NetworkPort", "Label", ProviderDefValue::kIndexString},
        PropertyCase{"Numbers", "Host_NetworkPort", "Traffic", ProviderDefValue::kIntArray},
        PropertyCase{"Address", "Host_IPEndpoint", "Address", ProviderDefValue::kString},
        PropertyCase{"Protocol", "Host_IPEndpoint", "ProtocolIFType", ProviderDefValue::kInteger}),
    [](const auto& testCase) { return testCase.param.name; });

TEST(HostinfoDefinition, ArraysArriveWhole) {
  const ExampleHome home("hostinfo");
  for (const ProviderDefValue& options : ExampleHome::values("Host_FileSystem", "MountOptions")) {
    EXPECT_THAT(options.getStringArray(), testing::Contains(testing::AnyOf("rw", "ro")));
    EXPECT_THAT(options.getStringArray(), testing::Not(testing::Contains("")));
  }
  for (const ProviderDefValue& traffic : ExampleHome::values("Host_NetworkPort", "Traffic")) {
    EXPECT_THAT(traffic.getIntArray(), testing::SizeIs(4));
  }
}

}  // namespace
