#include "platform/foundation/NSBundle.h"

#include <unicode/localematcher.h>

#include <algorithm>
#include <filesystem>

#include "platform/foundation/IcuSupport.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

constexpr std::string_view kLanguageFolder = ".lproj";
constexpr std::string_view kFallbackLanguage = "en";

/// The language that fits the settings' locale best; empty when there is none to choose from.
std::string bestLanguage(const std::vector<std::string>& languages) {
  UErrorCode status = U_ZERO_ERROR;
  icu::LocaleMatcher::Builder builder;
  builder.setNoDefaultLocale();
  std::vector<icu::Locale> locales;
  for (const std::string& language : languages) {
    locales.push_back(icu::Locale::forLanguageTag(language, status));
    builder.addSupportedLocale(locales.back());
  }
  const icu::LocaleMatcher matcher = builder.build(status);
  const icu::Locale* const best = matcher.getBestMatch(icuLocale(), status);
  requireSuccess(status, "choosing a language");
  if (best != nullptr) {
    const auto found = std::ranges::find(locales, *best);
    return languages[static_cast<std::size_t>(found - locales.begin())];
  }
  const auto fallback = std::ranges::find(languages, kFallbackLanguage);
  if (fallback != languages.end()) {
    return *fallback;
  }
  return languages.empty() ? std::string() : languages.front();
}

/// The shortest tag of the settings' locale ("en" for "en_US"). A folder of that name differs from
/// the locale in nothing, so the matcher would choose it; without the matcher, whose data takes
/// half of the time to open a bundle.
std::string shortestTag() {
  UErrorCode status = U_ZERO_ERROR;
  icu::Locale locale(icu::Locale(Settings::current().locale.c_str()).getBaseName());
  locale.minimizeSubtags(status);
  std::string tag = locale.toLanguageTag<std::string>(status);
  return U_SUCCESS(status) ? tag : std::string();
}

}  // namespace

Ref<NSBundle> NSBundle::bundleForClass(Class* isa) {
  return isa == nullptr ? nullptr : bundleWithPath(isa->image());
}

Ref<NSBundle> NSBundle::bundleWithPath(std::string_view path) {
  static auto* const bundles = new std::map<std::string, Ref<NSBundle>, std::less<>>;
  auto found = bundles->find(path);
  if (found == bundles->end()) {
    found = bundles->emplace(path, make<NSBundle>()).first;
    found->second->path_ = path;
  }
  return found->second;
}

bool NSBundle::hasTable(std::string_view language, std::string_view table) const {
  const std::filesystem::path folder = path_ + "/" + std::string(language) + kLanguageFolder.data();
  std::error_code error;
  return std::filesystem::exists(folder / (std::string(table) + ".strings"), error);
}

std::vector<std::string> NSBundle::languagesOfTable(std::string_view table) const {
  std::vector<std::string> languages;
  std::error_code error;
  for (const auto& folder : std::filesystem::directory_iterator(path_, error)) {
    if (folder.path().extension() == kLanguageFolder &&
        hasTable(folder.path().stem().string(), table)) {
      languages.push_back(folder.path().stem().string());
    }
  }
  std::ranges::sort(languages);
  return languages;
}

const NSBundle::Choice& NSBundle::choiceForTable(std::string_view table) const {
  const std::string& locale = Settings::current().locale;
  auto choice = choices_.find(table);
  if (choice == choices_.end() || choice->second.locale != locale) {
    Choice made{.locale = locale, .language = shortestTag()};
    if (!hasTable(made.language, table)) {
      made.language = bestLanguage(languagesOfTable(table));
    }
    choice = choices_.insert_or_assign(std::string(table), std::move(made)).first;
  }
  return choice->second;
}

std::string NSBundle::languageForTable(std::string_view table) const {
  return choiceForTable(table).language;
}

const StringTable& NSBundle::table(std::string_view name) {
  const Choice& choice = choiceForTable(name);
  if (choice.texts != nullptr) {
    return *choice.texts;
  }
  const std::string& language = choice.language;
  if (language.empty()) {
    throw FileError(path_ + ": there is no table \"" + std::string(name) + "\"");
  }
  const std::string key = language + "/" + std::string(name);
  auto found = tables_.find(key);
  if (found == tables_.end()) {
    const std::string folder = language + std::string(kLanguageFolder);
    found =
        tables_
            .emplace(key, readStringTable((std::filesystem::path(path_) / folder).string(), name))
            .first;
  }
  choice.texts = &found->second;
  return found->second;
}

Ref<NSString> NSBundle::textForKey(std::string_view key, std::string_view table) {
  try {
    const StringTable& texts = this->table(table);
    if (const auto found = texts.find(key); found != texts.end()) {
      return found->second;
    }
  } catch (const std::exception&) {
    // A table that cannot be used is a missing one: the caller still gets something to say. The
    // fault itself is reported by whoever asks for the table.
  }
  return nullptr;
}

Ref<NSString> NSBundle::localizedStringForKey(const Ref<NSString>& key, const Ref<NSString>& value,
                                              std::string_view table) {
  if (const Ref<NSString> found = key ? textForKey(key->utf8(), table) : nullptr) {
    return found;
  }
  return lengthOfText(value) > 0 ? value : key;
}

namespace {

const Registered kBundle = defineClass<NSBundle, NSObject>();

}  // namespace
}  // namespace tavro
