#pragma once

#include "platform/foundation/NSString.h"

namespace tavro {

/// Whether a displayed text holds the host's placeholder for a missing figure: two hyphens, or two
/// en dashes. What surrounds it says nothing either. NO for nil.
inline bool showsNoData(const Ref<NSString>& text) {
  return text && (containsString(*text, u"--") || containsString(*text, u"\u2013\u2013"));
}

}  // namespace tavro
