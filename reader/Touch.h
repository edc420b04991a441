#pragma once

#include <optional>
#include <vector>

#include "platform/accessibility/Traversal.h"

namespace tavro {

/// The index of the element that a finger at a point (screen coordinates) hears. What the views
/// answer to `_accessibilityHitTest:withEvent:` decides, when that is an element or lies in one.
/// Otherwise it is one of the elements whose frames hold the point: one whose row holds it too
/// comes before one that only reaches over from another row, then the nearest centre counts.
/// Nothing where there is no element.
std::optional<std::size_t> elementAt(const std::vector<AccessibleElement>& elements, UIView& root,
                                     CGPoint point);

/// Does what a tap at a point (screen coordinates) does: the foremost control or bar button there
/// acts. NO when there is none, or it has nothing to do. What the application raises is contained.
bool tap(UIView& root, CGPoint point);

}  // namespace tavro
