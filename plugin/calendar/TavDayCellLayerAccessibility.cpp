#include "platform/accessibility/SafeCategory.h"

namespace tavro {
namespace {

/// Known by name, not installed: a day of the week's drawing is silent.
class TavDayCellLayerAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "TavDayCellLayerAccessibility";
  static constexpr Name target = "TavDayCellLayer";
};

const Registered category = safeCategory<TavDayCellLayerAccessibility, kNoHostContract>();

}  // namespace
}  // namespace tavro
