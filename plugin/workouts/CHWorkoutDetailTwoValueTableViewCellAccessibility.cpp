#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "plugin/core/AXGroupedTitleValueView.h"
#include "plugin/core/Exports.h"
#include "plugin/core/NoData.h"

namespace tavro {
namespace {

/// The address is the key of the stored elements.
const char kElements = 0;

/// A cell of two figures is a container of two elements, each a title with its value.
class CHWorkoutDetailTwoValueTableViewCellAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "CHWorkoutDetailTwoValueTableViewCellAccessibility";
  static constexpr Name target = "CHWorkoutDetailTwoValueTableViewCell";

  bool isAccessibilityElement() { return false; }

  /// Made once; the elements refer to the labels, so they always say what is shown.
  id accessibilityElements() {
    if (!send<id>(self, "_axElements")) {
      const id title1 = safeValueForKey(self, "_titleLabel1");
      const id title2 = safeValueForKey(self, "_titleLabel2");
      const id value1 = safeValueForKey(self, "_valueLabel1");
      const id value2 = safeValueForKey(self, "_valueLabel2");
      if (title1 && title2 && value1 && value2) {
        send<void>(self, "_axSetElements:",
                   arrayWithObjects({groupedTitleValueView(self, title1, value1),
                                     groupedTitleValueView(self, title2, value2)}));
      }
    }
    return send<id>(self, "_axElements");
  }

  void configureWithTitle1(const id& title, const id& value) {
    super.send<void>(title, value);
    nameValue("_valueLabel1", value);
  }
  void configureWithTitle2(const id& title, const id& value) {
    super.send<void>(title, value);
    nameValue("_valueLabel2", value);
  }

  id _axElements() { return __UIAccessibilityGetAssociatedObject(self, &kElements); }
  void _axSetElements(const id& elements) {
    __UIAccessibilitySetAssociatedObject(self, &kElements, elements);
  }

  /// What a value says in place of its text; nil when its text is what is to be said.
  id _axStringForValue(const id& value) {
    return showsNoData(plainText(value)) ? localized("no.data")
                                         : trySend<id>(value, "accessibilityUserDefinedLabel");
  }

 private:
  void nameValue(Name label, const id& value) {
    trySend<void>(safeValueForKey(self, label),
                  "setAccessibilityLabel:", send<id>(self, "_axStringForValue:", value));
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("CHWorkoutDetailTwoValueTableViewCell", "_titleLabel1", "UILabel"),
    instanceVariable("CHWorkoutDetailTwoValueTableViewCell", "_titleLabel2", "UILabel"),
    instanceVariable("CHWorkoutDetailTwoValueTableViewCell", "_valueLabel1", "UILabel"),
    instanceVariable("CHWorkoutDetailTwoValueTableViewCell", "_valueLabel2", "UILabel"),
    instanceMethod("CHWorkoutDetailTwoValueTableViewCell", "configureWithTitle1: value1:", "v", "@",
                   "@"),
    instanceMethod("CHWorkoutDetailTwoValueTableViewCell", "configureWithTitle2: value2:", "v", "@",
                   "@"),
};

using Category = CHWorkoutDetailTwoValueTableViewCellAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::accessibilityElements>("accessibilityElements")
        .method<&Category::configureWithTitle1>("configureWithTitle1:value1:")
        .method<&Category::configureWithTitle2>("configureWithTitle2:value2:")
        .method<&Category::_axElements>("_axElements")
        .method<&Category::_axSetElements>("_axSetElements:")
        .method<&Category::_axStringForValue>("_axStringForValue:");

}  // namespace
}  // namespace tavro
