#pragma once

#include <functional>

#include "platform/uikit/UIControls.h"

namespace tavro {

/// A button in a bar; not a view. Naturally an element, a button that says its title. Messages:
/// `title`, `setTitle:`, `action` (":"), `customView`.
class UIBarButtonItem : public NSObject {
 public:
  static constexpr Name className = "UIBarButtonItem";

  [[nodiscard]] Ref<NSString> title() const { return title_; }
  void setTitle(const Ref<NSString>& title) { title_ = title; }
  /// The selector sent to the target with the item as its argument.
  [[nodiscard]] Name action() const { return action_; }
  void setTarget(const id& target, Name action);
  /// A view shown in the item's place, or nil.
  [[nodiscard]] Ref<UIView> customView() const { return customView_; }
  void setCustomView(const Ref<UIView>& view) { customView_ = view; }
  /// Tells the item where its bar shows it, in the bar's coordinates.
  void place(const Ref<UIView>& bar, CGRect frame);

  bool naturalIsElement() { return !customView_; }
  id naturalLabel() { return title_; }
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitButton; }
  id naturalElements();
  bool naturalActivate();
  CGRect naturalFrame();
  id naturalContainer() { return bar_.strong(); }

 private:
  Ref<NSString> title_;
  Name action_;
  Weak<> target_;
  Ref<UIView> customView_;
  Weak<UIView> bar_;
  CGRect frame_;
};

/// What a screen shows in the navigation bar. Messages: `title`, `rightBarButtonItem` (the first of
/// `rightBarButtonItems`, or nil), `rightBarButtonItems`, `leftBarButtonItems` (never nil).
class UINavigationItem : public NSObject {
 public:
  static constexpr Name className = "UINavigationItem";

  Ref<NSString> title;
  std::vector<Ref<UIBarButtonItem>> leftItems;
  std::vector<Ref<UIBarButtonItem>> rightItems;

  [[nodiscard]] id rightBarButtonItem() const;
  [[nodiscard]] Ref<NSArray> rightBarButtonItems() const;
  [[nodiscard]] Ref<NSArray> leftBarButtonItems() const;
  Ref<NSString> titleText() { return title; }
};

/// Shows a navigation item: its left items, its title as a heading, its right items, placed when
/// the item is set. A bar hands out its items itself, since they are not views.
class UINavigationBar : public UIView {
 public:
  static constexpr Name className = "UINavigationBar";

  void setItem(const Ref<UINavigationItem>& item);
  id naturalElements();

 private:
  void placeItems();

  Ref<UINavigationItem> item_;
  Ref<UILabel> titleLabel_;
};

/// A screen. Its view is made at the first request: `loadView`, then `viewDidLoad`, both messages.
/// Messages: `view`, `setView:`, `loadView`, `viewDidLoad`, `navigationItem`.
class UIViewController : public NSObject {
 public:
  static constexpr Name className = "UIViewController";
  ~UIViewController() override;

  [[nodiscard]] Ref<UIView> view();
  void setView(const Ref<UIView>& view);
  [[nodiscard]] Ref<UINavigationItem> navigationItem();
  /// Makes an empty view.
  void loadView();
  void viewDidLoad() {}

 private:
  Ref<UIView> view_;
  Ref<UINavigationItem> navigationItem_;
  bool loading_ = false;
};

/// The screen's root: a navigation bar, where the shown screen has a title or items, and the
/// screen's view below it.
class UIWindow : public UIView {
 public:
  static constexpr Name className = "UIWindow";
  static constexpr double navigationBarHeight = 44;

  /// The window whose content is on screen, or nil.
  static UIWindow* keyWindow();
  ~UIWindow() override;
  void makeKey();

  /// Shows a screen in place of the earlier one: lays it out, sends the load hook to what appears
  /// and posts that the screen changed.
  void setRootViewController(const Ref<UIViewController>& controller);
  [[nodiscard]] Ref<UIViewController> rootViewController() const { return controller_; }

 protected:
  [[nodiscard]] bool isWindow() const override { return true; }

 private:
  Ref<UIViewController> controller_;
};

/// A new controller of a native class, initialised by `init`.
template <class T>
Ref<T> makeController() {
  return as<T>(send<id>(make<T>(), "init"));
}

}  // namespace tavro
