#include <cmath>

#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Speech.h"
#include "plugin/core/ChartElements.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr std::size_t kSlices = 8;
constexpr double kSecondsPerSlice = 10800;
constexpr float kSliceShare = 0.125F;

/// The chart types of the host: energy, and two kinds of minutes.
constexpr std::int32_t kActiveEnergy = 0;
constexpr std::int32_t kMinutes = 1;
constexpr std::int32_t kOtherMinutes = 2;

/// What a slice's total is called; asked once a build.
class AmountSpeech {
 public:
  explicit AmountSpeech(std::int32_t chartType) : type_(chartType) {
    if (type_ == kActiveEnergy) {
      format_ = localized("calories.format");
    } else if (type_ == kMinutes || type_ == kOtherMinutes) {
      format_ = localized("minutes.format");
    }
  }

  /// nil for a chart of unknown type.
  [[nodiscard]] Ref<NSString> text(float amount) const {
    return type_ == kActiveEnergy
               ? stringWithFormat(format_, {AXFormatFloat(0, amount)})
               : stringWithFormat(format_, {saturatingCast<std::int64_t>(amount)});
  }

 private:
  std::int32_t type_;
  Ref<NSString> format_;
};

float sumOfPoints(const NSArray& points, std::size_t first, std::size_t end) {
  float sum = 0;
  for (std::size_t index = first; index < end; ++index) {
    sum += amountAt(points, index);
  }
  return sum;
}

/// The move or exercise chart is a container of eight elements, one for each three hours.
class ActivityMoveAndExerciseChartViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "ActivityMoveAndExerciseChartViewAccessibility";
  static constexpr Name target = "TavroApp.ActivityMoveAndExerciseChartView";

  bool isAccessibilityElement() { return false; }

  id accessibilityElements() {
    return elementsBuiltOnce(self, kSlices, [this](NSMutableArray& elements) { build(elements); });
  }

  void _accessibilityLoadAccessibilityInformation() {
    super.send<void>();
    loadGraphData(self, "moveAndExerciseChartPoints", "NSValue", kDayViewGraphElements);
  }

  // Replaces the host's method, which is not continued.
  void accessibilityReloadData() { send<void>(self, "_accessibilityLoadAccessibilityInformation"); }

  id _accessibilityGraphData() { return _accessibilityValueForKey(self, kDayViewGraphElements); }

 private:
  void build(NSMutableArray& elements) {
    const auto chart = as<UIView>(self);
    const auto points = as<NSArray>(trySend<id>(self, "_accessibilityGraphData"));
    if (!chart || !points) {
      return;
    }
    const AmountSpeech speech(safeIntForKey(self, "moveAndExerciseChartViewType"));
    const float height = std::floor(static_cast<float>(chart->frame().size.height));
    const float width = std::floor(static_cast<float>(chart->frame().size.width) * kSliceShare);
    const std::size_t pointsPerSlice = points->count() / kSlices;
    addDayParts(elements, chart, {kSlices, kSecondsPerSlice, "hxa", {width, height}},
                [&](std::size_t slice) {
                  return speech.text(
                      sumOfPoints(*points, slice * pointsPerSlice, (slice + 1) * pointsPerSlice));
                });
  }
};

constexpr HostCheck kHostContract[] = {
    instanceMethod("TavroApp.ActivityMoveAndExerciseChartView", "moveAndExerciseChartPoints", "@"),
    instanceMethod("TavroApp.ActivityMoveAndExerciseChartView", "moveAndExerciseChartMaxYValue",
                   "d"),
    instanceMethod("TavroApp.ActivityMoveAndExerciseChartView", "moveAndExerciseChartViewType",
                   "q"),
    instanceMethod("TavroApp.ActivityMoveAndExerciseChartView", "accessibilityReloadData", "v"),
};

using Category = ActivityMoveAndExerciseChartViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::accessibilityReloadData>("accessibilityReloadData")
        .method<&Category::_accessibilityGraphData>("_accessibilityGraphData");

}  // namespace
}  // namespace tavro
