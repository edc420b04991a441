#include "plugin/core/ChartElements.h"

#include "platform/accessibility/Labels.h"

namespace tavro {

void loadGraphData(Object* chart, Name key, Name firstObjectClass, Name retainedKey) {
  Ref<NSArray> points = safeArrayForKey(chart, key);
  if (points && !isKindOf(points->firstObject().get(), AXSafeClassFromString(firstObjectClass))) {
    points = nullptr;
  }
  _accessibilitySetRetainedValue(chart, points, retainedKey);
  _accessibilitySetRetainedValue(chart, nullptr, kUIAccessibilityStorageKeyChildren);
}

void addChartElement(NSMutableArray& elements, const Ref<UIView>& chart, const CGRect& frame,
                     const id& label, const id& value) {
  const auto element = accessibilityElementWithContainer(chart);
  send<void>(element, "setAccessibilityFrameInContainerSpace:", frame);
  send<void>(element, "setAccessibilityLabel:", label);
  send<void>(element, "setAccessibilityValue:", value);
  elements.addObject(element);
}

Ref<NSString> spanOfDay(NSDateIntervalFormatter& formatter, std::string_view dateTemplate,
                        const Ref<NSDate>& startOfDay, double start, double length) {
  formatter.setDateTemplate(dateTemplate);
  const double from = startOfDay->seconds + start;
  return formatter.stringFromMoments(from, from + length);
}

void addDayParts(NSMutableArray& elements, const Ref<UIView>& chart, const DayParts& parts,
                 const std::function<id(std::size_t)>& valueOf) {
  const auto formatter = make<NSDateIntervalFormatter>();
  const Ref<NSDate> startOfDay = currentCalendar()->startOfDayForDate(dateNow());
  for (std::size_t part = 0; part < parts.count; ++part) {
    const auto index = static_cast<double>(part);
    const bool isLast = part == parts.count - 1;
    const Ref<NSString> label =
        spanOfDay(*formatter, isLast ? "h:mma" : parts.dateTemplate, startOfDay,
                  index * parts.seconds, isLast ? parts.seconds - 1 : parts.seconds);
    const CGRect frame{parts.size.width * index, 0, parts.size.width, parts.size.height};
    addChartElement(elements, chart, frame, label, valueOf(part));
  }
}

float amountAt(const NSArray& points, std::size_t index) {
  return index < points.count()
             ? static_cast<float>(trySend<CGPoint>(points[index], "CGPointValue").y)
             : 0;
}

Ref<NSArray> descendantsOfClass(Object* view, Name className) {
  Class* const wanted = AXSafeClassFromString(className);
  return as<NSArray>(trySend<id>(
      view, "_accessibilityFindSubviewDescendantsPassingTest:",
      ViewTest([wanted](const id& descendant) { return isKindOf(descendant.get(), wanted); })));
}

void annotateLabelPair(const id& labelPair) {
  trySend<void>(labelPair, "setIsAccessibilityElement:", true);
  trySend<void>(labelPair,
                "setAccessibilityLabel:", accessibilityTextForSubhierarchy(labelPair, false, true));
  trySend<void>(labelPair, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
}

}  // namespace tavro
