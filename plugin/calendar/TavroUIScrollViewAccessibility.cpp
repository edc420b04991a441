#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// Holds the place for what every scroll view may need; changes nothing.
class TavroUIScrollViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TavroUIScrollViewAccessibility";
  static constexpr Name target = "UIScrollView";
};

const Registered category = safeCategory<TavroUIScrollViewAccessibility, kNoHostContract>();

}  // namespace
}  // namespace tavro
