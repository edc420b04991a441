#include "platform/foundation/NSBundle.h"
#include "plugin/core/Exports.h"

using namespace tavro;

namespace {

constexpr std::string_view kTable = "Accessibility";

Ref<NSBundle> ownBundle() { return NSBundle::bundleForClass(Class::named("AXTavroGlue")); }

}  // namespace

Ref<NSString> accessibilityLocalizedString(const Ref<NSString>& key) {
  const Ref<NSBundle> bundle = ownBundle();
  return bundle ? bundle->localizedStringForKey(key, nullptr, kTable) : nullptr;
}

Ref<NSString> tavro::localized(std::string_view key) {
  const Ref<NSBundle> bundle = ownBundle();
  if (!bundle) {
    return nullptr;
  }
  const Ref<NSString> text = bundle->textForKey(key, kTable);
  return text ? text : string(key);
}
