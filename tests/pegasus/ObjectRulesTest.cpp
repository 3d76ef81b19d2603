#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMParamValue.h>

#include <functional>
#include <sstream>
#include <tuple>
#include <type_traits>

#include "PegasusText.h"

using namespace Pegasus;

namespace {

using Refused = std::pair<const char*, std::function<void()>>;

template <class E, std::size_t N>
void expectRefused(const char* message, const Refused (&cases)[N]) {
  for (const auto& [what, action] : cases) EXPECT_EQ(thrownMessage<E>(action), message) << what;
}

CIMProperty makeProperty(const char* name, const CIMValue& value) {
  return CIMProperty(CIMName(name), value);
}

CIMProperty keyProperty(const char* name, const CIMValue& value) {
  CIMProperty property(CIMName(name), value, 0, CIMName(), CIMName("Origin"));
  property.addQualifier(CIMQualifier(CIMName("Key"), Boolean(true)));
  return property;
}

CIMClass keyedClass() {
  CIMClass cls(CIMName("Cls"), CIMName("Base"));
  cls.addQualifier(CIMQualifier(CIMName("Association"), Boolean(true)));
  cls.addQualifier(CIMQualifier(CIMName("Abstract"), Boolean(false)));
  cls.addProperty(keyProperty("Beta", CIMValue(CIMTYPE_STRING, false)));
  cls.addProperty(makeProperty("Other", CIMValue(CIMTYPE_UINT8, false)));
  cls.addProperty(keyProperty("Alpha", CIMValue(CIMTYPE_UINT32, false)));
  return cls;
}

TEST(ObjectRules, NullNamesAndEmptyHandlesAreUninitialized) {
  CIMProperty property = makeProperty("p", Uint32(1));
  CIMInstance instance(CIMName("A"));
  const Refused cases[] = {
      {"qualifier", [] { CIMQualifier(CIMName(), Uint32(1)); }},
      {"property", [] { CIMProperty(CIMName(), Uint32(1)); }},
      {"parameter", [] { CIMParameter(CIMName(), CIMTYPE_UINT8); }},
      {"class", [] { CIMClass{CIMName()}; }},
      {"param value", [] { CIMParamValue(String(), Uint32(1)); }},
      {"rename", [&] { property.setName(CIMName()); }},
      {"path", [&] { instance.setPath(CIMObjectPath()); }},
      {"add property", [&] { instance.addProperty(CIMProperty()); }},
      {"add qualifier", [&] { property.addQualifier(CIMQualifier()); }},
      {"add parameter", [] { CIMMethod(CIMName("A"), CIMTYPE_UINT8).addParameter({}); }},
      {"empty property", [] { CIMProperty().getValue(); }},
      {"empty class", [] { CIMClass().findMethod(CIMName("x")); }},
      {"empty object", [] { CIMObject().getClassName(); }},
      {"empty param value", [] { CIMParamValue().clone(); }},
      {"identical to empty", [&] { instance.identical(CIMInstance()); }},
      {"filter", [] { CIMInstance().instanceFilter(true, true, CIMPropertyList()); }},
  };
  expectRefused<UninitializedObjectException>("uninitialized object", cases);
  EXPECT_TRUE(CIMMethod().isUninitialized());
  EXPECT_FALSE(instance.isUninitialized());
  EXPECT_FALSE(CIMObject().isClass() || CIMObject().isInstance());
}

TEST(ObjectRules, TypesMustFit) {
  const CIMValue references(Array<CIMObjectPath>(1, CIMObjectPath(String("A"))));
  const CIMValue reference(CIMTYPE_REFERENCE, false);
  const CIMName p("p");
  const CIMName a("A");
  CIMProperty text1 = makeProperty("p", CIMValue(CIMTYPE_STRING, false));
  CIMProperty fixed(p, CIMValue(CIMTYPE_UINT8, true, 3), 3);
  CIMInstance instance(a);
  const Refused cases[] = {
      {"reference array", [&] { CIMProperty(p, references); }},
      {"fixed size of a scalar", [&] { CIMProperty(p, Uint32(1), 1); }},
      {"other fixed size", [&] { CIMProperty(p, Array<Uint32>(2), 3); }},
      {"referenced class of a number", [&] { CIMProperty(p, Uint32(1), 0, a); }},
      {"set to another type", [&] { text1.setValue(Uint32(1)); }},
      {"set to another size", [&] { fixed.setValue(Array<Uint8>(2)); }},
      {"set to null of no size", [&] { fixed.setValue(CIMValue(CIMTYPE_UINT8, true)); }},
      {"reference parameter without class", [&] { CIMParameter(p, CIMTYPE_REFERENCE); }},
      {"class of a number", [&] { CIMParameter(p, CIMTYPE_UINT8, false, 0, a); }},
      {"size of a scalar", [&] { CIMParameter(p, CIMTYPE_UINT8, false, 2); }},
      {"class with untyped reference", [&] { CIMClass(a).addProperty(CIMProperty(p, reference)); }},
      {"path of another class", [&] { instance.setPath(CIMObjectPath(String("B"))); }},
  };
  expectRefused<TypeMismatchException>("type mismatch", cases);

  text1.setValue(String("x"));
  text1.setValue(CIMValue(CIMTYPE_STRING, false));
  fixed.setValue(Array<Uint8>(3));
  fixed.setValue(CIMValue(CIMTYPE_UINT8, true, 3));
  instance.addProperty(CIMProperty(p, reference));
  CIMClass(a).addProperty(CIMProperty(p, reference, 0, a));
  EXPECT_TRUE(CIMParameter(p, CIMTYPE_REFERENCE, true, 2, a).isArray());
  instance.setPath(CIMObjectPath(String("root/x:a.k=1")));
  EXPECT_EQ(text(instance.getClassName().getString()), "a");
}

TEST(ObjectRules, NamesAreUniqueInAnyCase) {
  CIMClass cls = keyedClass();
  CIMMethod method(CIMName("Run"), CIMTYPE_UINT32);
  method.addParameter(CIMParameter(CIMName("In"), CIMTYPE_UINT8));
  cls.addMethod(method);
  const std::pair<std::string, std::function<void()>> cases[] = {
      {"property \"bETA\"", [&] { cls.addProperty(makeProperty("bETA", Uint32(1))); }},
      // Before it is said that a reference needs a class.
      {"property \"bETA\"",
       [&] { cls.addProperty(makeProperty("bETA", CIMValue(CIMTYPE_REFERENCE, false))); }},
      {"method \"RUN\"", [&] { cls.addMethod(CIMMethod(CIMName("RUN"), CIMTYPE_UINT8)); }},
      {"parameter \"in\"",
       [&] { method.addParameter(CIMParameter(CIMName("in"), CIMTYPE_UINT8)); }},
      {"qualifier \"abstract\"",
       [&] { cls.addQualifier(CIMQualifier(CIMName("abstract"), Uint8(1))); }},
  };
  for (const auto& [what, action] : cases) {
    EXPECT_EQ(thrownMessage<AlreadyExistsException>(action), "already exists: " + what);
  }
}

TEST(ObjectRules, FindIgnoresCaseAndGetChecksTheIndex) {
  CIMClass cls = keyedClass();
  CIMProperty property = cls.getProperty(0);
  EXPECT_EQ(cls.findProperty(CIMName("ALPHA")), 2u);
  EXPECT_EQ(cls.findProperty("nope"), PEG_NOT_FOUND);
  EXPECT_EQ(cls.findProperty(CIMName()), PEG_NOT_FOUND);
  EXPECT_EQ(property.findQualifier("KEY"), 0u);
  EXPECT_THROW(cls.findProperty("bad name"), InvalidNameException);
  const Refused cases[] = {
      {"qualifier", [&] { property.getQualifier(property.findQualifier("static")); }},
      {"property", [&] { cls.getProperty(3); }},
      {"remove qualifier", [&] { property.removeQualifier(PEG_NOT_FOUND); }},
      {"remove method", [&] { cls.removeMethod(0); }},
      {"parameter", [] { CIMMethod(CIMName("m"), CIMTYPE_UINT8).getParameter(0); }},
  };
  expectRefused<IndexOutOfBoundsException>("index out of bounds", cases);
}

TEST(ObjectRules, AnElementKeepsItsNameWhileItIsInAContainer) {
  const auto rename = [](auto element, const char* name) {
    const std::string kind =
        std::is_same_v<decltype(element), CIMProperty> ? "property" : "parameter";
    const std::string said = thrownMessage<Exception>([&] { element.setName(CIMName(name)); });
    if (said == "no exception") return true;
    EXPECT_EQ(said, "Attempted to change the name of a " + kind + " already in a container.");
    return false;
  };
  CIMProperty property = makeProperty("p", Uint32(1));
  EXPECT_TRUE(rename(property, "q"));
  {
    CIMInstance instance(CIMName("A"));
    instance.addProperty(property);
    EXPECT_FALSE(rename(property, "r"));
    EXPECT_TRUE(rename(property, "Q"));
    const CIMProperty orphan = instance.clone().getProperty(0);
    EXPECT_TRUE(rename(orphan, "r"));
    CIMInstance kept = instance.clone();
    EXPECT_FALSE(rename(kept.getProperty(0), "r"));
    EXPECT_TRUE(rename(property.clone(), "r"));
  }
  EXPECT_TRUE(rename(property, "r"));
  CIMMethod method(CIMName("m"), CIMTYPE_UINT8);
  CIMParameter parameter(CIMName("a"), CIMTYPE_UINT8);
  method.addParameter(parameter);
  EXPECT_FALSE(rename(parameter, "b"));
  // An element that the clone made its own knows its container, too.
  parameter = CIMParameter();
  CIMMethod copy = method.clone();
  EXPECT_FALSE(rename(copy.getParameter(0), "b"));
  parameter = method.getParameter(0);
  method.removeParameter(0);
  EXPECT_TRUE(rename(parameter, "b"));
  EXPECT_EQ(text(copy.getParameter(0).getName().getString()), "a");
}

TEST(ObjectRules, AContainerHoldsAThousandElements) {
  CIMInstance instance(CIMName("A"));
  const auto name = [](int i) { return CIMName(("p" + std::to_string(i)).c_str()); };
  for (int i = 0; i < 1000; ++i) instance.addProperty(CIMProperty(name(i), Uint32(1)));
  EXPECT_EQ(
      thrownMessage<Exception>([&] { instance.addProperty(CIMProperty(name(1000), Uint32(1))); }),
      "More than 1000 elements in a container are not supported.");
  EXPECT_EQ(instance.clone().getPropertyCount(), 1000u);
  instance.removeProperty(0);
  instance.addProperty(CIMProperty(name(1000), Uint32(1)));
  EXPECT_EQ(instance.findProperty(name(1000)), 999u);
}

TEST(ObjectRules, KeysComeInTheOrderOfTheClassAndSortedInThePath) {
  const CIMClass cls = keyedClass();
  Array<CIMName> keys;
  cls.getKeyNames(keys);
  ASSERT_EQ(keys.size(), 2u);
  EXPECT_EQ(text(keys[0].getString()) + text(keys[1].getString()), "BetaAlpha");
  EXPECT_TRUE(cls.hasKeys() && cls.isAssociation() && !cls.isAbstract());

  CIMInstance instance(CIMName("Cls"));
  instance.addProperty(makeProperty("beta", String("B")));
  EXPECT_EQ(thrownMessage<Exception>([&] { instance.buildPath(cls); }), "no such property: Alpha");
  instance.addProperty(makeProperty("ALPHA", Uint32(7)));
  EXPECT_EQ(text(instance.buildPath(cls).toString()), "Cls.Alpha=7,Beta=\"B\"");
}

TEST(ObjectRules, AKeyQualifierThatIsNoBooleanMakesNoKey) {
  CIMClass cls(CIMName("A"));
  char name[] = "a";
  for (const CIMValue& value :
       {CIMValue(String("TRUE")), CIMValue(CIMTYPE_BOOLEAN, false), CIMValue(Boolean(false))}) {
    CIMProperty property = makeProperty(name, Uint32(1));
    property.addQualifier(CIMQualifier(CIMName("key"), value));
    cls.addProperty(property);
    ++name[0];
  }
  EXPECT_FALSE(cls.hasKeys());
  cls.addQualifier(CIMQualifier(CIMName("abstract"), Array<Boolean>(1, true)));
  EXPECT_THROW(cls.isAbstract(), TypeMismatchException);
}

/// For each property: its initial, "q" with qualifiers, "o" with a class origin.
std::string summary(const CIMConstObject& object) {
  std::string out;
  for (Uint32 i = 0; i < object.getPropertyCount(); ++i) {
    const CIMConstProperty property = object.getProperty(i);
    out += text(property.getName().getString()).substr(0, 1);
    if (property.getQualifierCount() > 0) out += "q";
    if (!property.getClassOrigin().isNull()) out += "o";
    out += " ";
  }
  return out;
}

TEST(ObjectRules, FiltersAndBuildsInstances) {
  // With qualifiers, with class origins, the list's names of one letter each.
  const std::tuple<bool, bool, const char*, const char*> cases[] = {
      {true, true, nullptr, "Bqo O Aqo "}, {false, true, nullptr, "Bo O Ao "},
      {true, false, nullptr, "Bq O Aq "},  {false, false, "alpha other", "O A "},
      {true, true, "BETA nope", "Bqo "},   {true, true, "", ""},
  };
  const CIMClass cls = keyedClass();
  for (const auto& [qualifiers, origins, words, expected] : cases) {
    CIMPropertyList list;
    if (words) {
      Array<CIMName> names;
      std::istringstream stream(words);
      for (std::string word; stream >> word;) names.append(CIMName(word.c_str()));
      list.set(names);
    }
    EXPECT_EQ(summary(cls.buildInstance(qualifiers, origins, list)), expected);
    CIMInstance filtered = cls.buildInstance(true, true, CIMPropertyList());
    filtered.instanceFilter(qualifiers, origins, list);
    EXPECT_EQ(summary(filtered), expected);
    EXPECT_EQ(filtered.getQualifierCount(), qualifiers ? 2u : 0u);
  }
  EXPECT_EQ(summary(cls), "Bqo O Aqo ");
}

TEST(ObjectRules, FlavorsWriteTheirNames) {
  CIMFlavor flavor(CIMFlavor::DEFAULTS);
  flavor.addFlavor(CIMFlavor::RESTRICTED);
  flavor.removeFlavor(CIMFlavor::ENABLEOVERRIDE);
  EXPECT_EQ(text(CIMFlavor(CIMFlavor::DEFAULTS).toString()), "OVERRIDABLE TOSUBCLASS");
  EXPECT_EQ(text((flavor + CIMFlavor::TRANSLATABLE).toString()),
            "TOSUBCLASS TRANSLATABLE RESTRICTED");
}

TEST(ObjectRules, ObjectsKnowWhatTheyAre) {
  const CIMClass cls = keyedClass();
  const CIMInstance instance(CIMName("Cls"));
  const CIMObject classObject(cls);
  const CIMObject instanceObject(instance);
  EXPECT_TRUE(classObject.isClass() && instanceObject.isInstance());
  EXPECT_FALSE(instanceObject.isClass() || classObject.isInstance());
  const Refused cases[] = {
      {"class as instance", [&] { CIMInstance{classObject}; }},
      {"instance as class", [&] { CIMClass{instanceObject}; }},
      {"nothing as instance", [] { CIMInstance{CIMObject()}; }},
  };
  expectRefused<DynamicCastFailedException>("dynamic cast failed", cases);
  EXPECT_TRUE(CIMClass(classObject).identical(cls));
}

}  // namespace
