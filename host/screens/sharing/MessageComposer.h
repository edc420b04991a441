#pragma once

#include <string_view>

#include "platform/uikit/UIView.h"

namespace tavro {

/// Shows a sheet for a new message at the foot of a screen, until it is cancelled. The recipient is
/// empty where the user has yet to choose one.
void presentMessageComposer(UIView& screen, std::string_view recipient);

}  // namespace tavro
