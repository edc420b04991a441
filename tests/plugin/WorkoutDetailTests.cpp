#include <tuple>

#include "host/screens/workouts/WorkoutDetailCells.h"
#include "host/screens/workouts/WorkoutDetailController.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using TwoValueCell = CHWorkoutDetailTwoValueTableViewCell;
using Header = CHWorkoutDetailExpandingHeaderView;

class WorkoutDetailTest : public PluginTest {
 protected:
  static Workout workoutOf(HKWorkoutActivityType type, std::optional<double> distance) {
    Workout workout;
    workout.type = type;
    workout.start.iso = "2026-03-03T08:15";
    workout.duration = 3723;
    workout.energy = 314.8;
    workout.distance = distance;
    return workout;
  }

  static void configure(const Ref<CHWorkoutDetailPaceTableViewCell>& cell,
                        HKWorkoutActivityType type, std::optional<double> distance) {
    send<void>(cell, "configureWithWorkout:workoutActivity:dataCalculator:",
               workoutRecord(workoutOf(type, distance)), nullptr, make<CHWorkoutDataCalculator>());
  }

  static Ref<TwoValueCell> twoValues(const id& value1, const id& value2) {
    const auto cell = makeView<TwoValueCell>({0, 0, 390, 64});
    send<void>(cell, "configureWithTitle1:value1:", string("One"), value1);
    send<void>(cell, "configureWithTitle2:value2:", string("Two"), value2);
    return cell;
  }

  static id valueWithLabel(std::string_view text, std::string_view label) {
    const id made = attributedString(string(text));
    setLabel(made, label);
    return made;
  }

  static id group(const id& container, const id& title, const id& value) {
    return send<id>(send<id>(Class::named("AXGroupedTitleValueView"), "alloc"),
                    "initWithAccessibilityContainer:titleView:valueView:", container, title, value);
  }
};

TEST_F(WorkoutDetailTest, WhatWasNotRecordedIsNoDataAndWhatIsNotOfTheActivityIsLeftOut) {
  const Workout yoga = workoutOf(HKWorkoutActivityType::yoga, std::nullopt);
  const auto controller = makeController<WorkoutDetailController>();
  controller->setWorkout(&yoga);
  Utterances figures = heardOn(controller);
  figures.resize(8);
  EXPECT_EQ(figures, (Utterances{"Yoga, heading", "Total Time, 1 hour, 2 minutes, 3 seconds",
                                 "Distance, No data", "Active Energy, 315 kilocalories",
                                 "Elevation Gain, No data", "Average Heart Rate, No data",
                                 "Highest Heart Rate, No data", "Heart Rate"}));
}

TEST_F(WorkoutDetailTest, ThePaceCellSaysItsPaceAsADuration) {
  const std::tuple<HKWorkoutActivityType, std::optional<double>, const char*> cases[] = {
      {HKWorkoutActivityType::running, 10000, "Average Pace, 6 minutes, 12 seconds per km"},
      {HKWorkoutActivityType::swimming, 3000, "Average Pace, 2 minutes, 4 seconds per 100 m"},
      {HKWorkoutActivityType::walking, std::nullopt, "Average Pace, No data"},
      {HKWorkoutActivityType::walking, 0, "Average Pace, No data"},
      {HKWorkoutActivityType::cycling, 20000, "Average Speed, 19.3 km/h"},
  };
  for (const auto& [type, distance, expected] : cases) {
    const auto cell = makeView<CHWorkoutDetailPaceTableViewCell>({0, 0, 390, 56});
    configure(cell, type, distance);
    show(cell);
    EXPECT_EQ(heard(cell), Utterances{expected});
  }
}

TEST_F(WorkoutDetailTest, AConfigurationForCyclingRenewsNothing) {
  // Off screen, where no load hook helps.
  const auto cell = makeView<CHWorkoutDetailPaceTableViewCell>({0, 0, 390, 56});
  configure(cell, HKWorkoutActivityType::running, 10000);
  EXPECT_EQ(heard(cell), Utterances{"Average Pace, 6 minutes, 12 seconds per km"});
  configure(cell, HKWorkoutActivityType::cycling, 20000);
  EXPECT_EQ(utf8(cell->_valueLabel->text()), "19.3 km/h") << "the host's own part is done";
  EXPECT_EQ(heard(cell), Utterances{"Average Pace, 6 minutes, 12 seconds per km"});
  configure(cell, HKWorkoutActivityType::walking, 5000);
  EXPECT_EQ(heard(cell), Utterances{"Average Pace, 12 minutes, 25 seconds per km"});
  cell->_valueLabel->setText(nullptr);
  load(cell);
  EXPECT_EQ(send<id>(cell, "accessibilityValue"), nullptr);
  cell->_titleLabel = nullptr;
  cell->_valueLabel = nullptr;
  load(cell);
  EXPECT_EQ(send<id>(cell, "accessibilityUserDefinedLabel"), nullptr);
}

TEST_F(WorkoutDetailTest, ASplitSaysItsUnitItsVisibleDistanceAndItsPace) {
  struct Case {
    const char* unit;
    const char* distance;
    bool distanceHidden;
    const char* pace;
    const char* label;
  };
  const Case cases[] = {
      {"KM 7", "0.58 KM", false, "6'17''", "KM 7, 0.58 KM, 6 minutes, 17 seconds"},
      {"KM 1", "1 KM", true, "6'16''", "KM 1, 6 minutes, 16 seconds"},
      {"KM 1", "", false, "--", "KM 1, No data"},
      {"", "1 KM", false, "", "1 KM"},
      {"", "", true, "", ""},
  };
  for (const Case& each : cases) {
    const auto cell = makeView<CHWorkoutDetailSplitTableViewCell>({0, 0, 390, 36});
    cell->_unitLabel->setText(string(each.unit));
    cell->_distanceLabel->setText(string(each.distance));
    cell->_distanceLabel->setHidden(each.distanceHidden);
    cell->_paceLabel->setText(string(each.pace));
    EXPECT_EQ(labelOf(cell), each.label);
  }
  const auto bare = makeView<CHWorkoutDetailSplitTableViewCell>();
  bare->_unitLabel = bare->_distanceLabel = bare->_paceLabel = nullptr;
  EXPECT_EQ(send<id>(bare, "accessibilityLabel"), nullptr);
}

TEST_F(WorkoutDetailTest, AValueSaysNoDataOrTheLabelThatItCarriesOrItsText) {
  const std::pair<id, const char*> cases[] = {
      {valueWithLabel("5 KM", "5 kilometers"), "One, 5 kilometers"},
      {attributedString(string("5 KM")), "One, 5 KM"},
      {attributedString(string("--")), "One, No data"},
      {attributedString(string("––")), "One, No data"},
      {attributedString(string("about -- KM")), "One, No data"},
      {valueWithLabel("-- KM", "no kilometers"), "One, No data"},
      {attributedString(string("- –")), "One, - –"},
  };
  for (const auto& [value, expected] : cases) {
    EXPECT_EQ(heard(twoValues(value, value)).front(), expected);
  }
  // A cell that is used again.
  const auto cell = twoValues(valueWithLabel("5 KM", "5 kilometers"), nullptr);
  send<void>(cell, "configureWithTitle1:value1:", string("One"), attributedString(string("7")));
  EXPECT_EQ(heard(cell), Utterances{"One, 7"}) << "the earlier label is gone";
  EXPECT_EQ(send<id>(cell->_valueLabel1, "accessibilityUserDefinedLabel"), nullptr);
  send<void>(cell, "configureWithTitle2:value2:", string("Two"), valueWithLabel("8", "eight"));
  EXPECT_EQ(heard(cell), (Utterances{"One, 7", "Two, eight"}));
}

TEST_F(WorkoutDetailTest, TheTwoPairsAreMadeOnceAllFourLabelsAreThere) {
  const auto cell = twoValues(attributedString(string("1")), attributedString(string("2")));
  EXPECT_FALSE(isElement(cell));
  for (Ref<UILabel> TwoValueCell::*const label :
       {&TwoValueCell::_titleLabel1, &TwoValueCell::_valueLabel1, &TwoValueCell::_titleLabel2,
        &TwoValueCell::_valueLabel2}) {
    const Ref<UILabel> kept = (*cell).*label;
    (*cell).*label = nullptr;
    EXPECT_EQ(elementsOf(cell), nullptr);
    (*cell).*label = kept;
  }
  const Ref<NSArray> elements = elementsOf(cell);
  ASSERT_NE(elements, nullptr);
  EXPECT_EQ(elementsOf(cell), elements);
  EXPECT_EQ(send<id>(cell, "_axElements"), elements);
  cell->_titleLabel1->setText(string("Later"));
  cell->_valueLabel1 = nullptr;
  EXPECT_EQ(heard(cell), (Utterances{"Later, 1", "Two, 2"})) << "nothing drops what was made";
}

TEST_F(WorkoutDetailTest, AGroupIsAnElementWhileBothItsViewsSaySomething) {
  struct Case {
    id title;
    id value;
    Utterances heard;
  };
  const Ref<UILabel> spoken = makeLabel("5 KM");
  setLabel(spoken, "5 kilometers");
  setValue(spoken, "unheard");
  const Case cases[] = {
      {makeLabel("Distance"), spoken, {"Distance, 5 kilometers"}},
      {makeLabel("Distance"), makeLabel(""), {}},
      {makeLabel(""), spoken, {}},
      {nullptr, spoken, {}},
      {makeLabel("Distance"), nullptr, {}},
      {nullptr, nullptr, {}},
  };
  const auto cell = makeView<UIView>();
  for (const Case& each : cases) {
    EXPECT_EQ(heard(group(cell, each.title, each.value)), each.heard);
  }
  const Ref<UILabel> title = makeLabel("", {10, 20, 100, 30});
  const Ref<UILabel> value = makeLabel("1", {10, 50, 80, 30});
  const id element = group(cell, title, value);
  EXPECT_EQ(heard(element), Utterances());
  title->setText(string("Laps"));
  EXPECT_EQ(heard(element), Utterances{"Laps, 1"}) << "read anew at each request";
  EXPECT_EQ(frameOf(element), CGRect(10, 20, 100, 60));
  EXPECT_EQ(send<id>(element, "accessibilityContainer"), cell);
  EXPECT_EQ(frameOf(group(cell, title, nullptr)), CGRect(10, 20, 100, 30));
}

TEST_F(WorkoutDetailTest, AnExpandingHeaderIsAHeadingAndAButtonAndSaysWhetherItIsOpen) {
  const auto header = makeView<Header>({0, 100, 390, 44});
  header->setTitle("Splits");
  show(header);
  EXPECT_EQ(heard(header), Utterances{"Splits, button, heading, expanded"});
  setTraits(header, UIAccessibilityTraitSelected | UIAccessibilityTraitAdjustable);
  EXPECT_EQ(traitsOf(header), UIAccessibilityTraitButton | UIAccessibilityTraitHeader);
  header->setExpanded(false);
  EXPECT_EQ(heard(header), Utterances{"Splits, button, heading, collapsed"});
  header->_titleLabel = nullptr;
  header->_expandButton = nullptr;
  EXPECT_EQ(heard(header), Utterances{"button, heading, collapsed"});
  EXPECT_EQ(send<CGPoint>(header, "accessibilityActivationPoint"), CGPoint());
}

TEST_F(WorkoutDetailTest, AHeaderIsActivatedAtItsButtonWhichShowsAndHidesItsRows) {
  const auto table = makeView<UITableView>({0, 100, 390, 400});
  const auto header = makeView<Header>();
  header->setTitle("Splits");
  table->appendRow(header, Header::height);
  const auto row = makeLabel("a split");
  table->appendRow(row, 30);
  header->addRow(row);
  table->appendRow(makeLabel("below"), 30);
  show(table);
  const auto tap = [&] {
    const auto point = send<CGPoint>(header, "accessibilityActivationPoint");
    const id hit = send<id>(window, "_accessibilityHitTest:withEvent:", point, nullptr);
    EXPECT_EQ(hit, header->_expandButton);
    return as<UIControl>(hit)->sendAction();
  };
  EXPECT_TRUE(tap());
  EXPECT_EQ(heard(table), (Utterances{"Splits, button, heading, collapsed", "below"}));
  EXPECT_EQ(table->subviewList().back()->frame(), CGRect(0, Header::height, 390, 30));
  EXPECT_TRUE(tap());
  EXPECT_EQ(heard(table), (Utterances{"Splits, button, heading, expanded", "a split", "below"}));
  EXPECT_EQ(table->subviewList().back()->frame(), CGRect(0, Header::height + 30, 390, 30));
  send<void>(header->_expandButton, "setAccessibilityActivationPoint:", CGPoint{1, 2});
  EXPECT_EQ(send<CGPoint>(header, "accessibilityActivationPoint"), (CGPoint{1, 2}));
}

}  // namespace
}  // namespace tavro
