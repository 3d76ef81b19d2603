#include "cimhost/repository/QualifierTable.h"

namespace cimhost {
namespace {

using Pegasus::CIMFlavor;
using Pegasus::CIMValue;
using Scope = QualifierScope;

enum class Kind { boolean, trueBoolean, string, strings, uint32, sint64 };

// Flavors besides EnableOverride and ToSubclass, which hold unless the row says otherwise.
constexpr unsigned kPlain = 0;
constexpr unsigned kFixed = 1;       // DisableOverride
constexpr unsigned kRestricted = 2;  // Restricted
constexpr unsigned kText = 4;        // Translatable

constexpr unsigned kClasses = Scope::kClass | Scope::kAssociation | Scope::kIndication;
constexpr unsigned kProperties = Scope::kProperty | Scope::kReference;
constexpr unsigned kFeatures = kProperties | Scope::kMethod;
constexpr unsigned kTyped = Scope::kProperty | Scope::kMethod | Scope::kParameter;
constexpr unsigned kDeletion = Scope::kAssociation | Scope::kReference;

struct Row {
  const char* name;
  Kind kind;
  unsigned scope;
  unsigned flavor;
};

// DSP0004, 5.6.3 and 5.6.4.
constexpr Row kRows[] = {
    {"Abstract", Kind::boolean, kClasses, kRestricted},
    {"Aggregate", Kind::boolean, Scope::kReference, kFixed},
    {"Aggregation", Kind::boolean, Scope::kAssociation, kFixed},
    {"Alias", Kind::string, kFeatures, kText},
    {"ArrayType", Kind::string, kTyped, kFixed},
    {"Association", Kind::boolean, Scope::kAssociation, kFixed},
    {"BitMap", Kind::strings, kTyped, kPlain},
    {"BitValues", Kind::strings, kTyped, kText},
    {"ClassConstraint", Kind::strings, kClasses, kPlain},
    {"Composition", Kind::boolean, Scope::kAssociation, kFixed},
    {"Correlatable", Kind::strings, Scope::kProperty, kPlain},
    {"Counter", Kind::boolean, kTyped, kPlain},
    {"Delete", Kind::boolean, kDeletion, kPlain},
    {"Deprecated", Kind::strings, Scope::kAny, kRestricted},
    {"Description", Kind::string, Scope::kAny, kText},
    {"DisplayName", Kind::string, Scope::kAny, kText},
    {"DN", Kind::boolean, kTyped, kFixed},
    {"EmbeddedInstance", Kind::string, kTyped, kPlain},
    {"EmbeddedObject", Kind::boolean, kTyped, kFixed},
    {"Exception", Kind::boolean, Scope::kClass | Scope::kIndication, kFixed},
    {"Expensive", Kind::boolean, Scope::kAny, kPlain},
    {"Experimental", Kind::boolean, Scope::kAny, kRestricted},
    {"Gauge", Kind::boolean, kTyped, kPlain},
    {"Hidden", Kind::boolean, Scope::kAny, kPlain},
    {"IfDeleted", Kind::boolean, kDeletion, kPlain},
    {"In", Kind::trueBoolean, Scope::kParameter, kFixed},
    {"Indication", Kind::boolean, Scope::kClass | Scope::kIndication, kFixed},
    {"Invisible", Kind::boolean, Scope::kAny, kPlain},
    {"IsPUnit", Kind::boolean, kTyped, kPlain},
    {"Key", Kind::boolean, kProperties, kFixed},
    {"Large", Kind::boolean, kClasses | Scope::kProperty, kPlain},
    {"MappingStrings", Kind::strings, Scope::kAny, kPlain},
    {"Max", Kind::uint32, Scope::kReference, kPlain},
    {"MaxLen", Kind::uint32, kTyped, kPlain},
    {"MaxValue", Kind::sint64, kTyped, kPlain},
    {"MethodConstraint", Kind::strings, Scope::kMethod, kPlain},
    {"Min", Kind::uint32, Scope::kReference, kPlain},
    {"MinLen", Kind::uint32, kTyped, kPlain},
    {"MinValue", Kind::sint64, kTyped, kPlain},
    {"ModelCorrespondence", Kind::strings, Scope::kAny, kPlain},
    {"Nonlocal", Kind::string, Scope::kReference, kPlain},
    {"NonlocalType", Kind::string, Scope::kReference, kPlain},
    {"NullValue", Kind::string, Scope::kProperty, kPlain},
    {"OctetString", Kind::boolean, kTyped, kFixed},
    {"Out", Kind::boolean, Scope::kParameter, kFixed},
    {"Override", Kind::string, kFeatures, kRestricted},
    {"Propagated", Kind::string, kProperties, kFixed},
    {"PropertyConstraint", Kind::strings, kProperties, kPlain},
    {"PropertyUsage", Kind::string, Scope::kProperty, kPlain},
    {"Provider", Kind::string, Scope::kAny, kPlain},
    {"PUnit", Kind::string, kTyped, kPlain},
    {"Read", Kind::trueBoolean, kProperties, kPlain},
    {"Reference", Kind::string, Scope::kProperty, kPlain},
    {"Required", Kind::boolean, kFeatures | Scope::kParameter, kFixed},
    {"Revision", Kind::string, kClasses | Scope::kSchema, kText},
    {"Schema", Kind::string, kFeatures, kText},
    {"Source", Kind::string, kClasses, kPlain},
    {"SourceType", Kind::string, kClasses, kPlain},
    {"Static", Kind::boolean, Scope::kProperty | Scope::kMethod, kFixed},
    {"Structure", Kind::boolean, kClasses, kPlain},
    {"Syntax", Kind::string, kFeatures | Scope::kParameter, kPlain},
    {"SyntaxType", Kind::string, kFeatures | Scope::kParameter, kPlain},
    {"Terminal", Kind::boolean, kClasses, kPlain},
    {"TriggerType", Kind::string, kClasses | kFeatures, kPlain},
    {"UMLPackagePath", Kind::string, kClasses, kPlain},
    {"Units", Kind::string, kTyped, kText},
    {"UnknownValues", Kind::strings, Scope::kProperty, kPlain},
    {"UnsupportedValues", Kind::strings, Scope::kProperty, kPlain},
    {"ValueMap", Kind::strings, kTyped, kPlain},
    {"Values", Kind::strings, kTyped, kText},
    {"Version", Kind::string, kClasses | Scope::kSchema, kRestricted | kText},
    {"Weak", Kind::boolean, Scope::kReference, kFixed},
    {"Write", Kind::boolean, kProperties, kPlain},
    {"XMLNamespaceName", Kind::string, kTyped, kPlain},
};

CIMValue defaultOf(Kind kind) {
  switch (kind) {
    case Kind::boolean:
      return CIMValue(false);
    case Kind::trueBoolean:
      return CIMValue(true);
    case Kind::string:
      return CIMValue(Pegasus::CIMTYPE_STRING, false);
    case Kind::strings:
      return CIMValue(Pegasus::CIMTYPE_STRING, true);
    case Kind::uint32:
      return CIMValue(Pegasus::CIMTYPE_UINT32, false);
    case Kind::sint64:
      return CIMValue(Pegasus::CIMTYPE_SINT64, false);
  }
  return CIMValue();
}

CIMFlavor flavorOf(unsigned bits) {
  CIMFlavor flavor = (bits & kFixed) != 0 ? CIMFlavor::DISABLEOVERRIDE : CIMFlavor::OVERRIDABLE;
  flavor.addFlavor((bits & kRestricted) != 0 ? CIMFlavor::RESTRICTED : CIMFlavor::TOSUBCLASS);
  if ((bits & kText) != 0) flavor.addFlavor(CIMFlavor::TRANSLATABLE);
  return flavor;
}

using Table = std::unordered_map<Pegasus::CIMName, QualifierDeclaration, NameHash, NameEqual>;

Table makeTable() {
  Table table;
  for (const Row& row : kRows) {
    const Pegasus::CIMName name(row.name);
    table[name] = {Pegasus::CIMQualifier(name, defaultOf(row.kind), flavorOf(row.flavor)),
                   row.scope};
  }
  return table;
}

const Table& standardTable() {
  static const Table table = makeTable();
  return table;
}

}  // namespace

const QualifierDeclaration* findStandardQualifier(const Pegasus::CIMName& name) {
  const auto found = standardTable().find(name);
  return found != standardTable().end() ? &found->second : nullptr;
}

std::vector<QualifierDeclaration> standardQualifiers() {
  std::vector<QualifierDeclaration> result;
  for (const auto& each : standardTable()) result.push_back(each.second);
  return result;
}

}  // namespace cimhost
