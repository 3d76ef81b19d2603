#pragma once

#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Embedded/CIMOMHandleRep.h>

#include <cstdint>
#include <initializer_list>
#include <string>
#include <vector>

#include "conversion/CimText.h"
#include "conversion/MakeClass.h"

/// A CIM host of hand-built classes and foreign instances, which notes the calls that reach it.
class TestHost : public CIMOMHandleRep {
 public:
  void add(const CIMClass& cimClass) { classes_.push_back(cimClass); }
  void add(const CIMInstance& foreign) { foreign_.push_back(foreign); }

  /// "getClass root/t T_Item 0 1 1 null": the flags in the order of the arguments, then the list.
  std::vector<std::string> calls;

  /// After this many calls no class is found any more.
  size_t callLimit = SIZE_MAX;

  CIMClass getClass(const OperationContext&, const CIMNamespaceName& nameSpace,
                    const CIMName& className, Boolean localOnly, Boolean includeQualifiers,
                    Boolean includeClassOrigin, const CIMPropertyList& propertyList) override {
    const size_t made = note("getClass", nameSpace, textOf(className.getString()),
                             {localOnly, includeQualifiers, includeClassOrigin}, propertyList);
    for (const CIMClass& cimClass : classes_) {
      if (made > callLimit) break;
      if (cimClass.getClassName() == className) return cimClass.clone();
    }
    throw CIMException(CIM_ERR_NOT_FOUND, className.getString());
  }

  CIMInstance getInstance(const OperationContext&, const CIMNamespaceName& nameSpace,
                          const CIMObjectPath& path, Boolean localOnly, Boolean includeQualifiers,
                          Boolean includeClassOrigin,
                          const CIMPropertyList& propertyList) override {
    note("getInstance", nameSpace, textOf(path), {localOnly, includeQualifiers, includeClassOrigin},
         propertyList);
    for (const CIMInstance& instance : foreign_) {
      if (instance.getPath() == path) return instance.clone();
    }
    throw CIMException(CIM_ERR_NOT_FOUND, path.toString());
  }

  Array<CIMInstance> enumerateInstances(const OperationContext&, const CIMNamespaceName& nameSpace,
                                        const CIMName& className, Boolean deepInheritance,
                                        Boolean localOnly, Boolean includeQualifiers,
                                        Boolean includeClassOrigin,
                                        const CIMPropertyList& propertyList) override {
    note("enumerateInstances", nameSpace, textOf(className.getString()),
         {deepInheritance, localOnly, includeQualifiers, includeClassOrigin}, propertyList);
    Array<CIMInstance> found;
    for (const CIMInstance& instance : foreign_) {
      if (instance.getClassName() == className) found.append(instance.clone());
    }
    return found;
  }

 private:
  /// Gives how many calls there are now.
  size_t note(const char* operation, const CIMNamespaceName& nameSpace, const std::string& object,
              std::initializer_list<Boolean> flags, const CIMPropertyList& propertyList) {
    std::string call = std::string(operation) + " " + textOf(nameSpace.getString()) + " " + object;
    for (const Boolean flag : flags) call += flag ? " 1" : " 0";
    calls.push_back(call + (propertyList.isNull() ? " null" : " list"));
    return calls.size();
  }

  std::vector<CIMClass> classes_;
  std::vector<CIMInstance> foreign_;
};
