#pragma once

#include "cimhost/Operations.h"

#include <Pegasus/Embedded/CIMOMHandleRep.h>

namespace cimhost {

/// The CIM server as a provider sees it through its CIMOMHandle.
///
/// getClass: NOT_FOUND for a missing class; getInstance and enumerateInstances: INVALID_CLASS; all:
/// INVALID_NAMESPACE. localOnly is ignored for instances. A call may lead back into the provider
/// (enumeration of a class that it serves); more than kMaximumDepth such calls inside each other on
/// one thread are CIM_ERR_FAILED, so that no definition can exhaust the stack.
class EmbeddedCimom final : public Pegasus::CIMOMHandleRep {
 public:
  static constexpr int kMaximumDepth = 16;

  /// Both must outlive this object.
  EmbeddedCimom(const ClassRepository& repository, const Operations& operations);

  Pegasus::CIMClass getClass(const Pegasus::OperationContext& context,
                             const Pegasus::CIMNamespaceName& nameSpace,
                             const Pegasus::CIMName& className, Pegasus::Boolean localOnly,
                             Pegasus::Boolean includeQualifiers,
                             Pegasus::Boolean includeClassOrigin,
                             const Pegasus::CIMPropertyList& propertyList) override;
  Pegasus::CIMInstance getInstance(const Pegasus::OperationContext& context,
                                   const Pegasus::CIMNamespaceName& nameSpace,
                                   const Pegasus::CIMObjectPath& instanceName,
                                   Pegasus::Boolean localOnly, Pegasus::Boolean includeQualifiers,
                                   Pegasus::Boolean includeClassOrigin,
                                   const Pegasus::CIMPropertyList& propertyList) override;
  Pegasus::Array<Pegasus::CIMInstance> enumerateInstances(
      const Pegasus::OperationContext& context, const Pegasus::CIMNamespaceName& nameSpace,
      const Pegasus::CIMName& className, Pegasus::Boolean deepInheritance,
      Pegasus::Boolean localOnly, Pegasus::Boolean includeQualifiers,
      Pegasus::Boolean includeClassOrigin, const Pegasus::CIMPropertyList& propertyList) override;

 private:
  const ClassRepository& repository_;
  const Operations& operations_;
};

}  // namespace cimhost
