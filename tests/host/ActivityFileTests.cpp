#include <gtest/gtest.h>

#include <tuple>

#include "host/ActivityFile.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "tests/support/Cases.h"

namespace tavro {
namespace {

Workout readSample(const std::string& name) {
  return readActivityFile(TAVRO_SOURCE "/tests/data/" + name);
}

Workout readText(const std::string& text) {
  const TemporaryFolder folder;
  return readActivityFile(folder.file("activity", text));
}

/// A track of GPX, its points from the second line on.
std::string gpx(const std::string& points) {
  return "<gpx><trk><trkseg>\n" + points + "</trkseg></trk></gpx>";
}
std::string gpxPoint(const std::string& time, const std::string& rest = "",
                     const std::string& position = "lat='1' lon='2'") {
  return "<trkpt " + position + "><time>" + time + "</time>" + rest + "</trkpt>\n";
}
/// A lap of TCX, its points from the second line on.
std::string tcx(const std::string& points, const std::string& activity = "<Activity>") {
  return "<TrainingCenterDatabase><Activities>" + activity + "<Lap><Track>\n" + points +
         "</Track></Lap></Activity></Activities></TrainingCenterDatabase>";
}
std::string tcxPoint(const std::string& time, const std::string& rest = "") {
  return "<Trackpoint><Time>" + time + "</Time>" + rest + "</Trackpoint>\n";
}
std::string meters(const std::string& distance) {
  return "<DistanceMeters>" + distance + "</DistanceMeters>";
}

constexpr const char* kSix = "2026-03-11T06:00:00Z";
constexpr const char* kTenPastSix = "2026-03-11T06:10:00Z";

TEST(ActivityFile, ReadsATrack) {
  const Workout run = readSample("loop.gpx");
  EXPECT_TRUE(run.isImported);
  EXPECT_EQ(run.type, HKWorkoutActivityType::running);
  EXPECT_EQ(run.start.iso, "2026-03-11T06:00:00Z");
  EXPECT_DOUBLE_EQ(run.duration, 1200);
  EXPECT_EQ(run.source.name, "Trail Log");
  EXPECT_FALSE(run.source.isWatch);
  EXPECT_EQ(run.energy, 0);

  // A thousandth of a degree is 111.195 m; between the segments nothing is known.
  ASSERT_TRUE(run.distance);
  EXPECT_NEAR(*run.distance, 27 * 111.195, 0.1);
  ASSERT_EQ(run.splits.size(), 4U);
  EXPECT_DOUBLE_EQ(run.splits[0].distance, 1000);
  EXPECT_NEAR(run.splits[0].duration, 300.5 * 1000 / 1000.755, 0.1);
  EXPECT_NEAR(run.splits[3].distance, 2.27, 0.05);

  ASSERT_EQ(run.heartRate.size(), 3U) << "0 is no reading";
  EXPECT_EQ(run.heartRate[1].offset, 300.5);
  EXPECT_EQ(run.heartRate[1].beatsPerMinute, 120);
  EXPECT_EQ(run.heartRate[2].offset, 1200);
  EXPECT_EQ(run.heartRate[2].beatsPerMinute, 131.5);

  ASSERT_TRUE(run.route);
  EXPECT_EQ(run.route->title, "Lake loop");
  ASSERT_EQ(run.route->points.size(), 5U);
  EXPECT_EQ(run.route->points[0].east, 0);
  EXPECT_NEAR(run.route->points[4].east, 2001.5, 0.1);
  EXPECT_NEAR(run.route->points[4].north, 2001.5, 0.1);
}

TEST(ActivityFile, ReadsLaps) {
  const Workout ride = readSample("laps.tcx");
  EXPECT_EQ(ride.type, HKWorkoutActivityType::cycling);
  EXPECT_EQ(ride.start.iso, "2026-03-10T17:00:00Z");
  EXPECT_EQ(ride.duration, 500);
  EXPECT_EQ(ride.energy, 52.5);
  EXPECT_EQ(ride.source.name, "Pedal Notes");
  EXPECT_EQ(ride.distance, 2500);
  const double expected[][2] = {{1000, 200}, {1000, 200}, {500, 100}};
  ASSERT_EQ(ride.splits.size(), 3U);
  for (std::size_t index = 0; index < 3; ++index) {
    EXPECT_DOUBLE_EQ(ride.splits[index].distance, expected[index][0]);
    EXPECT_DOUBLE_EQ(ride.splits[index].duration, expected[index][1]);
  }
  ASSERT_EQ(ride.heartRate.size(), 2U) << "two laps share a moment";
  EXPECT_EQ(ride.heartRate[1].beatsPerMinute, 140);
  EXPECT_FALSE(ride.route);
}

TEST(ActivityFile, PrefixesPlayNoPart) {
  const std::string text =
      "<g:gpx xmlns:g='urn:a' c:creator='Log' xmlns:c='urn:c'><g:trk><g:type>Hike</g:type>"
      "<g:trkseg><g:trkpt lat='1' lon='2'><g:time>2026-03-11T06:00:00Z</g:time><g:extensions>"
      "<q:x xmlns:q='urn:q'><deep:hr xmlns:deep='urn:d'>77</deep:hr></q:x></g:extensions>"
      "</g:trkpt></g:trkseg></g:trk></g:gpx>";
  const Workout workout = readText(text);
  EXPECT_EQ(workout.type, HKWorkoutActivityType::hiking);
  EXPECT_EQ(workout.source.name, "Log");
  ASSERT_EQ(workout.heartRate.size(), 1U);
  EXPECT_EQ(workout.heartRate[0].beatsPerMinute, 77);
}

TEST(ActivityFile, NamesOfActivities) {
  const std::pair<const char*, HKWorkoutActivityType> cases[] = {
      {"Running", HKWorkoutActivityType::running}, {"Biking", HKWorkoutActivityType::cycling},
      {"WALKING", HKWorkoutActivityType::walking}, {"swim", HKWorkoutActivityType::swimming},
      {"Other", HKWorkoutActivityType::other},     {"", HKWorkoutActivityType::other},
      {"Runningly", HKWorkoutActivityType::other},
  };
  for (const auto& [name, type] : cases) {
    const std::string activity = "<Activity Sport='" + std::string(name) + "'>";
    EXPECT_EQ(readText(tcx(tcxPoint(kSix), activity)).type, type) << name;
  }
}

TEST(ActivityFile, TimesAreReadToTheMoment) {
  const std::tuple<const char*, const char*, double> cases[] = {
      {"2026-03-11T06:00:00Z", "2026-03-11T06:00:00Z", 600},
      {" 2026-03-11T06:00:00.250Z\n", "2026-03-11T06:00:00Z", 599.75},
      {"2026-03-11T06:00:00.", "2026-03-11T06:00:00Z", 600},
      {"2026-03-11T06:00:00", "2026-03-11T06:00:00Z", 600},
      {"2026-03-11T01:00:00+02:30", "2026-03-10T22:30:00Z", 7.0 * 3600 + 40 * 60},
      {"2026-03-10T23:00:00.5-07:00", "2026-03-11T06:00:00Z", 599.5},
  };
  for (const auto& [time, iso, later] : cases) {
    const Workout workout = readText(tcx(tcxPoint(time) + tcxPoint(kTenPastSix)));
    EXPECT_EQ(workout.start.iso, iso) << time;
    EXPECT_DOUBLE_EQ(workout.duration, later) << time;
  }
}

TEST(ActivityFile, TheFilesOwnDistanceCountsUnlessItFalls) {
  const std::string west =
      "<Position><LatitudeDegrees>0</LatitudeDegrees>"
      "<LongitudeDegrees>179.9955</LongitudeDegrees></Position>";
  const std::string east =
      "<Position><LatitudeDegrees>0</LatitudeDegrees>"
      "<LongitudeDegrees>-179.9955</LongitudeDegrees></Position>";
  const Workout own = readText(tcx(tcxPoint(kSix, west + meters("2")) + tcxPoint(kSix) +
                                   tcxPoint(kTenPastSix, east + meters("900"))));
  EXPECT_EQ(own.distance, 900);
  ASSERT_EQ(own.splits.size(), 1U);
  EXPECT_EQ(own.splits[0].duration, 600);
  // Across the date line, the short way.
  const Workout fallen =
      readText(tcx(tcxPoint(kSix, west + meters("5")) + tcxPoint(kTenPastSix, east + meters("4"))));
  EXPECT_NEAR(*fallen.distance, 1000.75, 0.1);
  EXPECT_NEAR(fallen.route->points[1].east, 1000.75, 0.1);
  ASSERT_EQ(fallen.splits.size(), 1U) << "less than a metre is no split of its own";
  EXPECT_NEAR(fallen.splits[0].distance, 1000.75, 0.1);
  EXPECT_DOUBLE_EQ(fallen.splits[0].duration, 600);
  EXPECT_EQ(readText(tcx(tcxPoint(kSix))).distance, std::nullopt);
}

TEST(ActivityFile, NamesLineAndReason) {
  const std::string good = gpxPoint(kSix);
  const std::pair<std::string, const char*> cases[] = {
      // Not an activity at all
      {"", "1: the file is empty"},
      {" \n\n", "1: the file is empty"},
      {"6 km in 30 minutes", "1: there is no XML in the file"},
      {"<gpx>\n<trk>\n</gpx>", "3: the XML is malformed: Start-end tags mismatch"},
      {"<gpx>\n\xff</gpx>", "2: the text is not valid UTF-8"},
      {"<?xml version='1.0'?>\n<kml/>", "2: the file is neither GPX nor TCX: its root is <kml>"},
      // Without points
      {"<gpx/>", "1: there are no track points in the file"},
      {"\n<gpx><rte><rtept lat='1' lon='2'/></rte></gpx>",
       "2: there are no track points in the file"},
      {tcx(""), "1: there are no track points in the file"},
      // Positions
      {gpx(gpxPoint(kSix, "", "lon='2'")),
       "2: the latitude is \"\", which is no number from -90 to 90"},
      {gpx(good + gpxPoint(kSix, "", "lat='90.1' lon='2'")),
       "3: the latitude is \"90.1\", which is no number from -90 to 90"},
      {gpx(good + gpxPoint(kSix, "", "lat='1' lon='nan'")),
       "3: the longitude is \"nan\", which is no number from -180 to 180"},
      {tcx(tcxPoint(kSix, "\n<Position><LatitudeDegrees>1</LatitudeDegrees></Position>")),
       "3: the longitude is \"\", which is no number from -180 to 180"},
      // Other numbers
      {gpx(gpxPoint(kSix, "\n<extensions>\n<hr>12o</hr></extensions>")),
       "4: <hr> is \"12o\", which is no number from 0 to 255"},
      {tcx(tcxPoint(kSix, "<HeartRateBpm><Value>-1</Value></HeartRateBpm>")),
       "2: <Value> is \"-1\", which is no number from 0 to 255"},
      {tcx(tcxPoint(kSix, meters("1e300"))),
       "2: <DistanceMeters> is \"1e300\", which is no number from 0 to 100000000"},
      {tcx(tcxPoint(kSix, meters("far\nfrom here"))),
       "2: <DistanceMeters> is \"far...\", which is no number from 0 to 100000000"},
      // Times
      {gpx(good + "<trkpt lat='1' lon='2'/>"), "3: the track point has no time"},
      {gpx(gpxPoint("yesterday")), "2: \"yesterday\" is no time like 2026-03-02T08:15:30Z"},
      {gpx(gpxPoint("2026-02-30T06:00:00Z")), "2: \"2026-02-30T06:00:00Z\" is no time like"},
      {gpx(gpxPoint("2026-03-11T06:00:00X")), "2: \"2026-03-11T06:00:00X\" is no time like"},
      {gpx(gpxPoint("2026-03-11T06:00:00+2:00")), "2: \"2026-03-11T06:00:00+2:00\" is no time"},
      {gpx(gpxPoint("1969-12-31T23:59:59Z")), "2: \"1969-12-31T23:59:59Z\" is no time like"},
      {gpx(gpxPoint("9999-12-31T23:59:59-01:00")), "2: \"9999-12-31T23:59:59-01:00\" is no time"},
      {gpx(gpxPoint(kTenPastSix) + good), "3: the track point lies before the one that it follows"},
  };
  for (const auto& [text, complaint] : cases) {
    SCOPED_TRACE(text);
    const std::string found =
        complaintAbout(text, [](const std::string& path) { readActivityFile(path); });
    EXPECT_TRUE(found.starts_with(complaint)) << found;
  }
}

TEST(ActivityFile, FilesThatCannotBeRead) {
  for (const std::string& path :
       {testing::TempDir() + "no-such-activity.gpx", testing::TempDir()}) {
    try {
      readActivityFile(path);
      ADD_FAILURE() << path;
    } catch (const FileError& error) {
      EXPECT_EQ(std::string(error.what()), path + ": the file cannot be read");
    }
  }
}

TEST(ActivityFile, WhatIsImportedIsTheLatestWorkout) {
  Settings::current().now = secondsFromIso("2026-03-11T15:20Z").value();
  Diary diary;
  EXPECT_TRUE(latestWorkouts(diary, 1).empty());
  diary.workouts.resize(4);
  diary.workouts[0].start.iso = "2026-03-10T07:00Z";
  diary.workouts[1].start.iso = "2026-03-11T07:00Z";
  diary.workouts[2].start.iso = "2026-03-12T07:00Z";  // has not begun yet
  diary.workouts[3].start.iso = "2026-03-09T07:00Z";
  const std::vector<const Workout*> byStart{&diary.workouts[1], &diary.workouts[0],
                                            &diary.workouts[3]};
  EXPECT_EQ(latestWorkouts(diary, 9), byStart);
  diary.workouts[3].start.iso = "2020-01-01T07:00Z";
  diary.workouts[3].isImported = true;
  EXPECT_EQ(latestWorkouts(diary, 1).front(), &diary.workouts[3]) << "whenever it was";
}

}  // namespace
}  // namespace tavro
