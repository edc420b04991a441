#pragma once

#include "platform/accessibility/SafeCategory.h"
#include "platform/healthkit/HKUnit.h"
#include "plugin/core/ChartElements.h"

// What the two charts of a trend's detail share.

namespace tavro {

/// How long a trend's element list lives, for a category `Chart` that names the host's key of its
/// stops and the key under which they are kept (`kStops`, `kGraphElements`): every layout ends in a
/// load, and every load takes the stops anew and drops the list.
template <class Chart>
class TrendChartCategory : public SafeCategory {
 public:
  void _accessibilityLoadAccessibilityInformation() {
    super.template send<void>();
    loadGraphData(self, Chart::kStops, "NSNumber", Chart::kGraphElements);
  }

  void layoutSubviews() {
    super.template send<void>();
    trySend<void>(self, "_accessibilityLoadAccessibilityInformation");
  }

  id _accessibilityGraphData() { return _accessibilityValueForKey(self, Chart::kGraphElements); }

 protected:
  /// The stops of the last load; nil when they were of no use.
  Ref<NSArray> stops() { return as<NSArray>(trySend<id>(self, "_accessibilityGraphData")); }
};

/// A trend's chart while its element list is built: its title label, marked as a header, comes
/// first; then one element a column, below the title. A chart without a title label hands out its
/// columns alone, from its upper edge.
class TrendChart {
 public:
  /// Makes room for the title and `columns` elements, and adds the title.
  TrendChart(Object* chart, NSMutableArray& elements, std::size_t columns);

  /// The chart as the container of its elements; nil when it is no view.
  [[nodiscard]] const Ref<UIView>& view() const { return view_; }
  /// Adds a column's element, as high as all of them; `x` in the chart's own coordinates.
  void addColumn(double x, double width, const id& label, const id& value);

 private:
  NSMutableArray& elements_;
  Ref<UIView> view_;
  double top_ = 0;
  double height_ = 0;
};

/// A stop of the host's, in points. Loading checks the first alone: 0 for one that is no number, or
/// that the host has taken away since.
float stopAt(const NSArray& stops, std::size_t index);

/// Says values with their unit; made once for several, since its words stay the same.
class ValueWithUnitSpeech {
 public:
  ValueWithUnitSpeech();
  /// nil for a value that is not finite.
  [[nodiscard]] Ref<NSString> text(double value, const Ref<HKUnit>& unit) const;

 private:
  Ref<NSString> format_;
};

}  // namespace tavro
