#pragma once

#include <Pegasus/Embedded/QualifiedHandle.h>

#include "QualifiedRep.h"

PEGASUS_NAMESPACE_BEGIN

/// The way between handles and what they refer to.
struct HandleAccess {
  /// The object behind a handle; throws UninitializedObjectException when there is none.
  template <class Rep, class Handle>
  static Ref<Rep> rep(const Handle& handle) {
    return Ref<Rep>(static_cast<Rep*>(&handle.rep()));
  }
  /// The same for any handle, empty included.
  template <class Handle>
  static const auto& repOrNull(const Handle& handle) {
    return handle.rep_;
  }
  template <class Handle, class Rep>
  static Handle handle(Ref<Rep> rep) {
    return Handle(std::move(rep));
  }
};

PEGASUS_NAMESPACE_END
