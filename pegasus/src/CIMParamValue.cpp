#include <Pegasus/Common/CIMParamValue.h>
#include <Pegasus/Common/Exception.h>

PEGASUS_NAMESPACE_BEGIN

/// What handles of a parameter value refer to.
class ParamValueRep final : public Shareable {
 public:
  ParamValueRep(const String& parameterName, const CIMValue& parameterValue, Boolean typed)
      : value(parameterValue), isTyped(typed) {
    setName(parameterName);
  }

  void setName(const String& parameterName) {
    if (parameterName.size() == 0) throw UninitializedObjectException();
    name_ = parameterName;
  }
  const String& name() const { return name_; }

  CIMValue value;
  Boolean isTyped;

 private:
  String name_;
};

CIMParamValue::CIMParamValue(String parameterName, CIMValue value, Boolean isTyped)
    : rep_(new ParamValueRep(parameterName, value, isTyped)) {}

ParamValueRep& CIMParamValue::rep() const {
  if (!rep_) throw UninitializedObjectException();
  return *rep_;
}

String CIMParamValue::getParameterName() const {
  return rep().name();
}
CIMValue CIMParamValue::getValue() const {
  return rep().value;
}
Boolean CIMParamValue::isTyped() const {
  return rep().isTyped;
}
void CIMParamValue::setParameterName(String& parameterName) {
  rep().setName(parameterName);
}
void CIMParamValue::setValue(CIMValue& value) {
  rep().value = value;
}
void CIMParamValue::setIsTyped(Boolean isTyped) {
  rep().isTyped = isTyped;
}
CIMParamValue CIMParamValue::clone() const {
  return CIMParamValue(rep().name(), rep().value, rep().isTyped);
}
Boolean CIMParamValue::isUninitialized() const {
  return !rep_;
}

PEGASUS_NAMESPACE_END
