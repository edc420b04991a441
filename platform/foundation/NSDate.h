#pragma once

#include <optional>
#include <string>

#include "platform/foundation/NSString.h"

namespace tavro {

/// A moment. Message: `description` ("2026-03-02 08:15:30 +0000", whatever the settings).
class NSDate : public NSObject {
 public:
  static constexpr Name className = "NSDate";

  /// Seconds since 1970-01-01 00:00 UTC.
  double seconds = 0;
};

/// The moment `seconds` after 1970-01-01 00:00 UTC.
Ref<NSDate> dateWithSeconds(double seconds);
/// The settings' present moment.
Ref<NSDate> dateNow();
/// nil for a nil date.
Ref<NSDate> dateByAddingTimeInterval(const Ref<NSDate>& date, double seconds);

/// A span between two moments; both ends belong to it. Messages: `startDate`, `endDate`,
/// `duration` ("d", seconds).
class NSDateInterval : public NSObject {
 public:
  static constexpr Name className = "NSDateInterval";

  Ref<NSDate> startDate;
  Ref<NSDate> endDate;

  [[nodiscard]] double duration() const;
  [[nodiscard]] bool containsDate(const Ref<NSDate>& date) const;
};

/// Raises when a date is nil or the end lies before the start.
Ref<NSDateInterval> dateInterval(const Ref<NSDate>& start, const Ref<NSDate>& end);

/// What a calendar tells of a moment. Weekday: 1 is Sunday ... 7 is Saturday. Months count from 1
/// as ICU counts them: the Hebrew leap month has its number in every year. Messages: each component
/// by its name ("q").
class NSDateComponents : public NSObject {
 public:
  static constexpr Name className = "NSDateComponents";

  std::int64_t era = 0;
  std::int64_t year = 0;
  std::int64_t month = 0;
  std::int64_t day = 0;
  std::int64_t hour = 0;
  std::int64_t minute = 0;
  std::int64_t second = 0;
  std::int64_t weekday = 0;
};

inline constexpr std::string_view NSCalendarIdentifierGregorian = "gregorian";

/// A calendar in the settings' time zone, or in one of its own. The one with the identifier
/// "gregorian" is proleptic; the user's follows ICU, Julian days before 1582 included.
class NSCalendar : public NSObject {
 public:
  static constexpr Name className = "NSCalendar";

  /// Empty for the settings' calendar.
  std::string identifier;
  /// Empty for the settings' time zone.
  std::string timeZone;

  /// All components of the date; nil for nil.
  [[nodiscard]] Ref<NSDateComponents> componentsFromDate(const Ref<NSDate>& date) const;
  /// The first moment of the date's day; nil for nil.
  [[nodiscard]] Ref<NSDate> startOfDayForDate(const Ref<NSDate>& date) const;
  /// The moment that the era, year, month, day and time name; out-of-range parts carry over. A
  /// time that the clocks skip names the next moment that exists, one that they repeat the first.
  [[nodiscard]] Ref<NSDate> dateFromComponents(const NSDateComponents& components) const;
  /// The same time of day that many calendar days later, where it exists; nil for nil.
  [[nodiscard]] Ref<NSDate> dateByAddingDays(const Ref<NSDate>& date, std::int64_t days) const;
};

/// The user's calendar.
Ref<NSCalendar> currentCalendar();
/// nil when ICU knows no calendar of that name.
Ref<NSCalendar> calendarWithIdentifier(std::string_view identifier);

/// Days from 1970-01-01 to a day of the proleptic Gregorian calendar.
std::int64_t daysFromCivil(std::int64_t year, std::int64_t month, std::int64_t day);
/// Reads "2026-03-02", "2026-03-02T08:15" or "2026-03-02T08:15:30" as local time of the settings'
/// time zone; with "Z" at the end as UTC. Nothing when the text is no such date.
std::optional<double> secondsFromIso(std::string_view text);

}  // namespace tavro
