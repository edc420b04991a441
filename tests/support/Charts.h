#pragma once

#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {

/// Charts of the day view.
class ChartTest : public PluginTest {
 protected:
  static Ref<NSArray> pointsOf(const std::vector<double>& amounts) {
    std::vector<id> points;
    for (const double amount : amounts) {
      points.emplace_back(value(CGPoint{0, amount}));
    }
    return arrayWithObjects(std::move(points));
  }

  static Utterances valuesOf(const id& chart) {
    Utterances values;
    const Ref<NSArray> elements = elementsOf(chart);
    for (const id& element : *elements) {
      values.push_back(valueOf(element));
    }
    return values;
  }
};

}  // namespace tavro
