#include "host/screens/trends/TrendControllers.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;

/// A metric whose host answers what a test wants it to answer.
class OddMetric : public TrendListMetricView {
 public:
  static constexpr Name className = "OddMetric";
  id title;
  id trend;
  bool raises = false;

  id oddTitle() { return title; }
  id oddTrend() {
    if (raises) {
      raise(kInvalidArgumentException, "no trend");
    }
    return trend;
  }
};
const Registered oddMetric = defineClass<OddMetric, TrendListMetricView>()
                                 .method<&OddMetric::oddTitle>("titleLabel")
                                 .method<&OddMetric::oddTrend>("trendString");

Trend trendOf(std::int64_t type, std::string title, TrendDirection direction) {
  Trend trend;
  trend.type = type;
  trend.title = std::move(title);
  trend.direction = direction;
  trend.averages = {1111.0, 2222.0};
  return trend;
}

class TrendViewsTest : public PluginTest {
 protected:
  void showScreen(const Ref<UIViewController>& controller) {
    window->setRootViewController(controller);
  }
};

TEST_F(TrendViewsTest, AMetricSaysTheTitleTheTrendAndTheValueThatItHas) {
  const id title = makeLabel("Move");
  const id trend = string("Trending up");
  struct Case {
    id title;
    id trend;
    bool raises;
    const char* spoken;
  };
  const Case cases[] = {
      {title, trend, false, "Move, Trending up, 2,222 KCAL, button"},
      {title, nullptr, false, "Move, 2,222 KCAL, button"},
      {title, string(""), false, "Move, 2,222 KCAL, button"},
      {title, title, false, "Move, 2,222 KCAL, button"},  // a trend that is no text
      {title, trend, true, "Move, 2,222 KCAL, button"},
      {nullptr, trend, false, "Trending up, 2,222 KCAL, button"},
      {make<UIImage>(), trend, false, "Trending up, 2,222 KCAL, button"},
  };
  for (const Case& each : cases) {
    const auto metric = makeView<OddMetric>({0, 0, 195, 72});
    metric->setTrend(trendOf(0, "Move", TrendDirection::up));
    metric->title = each.title;
    metric->trend = each.trend;
    metric->raises = each.raises;
    show(metric);
    EXPECT_EQ(heard(metric), Utterances{each.spoken});
  }
  const auto silent = makeView<OddMetric>({0, 0, 195, 72});
  EXPECT_EQ(send<id>(silent, "accessibilityLabel"), nullptr);
}

TEST_F(TrendViewsTest, AMetricSaysWhatItsLabelsSayNow) {
  const auto metric = makeView<TrendListMetricView>();
  metric->setTrend(trendOf(0, "Move", TrendDirection::up));
  metric->setTrend(trendOf(1, "Exercise", TrendDirection::down));
  EXPECT_EQ(labelOf(metric), "Exercise, Trending down, 2,222 MIN");
  as<UIView>(metric->valueLabel())->setHidden(true);
  EXPECT_EQ(labelOf(metric), "Exercise, Trending down");
}

TEST_F(TrendViewsTest, ATrendThatGoesDownSaysItsMetricThenWhatToDo) {
  Trend trend = trendOf(5, "Flights", TrendDirection::down);
  trend.advice = "Take the stairs.";
  const auto cell = makeView<TrendingDownTableViewCell>({0, 0, 390, 136});
  cell->setTrend(trend, {});
  show(cell);
  EXPECT_EQ(heard(cell),
            Utterances{"Flights, Trending down, 2,222 FLIGHTS, Take the stairs., button"});
  trend.advice = "";
  cell->setTrend(trend, {});
  EXPECT_EQ(heard(cell), Utterances{"Flights, Trending down, 2,222 FLIGHTS, button"});
}

TEST_F(TrendViewsTest, TheTraitsThatTheHostGaveStay) {
  const Ref<UIView> views[] = {makeView<TrendListMetricView>(),
                               makeView<TrendingDownTableViewCell>(),
                               makeView<TrendListHeaderView>()};
  for (const Ref<UIView>& view : views) {
    const auto own = send<UIAccessibilityTraits>(view, "accessibilityTraits");
    send<void>(view, "setAccessibilityTraits:", UIAccessibilityTraitSelected);
    EXPECT_EQ(send<UIAccessibilityTraits>(view, "accessibilityTraits"),
              own | UIAccessibilityTraitSelected);
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
  EXPECT_TRUE(send<bool>(elements.back().element, "accessibilityActivate"));
  EXPECT_EQ(taps, 10) << "a tap on a metric is one on its button";
  EXPECT_LE(elements.front().frame.maxX(), elements.back().frame.origin.x);

  const auto later = makeView<UIButton>();
  later->setTitle(string("More"));
  cell->addSubview(later);
  EXPECT_TRUE(send<bool>(later, "isAccessibilityElement"));
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
  std::vector<Trend> trends{
      trendOf(0, "Move", TrendDirection::up), trendOf(1, "Exercise", TrendDirection::steady),
      trendOf(4, "Steps", TrendDirection::up), trendOf(3, "Distance", TrendDirection::up),
      trendOf(5, "Flights", TrendDirection::down)};
  const auto list = makeController<TrendsViewController>();
  list->setTrends(&trends);
  showScreen(list);
  EXPECT_EQ(heard(list->view()),
            (Utterances{"Trending down, heading", "Flights, Trending down, 2,222 FLIGHTS, button",
                        "Trending up, heading", "Move, Trending up, 2,222 KCAL, button",
                        "Steps, Trending up, 2,222 STEPS, button",
                        "Distance, Trending up, 2,222 M, button", "Holding steady, heading",
                        "Exercise, Holding steady, 2,222 MIN, button"}));
  for (const std::size_t opened : {1U, 4U}) {
    showScreen(list);
    const std::vector<HeardElement> elements = readElements(list->view());
    EXPECT_TRUE(send<bool>(elements[opened].element, "accessibilityActivate"));
    EXPECT_EQ(utf8(window->rootViewController()->navigationItem()->title),
              opened == 1 ? "Flights" : "Steps");
  }
}

TEST_F(TrendViewsTest, EveryTypeOfTrendIsSaidInItsUnit) {
  const char* const units[] = {"kcal",  "min",       "count", "m",    "count",
                               "count", "mL/kg·min", "km/hr", "km/hr"};
  const char* const shown[] = {"2,222 KCAL",    "2,222 MIN",   "2,222 HR",
                               "2,222 M",       "2,222 STEPS", "2,222 FLIGHTS",
                               "2,222 VO₂ MAX", "2,222 KM/H",  "2,222 KM/H"};
  for (std::size_t type = 0; type < std::size(units); ++type) {
    Trend trend = trendOf(static_cast<std::int64_t>(type), "It", TrendDirection::up);
    trend.averages.average365 = std::nullopt;
    trend.bars = {{{0}, {0}, 1.5}, {{1}, {1}, std::nullopt}, {{2}, {2}, 0.0}};
    trend.weekdays.fill({3.25, std::nullopt});
    const std::string unit = units[type];
    const auto detail = makeController<TrendDetailViewController>();
    detail->setTrend(&trend);
    showScreen(detail);
    Utterances spoken = heard(detail->view());
    ASSERT_EQ(spoken.size(), 12U) << unit;
    spoken.resize(6);
    const std::string summary = "Trending up, Last 90 days: ";
    const std::string weekday = "Monday, 365-day average, 3.25 ";
    EXPECT_EQ(spoken, (Utterances{summary + shown[type] + ", Last 365 days: --",
                                  "It Over the Year, heading", "January 1, 1970, 1.5 " + unit,
                                  "January 3, 1970, 0 " + unit, "It by Weekday, heading",
                                  weekday + unit + ", 90-day average, 0 " + unit}));
    trend.weekdays.fill({});
    const auto withoutWeekdays = makeController<TrendDetailViewController>();
    withoutWeekdays->setTrend(&trend);
    EXPECT_EQ(heard(withoutWeekdays->view()).back(), "It Over the Year, heading");
  }
}

}  // namespace
}  // namespace tavro
