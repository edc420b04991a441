#include "platform/accessibility/Validation.h"

namespace tavro {
namespace {

/// A plug-in that needs a class which the application does not have.
class DemandingPlugin : public NSObject {
 public:
  static constexpr Name className = "DemandingPlugin";

  static void initialize(Class* /*self*/) {
    AXValidationManager::sharedInstance()->validate(classExists("NoClassOfTheApplication"));
  }
};

const Registered plugin =
    defineClass<DemandingPlugin, NSObject>().classMethod<&DemandingPlugin::initialize>(
        "accessibilityInitializeBundle");

}  // namespace
}  // namespace tavro
