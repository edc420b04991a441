#include "platform/uikit/UIViewController.h"

#include <algorithm>

#include "platform/foundation/Language.h"

namespace tavro {
namespace {

const Registered itemClass =
    defineClass<UIBarButtonItem, NSObject>()
        .method<&UIBarButtonItem::title>("title")
        .method<&UIBarButtonItem::setTitle>("setTitle:")
        .method<&UIBarButtonItem::action>("action")
        .method<&UIBarButtonItem::customView>("customView")
        .method<&UIBarButtonItem::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&UIBarButtonItem::naturalLabel>("_naturalAccessibilityLabel")
        .method<&UIBarButtonItem::naturalTraits>("_naturalAccessibilityTraits")
        .method<&UIBarButtonItem::naturalElements>("_naturalAccessibilityElements")
        .method<&UIBarButtonItem::naturalActivate>("_naturalAccessibilityActivate")
        .method<&UIBarButtonItem::naturalFrame>("_naturalAccessibilityFrame")
        .method<&UIBarButtonItem::naturalContainer>("_naturalAccessibilityContainer");

const Registered navigationItemClass =
    defineClass<UINavigationItem, NSObject>()
        .method<&UINavigationItem::titleText>("title")
        .method<&UINavigationItem::rightBarButtonItem>("rightBarButtonItem")
        .method<&UINavigationItem::rightBarButtonItems>("rightBarButtonItems")
        .method<&UINavigationItem::leftBarButtonItems>("leftBarButtonItems");

const Registered barClass =
    defineClass<UINavigationBar, UIView>().method<&UINavigationBar::naturalElements>(
        "_naturalAccessibilityElements");

const Registered controllerClass = defineClass<UIViewController, NSObject>()
                                       .method<&UIViewController::view>("view")
                                       .method<&UIViewController::setView>("setView:")
                                       .method<&UIViewController::loadView>("loadView")
                                       .method<&UIViewController::viewDidLoad>("viewDidLoad")
                                       .method<&UIViewController::navigationItem>("navigationItem");

const Registered windowClass = defineClass<UIWindow, UIView>();

UIWindow* keyWindowOfProcess = nullptr;

Ref<NSArray> arrayOf(const std::vector<Ref<UIBarButtonItem>>& items) {
  return arrayWithObjects({items.begin(), items.end()});
}

}  // namespace

void UIBarButtonItem::setTarget(const id& target, Name action) {
  target_ = Weak<>(target.get());
  action_ = action;
}

id UIBarButtonItem::naturalElements() {
  return customView_ ? arrayWithObjects({customView_}) : Ref<NSArray>();
}

bool UIBarButtonItem::naturalActivate() {
  const id target = target_.strong();
  if (!target || action_.empty()) {
    return false;
  }
  send<void>(target, action_, id(this));
  return true;
}

void UIBarButtonItem::place(const Ref<UIView>& bar, CGRect frame) {
  bar_ = bar;
  frame_ = frame;
  if (customView_) {
    customView_->setFrame(frame);
    bar->addSubview(customView_);
  }
}

CGRect UIBarButtonItem::naturalFrame() {
  return UIAccessibilityConvertFrameToScreenCoordinates(frame_, bar_.strong());
}

id UINavigationItem::rightBarButtonItem() const {
  return rightItems.empty() ? id() : id(rightItems.front());
}
Ref<NSArray> UINavigationItem::rightBarButtonItems() const { return arrayOf(rightItems); }
Ref<NSArray> UINavigationItem::leftBarButtonItems() const { return arrayOf(leftItems); }

void UINavigationBar::setItem(const Ref<UINavigationItem>& item) {
  item_ = item;
  titleLabel_ = makeView<UILabel>();
  titleLabel_->setText(item->title);
  accessibilityAttributes(*titleLabel_).traits = UIAccessibilityTraitHeader;
  addSubview(titleLabel_);
  placeItems();
}

void UINavigationBar::placeItems() {
  constexpr double itemWidth = 80;
  const CGSize size = frame().size;
  const bool mirrored = userInterfaceIsRightToLeft();
  const auto span = [&](double x, double width) {
    return CGRect(mirrored ? size.width - x - width : x, 0, width, size.height);
  };
  double left = 0;
  for (const Ref<UIBarButtonItem>& item : item_->leftItems) {
    item->place(Ref<UIView>(this), span(left, itemWidth));
    left += itemWidth;
  }
  double right = size.width;
  for (auto item = item_->rightItems.rbegin(); item != item_->rightItems.rend(); ++item) {
    right -= itemWidth;
    (*item)->place(Ref<UIView>(this), span(right, itemWidth));
  }
  titleLabel_->setFrame(span(left, std::max(0.0, right - left)));
}

id UINavigationBar::naturalElements() {
  std::vector<id> elements;
  if (item_) {
    elements.assign(item_->leftItems.begin(), item_->leftItems.end());
    if (item_->title) {
      elements.emplace_back(titleLabel_);
    }
    elements.insert(elements.end(), item_->rightItems.begin(), item_->rightItems.end());
  }
  return arrayWithObjects(std::move(elements));
}

UIViewController::~UIViewController() {
  if (view_) {
    view_->setController(nullptr);
  }
}

Ref<UIView> UIViewController::view() {
  if (!view_ && !loading_) {
    loading_ = true;
    send<void>(this, "loadView");
    send<void>(this, "viewDidLoad");
    loading_ = false;
  }
  return view_;
}

void UIViewController::setView(const Ref<UIView>& view) {
  if (view_) {
    view_->setController(nullptr);
  }
  view_ = view;
  if (view_) {
    view_->setController(this);
  }
}

void UIViewController::loadView() { setView(makeView<UIView>()); }

Ref<UINavigationItem> UIViewController::navigationItem() {
  if (!navigationItem_) {
    navigationItem_ = as<UINavigationItem>(send<id>(tavro::make<UINavigationItem>(), "init"));
  }
  return navigationItem_;
}

UIWindow* UIWindow::keyWindow() { return keyWindowOfProcess; }

UIWindow::~UIWindow() {
  if (keyWindowOfProcess == this) {
    keyWindowOfProcess = nullptr;
  }
}

void UIWindow::makeKey() {
  keyWindowOfProcess = this;
  layoutIfNeeded();
  loadAccessibilityInformation(*this);
}

void UIWindow::setRootViewController(const Ref<UIViewController>& controller) {
  const std::vector<Ref<UIView>> shown = subviewList();
  for (const Ref<UIView>& view : shown) {
    view->removeFromSuperview();
  }
  controller_ = controller;
  if (!controller) {
    return;
  }
  const Ref<UIView> content = controller->view();
  const Ref<UINavigationItem> item = controller->navigationItem();
  const bool hasBar = item->title || !item->leftItems.empty() || !item->rightItems.empty();
  const CGSize size = frame().size;
  const double top = hasBar ? navigationBarHeight : 0;
  // A screen that comes back is annotated anew, its bar's views too.
  forgetAccessibilityInformation(*content);
  if (hasBar) {
    const auto bar = makeView<UINavigationBar>({0, 0, size.width, top});
    bar->setItem(item);
    forgetAccessibilityInformation(*bar);
    addSubview(bar);
  }
  content->setFrame({0, top, size.width, size.height - top});
  addSubview(content);
  UIAccessibilityPostNotification(UIAccessibilityScreenChangedNotification, nullptr);
}

}  // namespace tavro
