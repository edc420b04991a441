#include "plugin/core/AXGroupedTitleValueView.h"

#include "platform/accessibility/Labels.h"

namespace tavro {
namespace {

using Group = AXGroupedTitleValueView;
const Registered groupClass = defineClass<Group, UIAccessibilityAggregateElement>()
                                  .method<&Group::initWithAccessibilityContainer>(
                                      "initWithAccessibilityContainer:titleView:valueView:")
                                  .method<&Group::isAccessibilityElement>("isAccessibilityElement")
                                  .method<&Group::accessibilityLabel>("accessibilityLabel")
                                  .method<&Group::accessibilityValue>("accessibilityValue")
                                  .variable<&Group::_titleView>("_titleView")
                                  .variable<&Group::_valueView>("_valueView");

}  // namespace

id AXGroupedTitleValueView::initWithAccessibilityContainer(const id& container, const id& titleView,
                                                           const id& valueView) {
  id element = send<id>(this, "initWithAccessibilityContainer:representedElements:", container,
                        axArrayByIgnoringNilElements({titleView, valueView}));
  if (element) {
    _titleView = titleView;
    _valueView = valueView;
  }
  return element;
}

bool AXGroupedTitleValueView::isAccessibilityElement() {
  return lengthOfText(accessibilityLabelOf(_titleView)) > 0 &&
         lengthOfText(accessibilityLabelOf(_valueView)) > 0;
}

id AXGroupedTitleValueView::accessibilityLabel() { return accessibilityLabelOf(_titleView); }

id AXGroupedTitleValueView::accessibilityValue() { return accessibilityLabelOf(_valueView); }

id groupedTitleValueView(const id& container, const id& titleView, const id& valueView) {
  return send<id>(make<Group>(), "initWithAccessibilityContainer:titleView:valueView:", container,
                  titleView, valueView);
}

}  // namespace tavro
