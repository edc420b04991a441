#pragma once

#include <string>

#include "platform/foundation/NSObject.h"

namespace tavro {

/// What an operation reports through an "^@" out-parameter instead of raising.
class NSError : public NSObject {
 public:
  static constexpr Name className = "NSError";

  std::string domain;
  std::int64_t code = 0;
};

}  // namespace tavro
