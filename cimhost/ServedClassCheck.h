#pragma once

#include "cimhost/Diagnostic.h"
#include "cimhost/ServedClasses.h"
#include "cimhost/repository/ClassRepository.h"

#include <vector>

namespace cimhost {

/// Where definitions and declarations do not fit together, as warnings: a class that is not
/// declared, or defined before, or both a class and an association; a defined property that its
/// class does not declare or spells in other letter case, and one that is declared without a Key
/// qualifier, for want of which the provider drops every instance.
std::vector<Diagnostic> checkServedClasses(const ServedClasses& served,
                                           const ClassRepository& repository);

}  // namespace cimhost
