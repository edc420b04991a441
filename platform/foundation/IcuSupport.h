#pragma once

#include <unicode/locid.h>
#include <unicode/timezone.h>
#include <unicode/unistr.h>

#include <memory>
#include <string>
#include <string_view>

#include "platform/foundation/IcuCache.h"
#include "platform/foundation/NSString.h"

// Internal to platform/foundation: the only header that shows ICU.

namespace tavro {

/// The text as ICU takes it, not copied; the view must outlive the result.
inline icu::UnicodeString borrowed(std::u16string_view text) {
  return {false, text.data(), static_cast<std::int32_t>(text.size())};
}
inline std::u16string_view viewOf(const icu::UnicodeString& text) {
  return {text.getBuffer(), static_cast<std::size_t>(text.length())};
}
/// A template or pattern, which is UTF-8, as ICU takes it.
inline icu::UnicodeString unicode(std::string_view utf8) {
  return icu::UnicodeString::fromUTF8(
      icu::StringPiece(utf8.data(), static_cast<std::int32_t>(utf8.size())));
}
Ref<NSString> stringOf(const icu::UnicodeString& text);

/// Raises when ICU failed at `what` ("formatting a date").
void requireSuccess(UErrorCode status, std::string_view what);

/// The settings' locale, with the calendar of that name unless it is empty.
icu::Locale icuLocale(std::string_view calendar = {});
/// The zone of that IANA name; UTC for a name that ICU does not know.
std::unique_ptr<icu::TimeZone> icuTimeZone(std::string_view name);

/// A key that tells settings apart: locale, time zone and calendar.
IcuKey userKey(std::string_view detail = {}, std::int64_t option = 0);
/// A key that tells locales apart, for what depends on no date.
IcuKey localeKey(std::string_view detail = {}, std::int64_t option = 0);

/// A moment as ICU takes it. A moment beyond some 270,000 years from 1970 becomes the last one in
/// that span, and what is not a number becomes 1970: ICU's arithmetic is safe there.
double icuMilliseconds(double seconds);

/// The plural category of an integer in a language, as ICU names it.
std::string pluralCategory(std::string_view language, std::int64_t integer);
/// The integer in the user's digits and grouping.
icu::UnicodeString groupedInteger(std::int64_t integer);

}  // namespace tavro
