#include "ComparedClasses.h"

#include "tests/support/TemporaryTree.h"

#include <algorithm>
#include <vector>

namespace {

// Each row is what one function gives: its name and type, then each property's type (* for a key)
// and name ([] for an array). Without "get" clients set it; a constant stands with text and type.
using Rows = std::vector<const char*>;

const Rows kElement = {
    "elementName getSi *string Name", "elementNumber getIi *uint32 Number",
    "element indexstring string Label",
    "elementValue getIi boolean Flag uint8 U8 sint8 S8 uint16 U16 sint16 S16 uint32 U32 sint32 S32",
    "elementLong getLi uint64 U64 sint64 S64", "elementValue getIi real32 R32 real64 R64",
    "elementLetter getIi char16 C16", "elementTime getSi datetime Time",
    "elementNumbers getAIi boolean Flags[] uint8 U8s[] sint16 S16s[] uint64 U64s[] real64 R64s[]",
    "elementTexts getASi string Texts[]", "elementTimes getASi datetime Times[]",
    // A number where the class declares a text: empty.
    "elementValue getIi string NoText"};

const Rows kStored = {"elementName getSi *string Name",
                      "Number Iv boolean Flag uint8 U8 sint32 S32 uint64 U64 real64 R64",
                      "Text Sv string Text datetime Time", "Numbers AIv sint32 S32s[]",
                      "Texts ASv string Texts[]"};

const Rows kPart = {"partName getSi *string Name", "partOwner getSi string Owner"};
const Rows kBroken = {"partName getSi *string Name", "partBroken getSi string Text"};
const Rows kNoFunction = {"partName getSi *string Name", "noSuchFunction getIi sint32 Number"};

const std::string kIndex = R"(<argument type="index"/>)";
const std::string kTransfer = R"(<argument type="input"/><argument type="output"/>)";

std::string call(const std::string& function, const std::string& type,
                 const std::string& arguments = "") {
  return "<functioncall><function name=\"" + function + "\" type=\"" + type + "\"/>" + arguments +
         "</functioncall>";
}

std::string constant(const std::string& type, const std::string& text) {
  return "<constant type=\"" + type + "\">" + text + "</constant>";
}

std::string accessors(const std::string& function, const std::string& type,
                      const std::string& property) {
  if (type == "indexstring") return "<get>" + constant(type, function) + "</get>";
  if (type.compare(0, 3, "get") == 0) return "<get>" + call(function, type, kIndex) + "</get>";
  const std::string place =
      kIndex + "<argument type=\"element\">" + constant("string", property) + "</argument>";
  return "<get>" + call("stored" + function, "get" + type, place) + "</get><set>" +
         call("store" + function, "set" + type, place) + "</set>";
}

// Texts for class declarations and for the definition file.
struct Texts {
  std::string declared, defined;
};

Texts propertiesOf(const Rows& rows) {
  Texts texts;
  for (const char* row : rows) {
    std::istringstream words(row);
    std::string function, functionType, type, name;
    for (words >> function >> functionType; words >> type >> name;) {
      const bool isKey = type[0] == '*';
      texts.declared += std::string("  [Key") + (isKey ? "" : "(false)") +
                        (name == "Name" ? ", Override(\"Name\")" : "") +
                        (functionType.back() == 'v' ? ", Write] " : "] ") + type.substr(isKey) +
                        " " + name + ";\n";
      name = name.substr(0, name.find('['));
      texts.defined += "    <property name=\"" + name + "\">" +
                       accessors(function, functionType, name) + "</property>\n";
    }
  }
  return texts;
}

// What comes in goes out: a parameter of each type in both directions.
std::string echoDeclaration() {
  const char* const types[] = {"boolean",  "uint8",  "sint16",   "sint32",   "uint64", "real64",
                               "datetime", "string", "uint16[]", "string[]", "char16"};
  std::string parameters;
  for (const std::string direction : {"In", "Out"}) {
    int number = 0;
    for (const std::string type : types) {
      const auto bracket = std::min(type.find('['), type.size());
      parameters += std::string(parameters.empty() ? "" : ",") + "\n    [" +
                    (direction == "In" ? "In, Out(false)] " : "In(false), Out] ") +
                    type.substr(0, bracket) + " " + direction + std::to_string(number++) +
                    type.substr(bracket);
    }
  }
  return "  [Static(false)] sint32 Echo(" + parameters + ");\n";
}

constexpr const char* kMethods = R"(
  [Static] sint32 Which([In(false), Out] uint32 Index, [In(false), Out] string Name);
  [Static(false)] sint32 Die();
  [Static(false)] sint32 NoFunction();
  [Static(false)] sint32 NotServed();
  sint32 NoStatic();
)";

std::string method(const std::string& name, const std::string& functionCall) {
  return "    <method name=\"" + name + "\">" + functionCall + "</method>\n";
}

// Adds a class below Cmp_Named.
void add(Texts& to, const std::string& name, const std::string& instances, const Rows& rows,
         const Texts& methods = {}, const std::string& module = "") {
  const Texts properties = propertiesOf(rows);
  to.declared +=
      "class " + name + " : Cmp_Named {\n" + properties.declared + methods.declared + "};\n";
  to.defined += "  <class name=\"" + name + "\" namespace=\"root/compare\">" + module +
                "\n    <instances>" + instances + "</instances>\n" + properties.defined +
                methods.defined + "  </class>\n";
}

constexpr const char* kMoreDeclarations = R"(class Cmp_NotServed : Cmp_Named {
};
[Association] class Cmp_Owns {
  [Key] Cmp_Stored ref Owner;
  [Key] Cmp_Part ref Owned;
};
[Association] class Cmp_Beside {
  [Key] Cmp_Part ref Left;
  [Key] Cmp_Broken ref Right;
};
)";

constexpr const char* kAssociations =
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
)";

Texts allClasses() {
  const std::string elements = call("elementCount", "getI");
  const std::string parts = call("partCount", "getI");
  const std::string two = constant("int", "2");
  Texts all{"[Abstract] class Cmp_Named {\n  [Key] string Name;\n};\n", ""};
  add(all, "Cmp_Part", parts, kPart);
  add(all, "Cmp_Element", elements, kElement,
      {echoDeclaration() + kMethods,
       method("Echo", call("echo", "execC", kTransfer)) +
           method("Which", call("whichElement", "execCi", kIndex + kTransfer)) +
           method("Die", call("die", "execA")) +
           method("NoFunction", call("noSuchMethod", "execA")) +
           method("NoStatic", call("elementCount", "execA"))});
  Texts below;
  add(below, "Cmp_SubElement", two, kElement);
  all.declared += "class Cmp_SubElement : Cmp_Element {\n};\n";
  all.defined += below.defined;
  add(all, "Cmp_Stored", elements, kStored);
  add(all, "Cmp_Broken", parts, kBroken);
  add(all, "Cmp_NoFunction", parts, kNoFunction);
  add(all, "Cmp_Empty", constant("int", "0"), kPart);
  add(all, "Cmp_NoLibrary", two, kPart, {},
      R"(<module name="/nowhere/libmissing.so" path="fullpath"/>)");
  return {all.declared + kMoreDeclarations, all.defined + kAssociations};
}

}  // namespace

void writeComparedHome(const std::filesystem::path& home) {
  for (const char* folder : {"run", "lib", "logs", "mof/root/compare"}) {
    std::filesystem::create_directories(home / folder);
  }
  std::filesystem::create_symlink(COMPARE_PLUGIN, home / "lib/libcompare.so");
  const Texts texts = allClasses();
  TemporaryTree::write(
      home / "run/compare.xml",
      "<plugin>\n  <module name=\"compare\" path=\"short\"/>\n" + texts.defined + "</plugin>\n");
  TemporaryTree::write(home / "mof/root/compare/compare.mof", texts.declared);
}
