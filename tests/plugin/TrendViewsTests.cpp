#include "host/screens/trends/TrendCharts.h"
#include "host/screens/trends/TrendControllers.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

Trend trendOf(std::int64_t type, std::string title, TrendDirection direction) {
  Trend trend;
  trend.type = type;
  trend.title = std::move(title);
  trend.direction = direction;
  trend.averages = {1111.0, 2222.0};
  return trend;
}

using TrendViewsTest = PluginTest;

TEST_F(TrendViewsTest, AMetricSaysTheTitleTheTrendAndTheValueThatItHas) {
  const id title = makeLabel("Move");
  const id trend = string("Trending up");
  const std::tuple<id, id, const char*> cases[] = {
      {title, trend, "Move, Trending up, 2,222 KCAL, button"},
      {title, nullptr, "Move, 2,222 KCAL, button"},
      {title, string(""), "Move, 2,222 KCAL, button"},
      {title, title, "Move, 2,222 KCAL, button"},  // a trend that is no text
      {nullptr, trend, "Trending up, 2,222 KCAL, button"},
      {make<UIImage>(), trend, "Trending up, 2,222 KCAL, button"},
  };
  const auto metric = makeView<TrendListMetricView>({0, 0, 195, 72});
  metric->setTrend(trendOf(0, "Move", TrendDirection::up));
  show(metric);
  for (const auto& [titleLabel, trendString, spoken] : cases) {
    answers(metric, "titleLabel", titleLabel);
    answers(metric, "trendString", trendString);
    EXPECT_EQ(heard(metric), Utterances{spoken});
  }
  raises(metric, "trendString");
  EXPECT_EQ(heard(metric), Utterances{"2,222 KCAL, button"});
  EXPECT_EQ(send<id>(makeView<TrendListMetricView>(), "accessibilityLabel"), nullptr);
}

TEST_F(TrendViewsTest, AMetricSaysWhatItsLabelsSayNow) {
  const auto metric = makeView<TrendListMetricView>();
  metric->setTrend(trendOf(0, "Move", TrendDirection::up));
  metric->setTrend(trendOf(1, "Exercise", TrendDirection::down));
  EXPECT_EQ(labelOf(metric), "Exercise, Trending down, 2,222 MIN");
  as<UIView>(metric->valueLabel())->setHidden(true);
  EXPECT_EQ(labelOf(metric), "Exercise, Trending down");
}

TEST_F(TrendViewsTest, ATrendThatGoesDownWithoutAdviceSaysItsMetricAlone) {
  const auto cell = makeView<TrendingDownTableViewCell>({0, 0, 390, 136});
  cell->setTrend(trendOf(5, "Flights", TrendDirection::down), {});
  show(cell);
  EXPECT_EQ(heard(cell), Utterances{"Flights, Trending down, 2,222 FLIGHTS, button"});
}

TEST_F(TrendViewsTest, TheTraitsThatTheHostGaveStay) {
  const Ref<UIView> views[] = {makeView<TrendListMetricView>(),
                               makeView<TrendingDownTableViewCell>(),
                               makeView<TrendListHeaderView>()};
  for (const Ref<UIView>& view : views) {
    const auto own = traitsOf(view);
    setTraits(view, UIAccessibilityTraitSelected);
    EXPECT_EQ(traitsOf(view), own | UIAccessibilityTraitSelected);
  }
}

TEST_F(TrendViewsTest, TheButtonsOfAPairLetTheirMetricsBeHeard) {
  int taps = 0;
  const auto cell = makeView<TrendPairTableViewCell>({0, 0, 390, 96});
  cell->addTrend(trendOf(0, "Move", TrendDirection::up), [&] { taps += 1; });
  cell->addTrend(trendOf(1, "Exercise", TrendDirection::steady), [&] { taps += 10; });
  EXPECT_EQ(heard(cell), (Utterances{"button", "button"})) << "without a load";
  show(cell);
  const Utterances metrics{"Move, Trending up, 2,222 KCAL, button",
                           "Exercise, Holding steady, 2,222 MIN, button"};
  EXPECT_EQ(heard(cell), metrics);
  const std::vector<HeardElement> elements = readElements(cell);
  EXPECT_TRUE(activate(elements.back().element));
  EXPECT_EQ(taps, 10) << "a tap on a metric is one on its button";
  EXPECT_LE(elements.front().frame.maxX(), elements.back().frame.origin.x);

  const auto later = makeView<UIButton>();
  later->setTitle(string("More"));
  cell->addSubview(later);
  EXPECT_TRUE(isElement(later));
  reloadAccessibilityInformation();
  EXPECT_EQ(heard(cell), metrics);
}

TEST_F(TrendViewsTest, HeadersAndSummariesLeaveOutWhatTheOtherSays) {
  const auto header = makeView<TrendListHeaderView>({0, 0, 390, 44});
  const auto summary = makeView<TrendDetailSummaryView>({0, 0, 390, 132});
  for (const Ref<UIView>& view : {Ref<UIView>(header), Ref<UIView>(summary)}) {
    const auto heading = makeLabel("Heading", {0, 0, 100, 20});
    send<void>(heading, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
    const auto focusable = makeLabel("Focusable", {0, 30, 100, 20});
    const auto neither = makeLabel("Neither", {0, 60, 100, 20});
    send<void>(neither, "setIsAccessibilityElement:", false);
    const auto hidden = makeLabel("HiddenSoSilent", {0, 90, 100, 20});
    hidden->setHidden(true);
    for (const Ref<UILabel>& label : {neither, hidden, focusable, heading}) {
      view->addSubview(label);
    }
    show(view);
  }
  EXPECT_EQ(heard(header), Utterances{"Heading, Neither, heading"});
  EXPECT_EQ(heard(summary), Utterances{"Focusable, Neither"});
}

TEST_F(TrendViewsTest, TheListGroupsTrendsByDirectionAndOpensThem) {
  const std::vector<Trend> trends{
      trendOf(0, "Move", TrendDirection::up), trendOf(1, "Exercise", TrendDirection::steady),
      trendOf(4, "Steps", TrendDirection::up), trendOf(5, "Flights", TrendDirection::down)};
  const auto list = makeController<TrendsViewController>();
  list->setTrends(&trends);
  for (const auto& [opened, title] : {std::pair(1U, "Flights"), {4U, "Steps"}, {6U, "Exercise"}}) {
    window->setRootViewController(list);
    EXPECT_TRUE(activate(readElements(list->view()).at(opened).element));
    EXPECT_EQ(utf8(window->rootViewController()->navigationItem()->title), title);
  }
}

TEST_F(TrendViewsTest, WhatWasNotRecordedIsLeftOutOrNothing) {
  Trend trend = trendOf(7, "It", TrendDirection::up);
  trend.averages.average365 = std::nullopt;
  trend.bars = {{{0}, {0}, 1.5}, {{1}, {1}, std::nullopt}, {{2}, {2}, 0.0}};
  trend.weekdays.fill({3.25, std::nullopt});
  const auto detail = makeController<TrendDetailViewController>();
  detail->setTrend(&trend);
  window->setRootViewController(detail);
  Utterances spoken = heard(detail->view());
  ASSERT_EQ(spoken.size(), 12U);
  spoken.resize(6);
  EXPECT_EQ(spoken, (Utterances{"Trending up, Last 90 days: 2,222 KM/H, Last 365 days: --",
                                "It Over the Year, heading", "January 1, 1970, 1.5 km/hr",
                                "January 3, 1970, 0 km/hr", "It by Weekday, heading",
                                "Monday, 365-day average, 3.25 km/hr, 90-day average, 0 km/hr"}));
  trend.weekdays.fill({});
  const auto withoutWeekdays = makeController<TrendDetailViewController>();
  withoutWeekdays->setTrend(&trend);
  EXPECT_EQ(heard(withoutWeekdays->view()).back(), "It Over the Year, heading");
}

TEST_F(TrendViewsTest, EveryTypeOfTrendIsSaidInItsUnit) {
  const char* const units[] = {"kcal",  "min",       "count", "m",    "count",
                               "count", "mL/kg·min", "km/hr", "km/hr"};
  for (std::size_t type = 0; type < std::size(units); ++type) {
    Trend trend = trendOf(static_cast<std::int64_t>(type), "It", TrendDirection::up);
    trend.bars = {{{0}, {0}, 1.5}};
    const auto chart = makeView<TrendDetailChartView>({0, 0, 300, 200});
    chart->setTrend(trend);
    show(chart);
    EXPECT_EQ(heard(chart).back(), std::string("January 1, 1970, 1.5 ") + units[type]);
  }
}

}  // namespace
}  // namespace tavro
