#pragma once

#include <functional>

#include "platform/uikit/UIControls.h"

namespace tavro {

/// How far a value may go, and by how much a press moves it.
struct ValueRange {
  double minimum = 0;
  double maximum = 0;
  double step = 1;
};

/// A value that a minus and a plus button change. Message: `_performPlusMinusActionWithButton:`
/// ("v,@"), what a tap on either button does; other objects change nothing.
class TVUIValueAdjustmentButtonController : public NSObject {
 public:
  static constexpr Name className = "TVUIValueAdjustmentButtonController";

  /// Takes over the buttons, which must be asked for by nobody else.
  void setButtons(const Ref<UIButton>& minus, const Ref<UIButton>& plus);
  /// The value is brought into the range. `changed` hears of it and of every later change; it must
  /// not keep this controller alive.
  void setValue(double value, const ValueRange& range, std::function<void(double)> changed);
  [[nodiscard]] double value() const { return value_; }

  void performPlusMinusActionWithButton(const id& button);

 private:
  void moveTo(double value);

  Ref<UIButton> minus_;
  Ref<UIButton> plus_;
  double value_ = 0;
  ValueRange range_;
  std::function<void(double)> changed_;
};

}  // namespace tavro
