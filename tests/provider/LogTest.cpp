// What each operation writes to the log, at which level, in which order.

#include "LinkTest.h"
#include "provider/ValueMap.h"

namespace {

struct Line {
  int level;  ///< It is written at this level and above.
  const char* text;
};

struct LogCase {
  const char* name;
  void (*operation)(ProviderTest& test);
  std::vector<Line> lines;  ///< In the order of the log.
};

class Log : public LinkTest {
 protected:
  void SetUp() override {
    LinkTest::SetUp();
    setTable(state->right, {"20260101120000.000000+060"});
    setTable(state->left, {"a"});
    host.add(makeClass("T_Full",
                       {declared("Other", CIMTYPE_STRING), declared("When", CIMTYPE_DATETIME),
                        declared("Name", CIMTYPE_STRING, Key::kYes)},
                       {method("Run", false)}));
    start(classes() +
          definedClass("T_Full", constant("int", "1"),
                       property("When", call("rightText", "getSi")) +
                           property("Name", constant("indexstring", "n")) +
                           "<method name=\"Run\">" + call("run", "execCi") + "</method>") +
          association("T_Link", pairOf("T_Item", "Name", "T_Volume", "Owner", "<true/>")));
  }
};

TEST_F(Log, HasTheLinesOfEachLevelInOrder) {
  const LogCase cases[] = {
      {"Enumerate",
       [](ProviderTest& test) { test.enumerate("root/t:T_Full"); },
       {{8, "CommonProvider:enumerateInstances T_Full Entry\n"},
        {8, "CommonProvider:ProviderDefClass found\n"},
        {9, "CommonProvider: for each instance 0\n"},
        {9, "getClass - ns:root/t, classname:T_Full\n"},
        {9, "number of properties is 3\n"},
        {9, "CommonProvider: for each property 0\n"},
        {9, "CommonProvider: end of a property process Other\n"},
        {9, "CommonProvider: ProviderDefProperty found When\n"},
        {9, "DATE TIME: 20260101120000.000000+060\n"},
        {9, "CommonProvider: for each property 2\n"},
        {9, "Adding String property value:n 0\n"},
        {9, "CommonProvider: end of a property process Name\n"},
        {9, "delever instances: root/t:T_Full.Name=\"n 0\"\n"},
        {9, "CommonProvider:End of ProviderDefClass process\n"}}},
      {"Association",
       [](ProviderTest& test) { test.enumerate("root/t:T_Link"); },
       {{9, "CommonProvider:End of ProviderDefClass process\n"},
        {9, "CommonProvider:ProviderDefAssociation found\n"},
        {9, "Source Instances T_Item: 1\n"},
        {7, "enumerateInstances in CommonProvider:enumerateInstances T_Volume Entry\n"},
        {9, "Source Instances T_Volume: 2\n"},
        {8, "getPropertyValues: Property - Owner\n"},
        {8, "getPropertyValue : Class Owner, Value a\n"},
        {8, "getPropertyValues: Property - Name\n"},
        {8, "getPropertyValue : Class Name, Value a\n"},
        {9, "delever instances: root/t:T_Link.Item="},
        {9, "CommonProvider:End of ProviderDefAssociation process\n"}}},
      {"Modify",
       [](ProviderTest& test) { test.modify("root/t:T_Full.Name=\"n 0\"", {}); },
       {{8, "CommonProvider:modifyInstances T_Full Entry\n"},
        {9, "getClass - ns:root/t, classname:T_Full\n"},
        {9, "number of properties is 3\n"},
        {9, "CommonProvider: for each property 2\n"},
        {9, "CommonProvider: ProviderDefProperty found Name\n"}}},
      {"Method",
       [](ProviderTest& test) { test.invoke("root/t:T_Full", "Run"); },
       {{8, "CommonProvider:invokeMethod T_Full Entry\n"},
        {8, "CommonProvider:ProviderDefClass found\n"},
        {9, "getClass - ns:root/t, classname:T_Full\n"}}},
      {"Names",
       [](ProviderTest& test) { test.associatorNames("//h/root/t:T_Item.Name=\"a\"", "T_Link"); },
       {{7, "associatorNames : object: T_Item.Name=\"a\", association : T_Link, result : "},
        {8, "ProviderDefAssociation found\n"},
        {8, "Result class is : T_Volume"},
        {8, "Source instances enumerated\n"},
        {7, "EnumerateInstances in associatorNames : object: T_Volume"},
        {8, "Target instances enumerated\n"},
        {8, "Number of associated instance is : 2\n"}}}};
  for (const LogCase& each : cases) {
    for (int level = 6; level <= 9; ++level) {
      SCOPED_TRACE(each.name + (" at level " + std::to_string(level)));
      std::filesystem::remove(tree.logs() / "CommonProvider.log");
      const LogLevel set(level);
      each.operation(*this);
      const std::string log = tree.log();
      size_t from = 0;
      for (const auto& [atLevel, text] : each.lines) {
        const size_t found = log.find(text, from);
        EXPECT_EQ(found != std::string::npos, level >= atLevel) << text << log;
        if (found != std::string::npos) from = found + std::char_traits<char>::length(text);
      }
    }
  }
}

using MapLog = ProviderTest;

TEST_F(MapLog, ValueMapNotesEachStep) {
  CIMProperty map = declared("Map", CIMTYPE_UINT8, Key::kUnqualified);
  for (const char* qualifier : {"ValueMap", "Values"}) {
    map.addQualifier(CIMQualifier(CIMName(qualifier), CIMValue(Array<String>(1, String("1")))));
  }
  CIMClass mapped = makeClass("T_Mapped", {map});
  const std::string found = "Found valuemap property \nQualifier: ValueMap\nQualifier: Values\n";
  const std::string map1 = "Found ValueMap Quarifier\n", values = "Found Values Quarifier\n";
  LogLevel level(9);
  EXPECT_TRUE(Vaneth::valueMapText(mapped, "Map", 1).has_value());
  EXPECT_EQ(tree.log(), found + map1 + "Found Value\n" + values);
  std::filesystem::remove(tree.logs() / "CommonProvider.log");
  EXPECT_TRUE(Vaneth::valueMapNumber(mapped, "Map", String("1")).has_value());
  EXPECT_EQ(tree.log(), found + values + "Found Value\n" + map1);
}

}  // namespace
