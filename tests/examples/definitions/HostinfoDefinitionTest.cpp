#include <gmock/gmock.h>

#include <algorithm>

#include "association/ProviderDefAssociation.h"
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

TEST(HostinfoDefinition, MethodsReachTheirFunctions) {
  const ExampleHome home("hostinfo");
  const ProviderDefClass* definition = getProviderDefClass("Host_FileSystem");
  const auto names = ExampleHome::values("Host_FileSystem", "Name");
  std::vector<ProviderDefValue> outputs;
  ASSERT_NE(definition->getMethod("FindByType"), nullptr);
  definition->getMethod("FindByType")->exec({"", 1}, outputs, 0);
  ASSERT_EQ(outputs.size(), 2u);
  EXPECT_EQ(outputs[0].getIntValue(), static_cast<int>(names.size()));
  EXPECT_THAT(outputs[1].getStringArray(), testing::ElementsAre(names[0].getStringValue()));

  const int last = static_cast<int>(names.size()) - 1;
  outputs.clear();
  ASSERT_NE(definition->getMethod("CheckSpace"), nullptr);
  EXPECT_EQ(definition->getMethod("CheckSpace")->exec({0}, outputs, last), 0);
  ASSERT_EQ(outputs.size(), 3u);
  EXPECT_EQ(outputs[2].getStringValue(), names.back().getStringValue());
}

TEST(HostinfoDefinition, TheNoteThatIsSetIsRead) {
  const ExampleHome home("hostinfo");
  ASSERT_GT(getProviderDefClass("Host_FileSystem")->getNumberOfInstances(), 0);
  const auto* owner = getProviderDefClass("Host_FileSystem")->getProperty("Owner");
  const std::string before = owner->getValue(0).getStringValue();
  EXPECT_EQ(owner->setValue("Ann B.", 0), 0);
  EXPECT_EQ(owner->getValue(0).getStringValue(), "Ann B.");
  EXPECT_EQ(owner->setValue(ProviderDefValue(before), 0), 0);
}

std::vector<std::vector<ProviderDefValue>> rows(const char* className, const char* property) {
  std::vector<std::vector<ProviderDefValue>> result;
  for (const ProviderDefValue& value : ExampleHome::values(className, property)) {
    result.push_back({value});
  }
  return result;
}

std::vector<int> positionsOf(const ProviderDefValue& wanted,
                             const std::vector<std::vector<ProviderDefValue>>& among) {
  std::vector<int> result;
  for (std::size_t i = 0; i < among.size(); ++i) {
    if (among[i][0].getStringValue() == wanted.getStringValue()) {
      result.push_back(static_cast<int>(i));
    }
  }
  return result;
}

TEST(HostinfoDefinition, LinksEachAddressWithItsPort) {
  const ExampleHome home("hostinfo");
  const ProviderDefAssociation* link = getProviderDefAssociation("Host_PortEndpoint");
  ASSERT_NE(link, nullptr);
  EXPECT_EQ(link->getPropertyNamePair(),
            std::make_pair(std::string("Port"), std::string("Endpoint")));
  const auto ports = rows("Host_NetworkPort", "Name");
  const auto endpoints = rows("Host_IPEndpoint", "PortName");

  std::size_t linked = 0;
  for (std::size_t i = 0; i < ports.size(); ++i) {
    const auto found = link->getAssociation("Host_NetworkPort", static_cast<int>(i), ports[i],
                                            "Host_IPEndpoint", endpoints);
    EXPECT_EQ(found, positionsOf(ports[i][0], endpoints));
    linked += found.size();
  }
  EXPECT_EQ(linked, endpoints.size());

  for (std::size_t i = 0; i < endpoints.size(); ++i) {
    EXPECT_EQ(link->getAssociation("Host_IPEndpoint", static_cast<int>(i), endpoints[i],
                                   "Host_NetworkPort", ports),
              positionsOf(endpoints[i][0], ports));
  }
}

}  // namespace
