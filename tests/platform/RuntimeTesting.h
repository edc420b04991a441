#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "platform/foundation/NSString.h"

namespace tavro::testing {

/// What a call raises, as "name: reason"; empty when it raises nothing.
inline std::string raisedBy(const std::function<void()>& call) {
  try {
    call();
  } catch (const NSException& exception) {
    return exception.what();
  }
  return {};
}

/// Whether the text holds the part; shows both when it does not.
inline ::testing::AssertionResult holds(const std::string& text, std::string_view part) {
  return text.find(part) == std::string::npos
             ? ::testing::AssertionFailure() << '"' << text << "\" lacks \"" << part << '"'
             : ::testing::AssertionSuccess();
}

/// A class of the process's own making, below NSObject unless another superclass is named.
inline Class* madeClass(std::string_view name, std::vector<Method> methods = {},
                        Name superclass = "NSObject") {
  const Name made = Name::make(name);
  declareClass({.name = made, .superclass = superclass, .methods = std::move(methods)});
  return Class::named(made);
}

/// A new instance of a class.
inline id newOf(Class* isa) { return send<id>(isa, "new"); }

}  // namespace tavro::testing
