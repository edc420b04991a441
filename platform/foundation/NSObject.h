#pragma once

#include <memory>

#include "platform/runtime/Message.h"

namespace tavro {

struct AccessibilityAttributes;
struct AccessibilityAttributesDeleter {
  void operator()(AccessibilityAttributes* attributes) const;
};

/// The root class of everything above the runtime.
///
/// Class messages: `alloc` (a new instance), `new` (`alloc`, then `init`).
/// Messages: `init` (yields the receiver), `description` (a text for people; the class's name where
/// a subclass says nothing better).
class NSObject : public Object {
 public:
  static constexpr Name className = "NSObject";

  /// What was set on this object for the screen reader; owned by the accessibility runtime, null
  /// until something is set.
  std::unique_ptr<AccessibilityAttributes, AccessibilityAttributesDeleter> accessibility;

 protected:
  NSObject();
  ~NSObject() override;
};

}  // namespace tavro
