#include "ComparedClasses.h"

#include "tests/support/TemporaryTree.h"

#include <iterator>

namespace {

// A property as the class declares it and as the definition file serves it.
struct PropertyRow {
  const char* qualifiers;
  const char* type;  // With [] for an array.
  const char* name;
  const char* function;      // Its family follows from the type; with Set it is stored.
  const char* functionType;  // Null: a constant, whose type and text stand in `function`.
};

constexpr PropertyRow kElement[] = {
    {"Key, Override(\"Name\")", "string", "Name", "elementName", "getSi"},
    {"Key", "uint32", "Number", "elementNumber", "getIi"},
    {"Key(false)", "string", "Label", "indexstring:element", nullptr},
    {"Key(false)", "boolean", "Flag", "elementValue", "getIi"},
    {"Key(false)", "uint8", "U8", "elementValue", "getIi"},
    {"Key(false)", "sint8", "S8", "elementValue", "getIi"},
    {"Key(false)", "uint16", "U16", "elementValue", "getIi"},
    {"Key(false)", "sint16", "S16", "elementValue", "getIi"},
    {"Key(false)", "uint32", "U32", "elementValue", "getIi"},
    {"Key(false)", "sint32", "S32", "elementValue", "getIi"},
    {"Key(false)", "uint64", "U64", "elementLong", "getLi"},
    {"Key(false)", "sint64", "S64", "elementLong", "getLi"},
    {"Key(false)", "real32", "R32", "elementValue", "getIi"},
    {"Key(false)", "real64", "R64", "elementValue", "getIi"},
    {"Key(false)", "char16", "C16", "elementLetter", "getIi"},
    {"Key(false)", "datetime", "Time", "elementTime", "getSi"},
    {"Key(false)", "boolean[]", "Flags", "elementNumbers", "getAIi"},
    {"Key(false)", "uint8[]", "U8s", "elementNumbers", "getAIi"},
    {"Key(false)", "sint16[]", "S16s", "elementNumbers", "getAIi"},
    {"Key(false)", "uint64[]", "U64s", "elementNumbers", "getAIi"},
    {"Key(false)", "real64[]", "R64s", "elementNumbers", "getAIi"},
    {"Key(false)", "string[]", "Texts", "elementTexts", "getASi"},
    {"Key(false)", "datetime[]", "Times", "elementTimes", "getASi"},
    // A number where the class declares a text: empty.
    {"Key(false)", "string", "NoText", "elementValue", "getIi"},
};

constexpr PropertyRow kStored[] = {
    {"Key, Override(\"Name\")", "string", "Name", "elementName", "getSi"},
    {"Key(false), Write", "boolean", "Flag", "Number", "Iv"},
    {"Key(false), Write", "uint8", "U8", "Number", "Iv"},
    {"Key(false), Write", "sint32", "S32", "Number", "Iv"},
    {"Key(false), Write", "uint64", "U64", "Number", "Iv"},
    {"Key(false), Write", "real64", "R64", "Number", "Iv"},
    {"Key(false), Write", "string", "Text", "Text", "Sv"},
    {"Key(false), Write", "datetime", "Time", "Text", "Sv"},
    {"Key(false), Write", "sint32[]", "S32s", "Numbers", "AIv"},
    {"Key(false), Write", "string[]", "Texts", "Texts", "ASv"},
};

constexpr PropertyRow kPart[] = {
    {"Key, Override(\"Name\")", "string", "Name", "partName", "getSi"},
    {"Key(false)", "string", "Owner", "partOwner", "getSi"},
};

constexpr PropertyRow kBroken[] = {
    {"Key, Override(\"Name\")", "string", "Name", "partName", "getSi"},
    {"Key(false)", "string", "Text", "partBroken", "getSi"},
};

constexpr PropertyRow kNoFunction[] = {
    {"Key, Override(\"Name\")", "string", "Name", "partName", "getSi"},
    {"Key(false)", "sint32", "Number", "noSuchFunction", "getIi"},
};

const std::string kIndex = "<argument type=\"index\"/>";

std::string call(const std::string& function, const std::string& type,
                 const std::string& arguments) {
  return "<functioncall><function name=\"" + function + "\" type=\"" + type + "\"/>" + arguments +
         "</functioncall>";
}

std::string propertyText(const PropertyRow& row) {
  const std::string type = row.functionType == nullptr ? "" : row.functionType;
  const std::string function = row.function;
  std::string body;
  if (type.empty()) {
    const auto colon = function.find(':');
    body = "<get><constant type=\"" + function.substr(0, colon) + "\">" +
           function.substr(colon + 1) + "</constant></get>";
  } else if (type.compare(0, 3, "get") == 0) {
    body = "<get>" + call(function, type, kIndex) + "</get>";
  } else {
    const std::string place = kIndex + "<argument type=\"element\"><constant type=\"string\">" +
                              row.name + "</constant></argument>";
    body = "<get>" + call("stored" + function, "get" + type, place) + "</get><set>" +
           call("store" + function, "set" + type, place) + "</set>";
  }
  return "    <property name=\"" + std::string(row.name) + "\">" + body + "</property>\n";
}

template <std::size_t size>
std::string classText(const std::string& name, const std::string& instances,
                      const PropertyRow (&rows)[size], const std::string& methods = "") {
  std::string text = "  <class name=\"" + name + "\" namespace=\"root/compare\">\n    <instances>" +
                     instances + "</instances>\n";
  for (const PropertyRow& row : rows) text += propertyText(row);
  return text + methods + "  </class>\n";
}

std::string methodText(const std::string& name, const std::string& function,
                       const std::string& type, const std::string& arguments) {
  return "    <method name=\"" + name + "\">" + call(function, type, arguments) + "</method>\n";
}

template <std::size_t size>
std::string classDeclaration(const std::string& head, const PropertyRow (&rows)[size],
                             const std::string& methods = "") {
  std::string text = head + " {\n";
  for (const PropertyRow& row : rows) {
    std::string type = row.type;
    const bool isArray = type.back() == ']';
    if (isArray) type.resize(type.size() - 2);
    text += "  [" + std::string(row.qualifiers) + "] " + type + " " + row.name +
            (isArray ? "[];\n" : ";\n");
  }
  return text + methods + "};\n";
}

// What comes in goes out: a parameter of each type in both directions.
std::string echoDeclaration() {
  const char* const types[] = {"boolean",  "uint8",  "sint16",   "sint32",   "uint64", "real64",
                               "datetime", "string", "uint16[]", "string[]", "char16"};
  std::string text = "  [Static(false)] sint32 Echo(";
  for (const std::string direction : {"In", "Out"}) {
    for (std::size_t i = 0; i < std::size(types); ++i) {
      std::string type = types[i];
      const bool isArray = type.back() == ']';
      if (isArray) type.resize(type.size() - 2);
      text += (direction == "Out" || i > 0 ? ",\n    [" : "\n    [");
      text += direction == "In" ? "In, Out(false)] " : "In(false), Out] ";
      text += type + " " + direction + std::to_string(i) + (isArray ? "[]" : "");
    }
  }
  return text + ");\n";
}

constexpr const char* kMethods = R"(
  [Static] sint32 Which([In(false), Out] uint32 Index, [In(false), Out] string Name);
  [Static(false)] sint32 Die();
  [Static(false)] sint32 NoFunction();
  [Static(false)] sint32 NotServed();
  sint32 NoStatic();
)";

}  // namespace

std::string comparedDeclarations() {
  return std::string("[Abstract] class Cmp_Named {\n  [Key] string Name;\n};\n") +
         classDeclaration("class Cmp_Part : Cmp_Named", kPart) +
         classDeclaration("class Cmp_Element : Cmp_Named", kElement, echoDeclaration() + kMethods) +
         "class Cmp_SubElement : Cmp_Element {\n};\n" +
         classDeclaration("class Cmp_Stored : Cmp_Named", kStored) +
         classDeclaration("class Cmp_Broken : Cmp_Named", kBroken) +
         classDeclaration("class Cmp_NoFunction : Cmp_Named", kNoFunction) +
         classDeclaration("class Cmp_Empty : Cmp_Named", kPart) +
         classDeclaration("class Cmp_NoLibrary : Cmp_Named", kPart) +
         "class Cmp_NotServed : Cmp_Named {\n};\n"
         "[Association] class Cmp_Owns {\n"
         "  [Key] Cmp_Stored ref Owner;\n  [Key] Cmp_Part ref Owned;\n};\n"
         "[Association] class Cmp_Beside {\n"
         "  [Key] Cmp_Part ref Left;\n  [Key] Cmp_Broken ref Right;\n};\n";
}

std::string comparedDefinitions() {
  const std::string elements = call("elementCount", "getI", "");
  const std::string parts = call("partCount", "getI", "");
  const std::string transfer = "<argument type=\"input\"/><argument type=\"output\"/>";
  const std::string methods = methodText("Echo", "echo", "execC", transfer) +
                              methodText("Which", "whichElement", "execCi", kIndex + transfer) +
                              methodText("Die", "die", "execA", "") +
                              methodText("NoFunction", "noSuchMethod", "execA", "") +
                              methodText("NoStatic", "elementCount", "execA", "");
  std::string noLibrary = classText("Cmp_NoLibrary", "<constant type=\"int\">2</constant>", kPart);
  noLibrary.insert(noLibrary.find("<instances>"),
                   "<module name=\"/nowhere/libmissing.so\" path=\"fullpath\"/>");
  return "<plugin>\n  <module name=\"compare\" path=\"short\"/>\n" +
         classText("Cmp_Element", elements, kElement, methods) +
         classText("Cmp_SubElement", "<constant type=\"int\">2</constant>", kElement) +
         classText("Cmp_Stored", elements, kStored) + classText("Cmp_Part", parts, kPart) +
         classText("Cmp_Broken", parts, kBroken) + classText("Cmp_NoFunction", parts, kNoFunction) +
         classText("Cmp_Empty", "<constant type=\"int\">0</constant>", kPart) + noLibrary +
         R"(  <association name="Cmp_Owns" namespace2="root/compare" propertyname1="Owner" propertyname2="Owned">
    <classname name="Cmp_Stored"><propertyname name="Name"/></classname>
    <classname name="Cmp_Part"><propertyname name="Owner"/></classname>
    <condition><equal>0 0</equal></condition>
  </association>
  <association name="Cmp_Beside" namespace2="root/compare" propertyname1="Left" propertyname2="Right">
    <classname name="Cmp_Part"><propertyname name="Name"/></classname>
    <classname name="Cmp_Broken"><propertyname name="Name"/></classname>
    <condition><equal>0 0</equal></condition>
  </association>
</plugin>
)";
}

void writeComparedHome(const std::filesystem::path& home) {
  for (const char* folder : {"run", "lib", "logs", "mof/root/compare"}) {
    std::filesystem::create_directories(home / folder);
  }
  std::filesystem::create_symlink(COMPARE_PLUGIN, home / "lib/libcompare.so");
  TemporaryTree::write(home / "run/compare.xml", comparedDefinitions());
  TemporaryTree::write(home / "mof/root/compare/compare.mof", comparedDeclarations());
}
