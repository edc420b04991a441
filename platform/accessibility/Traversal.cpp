#include "platform/accessibility/Traversal.h"

#include <algorithm>
#include <unordered_map>

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Language.h"

namespace tavro {
namespace {

/// Where a walk was and how deep it is. An object is visited at its first place only: lists may
/// hold each other, and lists of lists would multiply.
class Visits {
 public:
  /// Whether the walk goes on into the object; `leave` follows.
  bool enter(const id& object) {
    if (depth_ >= kDeepestNesting) {
      return false;
    }
    isFirst(object);  // where the walk begins is met by it
    ++depth_;
    return true;
  }
  void leave() { --depth_; }
  /// Whether the object was met for the first time. It is kept until the walk ends: the address of
  /// one that was made for the asking would soon be another's.
  bool isFirst(const id& object) { return seen_.try_emplace(object.get(), object).second; }

 private:
  static constexpr std::size_t kDeepestNesting = 200;
  std::size_t depth_ = 0;
  std::unordered_map<const Object*, id> seen_;
};

bool isSilent(const id& object) {
  const bool isView = isA<UIView>(object.get());
  return trySend<bool>(object, "accessibilityElementsHidden") ||
         (isView && !trySend<bool>(object, "_accessibilityViewIsVisible"));
}

/// What lies directly below an object, in reading order.
struct Children {
  std::vector<id> objects;
  bool isElementList = false;
};

Children childrenOf(const id& object) {
  Children children;
  if (const auto elements = as<NSArray>(trySend<id>(object, "accessibilityElements"))) {
    children.isElementList = true;
    children.objects.assign(elements->begin(), elements->end());
  } else if (const auto view = as<UIView>(object)) {
    const auto& subviews = view->subviewList();
    children.objects.assign(subviews.begin(), subviews.end());
  }
  // The frontmost modal view is the only one that is heard; subviews are listed back to front.
  const auto modal =
      std::find_if(children.objects.rbegin(), children.objects.rend(), [](const id& child) {
        return trySend<bool>(child, "accessibilityViewIsModal") && !isSilent(child);
      });
  if (modal != children.objects.rend()) {
    children.objects = std::vector{id(*modal)};
    return children;
  }
  if (!children.isElementList) {
    children.objects = sortedByGeometry(std::move(children.objects));
  }
  return children;
}

class ElementWalk {
 public:
  void visit(const id& object) {
    if (!object || isSilent(object) || !visits_.isFirst(object)) {
      return;
    }
    if (trySend<bool>(object, "isAccessibilityElement")) {
      found.push_back({object, containers_});
      return;
    }
    visitChildren(object);
  }

  void visitChildren(const id& object) {
    if (!object || !visits_.enter(object)) {
      return;
    }
    const Children children = childrenOf(object);
    if (children.isElementList) {
      containers_.push_back(object);
    }
    for (const id& child : children.objects) {
      visit(child);
    }
    if (children.isElementList) {
      containers_.pop_back();
    }
    visits_.leave();
  }

  std::vector<AccessibleElement> found;

 private:
  Visits visits_;
  std::vector<id> containers_;
};

class TextWalk {
 public:
  TextWalk(bool includesHeaders, bool includesFocusable, const Ref<NSArray>& exclusions)
      : includesHeaders_(includesHeaders),
        includesFocusable_(includesFocusable),
        exclusions_(exclusions) {}

  void visitChildren(const id& object) {
    if (!visits_.enter(object)) {
      return;
    }
    for (const id& child : childrenOf(object).objects) {
      visit(child);
    }
    visits_.leave();
  }

  std::vector<id> texts;

 private:
  void visit(const id& object) {
    if (!object || isExcluded(object) || isSilent(object) || !visits_.isFirst(object)) {
      return;
    }
    const bool isHeader = (trySend<UIAccessibilityTraits>(object, "accessibilityTraits") &
                           UIAccessibilityTraitHeader) != 0;
    const bool isElement = trySend<bool>(object, "isAccessibilityElement");
    const bool isIncluded = isHeader ? includesHeaders_ : !isElement || includesFocusable_;
    if (isIncluded) {
      texts.push_back(accessibilityLabelOf(object));
    }
    if (!isElement) {
      visitChildren(object);
    }
  }

  [[nodiscard]] bool isExcluded(const id& object) const {
    return exclusions_ && std::ranges::find(*exclusions_, object) != exclusions_->end();
  }

  bool includesHeaders_;
  bool includesFocusable_;
  Ref<NSArray> exclusions_;
  Visits visits_;
};

/// A merge sort: unlike the library's sorts it asks nothing of the comparison but an answer.
template <class T, class Precedes>
void mergeSort(std::vector<T>& items, const Precedes& precedes) {
  std::vector<T> merged(items.size());
  for (std::size_t width = 1; width < items.size(); width *= 2) {
    for (std::size_t start = 0; start < items.size(); start += 2 * width) {
      const std::size_t middle = std::min(start + width, items.size());
      const std::size_t end = std::min(start + 2 * width, items.size());
      std::size_t left = start;
      std::size_t right = middle;
      for (std::size_t out = start; out < end; ++out) {
        const bool takeRight =
            left == middle || (right < end && precedes(items[right], items[left]));
        merged[out] = std::move(items[takeRight ? right++ : left++]);
      }
    }
    items.swap(merged);
  }
}

bool shareRow(const CGRect& left, const CGRect& right) {
  const double smaller = std::min(left.size.height, right.size.height);
  const double overlap =
      std::min(left.maxY(), right.maxY()) - std::max(left.origin.y, right.origin.y);
  return smaller <= 0 ? overlap >= 0 : overlap >= smaller / 2;
}

std::int64_t order(double left, double right) { return left < right ? -1 : (right < left ? 1 : 0); }

std::int64_t compareToElement(Object* receiver, const id& other) {
  return compareGeometry(trySend<CGRect>(receiver, "accessibilityFrame"),
                         trySend<CGRect>(other, "accessibilityFrame"),
                         userInterfaceIsRightToLeft());
}

const Registered comparison =
    extendClass("NSObject").method<&compareToElement>("accessibilityCompareGeometry:");

}  // namespace

std::vector<AccessibleElement> accessibleElements(const id& root) {
  ElementWalk walk;
  walk.visit(root);
  return std::move(walk.found);
}

std::vector<id> accessibleDescendants(const id& root) {
  ElementWalk walk;
  walk.visitChildren(root);
  std::vector<id> elements;
  std::ranges::transform(walk.found, std::back_inserter(elements), &AccessibleElement::element);
  return elements;
}

Ref<NSString> textForSubhierarchy(const id& root, bool includesHeaders, bool includesFocusable,
                                  const Ref<NSArray>& exclusions) {
  TextWalk walk(includesHeaders, includesFocusable, exclusions);
  walk.visitChildren(root);
  return plainText(AXLabelForElements(arrayWithObjects(std::move(walk.texts))));
}

std::int64_t compareGeometry(const CGRect& left, const CGRect& right, bool rightToLeft) {
  if (!shareRow(left, right)) {
    return order(left.origin.y, right.origin.y);
  }
  return rightToLeft ? order(right.maxX(), left.maxX()) : order(left.origin.x, right.origin.x);
}

std::vector<id> sortedByGeometry(std::vector<id> objects) {
  if (objects.size() < 2) {
    return objects;
  }
  struct Placed {
    CGRect frame;
    id object;
  };
  std::vector<Placed> placed;
  placed.reserve(objects.size());
  for (id& object : objects) {
    placed.push_back({trySend<CGRect>(object, "accessibilityFrame"), std::move(object)});
  }
  const bool rightToLeft = userInterfaceIsRightToLeft();
  mergeSort(placed, [&](const Placed& left, const Placed& right) {
    return compareGeometry(left.frame, right.frame, rightToLeft) < 0;
  });
  std::ranges::transform(placed, objects.begin(), [](Placed& each) { return each.object; });
  return objects;
}

Ref<NSArray> sortedArrayUsingSelector(const Ref<NSArray>& array, Name selector) {
  if (!array || selector == Name("accessibilityCompareGeometry:")) {
    // Asks every frame once instead of once a comparison.
    return array ? arrayWithObjects(sortedByGeometry({array->begin(), array->end()})) : array;
  }
  std::vector<id> objects(array->begin(), array->end());
  mergeSort(objects, [&](const id& left, const id& right) {
    return send<std::int64_t>(left, selector, right) < 0;
  });
  return arrayWithObjects(std::move(objects));
}

}  // namespace tavro
