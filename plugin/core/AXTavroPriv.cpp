#include "platform/accessibility/KeyAccess.h"
#include "platform/foundation/NSString.h"

namespace tavro {
namespace {

// An ordinary category: every object has these messages as soon as the bundle is open.

const char kRingsDescription = 0;

id ringsDescription(NSObject* self) {
  return __UIAccessibilityGetAssociatedObject(self, &kRingsDescription);
}

void setRingsDescription(NSObject* self, Ref<NSString> description) {
  __UIAccessibilitySetAssociatedCopiedObject(self, &kRingsDescription, description);
}

/// What the object itself says of three fractions; nil when it has no answer or raises.
id descriptionForPercentages(NSObject* self, double move, double exercise, double stand,
                             bool isCapped) {
  return trySend<id>(self,
                     "accessibilityDescriptionForPercentages:exercisingPercentage:"
                     "standingPercentage:arePercentagesCapped:",
                     move, exercise, stand, isCapped);
}

const Registered category =
    extendClass("NSObject")
        .method<&ringsDescription>("_accessibilityRingsDescription")
        .method<&setRingsDescription>("_accessibilitySetRingsDescription:")
        .method<&descriptionForPercentages>(
            "_tavroUIAccessibilityDescriptionForPercentages:exercisingPercentage:"
            "standingPercentage:arePercentagesCapped:");

}  // namespace
}  // namespace tavro
