#include "platform/foundation/Settings.h"

namespace tavro {

Settings& Settings::current() {
  static Settings settings;
  return settings;
}

}  // namespace tavro
