#pragma once

#include "host/Diary.h"
#include "host/libraries/CHWorkoutFormattingManager.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// What the sections of the screen show: one workout.
struct WorkoutDetail {
  const Workout& entry;
  Ref<HKWorkout> record;
  Ref<CHWorkoutFormattingManager> formatting;
};

/// Appends a section's rows to the screen's table; appends none when the workout lacks the data.
using WorkoutDetailSection = void (*)(UITableView& table, const WorkoutDetail& detail);

/// One workout in full, section below section.
class WorkoutDetailController : public UIViewController {
 public:
  static constexpr Name className = "CHWorkoutDetailViewController";

  /// Set before the view is asked for; nullptr for none. The workout must outlive the controller.
  void setWorkout(const Workout* workout) { workout_ = workout; }
  void viewDidLoad();

 private:
  const Workout* workout_ = nullptr;
};

}  // namespace tavro
