// Handles share, clones do not.
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMParamValue.h>
#include <gtest/gtest.h>

#include "PegasusText.h"

using namespace Pegasus;
using pegasus_test::text;

namespace {

Uint32 number(const CIMValue& value) {
  Uint32 x = 0;
  value.get(x);
  return x;
}

CIMProperty makeProperty(Uint32 value) {
  CIMProperty property(CIMName("p"), value);
  property.addQualifier(CIMQualifier(CIMName("q"), value));
  property.addQualifier(CIMQualifier(CIMName("r"), value));
  return property;
}

CIMClass makeClass() {
  CIMClass cls(CIMName("A"));
  cls.addQualifier(CIMQualifier(CIMName("q"), Uint32(1)));
  cls.addProperty(makeProperty(1));
  CIMMethod method(CIMName("m"), CIMTYPE_UINT32);
  CIMParameter parameter(CIMName("a"), CIMTYPE_UINT32);
  parameter.addQualifier(CIMQualifier(CIMName("q"), Uint32(1)));
  method.addParameter(parameter);
  cls.addMethod(method);
  return cls;
}

Uint32 propertyQualifier(const CIMConstClass& cls, Uint32 index = 0) {
  return number(cls.getProperty(0).getQualifier(index).getValue());
}

Uint32 parameterQualifier(const CIMConstClass& cls) {
  return number(cls.getMethod(0).getParameter(0).getQualifier(0).getValue());
}

TEST(Handles, CopiesShareAndClonesDoNot) {
  CIMProperty a = makeProperty(1);
  CIMProperty b = a;
  b.setValue(Uint32(2));
  EXPECT_EQ(number(a.getValue()), 2u);
  CIMProperty c = a.clone();
  c.setValue(Uint32(3));
  c.getQualifier(0).setValue(Uint32(3));
  EXPECT_EQ(number(a.getValue()), 2u);
  EXPECT_EQ(number(a.getQualifier(0).getValue()), 1u);
  const CIMConstProperty reader = a;
  b.setValue(Uint32(4));
  EXPECT_EQ(number(reader.getValue()), 4u);
}

TEST(Handles, ContainersShareTheirElements) {
  CIMInstance i(CIMName("A"));
  CIMProperty p = makeProperty(1);
  i.addProperty(p);
  p.setValue(Uint32(2));
  EXPECT_EQ(number(i.getProperty(0).getValue()), 2u);
  CIMInstance j = i;
  CIMInstance k = i.clone();
  j.getProperty(0).setValue(Uint32(3));
  j.setPath(CIMObjectPath(String("root/x:A.k=1")));
  EXPECT_EQ(number(i.getProperty(0).getValue()), 3u);
  EXPECT_EQ(text(i.getPath().toString()), "root/x:A.k=1");
  EXPECT_EQ(number(k.getProperty(0).getValue()), 2u);
  EXPECT_EQ(text(k.getPath().toString()), "A");
  Array<CIMInstance> a(1, i);
  Array<CIMInstance> b = a;
  b[0].setPath(CIMObjectPath(String("A")));
  EXPECT_EQ(text(i.getPath().toString()), "A");
  const CIMObject object(i);
  i.getProperty(0).setValue(Uint32(5));
  EXPECT_EQ(number(object.getProperty(0).getValue()), 5u);
}

TEST(Handles, ReferencesShowLaterChanges) {
  CIMClass original = makeClass();
  CIMClass clone = original.clone();
  for (CIMClass cls : {original, clone}) {
    CIMProperty p = cls.getProperty(0);
    const CIMValue& value = p.getValue();
    const CIMObjectPath& path = cls.getPath();
    p.setValue(Uint32(9));
    cls.setPath(CIMObjectPath(String("root/x:A")));
    EXPECT_EQ(number(value), 9u);
    EXPECT_EQ(text(path.toString()), "root/x:A");
  }
}

TEST(Handles, ParameterValuesShare) {
  CIMParamValue a(String("n"), Uint32(1));
  CIMParamValue b = a;
  CIMParamValue c = a.clone();
  CIMValue two(Uint32(2));
  String name("m");
  b.setValue(two);
  b.setParameterName(name);
  b.setIsTyped(false);
  EXPECT_EQ(number(a.getValue()), 2u);
  EXPECT_EQ(text(a.getParameterName()), "m");
  EXPECT_FALSE(a.isTyped());
  EXPECT_EQ(number(c.getValue()), 1u);
  EXPECT_EQ(text(c.getParameterName()), "n");
  EXPECT_TRUE(c.isTyped());
}

TEST(Clones, AHandleFromAfterTheCloneChangesItsSideOnly) {
  for (const bool changeClone : {false, true}) {
    const CIMClass original = makeClass();
    const CIMClass clone = original.clone();
    CIMClass changed = changeClone ? clone : original;
    const CIMClass other = changeClone ? original : clone;
    CIMQualifier q = changed.getProperty(0).getQualifier(0);
    q.setValue(Uint32(2));
    changed.getProperty(0).getQualifier(1).setFlavor(CIMFlavor::TOINSTANCE);
    changed.getMethod(0).getParameter(0).getQualifier(0).setValue(Uint32(2));
    changed.getMethod(0).setType(CIMTYPE_STRING);
    changed.getProperty(0).removeQualifier(0);
    changed.getQualifier(0).setPropagated(true);
    q.setValue(Uint32(3));  // in no container any more
    EXPECT_EQ(changed.getProperty(0).getQualifierCount(), 1u);
    EXPECT_EQ(parameterQualifier(changed), 2u);
    EXPECT_TRUE(other.identical(makeClass()));
    EXPECT_FALSE(changed.identical(other));
  }
}

TEST(Clones, OutliveTheirOriginal) {
  CIMClass clone;
  CIMQualifier kept;
  {
    CIMClass original = makeClass();
    clone = original.clone();
    kept = original.getProperty(0).getQualifier(1);
  }
  kept.setValue(Uint32(5));
  EXPECT_EQ(propertyQualifier(clone, 1), 1u);
  clone.getProperty(0).getQualifier(1).setValue(Uint32(6));
  EXPECT_EQ(number(kept.getValue()), 5u);
  EXPECT_EQ(propertyQualifier(clone, 1), 6u);
}

}  // namespace
