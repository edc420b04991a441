#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// The row reads the map, then the weather.
class CHWorkoutDetailMapAndWeatherTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailMapAndWeatherTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutDetailMapAndWeatherTableViewCell";

  id accessibilityElements() {
    return axArrayByIgnoringNilElements(
        {safeValueForKey(self, "_mapView"), safeValueForKey(self, "_weatherView")});
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailMapAndWeatherTableViewCell", "_mapView",
                     "CHWorkoutDetailMapView"),
    instanceVariable("CHWorkoutDetailMapAndWeatherTableViewCell", "_weatherView",
                     "_CHWorkoutDetailWeatherView"),
};

using Category = CHWorkoutDetailMapAndWeatherTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>().method<&Category::accessibilityElements>(
        "accessibilityElements");

}  // namespace
}  // namespace tavro
