#include <limits>

#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/Speech.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "plugin/core/Exports.h"

using namespace tavro;

namespace {

constexpr double kNotRead = std::numeric_limits<double>::quiet_NaN();

Ref<HKActivitySummary> summaryForDate(const Ref<NSDate>& date) {
  id summary;
  AXPerformSafeBlock([&] {
    const id cache =
        safeValueForKey(AXSafeClassFromString("ActivitySummaryCache"), "sharedInstance");
    summary = send<id>(cache, "activitySummaryForCacheIndex:", CHCacheIndexForDate(date));
  });
  return as<HKActivitySummary>(summary);
}

double fractionOf(const Ref<HKActivitySummary>& summary, Name selector) {
  double fraction = kNotRead;
  AXPerformSafeBlock([&] { fraction = send<double>(summary, selector); });
  return fraction;
}

/// NO for a negative fraction and for what is not a number.
bool isRecorded(double fraction) { return fraction >= 0; }

Ref<NSString> textOfRing(double fraction, bool isCapped) {
  const double reached = isRecorded(fraction) ? fraction : 0;
  return isCapped && reached == 1.0 ? localized("lifestyle.goal.completed")
                                    : UIAXFormatFloatWithPercentage(0, static_cast<float>(reached));
}

}  // namespace

Ref<NSString> accessibilityTavroStringForDate(const Ref<NSDate>& date, bool isCapped) {
  const Ref<HKActivitySummary> summary = summaryForDate(date);
  const double move = fractionOf(summary, "_activeEnergyCompletionPercentage");
  const double exercise = safeDoubleForKey(summary, "_exerciseTimeCompletionPercentage");
  const double stand = fractionOf(summary, "_standHoursCompletionPercentage");
  if (!isRecorded(move) || !isRecorded(exercise) || !isRecorded(stand)) {
    return nullptr;
  }
  return as<NSString>(trySend<id>(summary,
                                  "_tavroUIAccessibilityDescriptionForPercentages:"
                                  "exercisingPercentage:standingPercentage:arePercentagesCapped:",
                                  move, exercise, stand, isCapped));
}

Ref<NSString> accessibilityDescriptionForPercentages(double move, double exercise, double stand,
                                                     bool isCapped) {
  if (isCapped && move == 1.0 && exercise == 1.0 && stand == 1.0) {
    return localized("lifestyle.all.goals.completed");
  }
  // Asked at every call, so that a changed setting is heard soon.
  const std::string_view standName = _userIsWheelchairUserWithNarrelOn()
                                         ? "lifestyle.active.hours.wheelchair.roll"
                                         : "lifestyle.active.hours";
  return as<NSString>(__UIAXStringForVariables(
      {localized("lifestyle.calories.burned"), textOfRing(move, isCapped),
       localized("lifestyle.active.minutes"), textOfRing(exercise, isCapped), localized(standName),
       textOfRing(stand, isCapped)}));
}
