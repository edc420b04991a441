#pragma once

#include "host/Diary.h"
#include "host/screens/goals/GoalView.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// Sets up the three goals one after the other; the goals that are not presented wait beside the
/// screen. Messages: `_displayExerciseGoalView`, `_displayStandGoalView`.
class CHASActivitySetupViewController : public UIViewController {
 public:
  static constexpr Name className = "CHASActivitySetupViewController";

  Ref<CHASActivitySetupGoalView> _moveGoalView;
  Ref<CHASActivitySetupGoalView> _exerciseGoalView;
  Ref<CHASActivitySetupGoalView> _standGoalView;
  Ref<CHASActivitySetupGoalView> _currentlyPresentedView;

  /// What the setup starts from; set before the view is asked for.
  void setGoals(const Goals& goals) { goals_ = goals; }
  /// The goals as they are set up now; of use once the view was asked for.
  [[nodiscard]] Goals goals() const;
  void viewDidLoad();
  void displayExerciseGoalView();
  void displayStandGoalView();
  [[nodiscard]] Ref<UIButton> continueButton() const { return continueButton_; }

 private:
  void present(const Ref<CHASActivitySetupGoalView>& goalView);
  void continueSetup();

  Goals goals_;
  Ref<UILabel> headline_;
  Ref<UIButton> continueButton_;
};

Ref<UIViewController> makeGoalSetup(const Application& application);

}  // namespace tavro
