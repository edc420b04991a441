#include <cmath>
#include <limits>
#include <span>

#include "host/screens/day/DayViewController.h"
#include "platform/accessibility/SafeCategory.h"
#include "tests/support/Charts.h"

namespace tavro {
namespace {

/// A chart whose host answers what a test wants it to answer.
class OddChart : public ActivityMoveAndExerciseChartView {
 public:
  static constexpr Name className = "OddChart";
  id points;
  std::int64_t type = 0;

  id oddPoints() { return points; }
  std::int64_t oddType() { return type; }
};

const Registered oddChart = defineClass<OddChart, ActivityMoveAndExerciseChartView>()
                                .method<&OddChart::oddPoints>("moveAndExerciseChartPoints")
                                .method<&OddChart::oddType>("moveAndExerciseChartViewType");

/// A chart that is asked for its elements while they are being built.
class ReentrantChart : public OddChart {
 public:
  static constexpr Name className = "ReentrantChart";
  id seen;

  std::int64_t askAgain() {
    seen = send<id>(this, "accessibilityElements");
    return 0;
  }
};

const Registered reentrantChart =
    defineClass<ReentrantChart, OddChart>().method<&ReentrantChart::askAgain>(
        "moveAndExerciseChartViewType");

int hostReloads = 0;
void countReload(Object* /*self*/) { ++hostReloads; }

class DailyChartTest : public ChartTest {
 protected:
  Ref<OddChart> chartWith(const id& points, std::int64_t type = 0) {
    const auto chart = makeView<OddChart>({10, 20, 300, 99.9});
    chart->setAmounts(MoveAndExerciseChartType::activeEnergy, std::span<const double>());
    chart->points = points;
    chart->type = type;
    show(chart);
    return chart;
  }
};

TEST_F(DailyChartTest, SlicesSpeakTheirTimesInTheUsersLocale) {
  struct Case {
    const char* locale;
    const char* first;
    const char* last;
  };
  // Skeletons with "h" stay on the twelve-hour clock, as ICU has it, also where 24 hours are usual.
  const Case cases[] = {
      {"en_US", "12\u2009–\u20093\u202fAM", "9:00\u2009–\u200911:59\u202fPM"},
      {"en_GB", "12–3\u202fam", "9:00\u2009–\u200911:59\u202fpm"},
      {"de_DE", "12\u2009–\u20093 Uhr AM", "9:00–11:59\u202fPM"},
      {"ja_JP", "午前0時～3時", "午後9時00分～11時59分"},
      {"ar_EG", "١٢–٣ ص", "٩:٠٠–١١:٥٩ م"},
  };
  for (const Case& each : cases) {
    Settings::current().locale = each.locale;
    const auto chart = chartWith(pointsOf(std::vector<double>(24, 1)));
    const Ref<NSArray> elements = elementsOf(chart);
    ASSERT_EQ(elements->count(), 8U) << each.locale;
    EXPECT_EQ(labelOf((*elements)[0]), each.first) << each.locale;
    EXPECT_EQ(labelOf((*elements)[7]), each.last) << each.locale;
  }
}

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
  struct Case {
    std::int64_t type;
    double amount;
    const char* value;
  };
  const Case cases[] = {
      {0, 412.6, "412.6 calories"},
      {0, 1234.56, "1,234.6 calories"},
      {1, 17.9, "17 minutes"},
      {2, 1.99, "1 minute"},
      {2, -3.5, "-3 minutes"},
      {3, 5, ""},
      {-1, 5, ""},
  };
  for (const Case& each : cases) {
    std::vector<double> amounts(8, each.amount);
    EXPECT_EQ(valuesOf(chartWith(pointsOf(amounts), each.type))[4], each.value)
        << each.type << " " << each.amount;
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
  EXPECT_EQ(send<CGRect>((*elements)[0], "accessibilityFrame"), CGRect(10, 20, 37, 99));
  EXPECT_EQ(send<CGRect>((*elements)[7], "accessibilityFrame"), CGRect(10 + 7 * 37, 20, 37, 99));
  chart->setFrame({110, 20, 300, 99.9});
  EXPECT_EQ(send<CGRect>((*elements)[0], "accessibilityFrame"), CGRect(110, 20, 37, 99))
      << "elements move with their chart";
}

TEST_F(DailyChartTest, UnusablePointsLeaveTheChartSilentUntilItIsLoadedAgain) {
  const id unusable[] = {nullptr, arrayWithObjects({}), arrayWithObjects({string("1")}),
                         string("no array")};
  for (const id& points : unusable) {
    const auto chart = chartWith(points);
    EXPECT_EQ(heard(chart), Utterances());
    chart->points = pointsOf(std::vector<double>(8, 1));
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
  chart->points = pointsOf(std::vector<double>(8, 9));
  chart->type = 2;
  EXPECT_EQ(elementsOf(chart), first);
  EXPECT_EQ(valueOf((*elementsOf(chart))[0]), "1 calories");
  send<void>(chart, "accessibilityReloadData");
  EXPECT_NE(elementsOf(chart), first);
  EXPECT_EQ(valueOf((*elementsOf(chart))[0]), "9 minutes");
}

TEST_F(DailyChartTest, TheHostsReloadIsReplaced) {
  // What stands below the category's method is the host's own, and nothing calls it.
  const Method* const grafted =
      classOf<ActivityMoveAndExerciseChartView>()->method("accessibilityReloadData");
  ASSERT_NE(grafted->replaced, nullptr);
  const_cast<Method*>(grafted->replaced)->implementation =
      methodOf<&countReload>("accessibilityReloadData").implementation;
  const auto chart = chartWith(pointsOf({1}));
  send<void>(chart, "accessibilityReloadData");
  EXPECT_EQ(hostReloads, 0);
  EXPECT_EQ(heard(chart).size(), 8U);
}

TEST_F(DailyChartTest, ARequestDuringTheBuildGetsTheSameList) {
  const auto chart = makeView<ReentrantChart>({0, 0, 300, 100});
  chart->setAmounts(MoveAndExerciseChartType::activeEnergy, std::span<const double>());
  chart->points = pointsOf(std::vector<double>(8, 1));
  show(chart);
  const Ref<NSArray> elements = elementsOf(chart);
  EXPECT_EQ(elements->count(), 8U);
  EXPECT_EQ(chart->seen, elements);
}

TEST_F(DailyChartTest, TheCellReadsTitleThenChartThenAuxiliaryLabel) {
  const auto cell = makeView<DayViewMoveAndExerciseChartTableViewCell>({0, 0, 390, 160});
  cell->pair().setTexts("Move", "10/20KCAL");
  cell->chart().setAmounts(MoveAndExerciseChartType::activeEnergy, std::vector<double>(24, 1));
  cell->auxiliary().setText(string("TOTAL 30 KCAL"));
  show(cell);
  const Utterances spoken = heard(cell);
  ASSERT_EQ(spoken.size(), 10U);
  EXPECT_EQ(spoken.front(), "Move, 10/20KCAL, heading");
  EXPECT_EQ(spoken[1].substr(spoken[1].rfind(' ') - 1), "3 calories");
  EXPECT_EQ(spoken.back(), "TOTAL 30 KCAL");
  cell->pair().setTexts("Move", "15/20KCAL");
  EXPECT_EQ(heard(cell).front(), "Move, 15/20KCAL, heading") << "the pair is read at each request";
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
