#include "host/screens/goals/GoalView.h"

#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using View = CHASActivitySetupGoalView;
const Registered viewClass = defineClass<View, UIView>()
                                 .method<&View::init>("init")
                                 .method<&View::buttonController>("buttonController")
                                 .method<&View::layoutSubviews>("layoutSubviews")
                                 .variable<&View::_goalLabel>("_goalLabel")
                                 .variable<&View::_unitLabel>("_unitLabel")
                                 .variable<&View::_minusButton>("_minusButton")
                                 .variable<&View::_plusButton>("_plusButton");

constexpr double kButtonSize = 56;

}  // namespace

id CHASActivitySetupGoalView::init() {
  _goalLabel = makeLabel("");
  _unitLabel = makeLabel("");
  _minusButton = makeView<UIButton>();
  _plusButton = makeView<UIButton>();
  // U+2212, the minus sign, is as wide as the plus sign.
  _minusButton->setTitle(string("\u2212"));
  _plusButton->setTitle(string("+"));
  for (const Ref<UIView>& part :
       std::initializer_list<Ref<UIView>>{_minusButton, _goalLabel, _unitLabel, _plusButton}) {
    addSubview(part);
  }
  buttonController_ = tavro::make<TVUIValueAdjustmentButtonController>();
  buttonController_->setButtons(_minusButton, _plusButton);
  return this;
}

void CHASActivitySetupGoalView::setGoal(double goal, std::string_view unit,
                                        const ValueRange& range) {
  _unitLabel->setText(string(unit));
  buttonController_->setValue(goal, range, [label = Weak<UILabel>(_goalLabel)](double value) {
    if (const auto shown = label.strong()) {
      shown->setText(decimalString(value, 0));
    }
  });
}

void CHASActivitySetupGoalView::layoutSubviews() {
  const CGSize size = frame().size;
  const double middle = size.width - 2 * kButtonSize;
  _minusButton->setFrame({0, 0, kButtonSize, kButtonSize});
  _plusButton->setFrame({size.width - kButtonSize, 0, kButtonSize, kButtonSize});
  _goalLabel->setFrame({kButtonSize, 0, middle, kButtonSize});
  _unitLabel->setFrame({kButtonSize, kButtonSize, middle, size.height - kButtonSize});
}

}  // namespace tavro
