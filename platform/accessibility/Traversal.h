#pragma once

#include <functional>
#include <vector>

#include "platform/uikit/UIView.h"

namespace tavro {

// Reading order. A modal view silences its siblings. What is hidden or invisible is silent with all
// below it. An element is a leaf. Otherwise an object's `accessibilityElements`, if not nil, are
// visited in the order given, else its subviews in geometric order. Objects that raise are silent.
// An object is visited once, at its first place, wherever else it is listed.

/// One element, and what it was found in.
struct AccessibleElement {
  id element;
  /// The objects with an element list of their own that lead to it, outermost first.
  std::vector<id> containers;
};

/// The elements at and below an object, in reading order.
std::vector<AccessibleElement> accessibleElements(const id& root);
/// The elements below an object, whatever the object itself is.
std::vector<id> accessibleDescendants(const id& root);

/// The texts below an object joined in reading order, whatever its ancestors are: what carries the
/// header trait if headers are included; else what is an element if focusable items are; text that
/// is neither always. nil when there is none.
Ref<NSString> textForSubhierarchy(const id& root, bool includesHeaders, bool includesFocusable,
                                  const Ref<NSArray>& exclusions);

/// Less than 0 when `left` is read before `right`, more than 0 when after, 0 when neither: rows
/// from top to bottom, then along the row in the reading direction of the language. Two elements
/// share a row when their vertical overlap is at least half the smaller height; a zero height
/// shares the row of the edge that it lies on. Not transitive. Frames in screen coordinates.
std::int64_t compareGeometry(const CGRect& left, const CGRect& right, bool rightToLeft);
/// The objects in the order of `accessibilityCompareGeometry:`. Stable.
std::vector<id> sortedByGeometry(std::vector<id> objects);
/// The array sorted by a comparison that yields "q" and takes one object, as
/// `sortedArrayUsingSelector:` does; stable, and safe for a comparison that is not transitive.
Ref<NSArray> sortedArrayUsingSelector(const Ref<NSArray>& array, Name selector);

}  // namespace tavro
