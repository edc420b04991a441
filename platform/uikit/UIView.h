#pragma once

#include <vector>

#include "platform/uikit/CALayer.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {

class UIViewController;

/// A rectangle on screen with views inside it. Messages: `frame`, `setFrame:`, `bounds`, `center`,
/// `isHidden`, `setHidden:`, `alpha`, `setAlpha:`, `subviews`, `superview`, `layer`,
/// `addSubview:`, `removeFromSuperview`, `layoutSubviews`.
class UIView : public NSObject {
 public:
  static constexpr Name className = "UIView";
  ~UIView() override;

  /// In the superview's coordinates.
  [[nodiscard]] CGRect frame() const { return frame_; }
  /// Asks for a new layout when the size changes.
  void setFrame(CGRect frame);
  /// In the view's own coordinates; the origin is where scrolling has moved to.
  [[nodiscard]] CGRect bounds() const;
  void setBoundsOrigin(CGPoint origin) { boundsOrigin_ = origin; }
  /// In the superview's coordinates.
  [[nodiscard]] CGPoint center() const { return frame_.center(); }

  [[nodiscard]] bool isHidden() const { return hidden_; }
  void setHidden(bool hidden) { hidden_ = hidden; }
  [[nodiscard]] double alpha() const { return alpha_; }
  void setAlpha(double alpha) { alpha_ = alpha; }

  /// Back to front; never nil.
  [[nodiscard]] Ref<NSArray> subviews() const;
  [[nodiscard]] const std::vector<Ref<UIView>>& subviewList() const { return subviews_; }
  [[nodiscard]] Ref<UIView> superview() const { return superview_; }
  [[nodiscard]] Ref<CALayer> layer();
  void addSubview(const Ref<UIView>& view);
  void removeFromSuperview();
  /// Whether the view is below the key window.
  [[nodiscard]] bool isOnScreen() const;

  void setNeedsLayout() { needsLayout_ = true; }
  /// Sends `layoutSubviews` to this view and those below it that need a layout.
  void layoutIfNeeded();
  void layoutSubviews() {}

  /// The controller whose view this is, or nil.
  [[nodiscard]] UIViewController* controller() const { return controller_; }
  void setController(UIViewController* controller) { controller_ = controller; }

  CGRect naturalFrame();
  id naturalContainer() { return superview(); }
  bool viewIsVisible();
  id hitTest(CGPoint point, const id& event);
  id findSubviewDescendant(const std::function<bool(const id&)>& test);
  Ref<NSArray> findSubviewDescendants(const std::function<bool(const id&)>& test);
  Ref<NSString> textForSubhierarchy(bool includesHeaders, bool includesFocusable,
                                    const Ref<NSArray>& exclusions);

 protected:
  [[nodiscard]] virtual bool isWindow() const { return false; }

 private:
  CGRect frame_;
  CGPoint boundsOrigin_;
  double alpha_ = 1;
  bool hidden_ = false;
  bool needsLayout_ = true;
  std::vector<Ref<UIView>> subviews_;
  UIView* superview_ = nullptr;
  UIViewController* controller_ = nullptr;
  Ref<CALayer> layer_;
};

using ViewTest = std::function<bool(const id&)>;

/// A new view of a native class, initialised by `init`.
template <class T>
Ref<T> makeView(CGRect frame = {}) {
  Ref<T> view = as<T>(send<id>(make<T>(), "init"));
  view->setFrame(frame);
  return view;
}

}  // namespace tavro
