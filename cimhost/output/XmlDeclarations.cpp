// Classes and qualifiers as elements of CIM-XML.

#include "cimhost/output/XmlElements.h"
#include "cimhost/repository/QualifierScope.h"

#include <Pegasus/Common/CIMMethod.h>
#include <Pegasus/Common/CIMParameter.h>

namespace cimhost {

using namespace Pegasus;

namespace {

// Only what differs from the defaults of DSP0201.
void appendFlavor(XmlBuffer& out, const CIMFlavor& flavor) {
  const bool overridable =
      flavor.hasFlavor(CIMFlavor::OVERRIDABLE) && !flavor.hasFlavor(CIMFlavor::DISABLEOVERRIDE);
  const bool toSubclass =
      flavor.hasFlavor(CIMFlavor::TOSUBCLASS) && !flavor.hasFlavor(CIMFlavor::RESTRICTED);
  if (!overridable) out.append(" OVERRIDABLE=\"false\"");
  if (!toSubclass) out.append(" TOSUBCLASS=\"false\"");
  if (flavor.hasFlavor(CIMFlavor::TOINSTANCE)) out.append(" TOINSTANCE=\"true\"");
  if (flavor.hasFlavor(CIMFlavor::TRANSLATABLE)) out.append(" TRANSLATABLE=\"true\"");
}

const char* parameterElement(const CIMConstParameter& parameter) {
  if (parameter.getType() == CIMTYPE_REFERENCE) {
    return parameter.isArray() ? "PARAMETER.REFARRAY" : "PARAMETER.REFERENCE";
  }
  return parameter.isArray() ? "PARAMETER.ARRAY" : "PARAMETER";
}

void appendParameter(XmlBuffer& out, const CIMConstParameter& parameter) {
  const char* const element = parameterElement(parameter);
  out.append("<");
  out.append(element);
  appendNameAttribute(out, parameter.getName());
  if (parameter.getType() == CIMTYPE_REFERENCE) {
    appendOptionalAttribute(out, " REFERENCECLASS=\"", parameter.getReferenceClassName());
  } else {
    appendTypeAttributes(out, "TYPE", parameter.getType());
  }
  if (parameter.getArraySize() != 0) appendArraySize(out, parameter.getArraySize());
  out.append(">");
  appendQualifiers(out, parameter);
  appendEndTag(out, element);
}

void appendMethod(XmlBuffer& out, const CIMConstMethod& method) {
  out.append("<METHOD");
  appendNameAttribute(out, method.getName());
  appendTypeAttributes(out, "TYPE", method.getType());
  appendOptionalAttribute(out, " CLASSORIGIN=\"", method.getClassOrigin());
  if (method.getPropagated()) out.append(" PROPAGATED=\"true\"");
  out.append(">");
  appendQualifiers(out, method);
  for (Uint32 i = 0; i < method.getParameterCount(); ++i) {
    appendParameter(out, method.getParameter(i));
  }
  out.append("</METHOD>");
}

struct ScopeRow {
  unsigned bit;
  const char* attribute;
};
constexpr ScopeRow kScopes[] = {
    {QualifierScope::kClass, " CLASS=\"true\""},
    {QualifierScope::kAssociation, " ASSOCIATION=\"true\""},
    {QualifierScope::kReference, " REFERENCE=\"true\""},
    {QualifierScope::kProperty, " PROPERTY=\"true\""},
    {QualifierScope::kMethod, " METHOD=\"true\""},
    {QualifierScope::kParameter, " PARAMETER=\"true\""},
    {QualifierScope::kIndication, " INDICATION=\"true\""},
};

}  // namespace

bool isFalseKey(const CIMConstQualifier& qualifier) {
  return qualifier.getName() == CIMName("Key") && qualifier.getValue().equal(CIMValue(false));
}

void appendClassName(XmlBuffer& out, const CIMName& name) {
  out.append("<CLASSNAME");
  appendNameAttribute(out, name);
  out.append("/>");
}

void appendClass(XmlBuffer& out, const CIMConstClass& declaration) {
  out.append("<CLASS");
  appendNameAttribute(out, declaration.getClassName());
  appendOptionalAttribute(out, " SUPERCLASS=\"", declaration.getSuperClassName());
  out.append(">");
  appendQualifiers(out, declaration);
  for (Uint32 i = 0; i < declaration.getPropertyCount(); ++i) {
    appendProperty(out, declaration.getProperty(i));
  }
  for (Uint32 i = 0; i < declaration.getMethodCount(); ++i) {
    appendMethod(out, declaration.getMethod(i));
  }
  out.append("</CLASS>");
}

void appendQualifier(XmlBuffer& out, const CIMConstQualifier& qualifier) {
  out.append("<QUALIFIER");
  appendNameAttribute(out, qualifier.getName());
  appendTypeAttributes(out, "TYPE", qualifier.getType());
  if (qualifier.getPropagated()) out.append(" PROPAGATED=\"true\"");
  appendFlavor(out, qualifier.getFlavor());
  out.append(">");
  appendValue(out, qualifier.getValue());
  out.append("</QUALIFIER>");
}

void appendQualifierDeclaration(XmlBuffer& out, const CIMConstQualifier& declaration,
                                unsigned scope) {
  out.append("<QUALIFIER.DECLARATION");
  appendNameAttribute(out, declaration.getName());
  appendTypeAttributes(out, "TYPE", declaration.getType());
  out.append(declaration.isArray() ? " ISARRAY=\"true\"" : " ISARRAY=\"false\"");
  appendFlavor(out, declaration.getFlavor());
  out.append("><SCOPE");
  for (const ScopeRow& row : kScopes) {
    if ((scope & row.bit) != 0) out.append(row.attribute);
  }
  out.append("></SCOPE>");
  appendValue(out, declaration.getValue());
  out.append("</QUALIFIER.DECLARATION>");
}

}  // namespace cimhost
