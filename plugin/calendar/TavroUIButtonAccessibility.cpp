#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// Holds the place for what every button may need; changes nothing.
class TavroUIButtonAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TavroUIButtonAccessibility";
  static constexpr Name target = "UIButton";
};

const Registered category = safeCategory<TavroUIButtonAccessibility, kNoHostContract>();

}  // namespace
}  // namespace tavro
