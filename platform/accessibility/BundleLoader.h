#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/foundation/NSBundle.h"

namespace tavro {

/// A plug-in that was opened; it stays in the process.
class LoadedBundle {
 public:
  /// An exported function of the bundle, or nullptr.
  [[nodiscard]] void* symbol(const char* name) const;
  /// The absolute path of its folder.
  [[nodiscard]] const std::string& path() const { return path_; }
  /// Calls the principal class once more; a plug-in acts on the first call of a process only.
  void initialize() const;
  /// The declarations that could not be carried out by the time the bundle was open.
  [[nodiscard]] const std::vector<RegistrationProblem>& problems() const { return problems_; }

 private:
  friend LoadedBundle openAccessibilityBundle(const std::string& path);
  std::string path_;
  std::string principalClass_;
  std::vector<RegistrationProblem> problems_;
  void* handle_ = nullptr;
};

/// Opens a bundle without initialising it: reads its `Info.strings` and its table "Accessibility"
/// in the user's language, opens its code and registers its classes. Throws a `FileError` that
/// names the file and the reason.
LoadedBundle openAccessibilityBundle(const std::string& path);

/// Opens a bundle and calls `accessibilityInitializeBundle` on its principal class.
LoadedBundle loadAccessibilityBundle(const std::string& path);

}  // namespace tavro
