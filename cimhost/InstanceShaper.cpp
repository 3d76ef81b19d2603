#include "cimhost/InstanceShaper.h"

namespace cimhost {

using namespace Pegasus;

namespace {

CIMClass wholeClass(const ClassRepository& repository, const CIMNamespaceName& nameSpace,
                    const CIMName& name) {
  return repository.getClass(nameSpace, name, false, true, true, CIMPropertyList());
}

bool isInherited(const CIMConstProperty& property) {
  return property.getPropagated();
}

}  // namespace

bool completePath(CIMObjectPath& path, const CIMNamespaceName& nameSpace, const String& hostName) {
  const bool withoutNamespace = path.getNameSpace().isNull();
  const bool withoutHost = path.getHost().size() == 0 && hostName.size() > 0;
  if (withoutNamespace) path.setNameSpace(nameSpace);
  if (withoutHost) path.setHost(hostName);
  return withoutNamespace || withoutHost;
}

InstanceShaper::InstanceShaper(const ClassRepository& repository, CIMNamespaceName nameSpace,
                               CIMName requestedClass, InstanceSelection selection, String hostName)
    : repository_(repository),
      nameSpace_(std::move(nameSpace)),
      requestedClass_(std::move(requestedClass)),
      selection_(std::move(selection)),
      hostName_(std::move(hostName)) {}

CIMInstance InstanceShaper::shape(const CIMInstance& delivered) {
  const CIMPropertyList& properties = propertiesOf(delivered.getClassName());
  const bool filtered = isFiltered(delivered, properties);
  CIMObjectPath path = delivered.getPath();
  const bool placed = completePath(path, nameSpace_, hostName_);
  if (!filtered && !placed && !selection_.includeClassOrigin) return delivered;

  CIMInstance shaped = delivered.clone();
  if (filtered) {
    shaped.instanceFilter(selection_.includeQualifiers, selection_.includeClassOrigin, properties);
  }
  if (placed) shaped.setPath(path);
  if (selection_.includeClassOrigin) addOrigins(shaped);
  return shaped;
}

void InstanceShaper::addOrigins(CIMInstance& instance) const {
  if (!repository_.hasClass(nameSpace_, instance.getClassName())) return;
  const CIMClass declaration = wholeClass(repository_, nameSpace_, instance.getClassName());
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    CIMProperty property = instance.getProperty(i);
    const Uint32 position = declaration.findProperty(property.getName());
    if (!property.getClassOrigin().isNull() || position == PEG_NOT_FOUND) continue;
    property.setClassOrigin(CIMConstClass(declaration).getProperty(position).getClassOrigin());
  }
}

const CIMPropertyList& InstanceShaper::propertiesOf(const CIMName& className) {
  if (selection_.deepInheritance && !selection_.localOnly) return selection_.propertyList;
  for (const auto& entry : lists_) {
    if (entry.first == className) return entry.second;
  }
  lists_.emplace_back(className, selectProperties(className));
  return lists_.back().second;
}

CIMPropertyList InstanceShaper::selectProperties(const CIMName& className) const {
  if (!repository_.hasClass(nameSpace_, className)) return selection_.propertyList;
  const CIMClass actual = wholeClass(repository_, nameSpace_, className);
  const CIMClass requested = wholeClass(repository_, nameSpace_, requestedClass_);
  Array<CIMName> names;
  for (Uint32 i = 0; i < actual.getPropertyCount(); ++i) {
    const CIMConstProperty property = actual.getProperty(i);
    const CIMName name = property.getName();
    const Uint32 position = requested.findProperty(name);
    const bool known = position != PEG_NOT_FOUND;
    if (!known && !selection_.deepInheritance) continue;
    if (selection_.localOnly && known && isInherited(property) &&
        isInherited(requested.getProperty(position))) {
      continue;
    }
    if (selection_.propertyList.useThisProperty(name)) names.append(name);
  }
  return CIMPropertyList(names);
}

bool InstanceShaper::isFiltered(const CIMInstance& instance,
                                const CIMPropertyList& properties) const {
  if (!selection_.includeQualifiers && instance.getQualifierCount() > 0) return true;
  for (Uint32 i = 0; i < instance.getPropertyCount(); ++i) {
    const CIMConstProperty property = instance.getProperty(i);
    if (!properties.useThisProperty(property.getName())) return true;
    if (!selection_.includeQualifiers && property.getQualifierCount() > 0) return true;
    if (!selection_.includeClassOrigin && !property.getClassOrigin().isNull()) return true;
  }
  return false;
}

}  // namespace cimhost
