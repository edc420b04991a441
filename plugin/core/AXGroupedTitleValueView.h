#pragma once

#include "platform/uikit/UIAccessibility.h"

namespace tavro {

/// One element for a title view and a value view: it says the title's label and, as its value, the
/// value's label, both as they are at the moment of asking. An element only while both say
/// something. Its frame is that of the two together. Either view may be nil.
class AXGroupedTitleValueView : public UIAccessibilityAggregateElement {
 public:
  static constexpr Name className = "AXGroupedTitleValueView";

  id _titleView;
  id _valueView;

  /// `initWithAccessibilityContainer:titleView:valueView:`
  id initWithAccessibilityContainer(const id& container, const id& titleView, const id& valueView);
  bool isAccessibilityElement();
  id accessibilityLabel();
  id accessibilityValue();
};

/// A new element whose container, held weakly, is that object.
id groupedTitleValueView(const id& container, const id& titleView, const id& valueView);

}  // namespace tavro
