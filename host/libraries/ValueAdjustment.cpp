#include "host/libraries/ValueAdjustment.h"

#include <algorithm>
#include <utility>

namespace tavro {
namespace {

using Controller = TVUIValueAdjustmentButtonController;
const Registered controllerClass =
    defineClass<Controller, NSObject>().method<&Controller::performPlusMinusActionWithButton>(
        "_performPlusMinusActionWithButton:");

}  // namespace

void TVUIValueAdjustmentButtonController::setButtons(const Ref<UIButton>& minus,
                                                     const Ref<UIButton>& plus) {
  minus_ = minus;
  plus_ = plus;
  for (const Ref<UIButton>& button : {minus, plus}) {
    if (!button) {
      continue;
    }
    button->setAction([controller = Weak<>(this), tapped = Weak<>(button.get())] {
      send<void>(controller.strong(), "_performPlusMinusActionWithButton:", tapped.strong());
    });
  }
}

void TVUIValueAdjustmentButtonController::setValue(double value, const ValueRange& range,
                                                   std::function<void(double)> changed) {
  range_ = range;
  changed_ = std::move(changed);
  moveTo(value);
}

void TVUIValueAdjustmentButtonController::performPlusMinusActionWithButton(const id& button) {
  if (button == plus_) {
    moveTo(value_ + range_.step);
  } else if (button == minus_) {
    moveTo(value_ - range_.step);
  }
}

void TVUIValueAdjustmentButtonController::moveTo(double value) {
  value_ = std::clamp(value, range_.minimum, range_.maximum);
  if (changed_) {
    changed_(value_);
  }
}

}  // namespace tavro
