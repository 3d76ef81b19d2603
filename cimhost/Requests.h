#pragma once

#include "cimhost/AssociationPlan.h"
#include "cimhost/InstanceShaper.h"

#include <Pegasus/Common/CIMInstance.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMParamValue.h>

namespace cimhost {

// What a client asks of Operations: the parameters of DSP0200's operations, under its names.

struct EnumerateInstancesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
  InstanceSelection selection;
};

struct EnumerateInstanceNamesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
};

struct GetInstanceRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath instanceName;  ///< Its host and namespace are replaced.
  InstanceSelection selection;          ///< deepInheritance is not used.
};

struct GetClassRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;
  bool localOnly = true;
  bool includeQualifiers = true;
  bool includeClassOrigin = false;
  Pegasus::CIMPropertyList propertyList;
};

struct EnumerateClassesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;  ///< Null: from the top of the namespace.
  bool deepInheritance = false;
  bool localOnly = true;
  bool includeQualifiers = true;
  bool includeClassOrigin = false;
};

struct EnumerateClassNamesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMName className;  ///< Null: from the top of the namespace.
  bool deepInheritance = false;
};

struct ModifyInstanceRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMInstance instance;  ///< Its path names the instance; its values are not checked.
  bool includeQualifiers = true;
  Pegasus::CIMPropertyList propertyList;  ///< Null: all properties.
};

struct CreateInstanceRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMInstance instance;
};

struct DeleteInstanceRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath instanceName;
};

struct InvokeMethodRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath objectName;  ///< An instance, or a class for what needs no instance.
  Pegasus::CIMName methodName;
  Pegasus::Array<Pegasus::CIMParamValue> parameters;
};

struct AssociatorsRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath objectName;
  AssociationFilter filter;
  InstanceSelection selection;  ///< deepInheritance and localOnly are not used.
};

struct AssociatorNamesRequest {
  Pegasus::CIMNamespaceName nameSpace;
  Pegasus::CIMObjectPath objectName;
  AssociationFilter filter;
};

/// `filter.associationClass` is what DSP0200 calls ResultClass here; `filter.resultClass` and
/// `filter.resultRole` are not used.
using ReferencesRequest = AssociatorsRequest;
using ReferenceNamesRequest = AssociatorNamesRequest;

}  // namespace cimhost
