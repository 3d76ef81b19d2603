// CIMObject::toString
#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMObject.h>

#include "HandleAccess.h"

PEGASUS_NAMESPACE_BEGIN

namespace {

const char* markupFor(Uint16 unit) {
  switch (unit) {
    case '&':
      return "&amp;";
    case '<':
      return "&lt;";
    case '>':
      return "&gt;";
    case '"':
      return "&quot;";
    default:
      return nullptr;
  }
}

/// Writes elements in the manner of DSP0201, with every value as one text.
class ObjectText {
 public:
  String take() { return out_; }

  void object(const CIMConstObject& object) {
    const char* const tag = object.isClass() ? "CLASS" : "INSTANCE";
    open(tag, object.isClass() ? "NAME" : "CLASSNAME", object.getClassName().getString());
    markup(">");
    qualifiers(object);
    for (Uint32 i = 0; i < object.getPropertyCount(); ++i) property(object.getProperty(i));
    if (object.isClass()) {
      methods(HandleAccess::handle<CIMConstClass>(HandleAccess::repOrNull(object)));
    }
    close(tag);
  }

 private:
  void markup(const char* text) { out_.append(String(text)); }

  void escaped(const String& text) {
    for (Uint32 i = 0; i < text.size(); ++i) {
      const Char16 unit = text[i];
      if (const char* const replacement = markupFor(unit)) {
        markup(replacement);
      } else {
        out_.append(unit);
      }
    }
  }

  void attribute(const char* name, const String& value) {
    markup(" ");
    markup(name);
    markup("=\"");
    escaped(value);
    markup("\"");
  }

  void open(const char* tag, const char* nameAttribute, const String& name) {
    markup("<");
    markup(tag);
    attribute(nameAttribute, name);
  }

  void close(const char* tag) {
    markup("</");
    markup(tag);
    markup(">");
  }

  void type(CIMType type, Boolean isArray) {
    attribute("TYPE", String(cimTypeToString(type)));
    if (isArray) attribute("ARRAY", String("true"));
    markup(">");
  }

  void value(const CIMValue& value) {
    if (value.isNull()) return;
    markup("<VALUE>");
    escaped(value.toString());
    markup("</VALUE>");
  }

  template <class Reader>
  void qualifiers(const Reader& owner) {
    for (Uint32 i = 0; i < owner.getQualifierCount(); ++i) {
      const CIMConstQualifier qualifier = owner.getQualifier(i);
      open("QUALIFIER", "NAME", qualifier.getName().getString());
      type(qualifier.getType(), qualifier.isArray());
      value(qualifier.getValue());
      close("QUALIFIER");
    }
  }

  void property(const CIMConstProperty& property) {
    open("PROPERTY", "NAME", property.getName().getString());
    type(property.getType(), property.isArray());
    qualifiers(property);
    value(property.getValue());
    close("PROPERTY");
  }

  void methods(const CIMConstClass& owner) {
    for (Uint32 i = 0; i < owner.getMethodCount(); ++i) {
      const CIMConstMethod method = owner.getMethod(i);
      open("METHOD", "NAME", method.getName().getString());
      type(method.getType(), false);
      qualifiers(method);
      for (Uint32 j = 0; j < method.getParameterCount(); ++j) parameter(method.getParameter(j));
      close("METHOD");
    }
  }

  void parameter(const CIMConstParameter& parameter) {
    open("PARAMETER", "NAME", parameter.getName().getString());
    type(parameter.getType(), parameter.isArray());
    qualifiers(parameter);
    close("PARAMETER");
  }

  String out_;
};

}  // namespace

String AnyObjectReader::toString() const {
  ObjectText text;
  text.object(HandleAccess::handle<CIMConstObject>(HandleAccess::repOrNull(*this)));
  return text.take();
}

PEGASUS_NAMESPACE_END
