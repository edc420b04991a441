#include <cmath>
#include <limits>

#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Speech.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSValue.h"
#include "platform/healthkit/HKWorkout.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr std::uint64_t kSlices = 8;
constexpr double kSecondsPerHour = 3600;

/// The lowest and the highest of some heart rates, in whole beats per minute.
class HeartRateRange {
 public:
  void add(double beatsPerMinute) {
    if (!std::isfinite(beatsPerMinute)) {
      return;
    }
    const double rounded = std::round(beatsPerMinute);
    highest_ = rounded > highest_ ? rounded : highest_;
    lowest_ = rounded < lowest_ ? rounded : lowest_;
  }

  /// nil when no heart beat in it.
  [[nodiscard]] Ref<NSString> text() const {
    if (highest_ == kNoHighest || lowest_ == kNoLowest) {
      return nullptr;
    }
    const Ref<NSString> highest = AXFormatFloat(0, static_cast<float>(highest_));
    if (std::abs(highest_ - lowest_) < std::numeric_limits<double>::epsilon()) {
      return localizedStringWithFormat(localized("heart.rate.graph.single"), {highest});
    }
    return localizedStringWithFormat(localized("heart.rate.graph.range"),
                                     {AXFormatFloat(0, static_cast<float>(lowest_)), highest});
  }

 private:
  // The smallest positive number: a heart rate of 0 is no heart rate.
  static constexpr double kNoHighest = std::numeric_limits<double>::min();
  static constexpr double kNoLowest = std::numeric_limits<double>::max();
  double highest_ = kNoHighest;
  double lowest_ = kNoLowest;
};

/// The rate of a reading; nothing for what is no reading, lies outside the span or cannot be read:
/// only a reading that says 0 counts as 0. Both ends belong to the span, so that a reading between
/// two slices counts in both.
Ref<NSNumber> rateWithin(const NSDateInterval& span, const id& reading) {
  return span.containsDate(as<NSDate>(trySend<id>(reading, "date")))
             ? typedRead<NSNumber>(trySend<id>(reading, "quantity"), "ch_beatsPerMinute")
             : nullptr;
}

HeartRateRange rangeOfReadings(const NSArray& readings, const NSDateInterval& span) {
  HeartRateRange range;
  Class* const readingClass = AXSafeClassFromString("HKHeartRateSummaryReading");
  for (const id& reading : readings) {
    if (isKindOf(reading.get(), readingClass)) {
      if (const Ref<NSNumber> rate = rateWithin(span, reading)) {
        range.add(rate->doubleValue());
      }
    }
  }
  return range;
}

/// The heart rate of a workout in slices of its time. The chart view hands out the drawn chart;
/// whoever makes that one accessible asks the chart view, its data source, for the slices.
class CHWorkoutDetailHeartRateChartViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailHeartRateChartViewAccessibility";
  static constexpr Name target = "CHWorkoutDetailHeartRateChartView";

  id accessibilityElements() {
    return axArrayByIgnoringNilElements(
        {safeUIViewForKey(safeValueForKey(self, "_chartView"), "_containerView")});
  }

  bool _accessibilityShouldUseSlices() {
    return safeBoolForKey(self, "_hasAdequateDataForDisplay");
  }

  std::uint64_t _accessibilityNumberOfSlices() { return kSlices; }

  id _axDateInterval() { return as<NSDateInterval>(safeValueForKeyPath(self, "dateInterval")); }

  double _accessibilityTimeIntervalPerSlice() { return duration() / numberOfSlices(); }

  std::uint64_t _accessibilityHoursPerSlice() {
    return saturatingCast<std::uint64_t>(duration() / kSecondsPerHour / numberOfSlices());
  }

  /// The time of day in hours; 0 for no date.
  float _decimalForDate(const id& date) {
    const Ref<NSDateComponents> parts = currentCalendar()->componentsFromDate(as<NSDate>(date));
    return parts ? static_cast<float>(parts->hour) + static_cast<float>(parts->minute) / 60.0F +
                       static_cast<float>(parts->second) / 3600.0F
                 : 0.0F;
  }

  id _accessibilityQuantityForSliceAtIndex(std::uint64_t index) {
    const Ref<NSDateInterval> slice = sliceAtIndex(index);
    const Ref<NSArray> readings = safeArrayForKey(self, "_heartRateReadings");
    return slice && readings ? id(rangeOfReadings(*readings, *slice).text()) : id();
  }

 private:
  Ref<NSDateInterval> interval() {
    return as<NSDateInterval>(trySend<id>(self, "_axDateInterval"));
  }
  double duration() {
    const Ref<NSDateInterval> whole = interval();
    return whole ? whole->duration() : 0;
  }
  double numberOfSlices() {
    return static_cast<double>(trySend<std::uint64_t>(self, "_accessibilityNumberOfSlices"));
  }

  Ref<NSDate> boundary(const Ref<NSDate>& start, double index) {
    return dateByAddingTimeInterval(
        start, trySend<double>(self, "_accessibilityTimeIntervalPerSlice") * index);
  }
  /// nil without an interval, and for one that ends before it starts.
  Ref<NSDateInterval> sliceAtIndex(std::uint64_t index) {
    Ref<NSDateInterval> slice;
    if (const Ref<NSDateInterval> whole = interval()) {
      const auto position = static_cast<double>(index);
      AXPerformSafeBlock([&] {
        slice = dateInterval(boundary(whole->startDate, position),
                             boundary(whole->startDate, position + 1));
      });
    }
    return slice;
  }
};

constexpr HostCheck kHostContract[] = {
    conformsToProtocol("CHWorkoutDetailHeartRateChartView", "TVUIChartDataSource"),
    instanceVariable("CHWorkoutDetailHeartRateChartView", "_heartRateReadings", "NSArray"),
    instanceVariable("CHWorkoutDetailHeartRateChartView", "_heartRateChartPoints",
                     "NSMutableArray"),
    instanceVariable("CHWorkoutDetailHeartRateChartView", "_chartView", "TVUIChartView"),
    instanceVariable("CHWorkoutDetailHeartRateChartView", "_hasAdequateDataForDisplay", "B"),
    instanceMethod("CHWorkoutDetailHeartRateChartView", "_dateInterval", "@"),
    instanceMethod("HKQuantity", "ch_beatsPerMinute", "d"),
};

using Category = CHWorkoutDetailHeartRateChartViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_accessibilityShouldUseSlices>("_accessibilityShouldUseSlices")
        .method<&Category::_accessibilityNumberOfSlices>("_accessibilityNumberOfSlices")
        .method<&Category::_accessibilityQuantityForSliceAtIndex>(
            "_accessibilityQuantityForSliceAtIndex:")
        .method<&Category::_accessibilityTimeIntervalPerSlice>("_accessibilityTimeIntervalPerSlice")
        .method<&Category::_accessibilityHoursPerSlice>("_accessibilityHoursPerSlice")
        .method<&Category::_decimalForDate>("_decimalForDate:")
        .method<&Category::_axDateInterval>("_axDateInterval");

}  // namespace
}  // namespace tavro
