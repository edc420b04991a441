#include <gtest/gtest.h>

#include <algorithm>
#include <string>

#include "host/Diary.h"
#include "platform/foundation/NSDate.h"
#include "tests/support/Cases.h"

namespace tavro {
namespace {

const std::string kSmallDiary = TAVRO_SOURCE "/tests/data/small_diary.json";

/// What reading the text complains of, without the name of the file; empty when it is content.
std::string complaintOf(const std::string& text) {
  return complaintAbout(text, [](const std::string& path) { Diary::read(path); });
}

/// The small diary with one piece of text replaced.
std::string broken(const std::string& piece, const std::string& replacement) {
  std::string text = contentOf(kSmallDiary);
  const std::size_t found = text.find(piece);
  EXPECT_NE(found, std::string::npos) << piece;
  return found == std::string::npos ? text : text.replace(found, piece.size(), replacement);
}

TEST(Diary, ReadsWhatMayBeAbsentAsAbsent) {
  const Diary diary = Diary::read(kSmallDiary);
  EXPECT_EQ(diary.person.wheelchair, HKWheelchairUse::notSet);
  EXPECT_FALSE(diary.days[0].hours || diary.days[0].timeZone || diary.days[0].resting);
  const Day& today = diary.days.at(1);
  EXPECT_EQ(today.date.number, daysFromCivil(2026, 3, 2));
  EXPECT_EQ(today.exercise, std::nullopt);
  EXPECT_EQ(today.resting, 900.5);
  EXPECT_EQ(today.timeZone, "Asia/Tokyo");
  ASSERT_TRUE(today.hours);
  EXPECT_EQ(today.hours->move[9], 8);
  EXPECT_TRUE(today.hours->stand[8]);
  const Workout& ride = diary.workouts.at(0);
  EXPECT_EQ(ride.heartRate.at(1).beatsPerMinute, 121.5);
  EXPECT_EQ(ride.route->points.at(1).east, -40);
  const Trend& trend = diary.trends.at(0);
  EXPECT_EQ(trend.direction, TrendDirection::down);
  EXPECT_EQ(trend.bars.at(1).value, std::nullopt);
  EXPECT_EQ(trend.weekdays[6].average365, 7);
  EXPECT_FALSE(diary.friends.at(0).hasNews);
  EXPECT_EQ(diary.achievements.at(0).progress, "Once\nonly");
  EXPECT_EQ(diary.achievements.at(1).earned, std::nullopt);
}

TEST(Diary, LaterSectionsMayBeMissing) {
  const std::string text = contentOf(kSmallDiary);
  EXPECT_EQ(complaintOf(text.substr(0, text.find(",\n\"trends\"")) + "}"), "");
}

TEST(Diary, NamesPlaceAndReason) {
  for (const auto& [piece, replacement, complaint] : casesOf<3>("broken_diaries.txt")) {
    SCOPED_TRACE(replacement);
    const std::string found = complaintOf(broken(piece, replacement));
    EXPECT_TRUE(found.starts_with(complaint)) << found;
  }
}

TEST(Diary, FilesThatCannotBeRead) {
  EXPECT_THROW(Diary::read(testing::TempDir() + "no-such-diary.json"), FileError);
  EXPECT_THROW(Diary::read(testing::TempDir()), FileError);
  EXPECT_NE(complaintOf(""), "");
  EXPECT_EQ(complaintOf("[]"), "top level: expected an object, found array");
  EXPECT_NE(complaintOf("{\"person\": \"\xff\"}"), "");
}

/// The day of a workout, by the clock where it was.
std::int64_t dayOf(const Workout& workout) {
  const double seconds = *secondsFromIso(workout.start.iso.substr(0, 10) + "T00:00Z");
  return static_cast<std::int64_t>(seconds / 86400);
}

/// The sample diary has to be one believable life.
const Diary& sample() {
  static const Diary diary = Diary::read(TAVRO_SAMPLE_DIARY);
  return diary;
}

TEST(SampleDiary, WorkoutsAgreeWithTheirDays) {
  for (const Workout& workout : sample().workouts) {
    SCOPED_TRACE(workout.start.iso);
    const auto day = std::ranges::find(sample().days, dayOf(workout),
                                       [](const Day& each) { return each.date.number; });
    ASSERT_NE(day, sample().days.end());
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
}

TEST(SampleDiary, TrendsAgreeWithTheDays) {
  constexpr double kRounding = 0.51;
  for (const TrendBar& bar : sample().trends.at(0).bars) {
    double sum = 0;
    int count = 0;
    for (const Day& day : sample().days) {
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
