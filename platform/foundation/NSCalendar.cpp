#include <unicode/gregocal.h>

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdlib>

#include "platform/foundation/IcuSupport.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

struct CalendarKind {};

struct Field {
  std::int64_t NSDateComponents::*component;
  UCalendarDateFields field;
  std::int64_t first;  ///< what ICU's 0 is called
  std::int64_t limit;  ///< how far from 0 ICU's arithmetic is safe
};

constexpr Field kFields[] = {
    {&NSDateComponents::era, UCAL_ERA, 0, 10'000},
    {&NSDateComponents::year, UCAL_YEAR, 0, 250'000},
    {&NSDateComponents::month, UCAL_MONTH, 1, 1'000'000},
    {&NSDateComponents::day, UCAL_DATE, 0, 50'000'000},
    {&NSDateComponents::hour, UCAL_HOUR_OF_DAY, 0, 1'000'000'000},
    {&NSDateComponents::minute, UCAL_MINUTE, 0, 1'000'000'000},
    {&NSDateComponents::second, UCAL_SECOND, 0, 1'000'000'000},
};

constexpr std::int64_t kLastAddedDays = 200'000'000;

std::unique_ptr<icu::Calendar> makeCalendar(std::string_view timeZone, std::string_view identifier,
                                            bool isProleptic) {
  UErrorCode status = U_ZERO_ERROR;
  std::unique_ptr<icu::Calendar> calendar(icu::Calendar::createInstance(
      icuTimeZone(timeZone).release(), icuLocale(identifier), status));
  requireSuccess(status, "making a calendar");
  if (auto* const gregorian = dynamic_cast<icu::GregorianCalendar*>(calendar.get());
      gregorian != nullptr && isProleptic) {
    constexpr double kBeforeEverything = -1.8e17;  // still within ICU's range of days
    gregorian->setGregorianChange(kBeforeEverything, status);
    requireSuccess(status, "making a proleptic calendar");
  }
  // The first moment of a day whose midnight the clocks skip is the next one that exists, and of
  // two midnights it is the first.
  calendar->setSkippedWallTimeOption(UCAL_WALLTIME_NEXT_VALID);
  calendar->setRepeatedWallTimeOption(UCAL_WALLTIME_FIRST);
  return calendar;
}

icu::Calendar& icuCalendar(const NSCalendar& calendar) {
  const Settings& settings = Settings::current();
  const std::string_view timeZone =
      calendar.timeZone.empty() ? settings.timeZone : calendar.timeZone;
  const std::string_view identifier =
      calendar.identifier.empty() ? settings.calendar : calendar.identifier;
  const bool isProleptic = calendar.identifier == NSCalendarIdentifierGregorian;
  return icuCache<CalendarKind, icu::Calendar>().get(
      {.option = isProleptic,
       .locale = settings.locale,
       .timeZone = timeZone,
       .calendar = identifier},
      [&] { return makeCalendar(timeZone, identifier, isProleptic); });
}

icu::Calendar& calendarAt(const NSCalendar& calendar, const NSDate& date) {
  icu::Calendar& moment = icuCalendar(calendar);
  UErrorCode status = U_ZERO_ERROR;
  moment.setTime(icuMilliseconds(date.seconds), status);
  requireSuccess(status, "setting a calendar");
  return moment;
}

Ref<NSDate> momentOf(const icu::Calendar& calendar) {
  UErrorCode status = U_ZERO_ERROR;
  const double milliseconds = calendar.getTime(status);
  requireSuccess(status, "reckoning a date");
  return dateWithSeconds(milliseconds / 1000);
}

/// The date in the proleptic Gregorian calendar, for which the standard library does. Nothing for
/// the years that it does not count, some 32,000 to either side.
Ref<NSDateComponents> prolepticComponents(const NSDate& date, const icu::TimeZone& zone) {
  using namespace std::chrono;
  constexpr std::int64_t kLastDay = 11'000'000;
  const double moment = icuMilliseconds(date.seconds);
  std::int32_t raw = 0;
  std::int32_t saving = 0;
  UErrorCode status = U_ZERO_ERROR;
  zone.getOffset(moment, false, raw, saving, status);
  requireSuccess(status, "reading a time zone");
  const sys_time<milliseconds> local{milliseconds(static_cast<std::int64_t>(std::floor(moment))) +
                                     milliseconds(raw + saving)};
  const auto day = floor<days>(local);
  if (std::abs(day.time_since_epoch().count()) > kLastDay) {
    return nullptr;
  }
  const year_month_day civil(day);
  const hh_mm_ss time(local - day);
  const auto year = std::int64_t{int{civil.year()}};
  Ref<NSDateComponents> components = make<NSDateComponents>();
  components->era = year > 0 ? 1 : 0;
  components->year = year > 0 ? year : 1 - year;
  components->month = unsigned{civil.month()};
  components->day = unsigned{civil.day()};
  components->hour = time.hours().count();
  components->minute = time.minutes().count();
  components->second = time.seconds().count();
  components->weekday = weekday(day).c_encoding() + 1;
  return components;
}

}  // namespace

Ref<NSDateComponents> NSCalendar::componentsFromDate(const Ref<NSDate>& date) const {
  if (!date) {
    return nullptr;
  }
  if (identifier == NSCalendarIdentifierGregorian) {
    if (auto components = prolepticComponents(*date, icuCalendar(*this).getTimeZone())) {
      return components;
    }
  }
  const icu::Calendar& moment = calendarAt(*this, *date);
  Ref<NSDateComponents> components = make<NSDateComponents>();
  UErrorCode status = U_ZERO_ERROR;
  for (const Field& field : kFields) {
    (*components).*field.component = moment.get(field.field, status) + field.first;
  }
  components->weekday = moment.get(UCAL_DAY_OF_WEEK, status);
  requireSuccess(status, "reading a calendar");
  return components;
}

Ref<NSDate> NSCalendar::startOfDayForDate(const Ref<NSDate>& date) const {
  if (!date) {
    return nullptr;
  }
  icu::Calendar& moment = calendarAt(*this, *date);
  for (const UCalendarDateFields field :
       {UCAL_HOUR_OF_DAY, UCAL_MINUTE, UCAL_SECOND, UCAL_MILLISECOND}) {
    moment.set(field, 0);
  }
  return momentOf(moment);
}

Ref<NSDate> NSCalendar::dateFromComponents(const NSDateComponents& components) const {
  icu::Calendar& moment = icuCalendar(*this);
  moment.clear();
  for (const Field& field : kFields) {
    const std::int64_t value = components.*field.component - field.first;
    moment.set(field.field,
               static_cast<std::int32_t>(std::clamp(value, -field.limit, field.limit)));
  }
  return momentOf(moment);
}

Ref<NSDate> NSCalendar::dateByAddingDays(const Ref<NSDate>& date, std::int64_t days) const {
  if (!date) {
    return nullptr;
  }
  icu::Calendar& moment = calendarAt(*this, *date);
  UErrorCode status = U_ZERO_ERROR;
  moment.add(UCAL_DATE,
             static_cast<std::int32_t>(std::clamp(days, -kLastAddedDays, kLastAddedDays)), status);
  requireSuccess(status, "adding days");
  return momentOf(moment);
}

Ref<NSCalendar> currentCalendar() { return make<NSCalendar>(); }

Ref<NSCalendar> calendarWithIdentifier(std::string_view identifier) {
  UErrorCode status = U_ZERO_ERROR;
  const std::unique_ptr<icu::StringEnumeration> known(
      icu::Calendar::getKeywordValuesForLocale("calendar", icu::Locale::getRoot(), false, status));
  requireSuccess(status, "listing the calendars");
  while (const char* const each = known->next(nullptr, status)) {
    if (identifier == each) {
      Ref<NSCalendar> calendar = make<NSCalendar>();
      calendar->identifier = identifier;
      return calendar;
    }
  }
  return nullptr;
}

namespace {

const Registered kCalendar = defineClass<NSCalendar, NSObject>();

}  // namespace
}  // namespace tavro
