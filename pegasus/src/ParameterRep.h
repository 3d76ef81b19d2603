#pragma once

#include <Pegasus/Common/CIMType.h>

#include "QualifiedRep.h"

PEGASUS_NAMESPACE_BEGIN

/// What handles of a parameter refer to.
class ParameterRep final : public QualifiedRep {
 public:
  static constexpr const char* kKind = "parameter";
  static constexpr bool kSharedByCopies = true;

  ParameterRep(const CIMName& name, CIMType parameterType, Boolean parameterIsArray,
               Uint32 fixedSize, const CIMName& referenceClass);

  bool identical(const ParameterRep& other) const;

  const CIMType type;
  const Boolean isArray;
  const Uint32 arraySize;
  const CIMName referenceClassName;
};

PEGASUS_NAMESPACE_END
