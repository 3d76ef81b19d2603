#pragma once

#include "ObjectRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of an instance refer to.
class InstanceRep final : public ObjectRep {
 public:
  using ObjectRep::ObjectRep;

  InstanceRep* clone() const override { return new InstanceRep(*this); }
  bool identical(const ObjectRep& other) const override;
  void checkProperty(const PropertyRep&) const override {}
};

PEGASUS_NAMESPACE_END
