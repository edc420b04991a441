#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <fstream>
#include <map>
#include <set>
#include <string>

#include "host/Diary.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/NSDate.h"

namespace tavro {
namespace {

#ifndef TAVRO_SAMPLE_DIARY
#define TAVRO_SAMPLE_DIARY "host/data/diary.json"
#endif

/// A file that lasts as long as the object does.
class TemporaryFile {
 public:
  explicit TemporaryFile(const std::string& text) { std::ofstream(path, std::ios::binary) << text; }
  ~TemporaryFile() { std::filesystem::remove(path); }
  TemporaryFile(const TemporaryFile&) = delete;
  TemporaryFile& operator=(const TemporaryFile&) = delete;

  const std::string path = testing::TempDir() + "diary-" +
                           testing::UnitTest::GetInstance()->current_test_info()->name() + ".json";
};

/// What reading the text complains of, without the name of the file; empty when it is content.
std::string complaintAbout(const std::string& text) {
  const TemporaryFile file(text);
  try {
    Diary::read(file.path);
  } catch (const FileError& error) {
    const std::string message = error.what();
    EXPECT_TRUE(message.starts_with(file.path + ": ")) << message;
    EXPECT_EQ(message.find('\n'), std::string::npos) << message;
    return message.substr(std::min(message.size(), file.path.size() + 2));
  }
  return "";
}

/// A whole diary, small enough to break anywhere.
constexpr std::string_view kSmallDiary = R"({
"person": {"firstName": "Robin", "wheelchair": "not set"},
"timeZone": "UTC",
"now": "2026-03-02T15:20",
"goals": {"move": 500, "exercise": 30, "stand": 12},
"days": [
{"date": "2026-02-28", "move": 400, "moveGoal": 500, "exercise": 20, "exerciseGoal": 30, "stand": 9, "standGoal": 12},
{"date": "2026-03-02", "move": 28, "moveGoal": 500, "exercise": null, "exerciseGoal": 30, "stand": 1, "standGoal": 12,
 "resting": 900.5, "timeZone": "Asia/Tokyo",
 "hours": {"move": [0,0,0,0,0,0,0,0,20,8,0,0,0,0,0,0,0,0,0,0,0,0,0,0],
           "exercise": [0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0],
           "stand": [false,false,false,false,false,false,false,false,true,false,false,false,false,false,false,false,false,false,false,false,false,false,false,false]}}],
"workouts": [
{"type": "cycling", "start": "2026-02-28T07:05", "duration": 600, "energy": 80, "source": {"name": "", "isWatch": false},
 "distance": 3000, "elevation": 12, "heartRate": [[0, 88], [300, 121.5]], "splits": [{"distance": 3000, "duration": 600}],
 "route": {"title": "Loop", "points": [[0, 0], [-40, 12.5]]},
 "weather": {"condition": "Clear", "temperature": "9 °C", "humidity": "50 %"}}],
"trends": [
{"type": 5, "title": "Flights", "direction": "down", "advice": "Climb.", "averages": {"average365": 9, "average90": 8},
 "bars": [{"start": "2026-01-01", "end": "2026-01-31", "value": 7}, {"start": "2026-02-01", "end": "2026-02-28", "value": null}],
 "weekdays": [{"average365": 1, "average90": null},{"average365": 2, "average90": 1},{"average365": 3, "average90": 1},
  {"average365": 4, "average90": 1},{"average365": 5, "average90": 1},{"average365": 6, "average90": 1},{"average365": 7, "average90": 1}]}],
"friends": [
{"name": "Ines", "move": 1, "moveGoal": 2, "exercise": 3, "exerciseGoal": 4, "stand": 5, "standGoal": 6,
 "competition": {"myScore": 7, "friendScore": 8, "daysRemaining": 3}}],
"inbox": [{"from": "Wren", "text": "Hello.", "unread": true}],
"achievements": [
{"id": "first", "title": "First", "wheelchairTitle": "First Roll", "section": "All", "earned": "2026-01-02", "progress": "Once\nonly"},
{"id": "second", "title": "Second", "section": "All", "earned": null, "progress": ""}]
})";

/// The small diary with one piece of text replaced.
std::string broken(std::string_view piece, std::string_view replacement) {
  std::string text(kSmallDiary);
  const std::size_t found = text.find(piece);
  EXPECT_NE(found, std::string::npos) << piece;
  return found == std::string::npos ? text : text.replace(found, piece.size(), replacement);
}

TEST(Diary, ReadsEveryMember) {
  const TemporaryFile file{std::string(kSmallDiary)};
  const Diary diary = Diary::read(file.path);

  EXPECT_EQ(diary.person.firstName, "Robin");
  EXPECT_EQ(diary.person.wheelchair, HKWheelchairUse::notSet);
  EXPECT_EQ(diary.timeZone, "UTC");
  EXPECT_EQ(diary.now.iso, "2026-03-02T15:20");
  EXPECT_EQ(diary.goals.exercise, 30);

  ASSERT_EQ(diary.days.size(), 2U);
  EXPECT_FALSE(diary.days[0].hours || diary.days[0].timeZone || diary.days[0].resting);
  const Day& today = diary.days[1];
  EXPECT_EQ(today.date.number, daysFromCivil(2026, 3, 2));
  EXPECT_EQ(today.move, 28);
  EXPECT_EQ(today.exercise, std::nullopt);
  EXPECT_EQ(today.standGoal, 12);
  EXPECT_EQ(today.resting, 900.5);
  EXPECT_EQ(today.timeZone, "Asia/Tokyo");
  ASSERT_TRUE(today.hours);
  EXPECT_EQ(today.hours->move[9], 8);
  EXPECT_TRUE(today.hours->stand[8]);

  ASSERT_EQ(diary.workouts.size(), 1U);
  const Workout& ride = diary.workouts[0];
  EXPECT_EQ(ride.type, HKWorkoutActivityType::cycling);
  EXPECT_EQ(ride.start.iso, "2026-02-28T07:05");
  EXPECT_EQ(ride.energy, 80);
  EXPECT_FALSE(ride.source.isWatch);
  EXPECT_EQ(ride.distance, 3000);
  EXPECT_EQ(ride.elevation, 12);
  EXPECT_EQ(ride.heartRate[1].beatsPerMinute, 121.5);
  EXPECT_EQ(ride.splits[0].duration, 600);
  EXPECT_EQ(ride.route->points[1].east, -40);
  EXPECT_EQ(ride.weather->humidity, "50 %");

  const Trend& trend = diary.trends.at(0);
  EXPECT_EQ(trend.direction, TrendDirection::down);
  EXPECT_EQ(trend.averages.average90, 8);
  EXPECT_EQ(trend.bars[1].end.number, daysFromCivil(2026, 2, 28));
  EXPECT_EQ(trend.bars[1].value, std::nullopt);
  EXPECT_EQ(trend.weekdays[6].average365, 7);

  const Friend& ines = diary.friends.at(0);
  EXPECT_EQ(ines.standGoal, 6);
  EXPECT_FALSE(ines.hasNews);
  EXPECT_EQ(ines.competition->friendScore, 8);
  EXPECT_TRUE(diary.inbox.at(0).unread);
  EXPECT_EQ(diary.achievements.at(0).wheelchairTitle, "First Roll");
  EXPECT_EQ(diary.achievements[0].earned->number, daysFromCivil(2026, 1, 2));
  EXPECT_EQ(diary.achievements[0].progress, "Once\nonly");
  EXPECT_EQ(diary.achievements[1].earned, std::nullopt);
}

TEST(Diary, LaterSectionsMayBeMissing) {
  std::string text(kSmallDiary.substr(0, kSmallDiary.find(",\n\"trends\"")));
  EXPECT_EQ(complaintAbout(text + "}"), "");
}

TEST(Diary, NamesPlaceAndReason) {
  const struct {
    const char* piece;
    const char* replacement;
    const char* complaint;
  } cases[] = {
      // Syntax
      {"\"timeZone\": \"UTC\",", "\"timeZone\" \"UTC\",", "line 3, column 16: "},
      {"\"now\"", "\"person\"", "the member \"person\" stands twice in one object"},
      {"\"duration\": 600", "\"duration\": 1e999", "number overflow parsing '1e999'"},
      // Members
      {"\"firstName\": \"Robin\", ", "", "person: the member \"firstName\" is missing"},
      {"\"stand\": 12}", "\"stnad\": 12}", "goals: unknown member \"stnad\""},
      {"\"exercise\": 20", "\"exercice\": 20", "days[0]: unknown member \"exercice\""},
      {"\"now\": \"2026-03-02T15:20\",", "", "top level: the member \"now\" is missing"},
      // Types
      {"\"exercise\": 20", "\"exercise\": \"20\"",
       "days[0].exercise: expected a number, found string"},
      {"\"moveGoal\": 500", "\"moveGoal\": null",
       "days[0].moveGoal: expected a number, found null"},
      {"{\"name\": \"\", \"isWatch\": false}", "{\"name\": 3, \"isWatch\": false}",
       "workouts[0].source.name: expected a text, found number"},
      {"\"isWatch\": false", "\"isWatch\": 0",
       "workouts[0].source.isWatch: expected true or false, found number"},
      {"{\"name\": \"\", \"isWatch\": false}", "[]",
       "workouts[0].source: expected an object, found array"},
      {"[{\"from\": \"Wren\", \"text\": \"Hello.\", \"unread\": true}]", "{}",
       "inbox: expected a list, found object"},
      {"\"daysRemaining\": 3", "\"daysRemaining\": 2.5",
       "friends[0].competition.daysRemaining: expected a whole number from 0, found number"},
      {"\"daysRemaining\": 3", "\"daysRemaining\": 18446744073709551615",
       "friends[0].competition.daysRemaining: the number is too large"},
      // Amounts
      {"\"exercise\": 20", "\"exercise\": -20", "days[0].exercise: the amount is negative"},
      {"[300, 121.5]", "[300, -1]", "workouts[0].heartRate[1][1]: the amount is negative"},
      // Counts
      {"[0,0,0,0,0,0,0,0,20,8,", "[0,0,0,0,0,0,0,0,20,",
       "days[1].hours.move: expected 24 values, found 23"},
      {"[300, 121.5]", "[300]", "workouts[0].heartRate[1]: expected 2 values, found 1"},
      {",{\"average365\": 7, \"average90\": 1}", "",
       "trends[0].weekdays: expected 7 values, found 6"},
      // Sums
      {"\"move\": 28", "\"move\": 40",
       "days[1].hours.move: the hours sum to 28.0, the day says 40.0"},
      {"\"stand\": 1,", "\"stand\": 2,",
       "days[1].hours.stand: the hours sum to 1.0, the day says 2.0"},
      {"\"move\": 28", "\"move\": null",
       "days[1].hours.move: the hours sum to 28.0, the day says null"},
      // Dates
      {"2026-02-28\", \"move", "2026-02-30\", \"move",
       "days[0].date: \"2026-02-30\" is no date like 2026-03-02"},
      {"2026-02-28\", \"move", "2026-02-28T10:00\", \"move",
       "days[0].date: \"2026-02-28T10:00\" is no date like 2026-03-02"},
      {"2026-02-28T07:05", "2026-02-28",
       "workouts[0].start: \"2026-02-28\" is no date and time like 2026-03-02T08:15"},
      {"2026-02-28T07:05", "2026-02-28T27:05",
       "workouts[0].start: \"2026-02-28T27:05\" is no date and time like 2026-03-02T08:15"},
      // Order
      {"2026-02-28\", \"move", "2026-03-02\", \"move",
       "days[1]: the entry does not lie after the one before it"},
      {"2026-03-02\", \"move", "2026-02-27\", \"move",
       "days[1]: the entry does not lie after the one before it"},
      {"2026-03-02\", \"move", "2026-03-03\", \"move", "days[1].date: the day lies after \"now\""},
      {"[[0, 88]", "[[300, 88]",
       "workouts[0].heartRate[1]: the entry does not lie after the one before it"},
      {"[300, 121.5]", "[601, 121.5]",
       "workouts[0].heartRate: a reading lies after the workout's end"},
      {"\"end\": \"2026-01-31\"", "\"end\": \"2025-12-31\"",
       "trends[0].bars[0].end: the bar ends before it starts"},
      {"\"id\": \"second\"", "\"id\": \"first\"", "achievements[1].id: the id stands there twice"},
      // Choices
      {"\"cycling\"", "\"cyling\"",
       "workouts[0].type: \"cyling\" is none of: cycling, hiking, running, swimming, walking, "
       "yoga"},
      {"\"not set\"", "\"unknown\"", "person.wheelchair: \"unknown\" is none of: not set, no, yes"},
      {"\"type\": 5", "\"type\": 9", "trends[0].type: there is no trend type 9"},
  };
  for (const auto& [piece, replacement, complaint] : cases) {
    SCOPED_TRACE(replacement);
    const std::string found = complaintAbout(broken(piece, replacement));
    EXPECT_TRUE(found.starts_with(complaint)) << found;
  }
}

TEST(Diary, FilesThatCannotBeRead) {
  EXPECT_THROW(Diary::read(testing::TempDir() + "no-such-diary.json"), FileError);
  EXPECT_THROW(Diary::read(testing::TempDir()), FileError);
  EXPECT_NE(complaintAbout(""), "");
  EXPECT_EQ(complaintAbout("[]"), "top level: expected an object, found array");
  EXPECT_NE(complaintAbout("{\"person\": \"\xff\"}"), "");
}

/// The day of a workout, by the clock where it was.
std::int64_t dayOf(const Workout& workout) {
  const double seconds = *secondsFromIso(workout.start.iso.substr(0, 10) + "T00:00Z");
  return static_cast<std::int64_t>(seconds / 86400);
}

/// The sample diary has to be one believable life.
class SampleDiary : public testing::Test {
 protected:
  static const Diary& diary() {
    static const Diary sample = Diary::read(TAVRO_SAMPLE_DIARY);
    return sample;
  }
  static const Day* dayNumbered(std::int64_t number) {
    for (const Day& day : diary().days) {
      if (day.date.number == number) {
        return &day;
      }
    }
    return nullptr;
  }
  static std::int64_t today() { return diary().days.back().date.number; }
};

TEST_F(SampleDiary, HasHoursForTheLastFortnight) {
  for (std::int64_t number = today() - 13; number <= today(); ++number) {
    const Day* const day = dayNumbered(number);
    EXPECT_TRUE(day == nullptr || day->hours) << "day " << number;
  }
  // The present day ends at the present moment.
  const std::size_t nextHour = std::stoul(diary().now.iso.substr(11, 2)) + 1;
  const Hours& hours = *diary().days.back().hours;
  for (std::size_t hour = nextHour; hour < 24; ++hour) {
    EXPECT_EQ(hours.move[hour] + hours.exercise[hour], 0) << "hour " << hour;
    EXPECT_FALSE(hours.stand[hour]) << "hour " << hour;
  }
}

TEST_F(SampleDiary, NoHourHoldsMoreThanAnHour) {
  for (const Day& day : diary().days) {
    EXPECT_LE(day.stand.value_or(0), 24);
    for (std::size_t hour = 0; day.hours && hour < 24; ++hour) {
      EXPECT_LE(day.hours->exercise[hour], 60) << "day " << day.date.number;
    }
  }
}

TEST_F(SampleDiary, ShowsEveryKindOfDay) {
  std::map<std::string, int> kinds;
  for (const Day& day : diary().days) {
    kinds["without data"] += !day.move && !day.exercise && !day.stand;
    kinds["partly without data"] += day.move && !day.exercise;
    kinds["goal missed"] += day.move && *day.move < day.moveGoal;
    kinds["over the goal"] += day.move && *day.move > day.moveGoal;
    kinds["all goals exactly"] +=
        day.move == day.moveGoal && day.exercise == day.exerciseGoal && day.stand == day.standGoal;
    kinds["elsewhere"] += day.timeZone.has_value();
  }
  kinds["absent"] = static_cast<int>(today() - diary().days.front().date.number + 1 -
                                     static_cast<std::int64_t>(diary().days.size()));
  for (const auto& [kind, count] : kinds) {
    EXPECT_GT(count, 0) << kind;
  }
  EXPECT_GE(today() - diary().days.front().date.number, 365);
}

TEST_F(SampleDiary, WorkoutsAgreeWithTheirDays) {
  std::set<HKWorkoutActivityType> types;
  for (const Workout& workout : diary().workouts) {
    SCOPED_TRACE(workout.start.iso);
    types.insert(workout.type);
    const Day* const day = dayNumbered(dayOf(workout));
    ASSERT_NE(day, nullptr);
    EXPECT_GE(day->move.value_or(0), workout.energy * 0.9);
    double distance = 0;
    double duration = 0;
    for (const Split& split : workout.splits) {
      distance += split.distance;
      duration += split.duration;
    }
    if (!workout.splits.empty()) {
      EXPECT_DOUBLE_EQ(distance, workout.distance.value_or(0));
      EXPECT_DOUBLE_EQ(duration, workout.duration);
    }
  }
  EXPECT_EQ(types.size(), 6U);
}

TEST_F(SampleDiary, TrendsAgreeWithTheDays) {
  ASSERT_EQ(diary().trends.size(), 9U);
  constexpr double kRounding = 0.51;
  const Trend& move = diary().trends[0];
  for (const TrendBar& bar : move.bars) {
    double sum = 0;
    int count = 0;
    for (const Day& day : diary().days) {
      if (day.date >= bar.start && day.date <= bar.end && day.move) {
        sum += *day.move;
        ++count;
      }
    }
    ASSERT_GT(count, 0);
    EXPECT_NEAR(*bar.value, sum / count, kRounding);
  }
}

}  // namespace
}  // namespace tavro
