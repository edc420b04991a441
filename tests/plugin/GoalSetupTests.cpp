#include "host/screens/goals/GoalSetupViewController.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

class GoalSetupTest : public PluginTest {
 protected:
  void SetUp() override {
    PluginTest::SetUp();
    setup = makeController<CHASActivitySetupViewController>();
    setup->setGoals({500, 30, 12});
    setAccessibilityNotificationObserver(
        [this](UIAccessibilityNotification notification, const id& argument) {
          if (notification == UIAccessibilityLayoutChangedNotification) {
            movedTo.push_back(argument);
          }
        });
  }

  static Ref<CHASActivitySetupGoalView> goalView(double goal) {
    const auto view = makeView<CHASActivitySetupGoalView>({0, 0, 358, 120});
    view->setGoal(goal, "minutes", {.minimum = 5, .maximum = 60, .step = 5});
    return view;
  }

  /// A controller that takes down which buttons are pressed.
  id recorder() {
    const auto controller = make<NSObject>();
    answers<void, const id&>(controller, "_performPlusMinusActionWithButton:",
                             [this](const id& button) { pressed.push_back(button); });
    return controller;
  }

  std::vector<id> pressed;
  Ref<CHASActivitySetupViewController> setup;
  std::vector<id> movedTo;
};

TEST_F(GoalSetupTest, AGoalIsOneAdjustableElementWithItsUnit) {
  const auto view = goalView(30);
  show(view);
  EXPECT_EQ(heard(view), Utterances{"30, minutes, adjustable"});
  setTraits(view, UIAccessibilityTraitButton | UIAccessibilityTraitHeader);
  EXPECT_EQ(traitsOf(view), UIAccessibilityTraitAdjustable);
  view->_goalLabel->setText(nullptr);
  EXPECT_EQ(valueOf(view), "minutes");
}

TEST_F(GoalSetupTest, WithoutEitherLabelTheValueIsTheViewsOwn) {
  const auto view = goalView(30);
  setValue(view, "own value");
  const auto unit = view->_unitLabel;
  view->_unitLabel = nullptr;
  EXPECT_EQ(valueOf(view), "own value");
  view->_unitLabel = unit;
  EXPECT_EQ(valueOf(view), "30, minutes");
  view->_goalLabel = nullptr;
  EXPECT_EQ(valueOf(view), "own value");
}

TEST_F(GoalSetupTest, GesturesPressTheHostsButtonsOnce) {
  const auto view = goalView(30);
  const id controller = recorder();
  answers(view, "buttonController", controller);
  send<void>(view, "accessibilityIncrement");
  EXPECT_EQ(pressed, std::vector<id>{view->_plusButton});
  send<void>(view, "accessibilityDecrement");
  EXPECT_EQ(pressed, (std::vector<id>{view->_plusButton, view->_minusButton}));
  answers<void, const id&>(controller, "_performPlusMinusActionWithButton:",
                           [](const id& /*button*/) { raise(kRangeException, "no goal"); });
  EXPECT_NO_THROW(send<void>(view, "accessibilityIncrement"));
}

TEST_F(GoalSetupTest, WithoutControllerOrButtonAGestureDoesNothing) {
  const auto view = goalView(30);
  const id controller = recorder();
  answers(view, "buttonController", controller);
  for (const id& notAButton : {id(), id(makeLabel("+"))}) {
    answers(view, "_plusButton", notAButton);
    send<void>(view, "accessibilityIncrement");
  }
  view->_minusButton = nullptr;
  send<void>(view, "accessibilityDecrement");
  EXPECT_EQ(pressed, std::vector<id>());
  answers(view, "_plusButton", view->_plusButton);
  for (const id& noController : {id(), id(make<NSObject>())}) {
    answers(view, "buttonController", noController);
    EXPECT_NO_THROW(send<void>(view, "accessibilityIncrement"));
  }
}

TEST_F(GoalSetupTest, GesturesAndTapsGoInStepsWithinTheLimits) {
  const auto view = goalView(48);
  const auto press = [&](Name gesture) {
    send<void>(view, gesture);
    return valueOf(view);
  };
  EXPECT_EQ(press("accessibilityIncrement"), "53, minutes");
  ASSERT_TRUE(activate(view->_plusButton));
  EXPECT_EQ(valueOf(view), "58, minutes");
  EXPECT_EQ(press("accessibilityIncrement"), "60, minutes");
  EXPECT_EQ(press("accessibilityIncrement"), "60, minutes");
  ASSERT_TRUE(activate(view->_minusButton));
  EXPECT_EQ(press("accessibilityDecrement"), "50, minutes");
  EXPECT_EQ(valueOf(goalView(1)), "5, minutes");
}

TEST_F(GoalSetupTest, OnlyThePresentedGoalIsHeardAndTheReaderMovesThere) {
  const Utterances steps[] = {
      {"Daily Move Goal, heading", "Daily Move Goal, 500, kilocalories a day, adjustable",
       "Continue, button"},
      {"Daily Exercise Goal, heading", "Daily Exercise Goal, 30, minutes a day, adjustable",
       "Continue, button"},
      {"Daily Stand Goal, heading", "Daily Stand Goal, 12, hours a day, adjustable",
       "Done, button"},
  };
  send<id>(setup, "view");
  const Ref<CHASActivitySetupGoalView> views[] = {setup->_moveGoalView, setup->_exerciseGoalView,
                                                  setup->_standGoalView};
  for (std::size_t step = 0; step < std::size(steps); ++step) {
    EXPECT_EQ(heard(setup->view()), steps[step]);
    EXPECT_EQ(movedTo, std::vector<id>{views[step]}) << "one move, to the presented goal";
    for (const auto& view : views) {
      EXPECT_EQ(send<bool>(view, "accessibilityElementsHidden"), view != views[step]);
    }
    movedTo.clear();
    ASSERT_TRUE(activate(setup->continueButton()));
  }
  EXPECT_EQ(heard(setup->view()).front(), "Your goals are set, heading");
  EXPECT_EQ(movedTo, std::vector<id>()) << "nothing else was presented";
}

TEST_F(GoalSetupTest, APresentedGoalIsHeardWhicheverWasBefore) {
  send<id>(setup, "view");
  send<void>(setup, "_displayStandGoalView");
  send<void>(setup, "_displayExerciseGoalView");
  EXPECT_EQ(movedTo, (std::vector<id>{setup->_moveGoalView, setup->_standGoalView,
                                      setup->_exerciseGoalView}));
  EXPECT_EQ(heard(setup->view())[1], "Daily Exercise Goal, 30, minutes a day, adjustable");
}

TEST_F(GoalSetupTest, AMissingGoalViewDoesNotKeepTheOthersFromTheirTurn) {
  send<id>(setup, "view");
  movedTo.clear();
  setup->_moveGoalView = nullptr;
  setup->_currentlyPresentedView = setup->_standGoalView;
  send<void>(setup, "_accessibilityUpdateCurrentPresentedView");
  EXPECT_TRUE(send<bool>(setup->_exerciseGoalView, "accessibilityElementsHidden"));
  EXPECT_FALSE(send<bool>(setup->_standGoalView, "accessibilityElementsHidden"));
  setup->_currentlyPresentedView = nullptr;
  send<void>(setup, "_accessibilityUpdateCurrentPresentedView");
  EXPECT_TRUE(send<bool>(setup->_standGoalView, "accessibilityElementsHidden"));
  EXPECT_EQ(movedTo, (std::vector<id>{setup->_standGoalView, nullptr}));
}

}  // namespace
}  // namespace tavro
