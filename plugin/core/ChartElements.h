#pragma once

#include <functional>

#include "platform/accessibility/KeyAccess.h"
#include "platform/foundation/Formatters.h"
#include "platform/uikit/UIView.h"

// What the chart categories share: a chart keeps the host's points and the elements that were built
// of them as retained values; loading renews the points and drops the elements.

namespace tavro {

/// Reads the host's array under `key`. When its first object is of that class, keeps the array
/// under `retainedKey`; otherwise drops what was kept. Drops the element list either way.
void loadGraphData(Object* chart, Name key, Name firstObjectClass, Name retainedKey);

/// The chart's element list. Without one, an empty list is kept at once, so that a request during
/// the build gets the same list, and then filled by `build(list)`.
template <class Build>
id elementsBuiltOnce(Object* chart, std::size_t capacity, const Build& build) {
  if (id built = _accessibilityValueForKey(chart, kUIAccessibilityStorageKeyChildren)) {
    return built;
  }
  Ref<NSMutableArray> elements = mutableArray(capacity);
  _accessibilitySetRetainedValue(chart, elements, kUIAccessibilityStorageKeyChildren);
  build(*elements);
  _accessibilitySetRetainedValue(chart, elements, kUIAccessibilityStorageKeyChildren);
  return elements;
}

/// Adds an element for a part of a chart; the frame is in the chart's own coordinates.
void addChartElement(NSMutableArray& elements, const Ref<UIView>& chart, const CGRect& frame,
                     const id& label, const id& value);

/// The spoken span of a part of the day: from `start` seconds after the day's beginning for
/// `length` seconds, by a template.
Ref<NSString> spanOfDay(NSDateIntervalFormatter& formatter, std::string_view dateTemplate,
                        const Ref<NSDate>& startOfDay, double start, double length);

/// The retained value in which the charts of the day view keep the host's points.
inline constexpr Name kDayViewGraphElements = "kAXDayViewCellGraphElements";

/// How a chart of the day view divides the day.
struct DayParts {
  std::size_t count = 0;
  double seconds = 0;             ///< the length of each part
  std::string_view dateTemplate;  ///< names each part but the last
  CGSize size;                    ///< of each part's element
};

/// Adds an element for each part of the present day, side by side from the chart's left edge. The
/// last part ends a second early, within the day, and says its minutes. `valueOf` yields the spoken
/// value of a part.
void addDayParts(NSMutableArray& elements, const Ref<UIView>& chart, const DayParts& parts,
                 const std::function<id(std::size_t)>& valueOf);

/// The y of a chart's point; 0 for what is not a point, and past the end: the points are the host's
/// own list, which may change at any time.
float amountAt(const NSArray& points, std::size_t index);

/// The views below a view that are of that class, in tree order; empty when there is no such class.
Ref<NSArray> descendantsOfClass(Object* view, Name className);

/// Makes a chart's title-and-value pair one heading that says both; nothing happens to nil.
void annotateLabelPair(const id& labelPair);

}  // namespace tavro
