#pragma once

#include "host/libraries/ValueAdjustment.h"

namespace tavro {

/// A goal with its unit, between a minus and a plus button. Message: `buttonController`.
class CHASActivitySetupGoalView : public UIView {
 public:
  static constexpr Name className = "CHASActivitySetupGoalView";

  Ref<UILabel> _goalLabel;
  Ref<UILabel> _unitLabel;
  Ref<UIButton> _minusButton;
  Ref<UIButton> _plusButton;

  /// Makes the view's parts.
  id init();
  id buttonController() { return buttonController_; }
  /// The goal is brought into the range.
  void setGoal(double goal, std::string_view unit, const ValueRange& range);
  [[nodiscard]] double goal() const { return buttonController_->value(); }
  void layoutSubviews();

 private:
  Ref<TVUIValueAdjustmentButtonController> buttonController_;
};

}  // namespace tavro
