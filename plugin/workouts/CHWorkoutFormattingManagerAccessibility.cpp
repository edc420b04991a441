#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

/// A formatted duration is shown as the host has it and said as hours, minutes and seconds by
/// whoever speaks the label that it carries.
class CHWorkoutFormattingManagerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutFormattingManagerAccessibility";
  static constexpr Name target = "CHWorkoutFormattingManager";

  id formattedDuration(const id& workout, const id& activity, const id& context) {
    id shown = super.send<id>(workout, activity, context);
    if (const auto duration = as<NSAttributedString>(shown); lengthOfText(duration) > 0) {
      const Ref<AXAttributedString> spoken = axAttributedString(plainText(duration));
      spoken->setAttribute(kCFBooleanTrue(), UIAccessibilityTokenDurationTimeHHMMSS);
      trySend<void>(shown, "setAccessibilityLabel:", spoken);
    }
    return shown;
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHWorkoutFormattingManager",
                   "formattedDurationForWorkout:workoutActivity:context:", "@", "@", "@", "@"),
};

using Category = CHWorkoutFormattingManagerAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::formattedDuration>(
        "formattedDurationForWorkout:workoutActivity:context:");

}  // namespace
}  // namespace tavro
