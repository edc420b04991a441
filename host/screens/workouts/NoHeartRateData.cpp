#include "host/screens/workouts/NoHeartRateData.h"

namespace tavro {
namespace {

using Controller = CHNoHeartRateDataViewController;
const Registered controllerClass = defineClass<Controller, UIViewController>()
                                       .method<&Controller::titleLabel>("titleLabel")
                                       .method<&Controller::linkLabel>("linkLabel")
                                       .method<&Controller::linkButton>("linkButton")
                                       .method<&Controller::loadView>("loadView");

constexpr CGRect kTitleFrame{20, 60, 350, 40};
constexpr CGRect kTextFrame{20, 110, 350, 80};
constexpr CGRect kLinkFrame{20, 210, 350, 44};

}  // namespace

void CHNoHeartRateDataViewController::loadView() {
  titleLabel_ = makeLabel("No Heart Rate Data", kTitleFrame);
  linkLabel_ = makeLabel("How to measure your heart rate", kLinkFrame);
  linkButton_ = makeView<UIButton>(kLinkFrame);
  // The page that it opens lies outside the application.
  linkButton_->setAction([] {});
  const auto view = makeView<UIView>();
  view->addSubview(titleLabel_);
  view->addSubview(makeLabel(
      "Your heart rate is recorded when you wear your watch snugly and start the workout on it.",
      kTextFrame));
  view->addSubview(linkLabel_);
  view->addSubview(linkButton_);
  setView(view);
}

Ref<UIViewController> makeNoHeartRateData(const Application& /*application*/) {
  return makeController<CHNoHeartRateDataViewController>();
}

}  // namespace tavro
