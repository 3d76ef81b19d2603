#pragma once

#include <Pegasus/Common/CIMQualifier.h>
#include <Pegasus/Common/Exception.h>
#include <Pegasus/Embedded/CIMOMHandleRep.h>

#include <cstdint>
#include <initializer_list>
#include <mutex>
#include <string>
#include <vector>

#include "conversion/CimText.h"
#include "conversion/MakeClass.h"

/// A CIM host of hand-built classes and foreign instances, which notes the calls that reach it.
class TestHost : public Pegasus::CIMOMHandleRep {
 public:
  void add(const Pegasus::CIMClass& cimClass) { classes_.push_back(cimClass); }
  void add(const Pegasus::CIMInstance& foreign) { foreign_.push_back(foreign); }

  /// "getClass root/t T_Item 0 1 1 null": the flags in the order of the arguments, then the list.
  std::vector<std::string> calls;

  /// After this many calls no class is found any more.
  size_t callLimit = SIZE_MAX;

  Pegasus::CIMClass getClass(const Pegasus::OperationContext&,
                             const Pegasus::CIMNamespaceName& nameSpace,
                             const Pegasus::CIMName& className, Pegasus::Boolean localOnly,
                             Pegasus::Boolean includeQualifiers,
                             Pegasus::Boolean includeClassOrigin,
                             const Pegasus::CIMPropertyList& propertyList) override {
    const size_t made = note("getClass", nameSpace, textOf(className.getString()),
                             {localOnly, includeQualifiers, includeClassOrigin}, propertyList);
    for (const Pegasus::CIMClass& cimClass : classes_) {
      if (made > callLimit) break;
      if (cimClass.getClassName() == className) return cimClass.clone();
    }
    throw Pegasus::CIMException(Pegasus::CIM_ERR_NOT_FOUND, className.getString());
  }

  Pegasus::CIMInstance getInstance(const Pegasus::OperationContext&,
                                   const Pegasus::CIMNamespaceName& nameSpace,
                                   const Pegasus::CIMObjectPath& path, Pegasus::Boolean localOnly,
                                   Pegasus::Boolean includeQualifiers,
                                   Pegasus::Boolean includeClassOrigin,
                                   const Pegasus::CIMPropertyList& propertyList) override {
    note("getInstance", nameSpace, textOf(path), {localOnly, includeQualifiers, includeClassOrigin},
         propertyList);
    for (const Pegasus::CIMInstance& instance : foreign_) {
      if (instance.getPath() == path) return instance.clone();
    }
    throw Pegasus::CIMException(Pegasus::CIM_ERR_NOT_FOUND, path.toString());
  }

  Pegasus::Array<Pegasus::CIMInstance> enumerateInstances(
      const Pegasus::OperationContext&, const Pegasus::CIMNamespaceName& nameSpace,
      const Pegasus::CIMName& className, Pegasus::Boolean deepInheritance,
      Pegasus::Boolean localOnly, Pegasus::Boolean includeQualifiers,
      Pegasus::Boolean includeClassOrigin, const Pegasus::CIMPropertyList& propertyList) override {
    note("enumerateInstances", nameSpace, textOf(className.getString()),
         {deepInheritance, localOnly, includeQualifiers, includeClassOrigin}, propertyList);
    Pegasus::Array<Pegasus::CIMInstance> found;
    for (const Pegasus::CIMInstance& instance : foreign_) {
      if (instance.getClassName() == className) found.append(instance.clone());
    }
    return found;
  }

 private:
  /// Gives how many calls there are now.
  size_t note(const char* operation, const Pegasus::CIMNamespaceName& nameSpace,
              const std::string& object, std::initializer_list<Pegasus::Boolean> flags,
              const Pegasus::CIMPropertyList& propertyList) {
    std::string call = std::string(operation) + " " + textOf(nameSpace.getString()) + " " + object;
    for (const Pegasus::Boolean flag : flags) call += flag ? " 1" : " 0";
    const std::lock_guard<std::mutex> lock(mutex_);
    calls.push_back(call + (propertyList.isNull() ? " null" : " list"));
    return calls.size();
  }

  std::mutex mutex_;
  std::vector<Pegasus::CIMClass> classes_;
  std::vector<Pegasus::CIMInstance> foreign_;
};
