#include <algorithm>
#include <cmath>

#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/Formatters.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "platform/runtime/Dispatch.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

constexpr Name kShownDate = "AXDate";
constexpr std::ptrdiff_t kDaysPerWeek = 7;
constexpr double kSecondsPerDay = 86400;

Ref<NSArray> weekdayNames() {
  static OnceToken token;
  static Ref<NSDateFormatter> formatter;
  dispatchOnce(token, [] { formatter = make<NSDateFormatter>(); });
  return formatter->standaloneWeekdaySymbols();
}

/// 0 is Sunday ... 6 is Saturday.
std::int64_t weekdayIndex(const Ref<NSDate>& date) {
  return currentCalendar()->componentsFromDate(date)->weekday - 1;
}

std::int64_t moduloWeek(std::int64_t days) {
  return (days % kDaysPerWeek + kDaysPerWeek) % kDaysPerWeek;
}

/// The weekday that a column is named after.
std::int64_t weekdayOfColumn(std::int64_t column) {
  return moduloWeek(column + HKFirstDayOfWeekForWeeklyGoalCalculations() - 1);
}
/// The column that is named after a weekday.
std::int64_t columnOfWeekday(std::int64_t weekday) {
  return moduloWeek(weekday + 1 - HKFirstDayOfWeekForWeeklyGoalCalculations());
}

Ref<NSString> ringsOrNoData(const Ref<NSDate>& date) {
  const Ref<NSString> rings = accessibilityTavroStringForDate(date, true);
  return rings ? rings : localized("no.data");
}

/// Gives the labels the rings of the shown date's week, Monday to Sunday. Each day stands under its
/// own weekday's name, whichever column that is.
void fillValues(const NSArray& labels, const Ref<NSDate>& shownDate) {
  const std::int64_t daysSinceMonday = moduloWeek(weekdayIndex(shownDate) + 6);
  for (std::int64_t day = 0; day < kDaysPerWeek; ++day) {
    const auto column = static_cast<std::size_t>(columnOfWeekday(moduloWeek(day + 1)));
    if (column < labels.count()) {
      const auto offset = static_cast<double>(day - daysSinceMonday);
      trySend<void>(labels[column], "setAccessibilityValue:",
                    ringsOrNoData(dateByAddingTimeInterval(shownDate, offset * kSecondsPerDay)));
    }
  }
}

/// The column above a label, in screen coordinates.
void setColumnFrame(const id& element, const Ref<UIView>& header) {
  const auto label = as<UIView>(element);
  const CGSize size = header ? header->bounds().size : CGSize();
  const CGSize column{size.width / kDaysPerWeek, size.height};
  if (!label || column.width <= 0 || column.height <= 0) {
    return;
  }
  const CGRect frame{label->center().x - column.width * 0.5, label->frame().origin.y, column.width,
                     column.height};
  trySend<void>(label, "setAccessibilityFrame:",
                UIAccessibilityConvertFrameToScreenCoordinates(frame, header));
}

/// Each label of the week's header says its weekday and, as its value, that day's rings.
class PaletteWeekdayHeaderViewAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "PaletteWeekdayHeaderViewAccessibility";
  static constexpr Name target = "PaletteWeekdayHeaderView";

  id initWithNavigationPalette(const id& palette) {
    const id header = super.send<id>(palette);
    reload(header);
    return header;
  }

  void layoutSubviews() {
    super.send<void>();
    reload(self);
  }

  void highlightWeekdayLabelForDateAndSetDay(const id& date) {
    super.send<void>(date);
    reload(self);
    _accessibilitySetRetainedValue(self, date, kShownDate);
  }

  void _accessibilityLoadAccessibilityInformation() {
    const Ref<NSArray> names = weekdayNames();
    const std::int64_t today = weekdayIndex(dateNow());
    const auto header = as<UIView>(self);
    if (const auto elements = as<NSArray>(send<id>(self, "accessibilityElements"))) {
      for (std::size_t index = 0; index < elements->count(); ++index) {
        const id& element = (*elements)[index];
        trySend<void>(element, "setAccessibilityContainer:", id(self));
        if (index >= names->count()) {
          continue;
        }
        const std::int64_t weekday = weekdayOfColumn(static_cast<std::int64_t>(index));
        const Ref<NSString> marker = weekday == today ? localized("today.indicator") : nullptr;
        const id& name = (*names)[static_cast<std::size_t>(weekday)];
        trySend<void>(element, "setAccessibilityValue:", nullptr);
        trySend<void>(element, "setAccessibilityLabel:", __UIAXStringForVariables({marker, name}));
        trySend<void>(element, "setIsAccessibilityElement:", true);
        setColumnFrame(element, header);
      }
    }
    super.send<void>();
  }

  id accessibilityElements() {
    const auto labels = typedRead<NSArray>(self, "_weekdayLabels");
    if (labels && lacksValue(*labels)) {
      const auto shownDate = as<NSDate>(_accessibilityValueForKey(self, kShownDate));
      fillValues(*labels, shownDate ? shownDate : dateNow());
    }
    return labels;
  }

  id _accessibilityHitTest(CGPoint point, const id& /*event*/) {
    const auto header = as<UIView>(self);
    const double columnWidth = header ? header->bounds().size.width / kDaysPerWeek : 0;
    const auto column = saturatingCast<std::uint64_t>(std::floor(point.x / columnWidth));
    const auto elements = as<NSArray>(send<id>(self, "accessibilityElements"));
    return elements && column < elements->count() ? (*elements)[column] : id();
  }

 private:
  static void reload(const id& header) {
    trySend<void>(header, "_accessibilityLoadAccessibilityInformation");
  }

  /// Whether one of the seven labels that are given values has none.
  static bool lacksValue(const NSArray& labels) {
    const auto filled = std::min(static_cast<std::ptrdiff_t>(labels.count()), kDaysPerWeek);
    return std::any_of(labels.begin(), labels.begin() + filled,
                       [](const id& label) { return !trySend<id>(label, "accessibilityValue"); });
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("PaletteWeekdayHeaderView", "_weekdayLabels", "NSMutableArray"),
    instanceMethod("PaletteWeekdayHeaderView", "highlightWeekdayLabelForDateAndSetDay:", "v", "@"),
    instanceMethod("PaletteWeekdayHeaderView", "layoutSubviews", "v"),
};

using Category = PaletteWeekdayHeaderViewAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::initWithNavigationPalette>("initWithNavigationPalette:")
        .method<&Category::layoutSubviews>("layoutSubviews")
        .method<&Category::highlightWeekdayLabelForDateAndSetDay>(
            "highlightWeekdayLabelForDateAndSetDay:")
        .method<&Category::_accessibilityLoadAccessibilityInformation>(
            "_accessibilityLoadAccessibilityInformation")
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::_accessibilityHitTest>("_accessibilityHitTest:withEvent:");

}  // namespace
}  // namespace tavro
