#pragma once

#include <functional>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

#include "platform/foundation/NSString.h"

namespace tavro {

/// One check of a host contract: a row of data.
struct HostCheck {
  enum class Kind {
    classExists,
    kindOfClass,
    protocol,
    instanceVariable,
    instanceMethod,
    classMethod
  };
  static constexpr std::size_t kMostEncodings = 8;

  Kind kind;
  Name className;
  /// The member, the other class or the protocol; empty for `classExists`. A selector is compared
  /// with its blanks removed.
  Name member;
  /// A variable's type, or a method's result and then its arguments; unused entries are empty.
  std::string_view encodings[kMostEncodings] = {};
};

constexpr HostCheck classExists(Name className) {
  return {HostCheck::Kind::classExists, className, {}};
}
constexpr HostCheck kindOfClass(Name className, Name superclass) {
  return {HostCheck::Kind::kindOfClass, className, superclass};
}
constexpr HostCheck conformsToProtocol(Name className, Name protocol) {
  return {HostCheck::Kind::protocol, className, protocol};
}
/// The type is an encoding ("B") or the name of the class that the variable holds.
constexpr HostCheck instanceVariable(Name className, Name variable, std::string_view type) {
  return {HostCheck::Kind::instanceVariable, className, variable, {type}};
}
template <class... Arguments>
constexpr HostCheck instanceMethod(Name className, Name selector, std::string_view result,
                                   Arguments... arguments) {
  return {HostCheck::Kind::instanceMethod, className, selector, {result, arguments...}};
}
template <class... Arguments>
constexpr HostCheck classMethod(Name className, Name selector, std::string_view result,
                                Arguments... arguments) {
  return {HostCheck::Kind::classMethod, className, selector, {result, arguments...}};
}

/// "class exists", "kind of class", "protocol", "instance variable", "instance method",
/// "class method".
std::string_view textOfKind(HostCheck::Kind kind);

/// A check with its outcome.
struct CheckOutcome {
  std::string category;  ///< empty for a process-wide check
  std::string className;
  std::string member;
  HostCheck::Kind kind;
  std::string type;  ///< expected: "@", "v, @, q", "UILabel"; empty where the kind has none
  bool passed;
  std::string reason;  ///< why it failed
};

/// What became of one method of a category.
struct GraftOutcome {
  std::string selector;
  bool isClassMethod;
  bool intercepts;  ///< proven: a message to the target class reaches the category
  std::string reason;
};

/// What became of one category that was asked for.
struct InstallationOutcome {
  std::string category;
  std::string target;
  bool installed;
  std::string reason;  ///< why not
  std::vector<GraftOutcome> methods;
};

struct ValidationReport {
  std::string targetName;
  std::vector<CheckOutcome> checks;
  std::vector<InstallationOutcome> installations;
};

using ChecksHandler = std::function<bool(id)>;
using PreValidationHandler = std::function<bool(id)>;
using PostValidationHandler = std::function<void(id)>;
using InstallationHandler = std::function<void(id)>;

/// Runs the checks of a plug-in and installs its categories.
///
/// Class message: `sharedInstance`. Messages:
/// `performValidations:withPreValidationHandler:postValidationHandler:safeCategoryInstallationHandler:`
/// with the four handlers above, any of which may be empty; `setValidationTargetName:`,
/// `setOverrideProcessName:` (strings), `setDebugBuild:` (boolean).
///
/// Order: the pre-validation handler, which decides whether checks run; if they do, the
/// process-wide checks; the installation handler, which only names categories; if checks run, each
/// named category's own; then the categories are installed in the order in which they were named;
/// then the post-validation handler. No method is grafted before all checks ran, so that they see
/// the bare host. A handler or a category's checks that raise are reported as a failed check and
/// stop nothing else.
class AXValidationManager : public NSObject {
 public:
  static constexpr Name className = "AXValidationManager";

  /// Process-wide.
  static Ref<AXValidationManager> sharedInstance();

  void performValidations(const ChecksHandler& checks, const PreValidationHandler& before,
                          const PostValidationHandler& after,
                          const InstallationHandler& installation);
  void setValidationTargetName(const Ref<NSString>& name);
  void setOverrideProcessName(const Ref<NSString>& name);
  void setDebugBuild(bool isDebugBuild) { isDebugBuild_ = isDebugBuild; }

  /// Carries out one check and adds its outcome to the report; yields whether it passed.
  bool validate(const HostCheck& check);

  /// Everything that was checked and installed so far, in order.
  [[nodiscard]] const ValidationReport& report() const { return report_; }
  [[nodiscard]] const std::string& processName() const { return processName_; }
  [[nodiscard]] bool isDebugBuild() const { return isDebugBuild_; }

 private:
  void validateCategories(const std::vector<Name>& categories);
  /// Calls a part of the plug-in; one that raises is a failed check of that method.
  void contain(Name className, Name selector, const std::function<void()>& part);

  ValidationReport report_;
  std::string processName_;
  std::string currentCategory_;
  bool isDebugBuild_ = false;
};

/// Whether checks are to be run: a setting of the runtime.
bool AXPerformValidationChecks();

}  // namespace tavro
