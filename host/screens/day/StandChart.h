#pragma once

#include <span>

#include "host/screens/day/DayViewLabels.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// A day's hours as marks in one view, taller where the hour counts as a stand hour. Message:
/// `standChartPoints` (values of points: the hour, then 1 where it counts, else 0).
class ActivityStandChartView : public UIView {
 public:
  static constexpr Name className = "TavroApp.ActivityStandChartView";

  /// Whether each hour counts, in order.
  void setHours(std::span<const bool> hours);
  id standChartPoints() { return points_; }
  /// Moves the marks.
  void layoutSubviews();

 private:
  Ref<NSArray> points_;
  std::vector<Ref<CALayer>> marks_;
};

/// The row of the stand chart: a title-and-value pair, the chart, and how many hours were idle.
/// Messages: `chartView`, `idleHoursLabel`.
class DayViewStandChartTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "TavroApp.DayViewStandChartTableViewCell";
  static constexpr double height = 120;

  /// Makes the row's parts.
  id init();
  id chartView() { return chartView_; }
  id idleHoursLabel() { return idleHoursLabel_; }
  [[nodiscard]] DayViewTitleAndValueLabelPair& pair() const { return *pair_; }
  [[nodiscard]] ActivityStandChartView& chart() const { return *chartView_; }
  [[nodiscard]] UILabel& idleHours() const { return *idleHoursLabel_; }
  void layoutSubviews();

 private:
  Ref<DayViewTitleAndValueLabelPair> pair_;
  Ref<ActivityStandChartView> chartView_;
  Ref<UILabel> idleHoursLabel_;
};

}  // namespace tavro
