#include <cmath>
#include <limits>
#include <span>
#include <tuple>

#include "host/screens/day/DayViewController.h"
#include "platform/accessibility/SafeCategory.h"
#include "tests/support/Charts.h"

namespace tavro {
namespace {

class DailyChartTest : public ChartTest {
 protected:
  Ref<ActivityMoveAndExerciseChartView> chartWith(const id& points, std::int64_t type = 0) {
    const auto chart = makeView<ActivityMoveAndExerciseChartView>({10, 20, 300, 99.9});
    chart->setAmounts(MoveAndExerciseChartType::activeEnergy, std::span<const double>());
    fill(chart, points, type);
    show(chart);
    return chart;
  }
  static void fill(const id& chart, const id& points, std::int64_t type = 0) {
    answers(chart, "moveAndExerciseChartPoints", points);
    answers<std::int64_t>(chart, "moveAndExerciseChartViewType", [type] { return type; });
  }
};

TEST_F(DailyChartTest, SlicesSumTheirPoints) {
  std::vector<double> hours(24);
  for (std::size_t hour = 0; hour < hours.size(); ++hour) {
    hours[hour] = static_cast<double>(hour);
  }
  std::vector<double> withTwoMore = hours;
  withTwoMore.insert(withTwoMore.end(), {1000, 1000});
  const Utterances hourly{"3 calories",  "12 calories", "21 calories", "30 calories",
                          "39 calories", "48 calories", "57 calories", "66 calories"};
  EXPECT_EQ(valuesOf(chartWith(pointsOf(hours))), hourly);
  EXPECT_EQ(valuesOf(chartWith(pointsOf(withTwoMore))), hourly) << "the rest is in no slice";
  EXPECT_EQ(valuesOf(chartWith(pointsOf(std::vector<double>(7, 5)))), Utterances(8, "0 calories"));
}

TEST_F(DailyChartTest, TheChartTypeDecidesHowAnAmountIsSaid) {
  const std::tuple<std::int64_t, double, const char*> cases[] = {
      {0, 412.6, "412.6 calories"},
      {0, 1234.56, "1,234.6 calories"},
      {1, 17.9, "17 minutes"},
      {2, 1.99, "1 minute"},
      {2, -3.5, "-3 minutes"},
      {3, 5, ""},
      {-1, 5, ""},
  };
  for (const auto& [type, amount, value] : cases) {
    std::vector<double> amounts(8, amount);
    EXPECT_EQ(valuesOf(chartWith(pointsOf(amounts), type))[4], value) << type << " " << amount;
  }
}

TEST_F(DailyChartTest, AmountsThatAreNoNumbersAreSaidAsNothingOrAsNone) {
  const double infinity = std::numeric_limits<double>::infinity();
  EXPECT_EQ(valuesOf(chartWith(pointsOf(std::vector<double>(8, infinity)), 0))[0], "");
  EXPECT_EQ(valuesOf(chartWith(pointsOf(std::vector<double>(8, std::nan(""))), 2))[0], "0 minutes");
}

TEST_F(DailyChartTest, SliceFramesAreWholePointsOfTheChart) {
  const auto chart = chartWith(pointsOf(std::vector<double>(24, 1)));
  const Ref<NSArray> elements = elementsOf(chart);
  // 300 / 8 is 37.5 and the height 99.9; both are rounded down. The chart stands at (10, 20).
  EXPECT_EQ(frameOf((*elements)[0]), CGRect(10, 20, 37, 99));
  EXPECT_EQ(frameOf((*elements)[7]), CGRect(10 + 7 * 37, 20, 37, 99));
  chart->setFrame({110, 20, 300, 99.9});
  EXPECT_EQ(frameOf((*elements)[0]), CGRect(110, 20, 37, 99)) << "elements move with their chart";
}

TEST_F(DailyChartTest, UnusablePointsLeaveTheChartSilentUntilItIsLoadedAgain) {
  const id unusable[] = {nullptr, arrayWithObjects({}), arrayWithObjects({string("1")}),
                         string("no array")};
  for (const id& points : unusable) {
    const auto chart = chartWith(points);
    EXPECT_EQ(heard(chart), Utterances());
    fill(chart, pointsOf(std::vector<double>(8, 1)));
    EXPECT_EQ(heard(chart), Utterances()) << "nothing is renewed without a load";
    send<void>(chart, "accessibilityReloadData");
    EXPECT_EQ(heard(chart).size(), 8U);
  }
}

TEST_F(DailyChartTest, OnlyTheFirstPointIsCheckedAndLaterOnesCountAsNothing) {
  std::vector<id> points;
  for (int index = 0; index < 8; ++index) {
    points.emplace_back(value(CGPoint{0, 2}));
  }
  points[3] = string("not a point");
  points[5] = number(7.0);  // a value too, but of a number
  const Utterances values = valuesOf(chartWith(arrayWithObjects(points)));
  EXPECT_EQ(values, (Utterances{"2 calories", "2 calories", "2 calories", "0 calories",
                                "2 calories", "0 calories", "2 calories", "2 calories"}));
}

TEST_F(DailyChartTest, ElementsAreKeptBetweenLoads) {
  const auto chart = chartWith(pointsOf(std::vector<double>(8, 1)));
  const Ref<NSArray> first = elementsOf(chart);
  fill(chart, pointsOf(std::vector<double>(8, 9)), 2);
  EXPECT_EQ(elementsOf(chart), first);
  EXPECT_EQ(valueOf((*elementsOf(chart))[0]), "1 calories");
  send<void>(chart, "accessibilityReloadData");
  EXPECT_NE(elementsOf(chart), first);
  EXPECT_EQ(valueOf((*elementsOf(chart))[0]), "9 minutes");
}

TEST_F(DailyChartTest, TheHostsReloadIsReplaced) {
  const auto chart = chartWith(pointsOf({1}));
  int hostReloads = 0;
  hostAnswers<void>(chart, "accessibilityReloadData", [&] { ++hostReloads; });
  send<void>(chart, "accessibilityReloadData");
  EXPECT_EQ(hostReloads, 0);
  EXPECT_EQ(heard(chart).size(), 8U);
}

TEST_F(DailyChartTest, ARequestDuringTheBuildGetsTheSameList) {
  const auto chart = chartWith(pointsOf(std::vector<double>(8, 1)));
  id seen;
  answers<std::int64_t>(chart, "moveAndExerciseChartViewType", [&]() -> std::int64_t {
    seen = send<id>(chart, "accessibilityElements");
    return 0;
  });
  const Ref<NSArray> elements = elementsOf(chart);
  EXPECT_EQ(elements->count(), 8U);
  EXPECT_EQ(seen, elements);
}

TEST_F(DailyChartTest, TheCellReadsItsPairAtEachRequest) {
  const auto cell = makeView<DayViewMoveAndExerciseChartTableViewCell>({0, 0, 390, 160});
  for (const char* const value : {"10/20KCAL", "15/20KCAL"}) {
    cell->pair().setTexts("Move", value);
    show(cell);
    EXPECT_EQ(heard(cell).front(), "Move, " + std::string(value) + ", heading");
  }
}

TEST_F(DailyChartTest, TheRingsCellHandsOutItsRingsAlone) {
  Day day;
  day.move = 250;
  day.moveGoal = 500;
  day.stand = 12;
  day.standGoal = 12;
  const auto cell = makeView<DayViewActivityRingsTableViewCell>({0, 0, 390, 220});
  cell->setDay(day);
  show(cell);
  EXPECT_EQ(heard(cell), Utterances{"Activity rings, Move 50%, Stand 100%"});
  const auto empty = makeView<DayViewActivityRingsTableViewCell>({0, 0, 390, 220});
  empty->addSubview(makeLabel("KCAL"));
  show(empty);
  EXPECT_EQ(heard(empty), Utterances()) << "no rings, nothing said";
}

}  // namespace
}  // namespace tavro
