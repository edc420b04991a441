#include "platform/accessibility/BundleLoader.h"

#include <dlfcn.h>

#include <filesystem>

#include "platform/runtime/Message.h"

namespace tavro {
namespace {

constexpr std::string_view kTable = "Accessibility";

std::string entry(const StringTable& info, const std::string& path, std::string_view key) {
  const auto found = info.find(key);
  if (found == info.end()) {
    throw FileError(path + "/Info.strings: the entry \"" + std::string(key) + "\" is missing");
  }
  return found->second->utf8();
}

}  // namespace

void* LoadedBundle::symbol(const char* name) const { return dlsym(handle_, name); }

void LoadedBundle::initialize() const {
  Class* const principal = Class::named(Name::make(principalClass_));
  if (principal == nullptr) {
    throw FileError(path_ + ": the bundle has no class \"" + principalClass_ + "\"");
  }
  send<void>(principal, "accessibilityInitializeBundle");
}

LoadedBundle openAccessibilityBundle(const std::string& path) {
  std::error_code error;
  const std::filesystem::path folder = std::filesystem::canonical(path, error);
  if (error || !std::filesystem::is_directory(folder)) {
    throw FileError(path + ": there is no such bundle");
  }
  LoadedBundle bundle;
  bundle.path_ = folder.string();
  const StringTable info = readStringTable(bundle.path_, "Info");
  bundle.principalClass_ = entry(info, bundle.path_, "principal.class");
  const std::string executable = bundle.path_ + "/" + entry(info, bundle.path_, "executable");

  const Ref<NSBundle> resources = NSBundle::bundleWithPath(bundle.path_);
  if (resources->languageForTable(kTable).empty()) {
    throw FileError(bundle.path_ + ": the bundle has no string table \"" + std::string(kTable) +
                    "\"");
  }
  static_cast<void>(resources->table(kTable));

  const ImageScope scope(bundle.path_);
  bundle.handle_ = dlopen(executable.c_str(), RTLD_NOW | RTLD_LOCAL | RTLD_NODELETE);
  if (bundle.handle_ == nullptr) {
    const char* const reason = dlerror();
    throw FileError(executable + ": the bundle's code cannot be opened: " +
                    (reason == nullptr ? "unknown reason" : reason));
  }
  bundle.problems_ = registrationProblems();
  return bundle;
}

LoadedBundle loadAccessibilityBundle(const std::string& path) {
  LoadedBundle bundle = openAccessibilityBundle(path);
  bundle.initialize();
  return bundle;
}

}  // namespace tavro
