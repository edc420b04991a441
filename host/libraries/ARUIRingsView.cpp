#include "host/libraries/ARUIRingsView.h"

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

const Registered ringsClass =
    defineClass<ARUIRingsView, UIView>()
        .method<&ARUIRingsView::summary>("summary")
        .method<&ARUIRingsView::setSummary>("setSummary:")
        .method<&ARUIRingsView::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&ARUIRingsView::naturalLabel>("_naturalAccessibilityLabel")
        .method<&ARUIRingsView::naturalValue>("_naturalAccessibilityValue")
        .method<&ARUIRingsView::naturalTraits>("_naturalAccessibilityTraits");

id textOfRing(std::string_view format, const HKActivitySummary::Ring& ring) {
  return ring.amount ? stringWithFormat(string(format), {percentString(ring.completion())}) : id();
}

}  // namespace

id ARUIRingsView::naturalLabel() { return string("Activity rings"); }

id ARUIRingsView::naturalValue() {
  if (!summary_) {
    return nullptr;
  }
  return AXLabelForElements(
      axArrayByIgnoringNilElements({textOfRing("Move %1$@", summary_->activeEnergy),
                                    textOfRing("Exercise %1$@", summary_->exerciseTime),
                                    textOfRing("Stand %1$@", summary_->standHours)}));
}

}  // namespace tavro
