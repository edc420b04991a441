#pragma once

#include "host/Diary.h"
#include "host/libraries/TVUIChartView.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// A workout's heart rate over its time, the data source of the chart that draws it. Messages:
/// `_dateInterval` (from the workout's start to its end, nil before a workout is shown) and those
/// of `TVUIChartDataSource`.
class CHWorkoutDetailHeartRateChartView : public UIView {
 public:
  static constexpr Name className = "CHWorkoutDetailHeartRateChartView";

  Ref<NSArray> _heartRateReadings;            ///< `HKHeartRateSummaryReading`s in the order of time
  Ref<NSMutableArray> _heartRateChartPoints;  ///< what is drawn of them
  Ref<TVUIChartView> _chartView;
  /// Whether there are enough readings for a chart to tell anything.
  bool _hasAdequateDataForDisplay = false;

  id init();
  void setWorkout(const Workout& workout);
  id dateInterval() { return interval_; }
  id chartDateInterval(const id& /*chart*/) { return interval_; }
  id chartPoints(const id& /*chart*/) { return _heartRateChartPoints; }
  void layoutSubviews();

 private:
  Ref<NSDateInterval> interval_;
};

/// The row of the heart-rate chart. Where there is too little to draw, an overlay says so and leads
/// to the screen that explains it. Message: `_createAndConstraintNoDataOverlay`.
class CHWorkoutDetailHeartRateChartTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutDetailHeartRateChartTableViewCell";
  static constexpr double height = 220;

  /// nil until it is needed; hidden while there is a chart to show.
  Ref<UIView> _noDataOverlayView;

  id init();
  void setWorkout(const Workout& workout);
  void createAndConstraintNoDataOverlay();
  void layoutSubviews();
  [[nodiscard]] CHWorkoutDetailHeartRateChartView& chart() const { return *chartView_; }

 private:
  Ref<UILabel> titleLabel_;
  Ref<CHWorkoutDetailHeartRateChartView> chartView_;
};

/// A new row for that workout, as high as the row's class says; keeps nothing of the workout.
Ref<UIView> heartRateRow(const Workout& workout);

}  // namespace tavro
