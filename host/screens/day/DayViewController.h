#pragma once

#include "host/Diary.h"
#include "host/libraries/ARUIRingsView.h"
#include "host/screens/day/MoveAndExerciseChart.h"
#include "host/screens/day/StandChart.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// The row of a day's rings, with each ring's amounts written beside it.
class DayViewActivityRingsTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "TavroApp.DayViewActivityRingsTableViewCell";
  static constexpr double height = 220;

  void setDay(const Day& day);
};

/// One day: its rings, and the charts of what it consists of. Made for a day of the diary; for a
/// day without an entry it shows that nothing was recorded.
class DayViewController : public UIViewController {
 public:
  static constexpr Name className = "TavroApp.DayViewController";

  /// Set before the view is asked for. The day must outlive the controller.
  void setDay(const Day* day) { day_ = day; }
  void viewDidLoad();

 private:
  const Day* day_ = nullptr;
};

/// The day's rings as the health library carries them.
Ref<HKActivitySummary> summaryOf(const Rings& rings);

}  // namespace tavro
