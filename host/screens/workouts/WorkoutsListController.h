#pragma once

#include "host/Diary.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// The workouts: their summary, then one section a month.
class WorkoutsListController : public UIViewController {
 public:
  static constexpr Name className = "CHWorkoutsListViewController";

  /// Set before the view is asked for, in the order in which they are listed. They must outlive the
  /// controller.
  void setWorkouts(std::vector<const Workout*> workouts) { workouts_ = std::move(workouts); }
  void viewDidLoad();

 private:
  std::vector<const Workout*> workouts_;
};

}  // namespace tavro
