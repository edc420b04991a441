#include "plugin/sharing/SendMessageButton.h"

#include "platform/accessibility/KeyAccess.h"
#include "platform/uikit/UIViewController.h"
#include "plugin/core/Exports.h"

namespace tavro {

void annotateSendMessageButton(Object* controller) {
  const id bar = safeValueForKey(as<UIViewController>(controller), "navigationItem");
  const Ref<NSArray> items = safeArrayForKey(bar, "rightBarButtonItems");
  if (!items) {
    return;
  }
  for (const id& item : *items) {
    if (trySend<Name>(item, "action") == Name("_sendMessageButtonTapped:")) {
      trySend<void>(item, "setAccessibilityLabel:", localized("messages"));
      trySend<void>(item, "setAccessibilityHint:", localized("messages.hint"));
      return;
    }
  }
}

}  // namespace tavro
