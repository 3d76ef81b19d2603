#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;
using pegasus_test::thrownMessage;

namespace {

const char* const kUninitialized = "uninitialized object";
const char* const kMismatch = "type mismatch";

struct RefusedCase {
  const char* what;
  std::function<void()> action;
};

template <class E, std::size_t N>
void expectRefused(const char* message, const RefusedCase (&cases)[N]) {
  for (const RefusedCase& c : cases) EXPECT_EQ(thrownMessage<E>(c.action), message) << c.what;
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
  const RefusedCase cases[] = {
      {"qualifier", [] { CIMQualifier(CIMName(), Uint32(1)); }},
      {"property", [] { CIMProperty(CIMName(), Uint32(1)); }},
      {"parameter", [] { CIMParameter(CIMName(), CIMTYPE_UINT8); }},
      {"method", [] { CIMMethod(CIMName(), CIMTYPE_UINT8); }},
      {"class", [] { CIMClass{CIMName()}; }},
      {"instance", [] { CIMInstance{CIMName()}; }},
      {"param value", [] { CIMParamValue(String(), Uint32(1)); }},
      {"rename", [&] { property.setName(CIMName()); }},
      {"path", [&] { instance.setPath(CIMObjectPath()); }},
      {"add property", [&] { instance.addProperty(CIMProperty()); }},
      {"add qualifier", [&] { property.addQualifier(CIMQualifier()); }},
      {"add method", [] { CIMClass(CIMName("A")).addMethod(CIMMethod()); }},
      {"add parameter", [] { CIMMethod(CIMName("A"), CIMTYPE_UINT8).addParameter({}); }},
      {"empty property", [] { CIMProperty().getValue(); }},
      {"empty qualifier", [] { CIMConstQualifier().getName(); }},
      {"empty class", [] { CIMClass().findMethod(CIMName("x")); }},
      {"empty object", [] { CIMObject().getClassName(); }},
      {"empty param value", [] { CIMParamValue().clone(); }},
      {"identical to empty", [&] { instance.identical(CIMInstance()); }},
      {"filter", [] { CIMInstance().instanceFilter(true, true, CIMPropertyList()); }},
  };
  expectRefused<UninitializedObjectException>(kUninitialized, cases);
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
  const RefusedCase cases[] = {
      {"reference array", [&] { CIMProperty(p, references); }},
      {"null reference array", [&] { CIMProperty(p, CIMValue(CIMTYPE_REFERENCE, true)); }},
      {"fixed size of a scalar", [&] { CIMProperty(p, Uint32(1), 1); }},
      {"other fixed size", [&] { CIMProperty(p, Array<Uint32>(2), 3); }},
      {"null of other fixed size", [&] { CIMProperty(p, CIMValue(CIMTYPE_UINT8, true, 2), 3); }},
      {"referenced class of a number", [&] { CIMProperty(p, Uint32(1), 0, a); }},
      {"set to another type", [&] { text1.setValue(Uint32(1)); }},
      {"set to the null Boolean", [&] { text1.setValue(CIMValue()); }},
      {"set to an array", [&] { text1.setValue(Array<String>(1)); }},
      {"set to another size", [&] { fixed.setValue(Array<Uint8>(2)); }},
      {"set to null of no size", [&] { fixed.setValue(CIMValue(CIMTYPE_UINT8, true)); }},
      {"reference parameter without class", [&] { CIMParameter(p, CIMTYPE_REFERENCE); }},
      {"class of a number", [&] { CIMParameter(p, CIMTYPE_UINT8, false, 0, a); }},
      {"size of a scalar", [&] { CIMParameter(p, CIMTYPE_UINT8, false, 2); }},
      {"class with untyped reference", [&] { CIMClass(a).addProperty(CIMProperty(p, reference)); }},
      {"path of another class", [&] { instance.setPath(CIMObjectPath(String("B"))); }},
  };
  expectRefused<TypeMismatchException>(kMismatch, cases);

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
  EXPECT_EQ(thrownMessage<AlreadyExistsException>(
                [&] { cls.addProperty(makeProperty("bETA", Uint32(1))); }),
            "already exists: property \"bETA\"");
  // Before it is said that a reference needs a class.
  EXPECT_THROW(cls.addProperty(makeProperty("bETA", CIMValue(CIMTYPE_REFERENCE, false))),
               AlreadyExistsException);
  EXPECT_EQ(thrownMessage<AlreadyExistsException>(
                [&] { cls.addMethod(CIMMethod(CIMName("RUN"), CIMTYPE_UINT8)); }),
            "already exists: method \"RUN\"");
  EXPECT_EQ(thrownMessage<AlreadyExistsException>(
                [&] { method.addParameter(CIMParameter(CIMName("in"), CIMTYPE_UINT8)); }),
            "already exists: parameter \"in\"");
  EXPECT_EQ(thrownMessage<AlreadyExistsException>(
                [&] { cls.addQualifier(CIMQualifier(CIMName("abstract"), Uint8(1))); }),
            "already exists: qualifier \"abstract\"");
}

TEST(ObjectRules, FindIgnoresCaseAndGetChecksTheIndex) {
  CIMClass cls = keyedClass();
  CIMProperty property = cls.getProperty(0);
  EXPECT_EQ(cls.findProperty(CIMName("ALPHA")), 2u);
  EXPECT_EQ(cls.findProperty("nope"), PEG_NOT_FOUND);
  EXPECT_EQ(cls.findProperty(CIMName()), PEG_NOT_FOUND);
  EXPECT_EQ(property.findQualifier("KEY"), 0u);
  for (const char* illegal : {"", "1x", "bad name"}) {
    EXPECT_THROW(cls.findProperty(illegal), InvalidNameException) << illegal;
  }
  const RefusedCase cases[] = {
      {"qualifier", [&] { property.getQualifier(property.findQualifier("static")); }},
      {"const qualifier", [&] { CIMConstProperty(property).getQualifier(1); }},
      {"property", [&] { cls.getProperty(3); }},
      {"method", [&] { cls.getMethod(0); }},
      {"remove property", [&] { cls.removeProperty(3); }},
      {"remove qualifier", [&] { property.removeQualifier(PEG_NOT_FOUND); }},
      {"remove method", [&] { cls.removeMethod(0); }},
      {"parameter", [] { CIMMethod(CIMName("m"), CIMTYPE_UINT8).getParameter(0); }},
  };
  expectRefused<IndexOutOfBoundsException>("index out of bounds", cases);
}

std::string containedMessage(const char* kind) {
  return std::string("Attempted to change the name of a ") + kind + " already in a container.";
}

TEST(ObjectRules, AnElementKeepsItsNameWhileItIsInAContainer) {
  const std::string message = containedMessage("property");
  CIMProperty property = makeProperty("p", Uint32(1));
  property.setName(CIMName("q"));
  {
    CIMInstance instance(CIMName("A"));
    instance.addProperty(property);
    EXPECT_EQ(thrownMessage<Exception>([&] { property.setName(CIMName("r")); }), message);
    property.setName(CIMName("Q"));
    CIMProperty clone = instance.clone().getProperty(0);
    clone.setName(CIMName("r"));  // its instance is gone
    CIMInstance kept = instance.clone();
    EXPECT_EQ(thrownMessage<Exception>([&] { kept.getProperty(0).setName(CIMName("r")); }),
              message);
    property.clone().setName(CIMName("r"));
  }
  property.setName(CIMName("r"));
  CIMMethod method(CIMName("m"), CIMTYPE_UINT8);
  CIMParameter parameter(CIMName("a"), CIMTYPE_UINT8);
  method.addParameter(parameter);
  EXPECT_EQ(thrownMessage<Exception>([&] { parameter.setName(CIMName("b")); }),
            containedMessage("parameter"));
  // An element that the clone made its own knows its container, too.
  parameter = CIMParameter();
  CIMMethod copy = method.clone();
  EXPECT_EQ(thrownMessage<Exception>([&] { copy.getParameter(0).setName(CIMName("b")); }),
            containedMessage("parameter"));
  method.getParameter(0).setName(CIMName("A"));
  parameter = method.getParameter(0);
  method.removeParameter(0);
  parameter.setName(CIMName("b"));
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
  EXPECT_FALSE(CIMClass(CIMName("A")).hasKeys());

  CIMInstance instance(CIMName("Cls"));
  EXPECT_EQ(text(instance.getPath().toString()), "Cls");
  instance.addProperty(makeProperty("beta", String("B")));
  EXPECT_EQ(thrownMessage<Exception>([&] { instance.buildPath(cls); }), "no such property: Alpha");
  instance.addProperty(makeProperty("ALPHA", Uint32(7)));
  EXPECT_EQ(text(instance.buildPath(cls).toString()), "Cls.Alpha=7,Beta=\"B\"");
}

TEST(ObjectRules, AKeyQualifierThatIsNoBooleanMakesNoKey) {
  CIMClass cls(CIMName("A"));
  const CIMValue values[] = {CIMValue(String("TRUE")), CIMValue(CIMTYPE_BOOLEAN, false), Uint8(1),
                             Boolean(false)};
  char name[] = "a";
  for (const CIMValue& value : values) {
    CIMProperty property = makeProperty(name, Uint32(1));
    property.addQualifier(CIMQualifier(CIMName("key"), value));
    cls.addProperty(property);
    ++name[0];
  }
  EXPECT_FALSE(cls.hasKeys());
  cls.addQualifier(CIMQualifier(CIMName("abstract"), Array<Boolean>(1, true)));
  EXPECT_THROW(cls.isAbstract(), TypeMismatchException);
}

struct FilterCase {
  bool qualifiers, origins;
  const char* list;  // names of one letter each; null for the null list
  const char* expected;
};

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
  const FilterCase cases[] = {
      {true, true, nullptr, "Bqo O Aqo "}, {false, true, nullptr, "Bo O Ao "},
      {true, false, nullptr, "Bq O Aq "},  {false, false, "alpha other", "O A "},
      {true, true, "BETA nope", "Bqo "},   {true, true, "", ""},
  };
  const CIMClass cls = keyedClass();
  for (const FilterCase& c : cases) {
    CIMPropertyList list;
    if (c.list) {
      Array<CIMName> names;
      std::istringstream words(c.list);
      for (std::string word; words >> word;) names.append(CIMName(word.c_str()));
      list.set(names);
    }
    CIMInstance built = cls.buildInstance(c.qualifiers, c.origins, list);
    EXPECT_EQ(summary(built), c.expected) << "built " << c.list;
    CIMInstance filtered = cls.buildInstance(true, true, CIMPropertyList());
    filtered.instanceFilter(c.qualifiers, c.origins, list);
    EXPECT_EQ(summary(filtered), c.expected) << "filtered " << c.list;
    EXPECT_EQ(filtered.getQualifierCount(), c.qualifiers ? 2u : 0u);
  }
  EXPECT_EQ(summary(cls), "Bqo O Aqo ");
}

TEST(ObjectRules, FlavorsWriteTheirNames) {
  CIMFlavor flavor(CIMFlavor::DEFAULTS);
  EXPECT_EQ(text(flavor.toString()), "OVERRIDABLE TOSUBCLASS");
  flavor.addFlavor(CIMFlavor::RESTRICTED);
  flavor.removeFlavor(CIMFlavor::ENABLEOVERRIDE);
  EXPECT_EQ(text((flavor + CIMFlavor::TRANSLATABLE).toString()),
            "TOSUBCLASS TRANSLATABLE RESTRICTED");
  EXPECT_EQ(text(CIMFlavor(CIMFlavor::NONE).toString()), "");
}

TEST(ObjectRules, ObjectsKnowWhatTheyAre) {
  const CIMClass cls = keyedClass();
  const CIMInstance instance(CIMName("Cls"));
  const CIMObject classObject(cls);
  const CIMObject instanceObject(instance);
  EXPECT_TRUE(classObject.isClass() && !classObject.isInstance());
  EXPECT_TRUE(instanceObject.isInstance() && !instanceObject.isClass());
  const RefusedCase cases[] = {
      {"class as instance", [&] { CIMInstance{classObject}; }},
      {"instance as class", [&] { CIMClass{instanceObject}; }},
      {"nothing as instance", [] { CIMInstance{CIMObject()}; }},
      {"nothing as class", [] { CIMClass{CIMObject()}; }},
  };
  expectRefused<DynamicCastFailedException>("dynamic cast failed", cases);
  EXPECT_TRUE(CIMClass(classObject).identical(cls));
  EXPECT_EQ(text(CIMClass(classObject).getSuperClassName().getString()), "Base");
}

}  // namespace
