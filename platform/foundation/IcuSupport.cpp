#include "platform/foundation/IcuSupport.h"

#include <cmath>

#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

constexpr double kLastMillisecond = 8.64e15;  // a hundred million days

std::size_t createdCount = 0;

}  // namespace

std::size_t icuFormattersCreated() { return createdCount; }
void detail::countCreatedIcuFormatter() { ++createdCount; }

void requireSuccess(UErrorCode status, std::string_view what) {
  if (U_FAILURE(status)) {
    raise(kInvalidArgumentException, std::string(what) + " failed: " + u_errorName(status));
  }
}

icu::Locale icuLocale(std::string_view calendar) {
  icu::Locale locale(Settings::current().locale.c_str());
  if (!calendar.empty()) {
    UErrorCode status = U_ZERO_ERROR;
    locale.setKeywordValue(
        "calendar", icu::StringPiece(calendar.data(), static_cast<int>(calendar.size())), status);
    requireSuccess(status, "choosing a calendar");
  }
  return locale;
}

std::unique_ptr<icu::TimeZone> icuTimeZone(std::string_view name) {
  return std::unique_ptr<icu::TimeZone>(icu::TimeZone::createTimeZone(unicode(name)));
}

IcuKey userKey(std::string_view detail, std::int64_t option) {
  const Settings& settings = Settings::current();
  return {detail, option, settings.locale, settings.timeZone, settings.calendar};
}

IcuKey localeKey(std::string_view detail, std::int64_t option) {
  return {.detail = detail, .option = option, .locale = Settings::current().locale};
}

double icuMilliseconds(double seconds) {
  return std::isnan(seconds) ? 0 : std::clamp(seconds * 1000, -kLastMillisecond, kLastMillisecond);
}

}  // namespace tavro
