#include "reader/Touch.h"

#include <algorithm>
#include <cmath>
#include <tuple>

#include "platform/uikit/UIViewController.h"

namespace tavro {
namespace {

constexpr int kDeepestNesting = 200;  // containers may form a cycle

/// What directly holds an object: its container, which for views is the view above.
id holderOf(const id& object) { return trySend<id>(object, "accessibilityContainer"); }

std::optional<std::size_t> indexOf(const std::vector<AccessibleElement>& elements,
                                   const id& object) {
  const auto found = std::ranges::find(elements, object, &AccessibleElement::element);
  return found == elements.end() ? std::nullopt
                                 : std::optional<std::size_t>(found - elements.begin());
}

bool rowHolds(const id& element, CGPoint point) {
  const id holder = holderOf(element);
  const auto view = as<UIView>(holder);
  // A view's frame for the screen reader may be larger than what it shows.
  return (view ? UIAccessibilityConvertFrameToScreenCoordinates(view->bounds(), view)
               : trySend<CGRect>(holder, "accessibilityFrame"))
      .contains(point);
}

bool tapItem(const id& bar, CGPoint point) {
  const auto items = as<NSArray>(trySend<id>(bar, "accessibilityElements"));
  return items && std::ranges::any_of(*items, [&](const id& item) {
           return as<UIBarButtonItem>(item) &&
                  trySend<CGRect>(item, "accessibilityFrame").contains(point) &&
                  send<bool>(item, "_naturalAccessibilityActivate");
         });
}

/// `origin` is where the view's superview has its own origin on screen.
bool tapIn(const Ref<UIView>& view, CGPoint origin, CGPoint point) {
  CGRect frame = view->frame();
  frame.origin = {frame.origin.x + origin.x, frame.origin.y + origin.y};
  if (view->isHidden() || view->alpha() <= 0 || !frame.contains(point)) {
    return false;
  }
  const CGPoint scrolled = view->bounds().origin;
  const CGPoint inside{frame.origin.x - scrolled.x, frame.origin.y - scrolled.y};
  const std::vector<Ref<UIView>> children = view->subviewList();
  for (auto child = children.rbegin(); child != children.rend(); ++child) {
    if (tapIn(*child, inside, point)) {
      return true;
    }
  }
  if (as<UINavigationBar>(view)) {
    return tapItem(view, point);
  }
  const auto control = as<UIControl>(view);
  return control && control->sendAction();
}

}  // namespace

std::optional<std::size_t> elementAt(const std::vector<AccessibleElement>& elements, UIView& root,
                                     CGPoint point) {
  const CGPoint origin = root.frame().origin;
  const CGPoint local{point.x - origin.x, point.y - origin.y};
  id hit = trySend<id>(&root, "_accessibilityHitTest:withEvent:", local, id());
  for (int depth = 0; hit && depth < kDeepestNesting; ++depth, hit = holderOf(hit)) {
    if (const auto index = indexOf(elements, hit)) {
      return index;
    }
  }
  struct Candidate {
    bool reachesOver;
    double distance;
    std::size_t index;
  };
  std::optional<Candidate> best;
  for (std::size_t index = 0; index < elements.size(); ++index) {
    const id& element = elements[index].element;
    const CGRect frame = trySend<CGRect>(element, "accessibilityFrame");
    if (!frame.contains(point)) {
      continue;
    }
    const CGPoint center = frame.center();
    const Candidate candidate{!rowHolds(element, point),
                              std::hypot(center.x - point.x, center.y - point.y), index};
    const auto rank = [](const Candidate& each) {
      return std::tuple(each.reachesOver, each.distance);
    };
    if (!best || rank(candidate) < rank(*best)) {
      best = candidate;
    }
  }
  return best ? std::optional(best->index) : std::nullopt;
}

bool tap(UIView& root, CGPoint point) {
  try {
    return tapIn(Ref<UIView>(&root), {}, point);
  } catch (...) {
    return true;  // something was there, and it failed
  }
}

}  // namespace tavro
