#include "platform/foundation/Language.h"

#include <unicode/locid.h>
#include <unicode/timezone.h>
#include <unicode/uloc.h>

#include <memory>

#include "platform/foundation/Settings.h"

namespace tavro {

bool userInterfaceIsRightToLeft() {
  static std::string known;
  static bool rightToLeft = false;
  const std::string& locale = Settings::current().locale;
  if (locale != known) {
    known = locale;
    rightToLeft = uloc_isRightToLeft(locale.c_str()) != 0;
  }
  return rightToLeft;
}

bool isKnownLocale(const std::string& name) {
  const icu::Locale locale = icu::Locale::createFromName(name.c_str());
  if (locale.isBogus() || *locale.getLanguage() == '\0') {
    return false;
  }
  for (const char* const* language = uloc_getISOLanguages(); *language != nullptr; ++language) {
    if (std::string_view(locale.getLanguage()) == *language) {
      return true;
    }
  }
  return false;
}

std::string nameOfLocale(const std::string& name) {
  const icu::Locale locale = icu::Locale::createFromName(name.c_str());
  icu::UnicodeString text;
  std::string utf8;
  return locale.getDisplayName(locale, text).toUTF8String(utf8);
}

bool isKnownTimeZone(const std::string& name) {
  const std::unique_ptr<icu::TimeZone> zone(
      icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(name)));
  return *zone != icu::TimeZone::getUnknown();
}

}  // namespace tavro
