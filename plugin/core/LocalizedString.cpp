#include "platform/foundation/NSBundle.h"
#include "plugin/core/Exports.h"

using namespace tavro;

Ref<NSString> accessibilityLocalizedString(const Ref<NSString>& key) {
  const Ref<NSBundle> bundle = NSBundle::bundleForClass(Class::named("AXTavroGlue"));
  return bundle ? bundle->localizedStringForKey(key, string(""), "Accessibility") : nullptr;
}
