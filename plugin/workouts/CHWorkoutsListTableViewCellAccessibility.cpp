#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Speech.h"
#include "platform/healthkit/HKWorkout.h"
#include "platform/uikit/UITables.h"

namespace tavro {
namespace {

/// A row of the workouts list is one element. Its icon says which application recorded the workout,
/// unless it was the watch, and its date is written out.
class CHWorkoutsListTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutsListTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutsListTableViewCell";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() { return UIAXStringForAllChildren(as<UIView>(self)); }

  void configureWithCurrentWorkout() {
    super.send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    const auto workout = typedRead<HKWorkout>(self, "workout");
    nameSource(trySend<id>(trySend<id>(workout, "sourceRevision"), "source"));
    writeOutDate(as<NSDate>(trySend<id>(workout, "startDate")));
  }

 private:
  void nameSource(const id& source) {
    const auto name = as<NSString>(trySend<id>(source, "name"));
    if (lengthOfText(name) > 0 && !safeBoolForKey(source, "_isOrlamWatch")) {
      const id icon = trySend<id>(as<UITableViewCell>(self), "imageView");
      trySend<void>(icon, "setAccessibilityLabel:", name);
      trySend<void>(icon, "setIsAccessibilityElement:", true);
    }
  }

  void writeOutDate(const Ref<NSDate>& date) {
    if (date) {
      trySend<void>(safeValueForKey(self, "_dateLabel"),
                    "setAccessibilityLabel:", AXDateStringForFormat(date, "EEEE, MMM d, yyyy"));
    }
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("CHWorkoutsListTableViewCell", "configureWithCurrentWorkout", "v"),
    instanceMethod("CHWorkoutsListTableViewCell", "workout", "@"),
    instanceMethod("CHWorkoutsListTableViewCell", "dateLabel", "@"),
    instanceMethod("HKSource", "_isOrlamWatch", "B"),
    kindOfClass("CHWorkoutsListTableViewCell", "UITableViewCell"),
};

using Category = CHWorkoutsListTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::accessibilityLabel>("accessibilityLabel")
        .method<&Category::configureWithCurrentWorkout>("configureWithCurrentWorkout")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation");

}  // namespace
}  // namespace tavro
