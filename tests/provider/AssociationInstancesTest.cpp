// Instances of association classes: one for each related pair.

#include "LinkTest.h"

namespace {

class AssociationInstances : public LinkTest {
 protected:
  /// The two references of each delivered instance: "a-p 1" for item a and part p 1.
  std::vector<std::string> links(const char* path) {
    std::vector<std::string> found;
    Array<CIMInstance> instances = enumerate(path).instances;
    for (Uint32 i = 0; i < instances.size(); ++i) {
      std::string link;
      for (const char* name : {"Item", "Part"}) {
        CIMObjectPath end;
        instances[i].getProperty(instances[i].findProperty(CIMName(name))).getValue().get(end);
        link += (link.empty() ? "" : "-") + textOf(end.getKeyBindings()[0].getValue());
      }
      found.push_back(link);
    }
    return found;
  }
};

TEST_F(AssociationInstances, HoldsBothReferencesAsPropertiesAndKeys) {
  setTable(state->left, {"a"});
  start(classes() + association("T_Link", itemsAndParts()));
  const std::string item = "root/t:T_Item.Name=\\\"a\\\"";
  const std::string part = "root/t:T_Part.Id=\\\"p 1\\\"";
  EXPECT_THAT(enumerate("root/t:t_link").events,
              ElementsAre("processing",
                          "root/t:t_link.Item=\"" + item + "\",Part=\"" + part +
                              "\" {Item=reference root/t:T_Item.Name=\"a\", Part=reference "
                              "root/t:T_Part.Id=\"p 1\"}",
                          "complete"));
  Array<CIMInstance> instances = enumerate("root/t:T_Link").instances;
  const Array<CIMKeyBinding> keys = instances[0].getPath().getKeyBindings();
  EXPECT_EQ(keys[0].getType(), CIMKeyBinding::REFERENCE);
  EXPECT_EQ(host.calls.back(), "getClass root/t T_Link 0 1 0 null");
  EXPECT_EQ(get(instances[0].getPath()).instances.size(), 1u);
}

TEST_F(AssociationInstances, EachPairOfClassesInTurn) {
  start(classes() + association("T_Link", itemsAndParts() + itemsAndVolumes() +
                                              pairOf("T_Volume", "Owner", "T_Item", "Name")));
  EXPECT_THAT(links("root/t:T_Link"), ElementsAre("a-p 1", "b-p 0", "b-p 2", "a-1",
                                                  // an item's own pair, the other way round
                                                  "a-1", "1-a", "1-a"));
}

TEST_F(AssociationInstances, ForeignInstancesComeThroughTheHandle) {
  start(classes() + association("T_Link", itemsAndVolumes()));
  EXPECT_THAT(links("root/t:T_Link"), ElementsAre("a-1"));
  EXPECT_THAT(host.calls,
              ElementsAre("getClass root/t T_Item 0 1 1 null", "getClass root/t T_Item 0 1 1 null",
                          "enumerateInstances root/t T_Volume 1 0 1 1 null",
                          "getClass root/t T_Link 0 1 0 null"));
}

TEST_F(AssociationInstances, PartsThatCannotBeBuiltAreNoEnds) {
  setTable(state->right, {"b", nullptr, "b", "z"});
  start(classes() + association("T_Link", pairOf("T_Item", "Name", "T_Part", "Owner", "<true/>")));
  EXPECT_THAT(links("root/t:T_Link"),
              ElementsAre("a-p 0", "a-p 2", "a-p 3", "b-p 0", "b-p 2", "b-p 3"));
}

TEST_F(AssociationInstances, NameThatIsAClassToo) {
  start(classes() +
        definedClass("T_Link", constant("int", "1"), property("Item", constant("string", "A"))) +
        association("T_Link", itemsAndVolumes()));
  const auto events = enumerate("root/t:T_Link").events;
  ASSERT_EQ(events.size(), 6u);
  EXPECT_EQ(events[1], "root/t:T_Link.Item=\"A\" {Item=reference A}");
  EXPECT_THAT((std::vector<std::string>{events[0], events[2], events[3], events[5]}),
              ElementsAre("processing", "complete", "processing", "complete"));
}

TEST_F(AssociationInstances, ErrorsPass) {
  start(classes() + association("T_Undeclared", itemsAndVolumes()) +
        association("T_Item2", itemsAndVolumes()));
  EXPECT_THROW(enumerate("root/t:T_Undeclared"), CIMException);
  // A class without the reference properties.
  host.add(makeClass("T_Item2", {declared("Part", CIMTYPE_REFERENCE)}));
  EXPECT_THROW(enumerate("root/t:T_Item2"), IndexOutOfBoundsException);
}

}  // namespace
