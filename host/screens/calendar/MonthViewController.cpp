#include "host/screens/calendar/MonthViewController.h"

#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

/// Gives all its subviews its own size.
class FillingView : public UIView {
 public:
  static constexpr Name className = "MonthContainerView";

  void layoutSubviews() {
    for (const Ref<UIView>& view : subviewList()) {
      view->setFrame({0, 0, frame().size.width, frame().size.height});
    }
  }
};

const Registered fillingClass =
    defineClass<FillingView, UIView>().method<&FillingView::layoutSubviews>("layoutSubviews");
const Registered loadingClass = defineClass<LoadingView, UIView>()
                                    .method<&LoadingView::init>("init")
                                    .method<&LoadingView::layoutSubviews>("layoutSubviews");
const Registered controllerClass =
    defineClass<MonthViewController, UIViewController>()
        .method<&MonthViewController::init>("init")
        .method<&MonthViewController::viewDidLoad>("viewDidLoad")
        .method<&MonthViewController::scrollToToday>("scrollToToday:");

constexpr double kLabelHeight = 24;

}  // namespace

id LoadingView::init() {
  label_ = makeLabel("Loading…");
  addSubview(label_);
  return this;
}

void LoadingView::layoutSubviews() {
  const CGSize size = frame().size;
  label_->setFrame({0, (size.height - kLabelHeight) / 2, size.width, kLabelHeight});
}

id MonthViewController::init() {
  months_ = makeController<MonthScrollViewController>();
  return this;
}

void MonthViewController::viewDidLoad() {
  const auto container = makeView<FillingView>();
  setView(container);
  container->addSubview(months_->view());
  loadingView_ = makeView<LoadingView>();
  loadingView_->setHidden(true);
  container->addSubview(loadingView_);
  navigationItem()->title = dateStringForFormat(dateNow(), "MMMMyyyy");
  const auto today = make<UIBarButtonItem>();
  today->setTarget(this, "scrollToToday:");
  navigationItem()->rightItems = {today};
}

void MonthViewController::setLoading(bool isLoading) {
  static_cast<void>(view());  // which makes the loading view
  if (loadingView_) {
    loadingView_->setHidden(!isLoading);
  }
}

}  // namespace tavro
