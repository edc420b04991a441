#include "platform/uikit/UIView.h"

#include <algorithm>

#include "platform/accessibility/Traversal.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {
namespace {

const Registered viewClass =
    defineClass<UIView, NSObject>()
        .method<&UIView::frame>("frame")
        .method<&UIView::setFrame>("setFrame:")
        .method<&UIView::bounds>("bounds")
        .method<&UIView::center>("center")
        .method<&UIView::isHidden>("isHidden")
        .method<&UIView::setHidden>("setHidden:")
        .method<&UIView::alpha>("alpha")
        .method<&UIView::setAlpha>("setAlpha:")
        .method<&UIView::subviews>("subviews")
        .method<&UIView::superview>("superview")
        .method<&UIView::layer>("layer")
        .method<&UIView::addSubview>("addSubview:")
        .method<&UIView::removeFromSuperview>("removeFromSuperview")
        .method<&UIView::layoutSubviews>("layoutSubviews")
        .method<&UIView::naturalFrame>("_naturalAccessibilityFrame")
        .method<&UIView::naturalContainer>("_naturalAccessibilityContainer")
        .method<&UIView::viewIsVisible>("_accessibilityViewIsVisible")
        .method<&UIView::hitTest>("_accessibilityHitTest:withEvent:")
        .method<&UIView::findSubviewDescendant>("_accessibilityFindSubviewDescendant:")
        .method<&UIView::findSubviewDescendants>("_accessibilityFindSubviewDescendantsPassingTest:")
        .method<&UIView::findSubviewDescendants>(
            "_accessibilityFindUnsortedDescendantsPassingTest:")
        .method<&UIView::textForSubhierarchy>(
            "_accessibilityTextForSubhierarchyIncludingHeaders:focusableItems:exclusions:");

/// Calls `visit` with every descendant in tree order, until it answers NO.
bool walkDescendants(const UIView& view, const std::function<bool(const Ref<UIView>&)>& visit) {
  const std::vector<Ref<UIView>> children = view.subviewList();
  return std::ranges::all_of(children, [&](const Ref<UIView>& child) {
    return visit(child) && walkDescendants(*child, visit);
  });
}

}  // namespace

UIView::~UIView() {
  for (const Ref<UIView>& view : subviews_) {
    view->superview_ = nullptr;
  }
  if (layer_) {
    layer_->setView(nullptr);
  }
}

void UIView::setFrame(CGRect frame) {
  needsLayout_ = needsLayout_ || frame.size != frame_.size;
  frame_ = frame;
}

CGRect UIView::bounds() const {
  return {boundsOrigin_.x, boundsOrigin_.y, frame_.size.width, frame_.size.height};
}

Ref<NSArray> UIView::subviews() const {
  return arrayWithObjects({subviews_.begin(), subviews_.end()});
}

Ref<CALayer> UIView::layer() {
  if (!layer_) {
    layer_ = as<CALayer>(send<id>(tavro::make<CALayer>(), "init"));
    layer_->setView(this);
  }
  return layer_;
}

void UIView::addSubview(const Ref<UIView>& view) {
  for (const UIView* above = this; above != nullptr; above = above->superview_) {
    if (above == view.get()) {
      raise(kInvalidArgumentException, "a view cannot be added inside itself");
    }
  }
  if (!view) {
    raise(kInvalidArgumentException, "nil cannot be added as a subview");
  }
  const Ref<UIView> kept = view;
  kept->removeFromSuperview();
  subviews_.push_back(kept);
  kept->superview_ = this;
  needsLayout_ = true;
  if (isOnScreen()) {
    kept->layoutIfNeeded();
    loadAccessibilityInformation(*kept);
  }
}

void UIView::removeFromSuperview() {
  if (superview_ == nullptr) {
    return;
  }
  const Ref<UIView> kept(this);
  auto& siblings = superview_->subviews_;
  siblings.erase(std::ranges::find(siblings, kept));
  superview_ = nullptr;
}

bool UIView::isOnScreen() const {
  for (const UIView* view = this; view != nullptr; view = view->superview_) {
    if (view->isWindow()) {
      return view == UIWindow::keyWindow();
    }
  }
  return false;
}

void UIView::layoutIfNeeded() {
  if (needsLayout_) {
    needsLayout_ = false;
    send<void>(this, "layoutSubviews");
  }
  const std::vector<Ref<UIView>> children = subviews_;
  for (const Ref<UIView>& view : children) {
    view->layoutIfNeeded();
  }
}

CGRect UIView::naturalFrame() {
  return UIAccessibilityConvertFrameToScreenCoordinates(bounds(), Ref<UIView>(this));
}

bool UIView::viewIsVisible() {
  if (accessibility && accessibility->viewIsVisible.has_value()) {
    return *accessibility->viewIsVisible;
  }
  if (accessibility && accessibility->overridesInvisibility) {
    return true;
  }
  for (const UIView* view = this; view != nullptr; view = view->superview_) {
    if (view->hidden_ || view->alpha_ <= 0) {
      return false;
    }
  }
  return true;
}

id UIView::hitTest(CGPoint point, const id& event) {
  const CGPoint inside{point.x + boundsOrigin_.x, point.y + boundsOrigin_.y};
  for (auto child = subviews_.rbegin(); child != subviews_.rend(); ++child) {
    const UIView& view = **child;
    if (!view.hidden_ && view.alpha_ > 0 && view.frame_.contains(inside)) {
      const CGPoint local{inside.x - view.frame_.origin.x, inside.y - view.frame_.origin.y};
      return send<id>(*child, "_accessibilityHitTest:withEvent:", local, event);
    }
  }
  return this;
}

id UIView::findSubviewDescendant(const ViewTest& test) {
  id found;
  walkDescendants(*this, [&](const Ref<UIView>& view) {
    found = test(view) ? id(view) : id();
    return !found;
  });
  return found;
}

Ref<NSArray> UIView::findSubviewDescendants(const ViewTest& test) {
  std::vector<id> found;
  walkDescendants(*this, [&](const Ref<UIView>& view) {
    if (test(view)) {
      found.emplace_back(view);
    }
    return true;
  });
  return arrayWithObjects(std::move(found));
}

Ref<NSString> UIView::textForSubhierarchy(bool includesHeaders, bool includesFocusable,
                                          const Ref<NSArray>& exclusions) {
  return tavro::textForSubhierarchy(this, includesHeaders, includesFocusable, exclusions);
}

}  // namespace tavro
