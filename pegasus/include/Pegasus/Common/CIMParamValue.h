// The value of a method's parameter on its way to or from an invocation.
#pragma once

#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/CIMValue.h>
#include <Pegasus/Common/String.h>
#include <Pegasus/Embedded/Shareable.h>

PEGASUS_NAMESPACE_BEGIN

class CIMValue;
class ParamValueRep;

/// A handle: copies refer to the same object, clone() makes another one.
///
/// Every member but isUninitialized throws UninitializedObjectException on an empty handle.
class PEGASUS_COMMON_LINKAGE CIMParamValue {
 public:
  CIMParamValue() = default;
  /// Throws UninitializedObjectException for an empty name.
  CIMParamValue(String parameterName, CIMValue value, Boolean isTyped = true);

  String getParameterName() const;
  CIMValue getValue() const;
  Boolean isTyped() const;
  void setParameterName(String& parameterName);
  void setValue(CIMValue& value);
  void setIsTyped(Boolean isTyped);
  CIMParamValue clone() const;
  Boolean isUninitialized() const;

 private:
  ParamValueRep& rep() const;

  Ref<ParamValueRep> rep_;
};

PEGASUS_NAMESPACE_END
