// One instance by its path, instance names, and the comparison of key bindings.

#include "ProviderTest.h"

using namespace Pegasus;

namespace {

struct PathCase {
  const char* path;
  const char* found;  ///< The text of the instance's P, "" for none.
};

std::ostream& operator<<(std::ostream& out, const PathCase& given) {
  return out << given.path;
}

class GetInstance : public ProviderTest, public testing::WithParamInterface<PathCase> {
 protected:
  void startItems() {
    setTable(state->left, {"a", "B", "B"});
    setTable(state->right, {"first", "second", "third"});
    state->numbers[0] = 1;
    host.add(makeClass("T_Item",
                       {declared("Name", CIMTYPE_STRING, Key::kYes),
                        declared("Id", CIMTYPE_SINT16, Key::kYes), declared("P", CIMTYPE_STRING)}));
    start(itemClass(property("Id", call("number", "getIi")) +
                    property("P", call("rightText", "getSi"))));
  }
};

TEST_P(GetInstance, DeliversTheFirstMatch) {
  startItems();
  RecordingHandler handler = get(pathOf(GetParam().path));
  ASSERT_FALSE(handler.events.empty());
  EXPECT_EQ(handler.events.front(), "processing");
  EXPECT_EQ(handler.events.back(), "complete");
  EXPECT_EQ(handler.events.size() - 2, handler.instances.size());
  std::string found;
  for (Uint32 i = 0; i < handler.instances.size(); ++i) {
    found += textOf(handler.instances[i].getProperty(2).getValue().toString());
  }
  EXPECT_EQ(found, GetParam().found);
}

INSTANTIATE_TEST_SUITE_P(Paths, GetInstance,
                         testing::Values(PathCase{"root/t:T_Item.Name=\"a\",Id=1", "first"},
                                         PathCase{"root/t:T_Item.Id=0x1,Name=\"a\"", "first"},
                                         PathCase{"root/t:t_item.NAME=\"a\",ID=1", "first"},
                                         PathCase{"//h/root/x:T_Item.Name=\"a\",Id=1", "first"},
                                         PathCase{"root/t:T_Item.Name=\"B\",Id=0", "second"},
                                         PathCase{"root/t:T_Item.Name=\"A\",Id=1", ""},
                                         PathCase{"root/t:T_Item.Name=\"a\",Id=\"1\"", ""},
                                         PathCase{"root/t:T_Item.Name=\"a\"", ""},
                                         PathCase{"root/t:T_Item.Name=\"a\",Id=1,More=1", ""},
                                         PathCase{"root/t:T_Item", ""},
                                         PathCase{"root/t:T_Nothing.Name=\"a\",Id=1", ""}));

TEST_F(GetInstance, NamesAreThePathsOfTheEnumeration) {
  startItems();
  RecordingHandler names;
  provider->enumerateInstanceNames(context, pathOf("root/t:T_Item"), names);
  EXPECT_THAT(names.events, ElementsAre("processing", "root/t:T_Item.Id=1,Name=\"a\"",
                                        "root/t:T_Item.Id=0,Name=\"B\"",
                                        "root/t:T_Item.Id=0,Name=\"B\"", "complete"));
  RecordingHandler none;
  provider->enumerateInstanceNames(context, pathOf("root/t:T_Nothing"), none);
  EXPECT_THAT(none.events, ElementsAre("processing", "complete"));
}

TEST_F(GetInstance, ErrorsOfTheHandlerPass) {
  startItems();
  struct Strict : RecordingHandler {
    void complete() override { throw CIMException(CIM_ERR_FAILED, String("Too few")); }
  } strict;
  EXPECT_THROW(provider->getInstance(context, pathOf("root/t:T_Item.Name=\"z\""), false, false,
                                     CIMPropertyList(), strict),
               CIMException);
}

struct Binding {
  const char* name;
  const char* value;
  CIMKeyBinding::Type type;
};

struct BindingsCase {
  const char* name;
  std::vector<Binding> a, b;
  bool equal;
};

std::ostream& operator<<(std::ostream& out, const BindingsCase& given) {
  return out << given.name;
}

Array<CIMKeyBinding> bindingsOf(const std::vector<Binding>& bindings) {
  Array<CIMKeyBinding> result;
  for (const Binding& binding : bindings) {
    result.append(CIMKeyBinding(CIMName(binding.name), String(binding.value), binding.type));
  }
  return result;
}

class CompareBindings : public testing::TestWithParam<BindingsCase> {};

TEST_P(CompareBindings, BothWays) {
  const Array<CIMKeyBinding> a = bindingsOf(GetParam().a);
  const Array<CIMKeyBinding> b = bindingsOf(GetParam().b);
  EXPECT_EQ(Vaneth::compareBindings(a, b), GetParam().equal);
  EXPECT_EQ(Vaneth::compareBindings(b, a), GetParam().equal);
}

constexpr auto kString = CIMKeyBinding::STRING;
constexpr auto kNumeric = CIMKeyBinding::NUMERIC;
constexpr auto kReference = CIMKeyBinding::REFERENCE;

INSTANTIATE_TEST_SUITE_P(
    Lists, CompareBindings,
    testing::Values(
        BindingsCase{"BothEmpty", {}, {}, true},
        BindingsCase{"OneEmpty", {}, {{"A", "1", kNumeric}}, false},
        BindingsCase{"NameCase", {{"Key", "x", kString}}, {{"kEY", "x", kString}}, true},
        BindingsCase{"ValueCase", {{"A", "x", kString}}, {{"A", "X", kString}}, false},
        BindingsCase{"OtherName", {{"A", "x", kString}}, {{"B", "x", kString}}, false},
        BindingsCase{"OtherType", {{"A", "1", kString}}, {{"A", "1", kNumeric}}, false},
        BindingsCase{"NumbersByValue", {{"A", "16", kNumeric}}, {{"A", "0x10", kNumeric}}, true},
        BindingsCase{"AnotherOrder",
                     {{"A", "1", kNumeric}, {"B", "2", kNumeric}},
                     {{"B", "2", kNumeric}, {"A", "1", kNumeric}},
                     false},
        BindingsCase{"SecondDiffers",
                     {{"A", "1", kNumeric}, {"B", "2", kNumeric}},
                     {{"A", "1", kNumeric}, {"B", "3", kNumeric}},
                     false},
        BindingsCase{"ReferenceToAnotherPlaceAndClass",
                     {{"A", "//h/root/a:C.k=1", kReference}},
                     {{"A", "root/b:D.K=1", kReference}},
                     true},
        BindingsCase{"ReferenceToAnotherKey",
                     {{"A", "C.k=1", kReference}},
                     {{"A", "C.k=2", kReference}},
                     false},
        BindingsCase{"ReferenceInReference",
                     {{"A", "C.r=\"x:D.k=1\"", kReference}},
                     {{"A", "C.r=\"y:E.k=1\"", kReference}},
                     true}),
    kByName);

TEST(CompareBindingsError, ReferenceThatIsNoPath) {
  const Array<CIMKeyBinding> bad = bindingsOf({{"A", "no path", kReference}});
  EXPECT_THROW(Vaneth::compareBindings(bad, bad), MalformedObjectNameException);
}

}  // namespace
