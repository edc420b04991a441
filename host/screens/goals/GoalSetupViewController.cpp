#include "host/screens/goals/GoalSetupViewController.h"

#include <algorithm>

#include "host/Application.h"

namespace tavro {
namespace {

using Controller = CHASActivitySetupViewController;
using GoalView = CHASActivitySetupGoalView;
const Registered controllerClass =
    defineClass<Controller, UIViewController>()
        .method<&Controller::viewDidLoad>("viewDidLoad")
        .method<&Controller::displayExerciseGoalView>("_displayExerciseGoalView")
        .method<&Controller::displayStandGoalView>("_displayStandGoalView")
        .variable<&Controller::_moveGoalView>("_moveGoalView")
        .variable<&Controller::_exerciseGoalView>("_exerciseGoalView")
        .variable<&Controller::_standGoalView>("_standGoalView")
        .variable<&Controller::_currentlyPresentedView>("_currentlyPresentedView");

/// The steps of the setup, in their order.
struct Step {
  Ref<GoalView> Controller::*view;
  double Goals::*goal;
  std::string_view headline;
  std::string_view unit;
  ValueRange range;
  /// What presents the following step; empty for the last one.
  Name next;
};
constexpr Step kSteps[] = {
    {.view = &Controller::_moveGoalView,
     .goal = &Goals::move,
     .headline = "Daily Move Goal",
     .unit = "kilocalories a day",
     .range = {.minimum = 10, .maximum = 5000, .step = 10},
     .next = "_displayExerciseGoalView"},
    {.view = &Controller::_exerciseGoalView,
     .goal = &Goals::exercise,
     .headline = "Daily Exercise Goal",
     .unit = "minutes a day",
     .range = {.minimum = 5, .maximum = 600, .step = 5},
     .next = "_displayStandGoalView"},
    {.view = &Controller::_standGoalView,
     .goal = &Goals::stand,
     .headline = "Daily Stand Goal",
     .unit = "hours a day",
     .range = {.minimum = 1, .maximum = 24, .step = 1},
     .next = {}},
};

constexpr double kScreenWidth = 390;
constexpr double kMargin = 16;
constexpr double kContentWidth = kScreenWidth - 2 * kMargin;

}  // namespace

Goals CHASActivitySetupViewController::goals() const {
  Goals goals;
  for (const Step& step : kSteps) {
    goals.*step.goal = (this->*step.view)->goal();
  }
  return goals;
}

void CHASActivitySetupViewController::viewDidLoad() {
  const auto screen = makeView<UIView>({0, 0, kScreenWidth, 800});
  setView(screen);
  headline_ = makeLabel("", {16, 60, kContentWidth, 40});
  send<void>(headline_, "setAccessibilityTraits:", UIAccessibilityTraitHeader);
  screen->addSubview(headline_);
  for (const Step& step : kSteps) {
    auto& goalView = this->*step.view;
    goalView = makeView<GoalView>();
    goalView->setGoal(goals_.*step.goal, step.unit, step.range);
    send<void>(goalView, "setAccessibilityLabel:", string(step.headline));
    screen->addSubview(goalView);
  }
  continueButton_ = makeView<UIButton>({16, 600, kContentWidth, 50});
  continueButton_->setAction([controller = Weak<Controller>(this)] {
    if (const Ref<Controller> shown = controller.strong()) {
      shown->continueSetup();
    }
  });
  screen->addSubview(continueButton_);
  present(_moveGoalView);
}

void CHASActivitySetupViewController::displayExerciseGoalView() { present(_exerciseGoalView); }

void CHASActivitySetupViewController::displayStandGoalView() { present(_standGoalView); }

void CHASActivitySetupViewController::present(const Ref<GoalView>& goalView) {
  _currentlyPresentedView = goalView;
  const auto* const presented =
      std::ranges::find_if(kSteps, [&](const Step& step) { return this->*step.view == goalView; });
  if (!goalView || presented == std::end(kSteps)) {
    return;
  }
  for (const Step& step : kSteps) {
    // Those that were presented wait to the left of the screen, those to come to the right.
    const auto stepsAway = static_cast<double>(&step - presented);
    (this->*step.view)->setFrame({kMargin + stepsAway * kScreenWidth, 200, kContentWidth, 120});
  }
  headline_->setText(string(presented->headline));
  continueButton_->setTitle(string(presented->next.empty() ? "Done" : "Continue"));
}

void CHASActivitySetupViewController::continueSetup() {
  const auto* const presented = std::ranges::find_if(
      kSteps, [&](const Step& step) { return this->*step.view == _currentlyPresentedView; });
  if (presented == std::end(kSteps)) {
    return;
  }
  if (presented->next.empty()) {
    headline_->setText(string("Your goals are set"));
    continueButton_->setHidden(true);
  } else {
    send<void>(this, presented->next);
  }
}

Ref<UIViewController> makeGoalSetup(const Application& application) {
  const auto controller = makeController<CHASActivitySetupViewController>();
  controller->setGoals(application.diary().goals);
  return controller;
}

}  // namespace tavro
