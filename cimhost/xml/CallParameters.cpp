#include "cimhost/xml/CallParameters.h"

#include "cimhost/Text.h"
#include "cimhost/xml/HttpError.h"

#include <strings.h>
#include <algorithm>
#include <string>

namespace cimhost {

using namespace Pegasus;

namespace {

bool equalNoCase(std::string_view a, std::string_view b) {
  return a.size() == b.size() && strncasecmp(a.data(), b.data(), a.size()) == 0;
}

[[noreturn]] void invalid(const std::string& reason) {
  throw CIMException(CIM_ERR_INVALID_PARAMETER, fromUtf8(reason));
}

bool isKnown(std::string_view known, std::string_view name) {
  bool found = false;
  forEachWord(known, [&](std::string_view each) { found = found || equalNoCase(each, name); });
  return found;
}

bool isNamed(const XmlElement& element, std::string_view name) {
  return element.is("IPARAMVALUE") && equalNoCase(element.attribute("NAME"), name);
}

// Reads one parameter; the message tells which.
template <class Read>
auto named(std::string_view name, Read read) {
  return readParameter("parameter " + std::string(name), read);
}

}  // namespace

void throwParameterError(const std::string& what, CIMStatusCode code) {
  const auto fail = [&](const std::string& reason) {
    throw CIMException(code, fromUtf8(what + ": " + reason));
  };
  try {
    throw;
  } catch (const CIMException&) {
    throw;
  } catch (const Exception& error) {
    fail(toUtf8(error.getMessage()));
  } catch (const ValueArgumentError& error) {
    fail(error.what());
  }
  throw std::logic_error("unreachable");
}

CallParameters::CallParameters(const XmlElement& call, std::string_view known) : call_(call) {
  const std::vector<XmlElement>& all = call.children;
  for (auto each = all.begin(); each != all.end(); ++each) {
    if (!each->is("IPARAMVALUE")) continue;
    const std::string& name = each->attribute("NAME");
    if (each->children.size() > 1) throwNotValid("IPARAMVALUE with two values");
    if (!isKnown(known, name)) invalid("the operation has no parameter " + name);
    // All earlier ones are known and differ, so there are few.
    if (std::any_of(all.begin(), each, [&](const auto& other) { return isNamed(other, name); })) {
      invalid("parameter " + name + " is given twice");
    }
  }
}

const XmlElement* CallParameters::find(std::string_view name) const {
  for (const XmlElement& each : call_.children) {
    if (isNamed(each, name)) return each.children.empty() ? nullptr : &each.children[0];
  }
  return nullptr;
}

const XmlElement& CallParameters::require(std::string_view name, std::string_view element) const {
  const XmlElement* const found = find(name);
  if (found == nullptr) invalid("parameter " + std::string(name) + " is missing");
  if (found->is(element)) return *found;
  invalid("parameter " + std::string(name) + " is no " + std::string(element));
}

bool CallParameters::boolean(std::string_view name, bool otherwise) const {
  if (find(name) == nullptr) return otherwise;
  const XmlElement& value = require(name, "VALUE");
  return named(name, [&] {
    Boolean result = false;
    readValue({CIMTYPE_BOOLEAN}, &value).get(result);
    return result;
  });
}

String CallParameters::text(std::string_view name) const {
  return find(name) == nullptr ? String() : fromUtf8(require(name, "VALUE").text);
}

CIMName CallParameters::name(std::string_view name) const {
  return named(name, [&] { return CIMName(fromUtf8(require(name, "VALUE").text)); });
}

CIMName CallParameters::className(std::string_view name) const {
  return find(name) == nullptr ? CIMName() : requiredClassName(name);
}

CIMName CallParameters::requiredClassName(std::string_view name) const {
  return named(name, [&] { return readObjectPath(require(name, "CLASSNAME")).getClassName(); });
}

CIMObjectPath CallParameters::instanceName(std::string_view name) const {
  return named(name, [&] { return readObjectPath(require(name, "INSTANCENAME")); });
}

CIMObjectPath CallParameters::objectName(std::string_view name) const {
  const XmlElement* const found = find(name);
  if (found == nullptr || !found->is("CLASSNAME")) return instanceName(name);
  return named(name, [&] { return readObjectPath(*found); });
}

CIMPropertyList CallParameters::propertyList(std::string_view name) const {
  if (find(name) == nullptr) return CIMPropertyList();
  return named(name, [&] {
    Array<String> texts;
    readValue({CIMTYPE_STRING, true}, &require(name, "VALUE.ARRAY")).get(texts);
    Array<CIMName> names;
    for (Uint32 i = 0; i < texts.size(); ++i) names.append(CIMName(texts[i]));
    return CIMPropertyList(names);
  });
}

}  // namespace cimhost
