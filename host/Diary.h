#pragma once

#include <array>
#include <compare>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "platform/healthkit/HKTypes.h"

namespace tavro {

// Plain data: everything that the application ever shows, as docs/diary.md describes it. Energies
// are kilocalories, distances metres, durations seconds unless a comment says otherwise; no amount
// is negative or not finite. An amount that was not recorded is nothing, which is not 0.

/// A day of the Gregorian calendar, independent of any time zone.
struct CalendarDay {
  /// Days since 1970-01-01, which is also the day's index in the activity summary cache.
  std::int64_t number = 0;
  // NOLINTNEXTLINE(modernize-use-nullptr): the check takes the 0 of the comparison for a pointer
  friend auto operator<=>(const CalendarDay&, const CalendarDay&) = default;
};

/// What the clock on the wall said, as a checked text for `secondsFromIso`. It becomes a moment
/// only when it is used, because it belongs to the time zone that the settings hold by then.
struct ClockTime {
  std::string iso;
};

struct Person {
  std::string firstName;
  HKWheelchairUse wheelchair = HKWheelchairUse::notSet;
};

/// The goals that the goal setup starts from.
struct Goals {
  double move = 0;      ///< kilocalories
  double exercise = 0;  ///< minutes
  double stand = 0;     ///< hours
};

/// A day's three rings.
struct Rings {
  std::optional<double> move;  ///< kilocalories
  double moveGoal = 0;
  std::optional<double> exercise;  ///< minutes
  double exerciseGoal = 0;
  std::optional<double> stand;  ///< hours
  double standGoal = 0;
};

/// A day hour by hour, from midnight to midnight of the clock where the person was. Hours after
/// the present moment hold 0.
struct Hours {
  std::array<double, 24> move{};      ///< kilocalories
  std::array<double, 24> exercise{};  ///< minutes
  std::array<bool, 24> stand{};       ///< whether the hour counts as a stand hour
};

struct Day : Rings {
  CalendarDay date;
  /// The energy that the body used at rest.
  std::optional<double> resting;
  /// The IANA time zone where the person was, when it is not the diary's.
  std::optional<std::string> timeZone;
  /// Agrees with the totals.
  std::optional<Hours> hours;
};

struct WorkoutSource {
  std::string name;  ///< may be empty
  bool isWatch = false;
};

struct HeartRateReading {
  double offset = 0;  ///< seconds after the workout's start
  double beatsPerMinute = 0;
};

struct Split {
  double distance = 0;
  double duration = 0;
};

/// Metres from where the route begins.
struct RoutePoint {
  double east = 0;
  double north = 0;
};

struct Route {
  std::string title;
  std::vector<RoutePoint> points;
};

/// Texts, as they are shown.
struct Weather {
  std::string condition;
  std::string temperature;
  std::string humidity;
};

struct Workout {
  HKWorkoutActivityType type = HKWorkoutActivityType::walking;
  ClockTime start;
  double duration = 0;
  double energy = 0;
  WorkoutSource source;
  std::optional<double> distance;
  std::optional<double> elevation;          ///< metres climbed
  std::vector<HeartRateReading> heartRate;  ///< in the order of time
  std::vector<Split> splits;
  std::optional<Route> route;
  std::optional<Weather> weather;
  /// Read from an activity file of its own, not from the diary's.
  bool isImported = false;
};

enum class TrendDirection { up, steady, down };

struct TrendBar {
  CalendarDay start;
  CalendarDay end;  ///< the last day that the bar stands for
  std::optional<double> value;
};

struct TrendAverages {
  std::optional<double> average365;
  std::optional<double> average90;
};

/// One metric over a year. All values are in the unit that belongs to the type.
struct Trend {
  /// 0 move (kcal), 1 exercise (min), 2 stand (count), 3 distance (m), 4 steps (count), 5 flights
  /// (count), 6 cardio fitness (mL/kg·min), 7 walking speed (km/hr), 8 running speed (km/hr).
  std::int64_t type = 0;
  std::string title;
  TrendDirection direction = TrendDirection::steady;
  /// What to do about a trend that goes down; empty for the others.
  std::string advice;
  TrendAverages averages;
  std::vector<TrendBar> bars;             ///< in the order of time
  std::array<TrendAverages, 7> weekdays;  ///< Sunday first
};

struct Competition {
  double myScore = 0;
  double friendScore = 0;
  std::int64_t daysRemaining = 0;
};

/// A friend's rings of today.
struct Friend : Rings {
  std::string name;
  /// Shown as a bullet in front of the name.
  bool hasNews = false;
  std::optional<Competition> competition;
};

struct InboxMessage {
  std::string from;
  std::string text;
  bool unread = false;
};

struct Achievement {
  std::string id;
  /// "{name}" in it stands for the person's first name.
  std::string title;
  /// The title for a wheelchair user, where it differs.
  std::optional<std::string> wheelchairTitle;
  std::string section;
  std::optional<CalendarDay> earned;
  /// May have several lines.
  std::string progress;
};

struct Diary {
  Person person;
  std::string timeZone;  ///< an IANA name
  ClockTime now;         ///< the moment at which the application is opened
  Goals goals;
  std::vector<Day> days;  ///< in the order of time, none twice, none after now; days may be missing
  std::vector<Workout> workouts;  ///< in any order
  std::vector<Trend> trends;      ///< no type twice
  std::vector<Friend> friends;
  std::vector<InboxMessage> inbox;
  std::vector<Achievement> achievements;  ///< no id twice

  /// Reads and checks a file. Throws a `FileError` whose one sentence names the file, the place in
  /// it ("days[12].exercise", or line and column where it is not JSON) and the reason.
  static Diary read(const std::string& path);
};

}  // namespace tavro
