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
  const Ref<NSDate> from = dateByAddingTimeInterval(startOfDay, start);
  return formatter.stringFromDate(from, dateByAddingTimeInterval(from, length));
}

void annotateLabelPair(const id& labelPair) {
  trySend<void>(labelPair, "setIsAccessibilityElement:", true);
  trySend<void>(labelPair,
                "setAccessibilityLabel:", accessibilityTextForSubhierarchy(labelPair, false, true));
  trySend<void>(labelPair, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
}

}  // namespace tavro
