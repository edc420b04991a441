#pragma once

#include <span>

#include "host/screens/day/DayViewLabels.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// What a move-and-exercise chart shows.
enum class MoveAndExerciseChartType : std::int64_t { activeEnergy = 0, exerciseMinutes = 2 };

/// A day's move or exercise as bars, one for each amount, drawn in one view. Messages:
/// `moveAndExerciseChartPoints` (values of points: the hour, the amount),
/// `moveAndExerciseChartMaxYValue`, `moveAndExerciseChartViewType`, `accessibilityReloadData`.
class ActivityMoveAndExerciseChartView : public UIView {
 public:
  static constexpr Name className = "TavroApp.ActivityMoveAndExerciseChartView";

  /// Shows other amounts, in the order of the hours, and sends `accessibilityReloadData`.
  void setAmounts(MoveAndExerciseChartType type, std::span<const double> amounts);

  id moveAndExerciseChartPoints() { return points_; }
  double moveAndExerciseChartMaxYValue() { return maximum_; }
  std::int64_t moveAndExerciseChartViewType() { return static_cast<std::int64_t>(type_); }
  void accessibilityReloadData() {}
  /// Moves the bars.
  void layoutSubviews();

 private:
  Ref<NSArray> points_;
  double maximum_ = 0;
  MoveAndExerciseChartType type_ = MoveAndExerciseChartType::activeEnergy;
  std::vector<Ref<CALayer>> bars_;
};

/// The row of a move or exercise chart. Messages: `labelPair`, `chartView`, `auxiliaryLabel`.
class DayViewMoveAndExerciseChartTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "TavroApp.DayViewMoveAndExerciseChartTableViewCell";
  static constexpr double height = 160;

  /// Makes the row's parts.
  id init();
  id labelPair() { return labelPair_; }
  id chartView() { return chartView_; }
  id auxiliaryLabel() { return auxiliaryLabel_; }
  [[nodiscard]] DayViewTitleAndValueLabelPair& pair() const { return *labelPair_; }
  [[nodiscard]] ActivityMoveAndExerciseChartView& chart() const { return *chartView_; }
  [[nodiscard]] UILabel& auxiliary() const { return *auxiliaryLabel_; }
  void layoutSubviews();

 private:
  Ref<DayViewTitleAndValueLabelPair> labelPair_;
  Ref<ActivityMoveAndExerciseChartView> chartView_;
  Ref<UILabel> auxiliaryLabel_;
};

}  // namespace tavro
