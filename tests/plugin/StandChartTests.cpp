#include <cmath>
#include <tuple>

#include "host/screens/day/StandChart.h"
#include "tests/support/Charts.h"

namespace tavro {
namespace {

class StandChartTest : public ChartTest {
 protected:
  Ref<ActivityStandChartView> chartWith(const id& points) {
    const auto chart = makeView<ActivityStandChartView>({10, 20, 320, 99.9});
    fill(chart, points);
    show(chart);
    return chart;
  }
  static void fill(const id& chart, const id& points) {
    answers(chart, "standChartPoints", points);
  }

  /// What is heard of a row, the hours of its chart left out.
  static Utterances aroundTheChart(const id& cell) {
    Utterances spoken = heard(cell);
    std::erase_if(spoken, [](const std::string& text) { return text.ends_with(" hour"); });
    return spoken;
  }
};

TEST_F(StandChartTest, EachPointIsAnHourOfTheDay) {
  const std::tuple<std::size_t, const char*, std::size_t, const char*> cases[] = {
      {24, "UTC", 0, "12\u2009–\u20091\u202fAM"},
      {24, "UTC", 23, "11:00\u2009–\u200911:59\u202fPM"},
      {1, "UTC", 0, "12:00\u2009–\u200912:59\u202fAM"},
      {5, "UTC", 3, "3\u2009–\u20094\u202fAM"},
      {5, "UTC", 4, "4:00\u2009–\u20094:59\u202fAM"},
      // The clocks went from 2 to 3 on that day: the third hour is the one from 3 to 4.
      {24, "America/New_York", 2, "3\u2009–\u20094\u202fAM"},
  };
  for (const auto& [points, timeZone, index, label] : cases) {
    Settings::current().timeZone = timeZone;
    Settings::current().now = secondsFromIso("2026-03-08T15:20Z").value();
    const Ref<NSArray> elements = elementsOf(chartWith(pointsOf(std::vector<double>(points, 1))));
    ASSERT_EQ(elements->count(), points);
    EXPECT_EQ(labelOf((*elements)[index]), label) << index;
  }
}

TEST_F(StandChartTest, AnHourCountsWhenItsAmountIsAboveZero) {
  const Ref<NSArray> points = pointsOf({0.5, 0, -1, std::nan(""), 1e-50, 1});
  std::vector<id> objects(points->begin(), points->end());
  objects.emplace_back(string("no point"));
  EXPECT_EQ(valuesOf(chartWith(arrayWithObjects(objects))),
            (Utterances{"Stand hour", "Idle hour", "Idle hour", "Idle hour", "Idle hour",
                        "Stand hour", "Idle hour"}))
      << "1e-50 is nothing in single precision";
}

TEST_F(StandChartTest, HourFramesReachOverTheWholeChart) {
  const Ref<NSArray> elements = elementsOf(chartWith(pointsOf(std::vector<double>(24, 1))));
  // 320 / 24 is 13.33, rounded up; the height 99.9 is rounded down. The chart stands at (10, 20).
  EXPECT_EQ(frameOf((*elements)[0]), CGRect(10, 20, 14, 99));
  EXPECT_EQ(frameOf((*elements)[23]), CGRect(10 + 23 * 14, 20, 14, 99));
}

TEST_F(StandChartTest, UnusablePointsLeaveTheChartSilentUntilItIsLoadedAgain) {
  const id unusable[] = {nullptr, arrayWithObjects({}), arrayWithObjects({string("1")}),
                         string("no array")};
  for (const id& points : unusable) {
    const auto chart = chartWith(points);
    EXPECT_EQ(heard(chart), Utterances());
    EXPECT_NE(elementsOf(chart), nullptr) << "an empty list, not the chart's own drawing";
    fill(chart, pointsOf({1, 1}));
    EXPECT_EQ(heard(chart), Utterances());
    load(chart);
    EXPECT_EQ(heard(chart).size(), 2U);
    fill(chart, points);
    load(chart);
    EXPECT_EQ(heard(chart), Utterances()) << "what was heard before is gone";
  }
}

TEST_F(StandChartTest, ElementsAreKeptBetweenLoads) {
  const auto chart = chartWith(pointsOf({1, 1}));
  const Ref<NSArray> first = elementsOf(chart);
  fill(chart, pointsOf({0, 0, 0}));
  EXPECT_EQ(elementsOf(chart), first);
  EXPECT_EQ(valuesOf(chart), Utterances(2, "Stand hour"));
  load(chart);
  EXPECT_EQ(valuesOf(chart), Utterances(3, "Idle hour"));
}

TEST_F(StandChartTest, TheCellReadsTitleThenChartThenIdleHours) {
  const auto cell = makeView<DayViewStandChartTableViewCell>({0, 0, 390, 120});
  const bool hours[] = {true, false};
  cell->chart().setHours(hours);
  cell->pair().setTexts("Stand", "8/12HRS");
  cell->idleHours().setText(string("8 IDLE HOURS"));
  show(cell);
  // The pair is found by its class, the first in the tree.
  const auto another = makeView<DayViewTitleAndValueLabelPair>({0, 0, 390, 20});
  another->setTexts("Another", "pair");
  cell->addSubview(another);
  cell->pair().setTexts("Stand", "9/12HRS");
  EXPECT_EQ(aroundTheChart(cell), (Utterances{"Stand, 9/12HRS, heading", "8 IDLE HOURS"}));
  another->removeFromSuperview();
  cell->pair().removeFromSuperview();
  EXPECT_EQ(aroundTheChart(cell), Utterances{"8 IDLE HOURS"});
  EXPECT_EQ(heard(cell).size(), 3U) << "the chart is heard without the pair";
}

}  // namespace
}  // namespace tavro
