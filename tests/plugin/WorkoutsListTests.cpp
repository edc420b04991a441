#include <tuple>

#include "host/libraries/CHWorkoutFormattingManager.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "host/screens/workouts/WorkoutsListCells.h"
#include "host/screens/workouts/WorkoutsListController.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

class WorkoutsListTest : public PluginTest {
 protected:
  static Workout run(const char* start, double distance = 5000) {
    Workout workout;
    workout.type = HKWorkoutActivityType::running;
    workout.start.iso = start;
    workout.duration = 1800;
    workout.energy = 300;
    workout.source = {"Pedal Notes", false};
    workout.distance = distance;
    return workout;
  }

  Ref<CHWorkoutsListTableViewCell> rowWith(const Ref<HKWorkout>& workout) {
    const auto row = makeView<CHWorkoutsListTableViewCell>({0, 0, 390, 60});
    row->setWorkout(workout);
    send<void>(row, "configureWithCurrentWorkout");
    show(row);
    return row;
  }

  static Ref<CHWorkoutSummaryTabbedLabelContainer> container(std::string_view title,
                                                             std::string_view total,
                                                             std::string_view average) {
    const auto made = makeView<CHWorkoutSummaryTabbedLabelContainer>({0, 0, 300, 40});
    made->setTexts(title, total, average);
    return made;
  }
};

TEST_F(WorkoutsListTest, ARowIsOneElementThatNamesItsSourceUnlessItIsTheWatch) {
  struct Case {
    const char* source;
    bool isWatch;
    const char* heard;
  };
  const Case cases[] = {
      {"Pedal Notes", false, "Pedal Notes, Outdoor Run, Tuesday, Mar 3, 2020, 5 KM"},
      {"Robin's Watch", true, "Outdoor Run, Tuesday, Mar 3, 2020, 5 KM"},
      {"", false, "Outdoor Run, Tuesday, Mar 3, 2020, 5 KM"},
      {"", true, "Outdoor Run, Tuesday, Mar 3, 2020, 5 KM"},
  };
  for (const Case& each : cases) {
    Workout workout = run("2020-03-03T08:15");
    workout.source = {each.source, each.isWatch};
    EXPECT_EQ(heard(rowWith(workoutRecord(workout))), Utterances{each.heard});
  }
}

TEST_F(WorkoutsListTest, AReusedRowIsAnnotatedAtEachConfiguration) {
  const auto row = rowWith(workoutRecord(run("2020-03-03T08:15")));
  Workout byWatch = run("2020-03-04T08:15");
  byWatch.source = {"Robin's Watch", true};
  row->setWorkout(workoutRecord(byWatch));
  send<void>(row, "configureWithCurrentWorkout");
  EXPECT_EQ(heard(row), Utterances{"Pedal Notes, Outdoor Run, Wednesday, Mar 4, 2020, 5 KM"})
      << "the icon keeps its earlier name, the date does not";
  row->setWorkout(nullptr);
  send<void>(row, "configureWithCurrentWorkout");
  EXPECT_EQ(labelOf(row->_dateLabel), "Wednesday, Mar 4, 2020") << "without a workout, untouched";
}

TEST_F(WorkoutsListTest, AnIncompleteWorkoutLeavesItsPartSilent) {
  const auto withoutSource = workoutRecord(run("2020-03-03T08:15"));
  withoutSource->record.sourceRevision = nullptr;
  const auto withoutDate = workoutRecord(run("2020-03-03T08:15"));
  withoutDate->record.startDate = nullptr;
  const std::pair<id, const char*> cases[] = {
      {withoutSource, "Outdoor Run, Tuesday, Mar 3, 2020, 5 KM"},
      {withoutDate, "Pedal Notes, Outdoor Run, shown date, 5 KM"},
      {string("no workout"), "Outdoor Run, shown date, 5 KM"},
      {nullptr, "Outdoor Run, shown date, 5 KM"},
  };
  for (const auto& [workout, expected] : cases) {
    const auto row = makeView<CHWorkoutsListTableViewCell>({0, 0, 390, 60});
    row->setWorkout(workoutRecord(run("2020-03-03T08:15")));
    row->configureWithCurrentWorkout();
    row->_dateLabel->setText(string("shown date"));
    answers(row, "workout", workout);
    show(row);
    EXPECT_EQ(heard(row), Utterances{expected});
  }
}

TEST_F(WorkoutsListTest, TheSummaryHandsOutItsVisibleFiguresInReadingOrder) {
  const auto cell = makeView<CHListSummaryTableViewCell>({0, 0, 390, 200});
  Workout swim = run("2020-03-03T08:15", 1000);
  swim.type = HKWorkoutActivityType::swimming;
  show(cell);
  cell->setWorkouts({workoutRecord(swim)});
  Utterances withoutPace = heard(cell);
  EXPECT_EQ(withoutPace.size(), 4U) << "nobody was on foot";
  EXPECT_EQ(withoutPace.back(), "Distance, Total, 1 KM, Average, 1 KM");
  cell->_durationLabel->setAlpha(0);
  cell->_activeEnergyLabel = nullptr;
  EXPECT_EQ(heard(cell),
            (Utterances{"Workouts, Total, 1", "Distance, Total, 1 KM, Average, 1 KM"}));
}

TEST_F(WorkoutsListTest, AFigureSaysItsTitleThenTotalAndAverageWithTheirHeaders) {
  const std::tuple<const char*, const char*, const char*, Utterances> cases[] = {
      {"Pace", "1", "2", {"Pace, Total, 1, Average, 2"}},
      {"Pace", "", "2", {"Pace, Average, 2"}},
      {"Pace", "1", "", {"Pace, Total, 1"}},
      {"", "1", "2", {"Total, 1, Average, 2"}},
      {"Pace", "", "", {"Pace"}},
      {"", "", "", {}},
  };
  for (const auto& [title, total, average, expected] : cases) {
    EXPECT_EQ(heard(container(title, total, average)), expected);
  }
  EXPECT_EQ(heard(makeView<CHWorkoutSummaryTabbedLabelContainer>()), Utterances());
}

TEST_F(WorkoutsListTest, OnlyTheFiguresCarryTheStoredAttribute) {
  const auto figure = container("Duration", "1:02:03", "0:30");
  const auto other = container("Duration", "1:02:03", "0:30");
  EXPECT_EQ(send<id>(figure, "_accessibilityLabelAttribute"), nullptr);
  send<void>(figure, "_accessibilitySetLabelAttribute:",
             string(UIAccessibilityTokenDurationTimeHHMMSS.text()));
  const auto label = as<NSAttributedString>(send<id>(figure, "accessibilityLabel"));
  ASSERT_NE(label, nullptr);
  std::vector<std::u16string_view> marked;
  for (const NSAttributedString::Run& run : label->runs()) {
    EXPECT_EQ(run.key.text(), UIAccessibilityTokenDurationTimeHHMMSS.text());
    EXPECT_EQ(run.value, kCFBooleanTrue());
    marked.push_back(label->string()->text().substr(run.range.location, run.range.length));
  }
  EXPECT_EQ(marked, (std::vector<std::u16string_view>{u"1:02:03", u"0:30"}));
  EXPECT_EQ(heard(figure), Utterances{"Duration, Total, 1 hour, 2 minutes, 3 seconds, Average, "
                                      "30 seconds"});
  EXPECT_EQ(heard(other), Utterances{"Duration, Total, 1:02:03, Average, 0:30"});
  send<void>(figure, "_accessibilitySetLabelAttribute:", nullptr);
  EXPECT_EQ(heard(figure), heard(other));
}

TEST_F(WorkoutsListTest, ASectionIsOneHeadingAndKeepsItsTraits) {
  const auto header = makeView<CHListTableHeaderView>({0, 0, 390, 36});
  header->setTexts(string("March 2020"), 1);
  EXPECT_EQ(heard(header), Utterances{"March 2020, 1 workout, heading"});
  setTraits(header, UIAccessibilityTraitSelected);
  EXPECT_EQ(heard(header), Utterances{"March 2020, 1 workout, selected, heading"});
  header->_detailLabel->setText(nullptr);
  EXPECT_EQ(labelOf(header), "March 2020");
  header->_dateLabel = nullptr;
  EXPECT_EQ(send<id>(header, "accessibilityLabel"), nullptr);
}

TEST_F(WorkoutsListTest, TheHookYieldsWhatTheHostYielded) {
  constexpr Name selector = "formattedDurationForWorkout:workoutActivity:context:";
  const auto manager = make<CHWorkoutFormattingManager>();
  const std::pair<id, const char*> cases[] = {
      {attributedString(string("1:02:03")), "1 hour, 2 minutes, 3 seconds"},
      {axAttributedString(string("0:07")), "7 seconds"},
      {attributedString(string("")), ""},
      {string("1:02:03"), ""},
      {nullptr, ""},
  };
  for (const auto& [formatted, label] : cases) {
    hostAnswers<id, const id&, const id&, const id&>(
        manager, selector, [shown = formatted](const id&, const id&, const id&) { return shown; });
    const id yielded = send<id>(manager, selector, nullptr, nullptr, nullptr);
    EXPECT_EQ(yielded, formatted);
    EXPECT_EQ(spokenText(send<id>(yielded, "accessibilityUserDefinedLabel")), label);
    if (const auto text = as<NSAttributedString>(yielded)) {
      EXPECT_TRUE(text->runs().empty()) << "what is shown carries no speech";
    }
  }
}

TEST_F(WorkoutsListTest, AScreenWithoutWorkoutsSaysSo) {
  EXPECT_EQ(heardOn(makeController<WorkoutsListController>()),
            (Utterances{"Workouts, heading", "No workouts were recorded."}));
}

}  // namespace
}  // namespace tavro
