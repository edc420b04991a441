#pragma once

#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// Explains why a workout has no heart rate, with a link to more. The link is a text that a button
/// without a title lies over. Messages: `titleLabel`, `linkLabel`, `linkButton`.
class CHNoHeartRateDataViewController : public UIViewController {
 public:
  static constexpr Name className = "CHNoHeartRateDataViewController";

  id titleLabel() { return titleLabel_; }
  id linkLabel() { return linkLabel_; }
  id linkButton() { return linkButton_; }
  void loadView();

 private:
  Ref<UILabel> titleLabel_;
  Ref<UILabel> linkLabel_;
  Ref<UIButton> linkButton_;
};

/// The screen "no-heart-rate".
Ref<UIViewController> makeNoHeartRateData(const Application& application);

}  // namespace tavro
