#pragma once

#include "platform/runtime/Object.h"

namespace tavro {

/// Labels and explains the button that sends a message: the first of the controller's right-hand
/// bar items whose action is `_sendMessageButtonTapped:`. Without such an item nothing happens.
void annotateSendMessageButton(Object* controller);

}  // namespace tavro
