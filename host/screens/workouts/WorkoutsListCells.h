#pragma once

#include "platform/healthkit/HKWorkout.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// One workout: the icon of what recorded it, its activity, its start and its distance, or its
/// energy where it has none. Messages: `workout`, `setWorkout:`, `configureWithCurrentWorkout`,
/// `dateLabel`.
class CHWorkoutsListTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHWorkoutsListTableViewCell";
  static constexpr double height = 60;

  Ref<UILabel> _dateLabel;

  /// Makes the row's parts.
  id init();
  id workout() { return workout_; }
  /// Shows a workout from the next `configureWithCurrentWorkout` on.
  void setWorkout(const Ref<HKWorkout>& workout) { workout_ = workout; }
  /// Fills the row; empties it when there is no workout.
  void configureWithCurrentWorkout();
  id dateLabel() { return _dateLabel; }
  void layoutSubviews();

 private:
  Ref<HKWorkout> workout_;
  Ref<UILabel> figureLabel_;
};

/// A figure of the summary: its title, its total and its average; either may be empty.
class CHWorkoutSummaryTabbedLabelContainer : public UIView {
 public:
  static constexpr Name className = "_CHWorkoutSummaryTabbedLabelContainer";

  Ref<NSString> _titleText;
  Ref<NSString> _totalText;
  Ref<NSString> _averageText;

  void setTexts(std::string_view title, std::string_view total, std::string_view average);
  void layoutSubviews();

 private:
  std::vector<Ref<UILabel>> labels_;
};

/// The summary of the workouts listed: five figures below each other. Those that are of no use to
/// these workouts are hidden.
class CHListSummaryTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "CHListSummaryTableViewCell";
  static constexpr double height = 200;

  Ref<CHWorkoutSummaryTabbedLabelContainer> _numberOfWorkoutsLabel;
  Ref<CHWorkoutSummaryTabbedLabelContainer> _durationLabel;
  Ref<CHWorkoutSummaryTabbedLabelContainer> _activeEnergyLabel;
  Ref<CHWorkoutSummaryTabbedLabelContainer> _distanceLabel;
  Ref<CHWorkoutSummaryTabbedLabelContainer> _paceLabel;

  /// Makes the figures.
  id init();
  void setWorkouts(const std::vector<Ref<HKWorkout>>& workouts);
  void layoutSubviews();
};

/// Heads a section of the list: a month, and how many workouts it has.
class CHListTableHeaderView : public UIView {
 public:
  static constexpr Name className = "CHListTableHeaderView";
  static constexpr double height = 36;

  Ref<UILabel> _dateLabel;
  Ref<UITableViewHeaderFooterViewLabel> _detailLabel;

  void setTexts(const Ref<NSString>& date, std::size_t workouts);
  void layoutSubviews();
};

}  // namespace tavro
