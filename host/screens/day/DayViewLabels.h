#pragma once

#include "platform/uikit/UIControls.h"

namespace tavro {

/// A title beside its value. Messages: `titleLabel`, `valueLabel`.
class DayViewTitleAndValueLabelPair : public UIView {
 public:
  static constexpr Name className = "TavroApp.DayViewTitleAndValueLabelPair";

  [[nodiscard]] Ref<UILabel> titleLabel() const { return titleLabel_; }
  [[nodiscard]] Ref<UILabel> valueLabel() const { return valueLabel_; }
  void setTexts(std::string_view title, std::string_view value);
  void layoutSubviews();

 private:
  Ref<UILabel> titleLabel_;
  Ref<UILabel> valueLabel_;
};

}  // namespace tavro
