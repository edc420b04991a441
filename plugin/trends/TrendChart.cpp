#include "plugin/trends/TrendChart.h"

#include <cmath>

#include "platform/accessibility/Speech.h"
#include "plugin/core/Exports.h"

namespace tavro {

TrendChart::TrendChart(Object* chart, NSMutableArray& elements, std::size_t columns)
    : elements_(elements), view_(as<UIView>(chart)) {
  elements.reserve(columns + 1);
  const Ref<UIView> title = safeUIViewForKey(chart, "titleLabel");
  trySend<void>(title, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
  elements.axSafelyAddObject(title);
  if (view_) {
    // The host leaves a row as high as the title between it and the columns.
    top_ = title ? 2 * title->frame().size.height : 0;
    height_ = std::floor(static_cast<float>(view_->frame().size.height)) - top_;
  }
}

void TrendChart::addColumn(double x, double width, const id& label, const id& value) {
  addChartElement(elements_, view_, {x, top_, width, height_}, label, value);
}

float stopAt(const NSArray& stops, std::size_t index) {
  return index < stops.count() ? trySend<float>(stops[index], "floatValue") : 0;
}

ValueWithUnitSpeech::ValueWithUnitSpeech() : format_(localized("trends.value.with.unit")) {}

Ref<NSString> ValueWithUnitSpeech::text(double value, const Ref<HKUnit>& unit) const {
  return stringWithFormat(format_, {AXFormatFloat(1, static_cast<float>(value)), unit});
}

}  // namespace tavro
