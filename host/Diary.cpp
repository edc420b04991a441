#include "host/Diary.h"

#include <numeric>

#include "host/JsonReader.h"
#include "platform/foundation/NSDate.h"

namespace tavro {

// `fill` is found by its arguments from the reader's templates, so that these overloads stand in
// the namespace itself.

/// The day of a text like "2026-03-02". Read as a time of UTC, so that the settings' time zone
/// plays no part.
static std::optional<CalendarDay> calendarDay(const std::string& text) {
  constexpr double kSecondsPerDay = 86400;
  const std::optional<double> seconds = secondsFromIso(text + "T00:00Z");
  if (!seconds) {
    return std::nullopt;
  }
  return CalendarDay{static_cast<std::int64_t>(std::floor(*seconds / kSecondsPerDay))};
}

static void fill(const Place& place, CalendarDay& day) {
  std::string text;
  fill(place, text);
  const std::optional<CalendarDay> read = calendarDay(text);
  if (!read) {
    place.fail("\"" + text + "\" is no date like 2026-03-02");
  }
  day = *read;
}

static void fill(const Place& place, ClockTime& time) {
  fill(place, time.iso);
  const std::string utc = time.iso.ends_with('Z') ? time.iso : time.iso + "Z";
  if (utc.find('T') == std::string::npos || !secondsFromIso(utc)) {
    place.fail("\"" + time.iso + "\" is no date and time like 2026-03-02T08:15");
  }
}

constexpr Choice<HKWheelchairUse> kWheelchairUses[] = {
    {"not set", HKWheelchairUse::notSet},
    {"no", HKWheelchairUse::no},
    {"yes", HKWheelchairUse::yes},
};
constexpr Choice<HKWorkoutActivityType> kWorkoutTypes[] = {
    {"cycling", HKWorkoutActivityType::cycling}, {"hiking", HKWorkoutActivityType::hiking},
    {"running", HKWorkoutActivityType::running}, {"swimming", HKWorkoutActivityType::swimming},
    {"walking", HKWorkoutActivityType::walking}, {"yoga", HKWorkoutActivityType::yoga},
    {"other", HKWorkoutActivityType::other},
};
constexpr Choice<TrendDirection> kTrendDirections[] = {
    {"up", TrendDirection::up},
    {"steady", TrendDirection::steady},
    {"down", TrendDirection::down},
};

static void fill(const Place& place, HKWheelchairUse& use) { choose(place, use, kWheelchairUses); }
static void fill(const Place& place, HKWorkoutActivityType& type) {
  choose(place, type, kWorkoutTypes);
}
static void fill(const Place& place, TrendDirection& direction) {
  choose(place, direction, kTrendDirections);
}

static void fill(const Place& place, HeartRateReading& reading) {
  expectCount(place, 2);
  fill(place[0], reading.offset);
  fill(place[1], reading.beatsPerMinute);
}

static void fill(const Place& place, RoutePoint& point) {
  expectCount(place, 2);
  point = {coordinate(place[0]), coordinate(place[1])};
}

constexpr Member<Person> kPerson[] = {
    required<&Person::firstName>("firstName"),
    required<&Person::wheelchair>("wheelchair"),
};
static void fill(const Place& place, Person& person) { fillMembers(place, person, kPerson); }

constexpr Member<Goals> kGoals[] = {
    required<&Goals::move>("move"),
    required<&Goals::exercise>("exercise"),
    required<&Goals::stand>("stand"),
};
static void fill(const Place& place, Goals& goals) { fillMembers(place, goals, kGoals); }

constexpr Member<Hours> kHours[] = {
    required<&Hours::move>("move"),
    required<&Hours::exercise>("exercise"),
    required<&Hours::stand>("stand"),
};
static void fill(const Place& place, Hours& hours) { fillMembers(place, hours, kHours); }

constexpr Member<Day> kDay[] = {
    required<&Day::date>("date"),
    required<&Day::move>("move"),
    required<&Day::moveGoal>("moveGoal"),
    required<&Day::exercise>("exercise"),
    required<&Day::exerciseGoal>("exerciseGoal"),
    required<&Day::stand>("stand"),
    required<&Day::standGoal>("standGoal"),
    optional<&Day::resting>("resting"),
    optional<&Day::timeZone>("timeZone"),
    optional<&Day::hours>("hours"),
};
static void checkSum(const Place& place, double sum, const std::optional<double>& total) {
  constexpr double kRounding = 0.5;
  if (std::abs(sum - total.value_or(0)) > kRounding) {
    place.fail("the hours sum to " + numberText(sum) + ", the day says " +
               (total ? numberText(*total) : "null"));
  }
}
static double sumOf(const auto& hours) { return std::accumulate(hours.begin(), hours.end(), 0.0); }

static void fill(const Place& place, Day& day) {
  fillMembers(place, day, kDay);
  if (day.hours) {
    const Place hours = place["hours"];
    checkSum(hours["move"], sumOf(day.hours->move), day.move);
    checkSum(hours["exercise"], sumOf(day.hours->exercise), day.exercise);
    checkSum(hours["stand"], sumOf(day.hours->stand), day.stand);
  }
}

constexpr Member<WorkoutSource> kWorkoutSource[] = {
    required<&WorkoutSource::name>("name"),
    required<&WorkoutSource::isWatch>("isWatch"),
};
static void fill(const Place& place, WorkoutSource& source) {
  fillMembers(place, source, kWorkoutSource);
}

constexpr Member<Split> kSplit[] = {
    required<&Split::distance>("distance"),
    required<&Split::duration>("duration"),
};
static void fill(const Place& place, Split& split) { fillMembers(place, split, kSplit); }

constexpr Member<Route> kRoute[] = {
    required<&Route::title>("title"),
    required<&Route::points>("points"),
};
static void fill(const Place& place, Route& route) { fillMembers(place, route, kRoute); }

constexpr Member<Weather> kWeather[] = {
    required<&Weather::condition>("condition"),
    required<&Weather::temperature>("temperature"),
    required<&Weather::humidity>("humidity"),
};
static void fill(const Place& place, Weather& weather) { fillMembers(place, weather, kWeather); }

constexpr Member<Workout> kWorkout[] = {
    required<&Workout::type>("type"),           required<&Workout::start>("start"),
    required<&Workout::duration>("duration"),   required<&Workout::energy>("energy"),
    required<&Workout::source>("source"),       optional<&Workout::distance>("distance"),
    optional<&Workout::elevation>("elevation"), optional<&Workout::heartRate>("heartRate"),
    optional<&Workout::splits>("splits"),       optional<&Workout::route>("route"),
    optional<&Workout::weather>("weather"),
};
static void fill(const Place& place, Workout& workout) {
  fillMembers(place, workout, kWorkout);
  expectAscending(place, "heartRate", workout.heartRate, &HeartRateReading::offset);
  if (!workout.heartRate.empty() && workout.heartRate.back().offset > workout.duration) {
    place["heartRate"].fail("a reading lies after the workout's end");
  }
}

constexpr Member<TrendBar> kTrendBar[] = {
    required<&TrendBar::start>("start"),
    required<&TrendBar::end>("end"),
    required<&TrendBar::value>("value"),
};
static void fill(const Place& place, TrendBar& bar) {
  fillMembers(place, bar, kTrendBar);
  if (bar.end < bar.start) {
    place["end"].fail("the bar ends before it starts");
  }
}

constexpr Member<TrendAverages> kTrendAverages[] = {
    required<&TrendAverages::average365>("average365"),
    required<&TrendAverages::average90>("average90"),
};
static void fill(const Place& place, TrendAverages& averages) {
  fillMembers(place, averages, kTrendAverages);
}

constexpr Member<Trend> kTrend[] = {
    required<&Trend::type>("type"),           required<&Trend::title>("title"),
    required<&Trend::direction>("direction"), optional<&Trend::advice>("advice"),
    required<&Trend::averages>("averages"),   required<&Trend::bars>("bars"),
    required<&Trend::weekdays>("weekdays"),
};
static void fill(const Place& place, Trend& trend) {
  constexpr std::int64_t kLastType = 8;
  fillMembers(place, trend, kTrend);
  if (trend.type > kLastType) {
    place["type"].fail("there is no trend type " + std::to_string(trend.type));
  }
  expectAscending(place, "bars", trend.bars, &TrendBar::start);
}

constexpr Member<Competition> kCompetition[] = {
    required<&Competition::myScore>("myScore"),
    required<&Competition::friendScore>("friendScore"),
    required<&Competition::daysRemaining>("daysRemaining"),
};
static void fill(const Place& place, Competition& competition) {
  fillMembers(place, competition, kCompetition);
}

constexpr Member<Friend> kFriend[] = {
    required<&Friend::name>("name"),
    optional<&Friend::hasNews>("hasNews"),
    required<&Friend::move>("move"),
    required<&Friend::moveGoal>("moveGoal"),
    required<&Friend::exercise>("exercise"),
    required<&Friend::exerciseGoal>("exerciseGoal"),
    required<&Friend::stand>("stand"),
    required<&Friend::standGoal>("standGoal"),
    optional<&Friend::competition>("competition"),
};
static void fill(const Place& place, Friend& person) { fillMembers(place, person, kFriend); }

constexpr Member<InboxMessage> kInboxMessage[] = {
    required<&InboxMessage::from>("from"),
    required<&InboxMessage::text>("text"),
    optional<&InboxMessage::unread>("unread"),
};
static void fill(const Place& place, InboxMessage& message) {
  fillMembers(place, message, kInboxMessage);
}

constexpr Member<Achievement> kAchievement[] = {
    required<&Achievement::id>("id"),
    required<&Achievement::title>("title"),
    optional<&Achievement::wheelchairTitle>("wheelchairTitle"),
    required<&Achievement::section>("section"),
    required<&Achievement::earned>("earned"),
    required<&Achievement::progress>("progress"),
};
static void fill(const Place& place, Achievement& achievement) {
  fillMembers(place, achievement, kAchievement);
}

constexpr Member<Diary> kDiary[] = {
    required<&Diary::person>("person"), required<&Diary::timeZone>("timeZone"),
    required<&Diary::now>("now"),       required<&Diary::goals>("goals"),
    required<&Diary::days>("days"),     required<&Diary::workouts>("workouts"),
    optional<&Diary::trends>("trends"), optional<&Diary::friends>("friends"),
    optional<&Diary::inbox>("inbox"),   optional<&Diary::achievements>("achievements"),
};
static void fill(const Place& place, Diary& diary) {
  fillMembers(place, diary, kDiary);
  expectAscending(place, "days", diary.days, &Day::date);
  const std::optional<CalendarDay> today =
      calendarDay(diary.now.iso.substr(0, diary.now.iso.find('T')));
  if (!diary.days.empty() && diary.days.back().date > today) {
    place["days"][diary.days.size() - 1]["date"].fail("the day lies after \"now\"");
  }
  expectUnique(place, "trends", diary.trends, &Trend::type, "type");
  expectUnique(place, "achievements", diary.achievements, &Achievement::id, "id");
}

Diary Diary::read(const std::string& path) {
  const Json json = readJson(path);
  Diary diary;
  fill(Place(json, path), diary);
  return diary;
}

}  // namespace tavro
