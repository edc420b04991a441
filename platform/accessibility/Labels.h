#pragma once

#include <initializer_list>

#include "platform/foundation/NSAttributedString.h"
#include "platform/uikit/UIView.h"

namespace tavro {

// Joined texts. The separator is ", " in every language. Parts that are nil or empty are skipped;
// nil when nothing is left. When a part is attributed the result is an `AXAttributedString` that
// carries each part's attributes over that part; else it is an `NSString`.

/// Ends the list of a joiner's variables.
inline constexpr std::u16string_view kVariablesSentinel = u"__AXStringForVariablesSentinel";

/// The parts in order. The list may end with the sentinel string.
id __UIAXStringForVariables(std::initializer_list<id> parts);
/// The same.
id __AXStringForVariables(std::initializer_list<id> parts);

/// Texts stand for themselves, other objects for their `accessibilityLabel`. Views that are not
/// visible are left out.
id AXLabelForElements(const Ref<NSArray>& elements);
/// The same.
id UIAXLabelForElements(const Ref<NSArray>& elements);
/// The union of the screen frames, without objects that raise; the zero rectangle when there is
/// none.
CGRect UIAXFrameForElements(const Ref<NSArray>& elements);
/// The labels of all accessible descendants in reading order; nil for nil.
id UIAXStringForAllChildren(const Ref<UIView>& view);
/// `_accessibilityStringForLabelKeyValues:`: the labels of the objects under keys that are
/// separated by a comma and a blank.
id stringForLabelKeyValues(const id& object, std::string_view keys);

/// The object's `accessibilityLabel`; nil when asking raises.
id accessibilityLabelOf(const id& object);
/// `_accessibilityTextForSubhierarchyIncludingHeaders:focusableItems:exclusions:` without
/// exclusions; nil when asking raises.
id accessibilityTextForSubhierarchy(const id& view, bool includesHeaders, bool focusableItems);

}  // namespace tavro
