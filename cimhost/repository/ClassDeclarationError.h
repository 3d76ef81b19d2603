#pragma once

#include <Pegasus/Common/CIMName.h>
#include <Pegasus/Common/Exception.h>

namespace cimhost {

/// Why ClassRepository::addClass refused a class, and which part of the declaration is at fault.
class ClassDeclarationError : public Pegasus::CIMException {
 public:
  /// The innermost names that are not null tell the part; all null: the class itself.
  struct Part {
    Pegasus::CIMName feature;    ///< A property or method.
    Pegasus::CIMName parameter;  ///< Of the method `feature`.
    Pegasus::CIMName qualifier;  ///< Of the parameter, feature or class.
  };

  ClassDeclarationError(Pegasus::CIMStatusCode code, const Pegasus::String& message, Part part)
      : CIMException(code, message), part_(std::move(part)) {}

  const Part& part() const { return part_; }

 private:
  Part part_;
};

}  // namespace cimhost
