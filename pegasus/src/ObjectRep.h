#pragma once

#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMPropertyList.h>

#include "PropertyRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a class or an instance refer to. Its element name is the class name that it was
/// made with; the one that counts is in the path.
class ObjectRep : public QualifiedRep {
 public:
  explicit ObjectRep(const CIMName& className)
      : QualifiedRep(className), path_(String(), CIMNamespaceName(), className) {}

  virtual ObjectRep* clone() const = 0;
  virtual bool identical(const ObjectRep& other) const = 0;
  /// Throws what the kind of object does not accept.
  virtual void checkProperty(const PropertyRep& property) const = 0;

  const CIMObjectPath& path() const { return path_; }
  void setPath(const CIMObjectPath& path);
  void filter(Boolean includeQualifiers, Boolean includeClassOrigin,
              const CIMPropertyList& propertyList);

  ElementList<PropertyRep> properties;

 protected:
  bool sameContent(const ObjectRep& other) const;

 private:
  CIMObjectPath path_;
};

PEGASUS_NAMESPACE_END
