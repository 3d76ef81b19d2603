// What each operation writes to the log, at which level, in which order.

#include "LinkTest.h"
#include "provider/ValueMap.h"

using namespace Pegasus;

namespace {

struct LogCase {
  const char* name;
  void (*operation)(Vaneth::CommonProvider& provider);
  int level;  ///< The texts are written at this level and not below.
  std::vector<const char*> texts;
};

std::ostream& operator<<(std::ostream& out, const LogCase& given) {
  return out << given.name;
}

class Log : public LinkTest, public testing::WithParamInterface<LogCase> {};

TEST_P(Log, HasTheTextsInOrderAtTheirLevel) {
  const LogCase& given = GetParam();
  setTable(state->right, {"20260101120000.000000+060"});
  setTable(state->left, {"a"});
  CIMClass full =
      makeClass("T_Full", {declared("Other", CIMTYPE_STRING), declared("When", CIMTYPE_DATETIME),
                           declared("Name", CIMTYPE_STRING, Key::kYes)});
  CIMMethod method(CIMName("Run"), CIMTYPE_SINT32);
  method.addQualifier(CIMQualifier(CIMName("static"), CIMValue(Boolean(false))));
  full.addMethod(method);
  host.add(full);
  start(classes() +
        definedClass("T_Full", constant("int", "1"),
                     property("When", call("rightText", "getSi")) +
                         property("Name", constant("indexstring", "n"), call("setText", "setSi")) +
                         "<method name=\"Run\">" + call("run", "execCi") + "</method>") +
        association("T_Link", pairOf("T_Item", "Name", "T_Volume", "Owner", "<true/>")));
  {
    LogLevel below(given.level - 1);
    given.operation(*provider);
  }
  for (const char* text : given.texts) EXPECT_THAT(tree.log(), Not(HasSubstr(text)));
  std::filesystem::remove(tree.logs() / "CommonProvider.log");
  LogLevel level(given.level);
  given.operation(*provider);
  const std::string log = tree.log();
  size_t from = 0;
  for (const char* text : given.texts) {
    const size_t found = log.find(text, from);
    ASSERT_NE(found, std::string::npos) << text << "is not where it should be in\n" << log;
    from = found + std::char_traits<char>::length(text);
  }
}

template <const char* const& kPath>
void enumerateOf(Vaneth::CommonProvider& provider) {
  RecordingHandler handler;
  provider.enumerateInstances(OperationContext(), pathOf(kPath), false, false, CIMPropertyList(),
                              handler);
}

constexpr const char* kFull = "root/t:T_Full";
constexpr const char* kLink = "root/t:T_Link";

void modifyFull(Vaneth::CommonProvider& provider) {
  CIMInstance sent(CIMName("T_Full"));
  sent.addProperty(CIMProperty(CIMName("Name"), CIMValue(String("x"))));
  RecordingHandler handler;
  provider.modifyInstance(OperationContext(), pathOf("root/t:T_Full.Name=\"n 0\""), sent, false,
                          CIMPropertyList(), handler);
}

void invokeFull(Vaneth::CommonProvider& provider) {
  RecordingHandler handler;
  provider.invokeMethod(OperationContext(), pathOf(kFull), CIMName("Run"), Array<CIMParamValue>(),
                        handler);
}

void namesOfItem(Vaneth::CommonProvider& provider) {
  RecordingHandler handler;
  provider.associatorNames(OperationContext(), pathOf("//h/root/t:T_Item.Name=\"a\""),
                           CIMName("T_Link"), CIMName(), String(), String(), handler);
}

INSTANTIATE_TEST_SUITE_P(
    Operations, Log,
    testing::Values(
        LogCase{"Enumerate8",
                enumerateOf<kFull>,
                8,
                {"CommonProvider:enumerateInstances T_Full Entry\n",
                 "CommonProvider:ProviderDefClass found\n"}},
        LogCase{
            "Enumerate9",
            enumerateOf<kFull>,
            9,
            {"CommonProvider: for each instance 0\n", "getClass - ns:root/t, classname:T_Full\n",
             "number of properties is 3\n", "CommonProvider: for each property 0\n",
             "CommonProvider: end of a property process Other\n",
             "CommonProvider: for each property 1\n",
             "CommonProvider: ProviderDefProperty found When\n",
             "DATE TIME: 20260101120000.000000+060\n",
             "CommonProvider: end of a property process When\n",
             "CommonProvider: for each property 2\n",
             "CommonProvider: ProviderDefProperty found Name\n",
             "Adding String property value:n 0\n",
             "CommonProvider: end of a property process Name\n",
             "delever instances: root/t:T_Full.Name=\"n 0\"\n",
             "CommonProvider:End of ProviderDefClass process\n"}},
        LogCase{"Association7",
                enumerateOf<kLink>,
                7,
                {"enumerateInstances in CommonProvider:enumerateInstances T_Volume Entry\n"}},
        LogCase{
            "Association8",
            enumerateOf<kLink>,
            8,
            {"getPropertyValues: Property - Owner\n", "getPropertyValue : Class Owner, Value a\n",
             "getPropertyValues: Property - Name\n", "getPropertyValue : Class Name, Value a\n"}},
        LogCase{"Association9",
                enumerateOf<kLink>,
                9,
                {"CommonProvider:End of ProviderDefClass process\n",
                 "CommonProvider:ProviderDefAssociation found\n", "Source Instances T_Item: 1\n",
                 "Source Instances T_Volume: 2\n",
                 "delever instances: root/t:T_Link.Item=", "delever instances: root/t:T_Link.Item=",
                 "CommonProvider:End of ProviderDefAssociation process\n"}},
        LogCase{"Modify8", modifyFull, 8, {"CommonProvider:modifyInstances T_Full Entry\n"}},
        LogCase{"Modify9",
                modifyFull,
                9,
                {"CommonProvider:End of ProviderDefClass process\n",
                 "getClass - ns:root/t, classname:T_Full\n", "number of properties is 3\n",
                 "CommonProvider: for each property 2\n",
                 "CommonProvider: ProviderDefProperty found Name\n"}},
        LogCase{"Method8",
                invokeFull,
                8,
                {"CommonProvider:invokeMethod T_Full Entry\n",
                 "CommonProvider:ProviderDefClass found\n"}},
        LogCase{"Method9", invokeFull, 9, {"getClass - ns:root/t, classname:T_Full\n"}},
        LogCase{"Names7",
                namesOfItem,
                7,
                {"associatorNames : object: T_Item.Name=\"a\", association : T_Link, result : ",
                 "EnumerateInstances in associatorNames : object: T_Volume"}},
        LogCase{"Names8",
                namesOfItem,
                8,
                {"ProviderDefAssociation found\n", "Result class is : T_Volume",
                 "Source instances enumerated\n", "Target instances enumerated\n",
                 "Number of associated instance is : 2\n"}}),
    kByName);

using MapLog = Log;

TEST_F(MapLog, ValueMapNotesEachStep) {
  LogLevel level(9);
  CIMProperty map = declared("Map", CIMTYPE_UINT8, Key::kUnqualified);
  Array<String> texts;
  texts.append(String("1"));
  map.addQualifier(CIMQualifier(CIMName("ValueMap"), CIMValue(texts)));
  map.addQualifier(CIMQualifier(CIMName("Values"), CIMValue(texts)));
  CIMClass mapped = makeClass("T_Mapped", {map});
  EXPECT_TRUE(Vaneth::valueMapText(mapped, "Map", 1).has_value());
  EXPECT_EQ(tree.log(),
            "Found valuemap property \nQualifier: ValueMap\nQualifier: Values\n"
            "Found ValueMap Quarifier\nFound Value\nFound Values Quarifier\n");
  std::filesystem::remove(tree.logs() / "CommonProvider.log");
  EXPECT_TRUE(Vaneth::valueMapNumber(mapped, "Map", String("1")).has_value());
  EXPECT_EQ(tree.log(),
            "Found valuemap property \nQualifier: ValueMap\nQualifier: Values\n"
            "Found Values Quarifier\nFound Value\nFound ValueMap Quarifier\n");
}

}  // namespace
