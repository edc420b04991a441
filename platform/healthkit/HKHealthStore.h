#pragma once

#include "platform/foundation/NSError.h"
#include "platform/healthkit/HKTypes.h"

namespace tavro {

/// The answer to the wheelchair query. Message: `wheelchairUse` ("q").
class HKWheelchairUseObject : public NSObject {
 public:
  static constexpr Name className = "HKWheelchairUseObject";

  HKWheelchairUse value = HKWheelchairUse::notSet;

  [[nodiscard]] HKWheelchairUse wheelchairUse() const { return value; }
};

/// The gate to the user's health data. Message: `wheelchairUseWithError:` ("@,^@").
class HKHealthStore : public NSObject {
 public:
  static constexpr Name className = "HKHealthStore";
  /// The domain of the store's errors.
  static constexpr std::string_view kErrorDomain = "HKErrorDomain";

  /// What the settings hold; every call is counted there. On failure nil, and an `NSError` in
  /// `error` unless that is null; on success `error` is left alone. May be called on any thread,
  /// on a store that was made there; the results belong to that thread.
  Ref<HKWheelchairUseObject> wheelchairUse(id* error);
};

}  // namespace tavro
