#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// Known by name, not installed: the week's drawing is silent behind the days that lie on it.
class WeekViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "WeekViewAccessibility";
  static constexpr Name target = "WeekView";
};

const Registered category = safeCategory<WeekViewAccessibility, kNoHostContract>();

}  // namespace
}  // namespace tavro
