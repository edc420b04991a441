#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/accessibility/SafeCategory.h"
#include "platform/foundation/NSValue.h"
#include "plugin/core/Exports.h"

namespace tavro {
namespace {

/// The address is the key of the stored attribute.
const char kLabelAttribute = 0;

/// A figure of the summary is one element: its title, then its total and its average, each with a
/// header. Another component may ask for both figures to carry a speech attribute.
class _CHWorkoutSummaryTabbedLabelContainerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "_CHWorkoutSummaryTabbedLabelContainerAccessibility";
  static constexpr Name target = "_CHWorkoutSummaryTabbedLabelContainer";

  bool isAccessibilityElement() { return true; }

  id accessibilityLabel() {
    const Ref<NSMutableArray> parts = mutableArray();
    const id title = safeValueForKey(self, "_titleText");
    if (lengthOfText(title) > 0) {
      parts->addObject(title);
    }
    addFigure(*parts, "_totalText", "summary.cell.header.total");
    addFigure(*parts, "_averageText", "summary.cell.header.average");
    return UIAXLabelForElements(parts);
  }

  /// The name of the speech attribute, or nil.
  id _accessibilityLabelAttribute() {
    return __UIAccessibilityGetAssociatedObject(self, &kLabelAttribute);
  }
  void _accessibilitySetLabelAttribute(const id& name) {
    __UIAccessibilitySetAssociatedObject(self, &kLabelAttribute, name);
  }

 private:
  void addFigure(NSMutableArray& parts, Name key, std::string_view header) {
    const auto figure = typedRead<NSString>(self, key);
    if (lengthOfText(figure) == 0) {
      return;
    }
    parts.axSafelyAddObject(localized(header));
    const auto attribute = as<NSString>(_accessibilityLabelAttribute());
    if (!attribute) {
      parts.addObject(figure);
      return;
    }
    const Ref<AXAttributedString> marked = axAttributedString(figure);
    marked->setAttribute(kCFBooleanTrue(), Name::make(attribute->utf8()));
    parts.addObject(marked);
  }
};

constexpr HostCheck kHostContract[] = {
    instanceVariable("_CHWorkoutSummaryTabbedLabelContainer", "_titleText", "NSString"),
    instanceVariable("_CHWorkoutSummaryTabbedLabelContainer", "_totalText", "NSString"),
    instanceVariable("_CHWorkoutSummaryTabbedLabelContainer", "_averageText", "NSString"),
};

using Category = _CHWorkoutSummaryTabbedLabelContainerAccessibility;
const Registered category =
    safeCategory<Category, kHostContract>()
        .method<&Category::isAccessibilityElement>("isAccessibilityElement")
        .method<&Category::accessibilityLabel>("accessibilityLabel")
        .method<&Category::_accessibilityLabelAttribute>("_accessibilityLabelAttribute")
        .method<&Category::_accessibilitySetLabelAttribute>("_accessibilitySetLabelAttribute:");

}  // namespace
}  // namespace tavro
