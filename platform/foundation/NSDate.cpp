#include "platform/foundation/NSDate.h"

#include <algorithm>
#include <array>
#include <cstdio>

#include "platform/foundation/Settings.h"

namespace tavro {

Ref<NSDate> dateWithSeconds(double seconds) {
  Ref<NSDate> date = make<NSDate>();
  date->seconds = seconds;
  return date;
}

Ref<NSDate> dateNow() { return dateWithSeconds(Settings::current().now); }

Ref<NSDate> dateByAddingTimeInterval(const Ref<NSDate>& date, double seconds) {
  return date ? dateWithSeconds(date->seconds + seconds) : nullptr;
}

double NSDateInterval::duration() const {
  return startDate && endDate ? endDate->seconds - startDate->seconds : 0;
}

bool NSDateInterval::containsDate(const Ref<NSDate>& date) const {
  return date && startDate && endDate && date->seconds >= startDate->seconds &&
         date->seconds <= endDate->seconds;
}

Ref<NSDateInterval> dateInterval(const Ref<NSDate>& start, const Ref<NSDate>& end) {
  // Written so that what is not a number is refused too.
  if (!start || !end || !(start->seconds <= end->seconds)) {
    raise(kInvalidArgumentException, "a date interval needs a start and an end that follows it");
  }
  Ref<NSDateInterval> interval = make<NSDateInterval>();
  interval->startDate = start;
  interval->endDate = end;
  return interval;
}

std::int64_t daysFromCivil(std::int64_t year, std::int64_t month, std::int64_t day) {
  // Years begin in March here, so that the leap day is a year's last; an era is 400 years.
  year -= month <= 2 ? 1 : 0;
  const std::int64_t era = (year >= 0 ? year : year - 399) / 400;
  const std::int64_t yearOfEra = year - era * 400;
  const std::int64_t dayOfYear = (153 * (month > 2 ? month - 3 : month + 9) + 2) / 5 + day - 1;
  const std::int64_t dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
  constexpr std::int64_t kDaysOfEra = 146097;
  constexpr std::int64_t kDaysBefore1970 = 719468;
  return era * kDaysOfEra + dayOfEra - kDaysBefore1970;
}

namespace {

constexpr std::string_view kIsoForm = "dddd-dd-ddTdd:dd:dd";
constexpr std::size_t kIsoLengths[] = {10, 16, 19};  // a day; to the minute; to the second

/// The numbers of an ISO text in their order; nothing when it has another form.
std::optional<std::array<std::int64_t, 6>> isoNumbers(std::string_view text) {
  if (std::ranges::find(kIsoLengths, text.size()) == std::end(kIsoLengths)) {
    return std::nullopt;
  }
  std::array<std::int64_t, 6> numbers{};
  std::size_t current = 0;
  for (std::size_t index = 0; index < text.size(); ++index) {
    const bool isDigit = text[index] >= '0' && text[index] <= '9';
    const bool wantsDigit = kIsoForm[index] == 'd';
    if (isDigit != wantsDigit || (!isDigit && text[index] != kIsoForm[index])) {
      return std::nullopt;
    }
    if (isDigit) {
      numbers[current] = numbers[current] * 10 + (text[index] - '0');
    } else {
      ++current;
    }
  }
  return numbers;
}

bool isDateAndTime(const std::array<std::int64_t, 6>& numbers) {
  const auto [year, month, day, hour, minute, second] = numbers;
  if (month < 1 || month > 12 || day < 1 || hour > 23 || minute > 59 || second > 59) {
    return false;
  }
  const std::int64_t nextMonth =
      month == 12 ? daysFromCivil(year + 1, 1, 1) : daysFromCivil(year, month + 1, 1);
  return day <= nextMonth - daysFromCivil(year, month, 1);
}

}  // namespace

std::optional<double> secondsFromIso(std::string_view text) {
  const bool isUtc = text.ends_with('Z');
  text.remove_suffix(isUtc ? 1 : 0);
  const auto numbers = isoNumbers(text);
  if (!numbers || !isDateAndTime(*numbers)) {
    return std::nullopt;
  }
  const auto [year, month, day, hour, minute, second] = *numbers;
  if (isUtc) {
    return static_cast<double>(daysFromCivil(year, month, day) * 86400 + hour * 3600 + minute * 60 +
                               second);
  }
  const Ref<NSDateComponents> components = make<NSDateComponents>();
  components->era = 1;
  components->year = year;
  components->month = month;
  components->day = day;
  components->hour = hour;
  components->minute = minute;
  components->second = second;
  return calendarWithIdentifier(NSCalendarIdentifierGregorian)
      ->dateFromComponents(*components)
      ->seconds;
}

namespace {

Ref<NSString> description(NSDate* self) {
  const Ref<NSCalendar> calendar = calendarWithIdentifier(NSCalendarIdentifierGregorian);
  calendar->timeZone = "UTC";
  const Ref<NSDateComponents> parts = calendar->componentsFromDate(self);
  std::array<char, 64> text{};
  const auto number = [](std::int64_t part) { return static_cast<int>(part); };
  const int length =
      std::snprintf(text.data(), text.size(), "%04d-%02d-%02d %02d:%02d:%02d +0000",
                    number(parts->year), number(parts->month), number(parts->day),
                    number(parts->hour), number(parts->minute), number(parts->second));
  return string(std::string_view(text.data(), static_cast<std::size_t>(length)));
}

template <auto Component>
std::int64_t component(NSDateComponents* self) {
  return self->*Component;
}

Ref<NSDate> startDate(NSDateInterval* self) { return self->startDate; }
Ref<NSDate> endDate(NSDateInterval* self) { return self->endDate; }

const Registered kDate = defineClass<NSDate, NSObject>().method<&description>("description");
const Registered kDateInterval = defineClass<NSDateInterval, NSObject>()
                                     .method<&startDate>("startDate")
                                     .method<&endDate>("endDate")
                                     .method<&NSDateInterval::duration>("duration");
const Registered kDateComponents = defineClass<NSDateComponents, NSObject>()
                                       .method<&component<&NSDateComponents::era>>("era")
                                       .method<&component<&NSDateComponents::year>>("year")
                                       .method<&component<&NSDateComponents::month>>("month")
                                       .method<&component<&NSDateComponents::day>>("day")
                                       .method<&component<&NSDateComponents::hour>>("hour")
                                       .method<&component<&NSDateComponents::minute>>("minute")
                                       .method<&component<&NSDateComponents::second>>("second")
                                       .method<&component<&NSDateComponents::weekday>>("weekday");

}  // namespace
}  // namespace tavro
