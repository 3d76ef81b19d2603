// One instance by its path, instance names, and the comparison of key bindings.

#include "ProviderTest.h"

namespace {

class GetInstance : public ProviderTest {
 protected:
  void SetUp() override {
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

TEST_F(GetInstance, DeliversTheFirstMatch) {
  const std::pair<const char*, const char*> cases[] = {
      {"root/t:T_Item.Name=\"a\",Id=1", "first"},
      {"root/t:T_Item.Id=0x1,Name=\"a\"", "first"},
      {"//h/root/x:t_item.NAME=\"a\",ID=1", "first"},
      {"root/t:T_Item.Name=\"B\",Id=0", "second"},
      {"root/t:T_Item.Name=\"A\",Id=1", ""},
      {"root/t:T_Item.Name=\"a\",Id=\"1\"", ""},
      {"root/t:T_Item.Name=\"a\"", ""},
      {"root/t:T_Item.Name=\"a\",Id=1,More=1", ""},
      {"root/t:T_Item", ""},
      {"root/t:T_Nothing.Name=\"a\",Id=1", ""}};
  for (const auto& [path, found] : cases) {
    RecordingHandler handler = get(pathOf(path));
    const size_t instances = handler.instances.size();
    EXPECT_EQ(instances, *found == '\0' ? 0u : 1u) << path;
    ASSERT_EQ(handler.events.size(), instances + 2) << path;
    EXPECT_EQ(handler.events.front(), "processing");
    EXPECT_EQ(handler.events.back(), "complete");
    EXPECT_THAT(handler.events[instances], HasSubstr(found));
  }
}

TEST_F(GetInstance, NamesAreThePathsOfTheEnumeration) {
  EXPECT_THAT(
      instanceNames("root/t:T_Item").events,
      ElementsAre("processing", "root/t:T_Item.Id=1,Name=\"a\"", "root/t:T_Item.Id=0,Name=\"B\"",
                  "root/t:T_Item.Id=0,Name=\"B\"", "complete"));
  EXPECT_THAT(instanceNames("root/t:T_Nothing").events, ElementsAre("processing", "complete"));
}

TEST(CompareBindings, BothWays) {
  const struct {
    const char *a, *b;  // Paths with these bindings.
    bool equal;
  } cases[] = {
      {"T", "T", true},
      {"T", "T.A=1", false},
      {"T.A=\"C.k=1\"", "T.B=\"C.k=1\"", false},
      {"T.A=1,B=2", "T.A=1,B=3", false},
      // References to another place and class, to another key, within a reference.
      {"T.A=\"//h/root/a:C.k=1\"", "T.A=\"root/b:D.K=1\"", true},
      {"T.A=\"C.k=1\"", "T.A=\"C.k=2\"", false},
      {R"(T.A="C.r=\"x:D.k=1\"")", R"(T.A="C.r=\"y:E.k=1\"")", true},
  };
  for (const auto& c : cases) {
    const Array<CIMKeyBinding> a = pathOf(c.a).getKeyBindings();
    const Array<CIMKeyBinding> b = pathOf(c.b).getKeyBindings();
    EXPECT_EQ(Vaneth::compareBindings(a, b), c.equal) << c.a << " " << c.b;
    EXPECT_EQ(Vaneth::compareBindings(b, a), c.equal) << c.a << " " << c.b;
  }
  // The order counts: paths sort theirs.
  Array<CIMKeyBinding> turned;
  for (const char* name : {"B", "A"}) {
    turned.append(CIMKeyBinding(CIMName(name), String("1"), CIMKeyBinding::NUMERIC));
  }
  EXPECT_FALSE(Vaneth::compareBindings(turned, pathOf("T.A=1,B=1").getKeyBindings()));
  const Array<CIMKeyBinding> noPath(
      1, CIMKeyBinding(CIMName("A"), String("no path"), CIMKeyBinding::REFERENCE));
  EXPECT_THROW(Vaneth::compareBindings(noPath, noPath), MalformedObjectNameException);
}

}  // namespace
