#pragma once

#include "platform/runtime/Message.h"

namespace tavro {

// Free functions that other rooms find by name. They are class methods of one class without
// instances, so a missing one or a wrong signature is what it is for every other message.
// A library declares:  extendClass(kFunctions).classMethod<&copyName>("CopyName")
// where the C++ function takes the class as its first argument.

inline constexpr Name kFunctions = "__Functions";

/// Calls the function of that name; raises when there is none or when its signature differs.
template <class R, class... A>
R callFunction(Name name, const A&... arguments) {
  return send<R>(Class::named(kFunctions), name, arguments...);
}

}  // namespace tavro
