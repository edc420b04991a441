#include <functional>

#include "host/screens/trends/TrendCharts.h"
#include "platform/foundation/IcuCache.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;
using Answer = std::function<id(std::int64_t)>;

id raising(std::int64_t /*index*/) { raise(kInvalidArgumentException, "no such bar"); }

Ref<HKQuantity> meters(double amount) {
  return HKQuantity::quantityWithUnit(HKUnit::meterUnit(), amount);
}

/// A chart whose host answers what a test wants it to answer.
class OddTrendChart : public TrendDetailChartView {
 public:
  static constexpr Name className = "OddTrendChart";
  id stops;
  id title;
  Answer unit = [](std::int64_t) { return HKUnit::meterUnit(); };
  Answer quantity = [](std::int64_t index) { return meters(static_cast<double>(index)); };
  Answer interval = [](std::int64_t index) {
    const auto day = static_cast<double>(index) * 86400;
    return dateInterval(dateWithSeconds(day), dateWithSeconds(day));
  };
  std::int64_t unitReads = 0;
  std::int64_t quantityReads = 0;

  id oddInit() {
    TrendDetailChartView::init();
    title = TrendDetailChartView::titleLabel();
    as<UILabel>(title)->setText(string("Distance"));
    return this;
  }
  id oddStops() { return stops; }
  id oddTitle() { return title; }
  id oddUnit() { return unit(unitReads++); }
  id oddQuantity(std::int64_t index) {
    ++quantityReads;
    return quantity(index);
  }
  id oddInterval(std::int64_t index) { return interval(index); }
};

using Odd = OddTrendChart;
const Registered oddChart = defineClass<Odd, TrendDetailChartView>()
                                .method<&Odd::oddInit>("init")
                                .method<&Odd::oddStops>("barStops")
                                .method<&Odd::oddTitle>("titleLabel")
                                .method<&Odd::oddUnit>("accessibilityUnit")
                                .method<&Odd::oddQuantity>("accessibilityQuantityForIndex:")
                                .method<&Odd::oddInterval>("accessibilityDateIntervalForIndex:");

const Utterances kTitleAlone{"Distance, heading"};
const Utterances kThreeBars{"Distance, heading", "January 1, 1970, 0 m", "January 2, 1970, 1 m",
                            "January 3, 1970, 2 m"};

class TrendChartTest : public PluginTest {
 protected:
  static Ref<OddTrendChart> makeChart(const id& stops) {
    auto chart = makeView<OddTrendChart>({10, 100, 300, 200.7});
    chart->stops = stops;
    return chart;
  }
  /// A chart on screen, with stops at 0, 50 and 120.
  Ref<OddTrendChart> shownChart() {
    auto chart = makeChart(arrayWithObjects({number(0.0), number(50.0), number(120.0)}));
    show(chart);
    return chart;
  }
  static CGRect frameOf(const id& element) { return send<CGRect>(element, "accessibilityFrame"); }
  static void layOut(const Ref<UIView>& chart) {
    chart->setNeedsLayout();
    chart->layoutIfNeeded();
  }
};

TEST_F(TrendChartTest, BarsSpeakTheirDaysAndAmountsInTheUsersLocale) {
  struct Case {
    const char* locale;
    const char* calendar;
    const char* bar;
  };
  const Case cases[] = {
      {"en_US", "", "March 1\u2009–\u200931, 2025, 1,234.57 m"},
      {"de_DE", "", "1.–31. März 2025, 1.234,57 m"},
      {"ja_JP", "", "2025年3月1日～31日, 1,234.57 m"},
      {"en_US", "hebrew", "1 Adar\u2009–\u20092 Nisan 5785, 1,234.57 m"},
  };
  for (const Case& each : cases) {
    Settings::current().locale = each.locale;
    Settings::current().calendar = each.calendar;
    Trend trend;
    trend.type = 3;
    trend.bars = {{{daysFromCivil(2025, 3, 1)}, {daysFromCivil(2025, 3, 31)}, 1234.567}};
    const auto chart = makeView<TrendDetailChartView>({0, 0, 300, 200});
    chart->setTrend(trend);
    show(chart);
    EXPECT_EQ(heard(chart).back(), each.bar) << each.locale;
  }
}

TEST_F(TrendChartTest, ABarStandsOneWidthRightOfItsStopBelowTheTitle) {
  const auto chart = shownChart();
  as<UIView>(chart->title)->setFrame({0, 5, 300, 20});
  const Ref<NSArray> elements = elementsOf(chart);
  ASSERT_EQ(elements->count(), 4U);
  EXPECT_EQ((*elements)[0], chart->title);
  // 40 is twice the title's height, not its lower edge; 160 is what 200.7 leaves, rounded down.
  EXPECT_EQ(frameOf((*elements)[1]), CGRect(10 + 100 + 0, 100 + 40, 100, 160));
  EXPECT_EQ(frameOf((*elements)[2]), CGRect(10 + 100 + 50, 140, 100, 160));
  EXPECT_EQ(frameOf((*elements)[3]), CGRect(10 + 100 + 120, 140, 100, 160));
}

TEST_F(TrendChartTest, AnElementCoversTheBarThatTheHostDrew) {
  Trend trend;
  for (int day = 0; day < 4; ++day) {
    trend.bars.push_back({{day}, {day}, 1.0 + day});
  }
  const auto chart = makeView<TrendDetailChartView>({10, 100, 300, 200});
  chart->setTrend(trend);
  show(chart);
  const Ref<NSArray> elements = elementsOf(chart);
  const Ref<NSArray> drawn = chart->layer()->sublayers();
  ASSERT_EQ(elements->count(), 5U);
  for (std::size_t bar = 0; bar < 4; ++bar) {
    const CGRect column = frameOf((*elements)[bar + 1]);
    const CGRect layer = as<CALayer>((*drawn)[bar])->frame();
    EXPECT_EQ(column.origin.x, 10 + layer.origin.x) << bar;
    EXPECT_EQ(column.size.width, layer.size.width) << bar;
    EXPECT_EQ(column.maxY(), 100 + layer.maxY()) << bar;
  }
  const CGRect tallest = as<CALayer>((*drawn)[3])->frame();
  EXPECT_EQ(tallest.size.height, frameOf((*elements)[4]).size.height);
}

TEST_F(TrendChartTest, ABarThatCannotBeSaidIsLeftOut) {
  const auto atOne = [](const Answer& odd, const Answer& usual) {
    return [odd, usual](std::int64_t index) { return index == 1 ? odd(index) : usual(index); };
  };
  const Answer nothing = [](std::int64_t) { return nullptr; };
  const Answer text = [](std::int64_t) { return string("1 m"); };
  const Answer minutes = [](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::minuteUnit(), 1);
  };
  for (const Answer& odd : {nothing, text, minutes, Answer(&raising)}) {
    const auto chart = shownChart();
    chart->quantity = atOne(odd, chart->quantity);
    EXPECT_EQ(heard(chart), (Utterances{kThreeBars[0], kThreeBars[1], kThreeBars[3]}));
  }
  for (const Answer& odd : {nothing, text, Answer(&raising)}) {
    auto chart = shownChart();
    chart->interval = atOne(odd, chart->interval);
    EXPECT_EQ(heard(chart), (Utterances{kThreeBars[0], kThreeBars[1], kThreeBars[3]}));
    chart = shownChart();
    chart->unit = odd;
    EXPECT_EQ(heard(chart), kTitleAlone);
  }
}

TEST_F(TrendChartTest, TheUnitIsReadForEveryBar) {
  const auto chart = shownChart();
  chart->quantity = [](std::int64_t) { return meters(1500); };
  chart->unit = [](std::int64_t read) {
    return read == 1 ? HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo)
                     : HKUnit::meterUnit();
  };
  EXPECT_EQ(heard(chart), (Utterances{"Distance, heading", "January 1, 1970, 1,500 m",
                                      "January 2, 1970, 1.5 km", "January 3, 1970, 1,500 m"}));
}

TEST_F(TrendChartTest, WithoutUsableStopsThereIsTheTitleAlone) {
  for (const id& stops : {id(), id(arrayWithObjects({})), id(string("no array")),
                          id(arrayWithObjects({string("0"), number(1.0)}))}) {
    const auto chart = makeChart(stops);
    show(chart);
    EXPECT_EQ(heard(chart), kTitleAlone);
  }
}

TEST_F(TrendChartTest, OnlyTheFirstStopIsChecked) {
  const auto chart = makeChart(arrayWithObjects({number(7.0), string("far"), number(9.0)}));
  show(chart);
  EXPECT_EQ(heard(chart), kThreeBars);
  EXPECT_EQ(frameOf((*elementsOf(chart))[2]).origin.x, 10 + 100 + 0);
  EXPECT_EQ(frameOf((*elementsOf(chart))[3]).origin.x, 10 + 100 + 9);
}

TEST_F(TrendChartTest, BeforeTheFirstLayoutThereIsTheTitleAlone) {
  const auto chart = makeChart(arrayWithObjects({number(0.0), number(1.0), number(2.0)}));
  EXPECT_EQ(heard(chart), kTitleAlone);
  show(chart);
  EXPECT_EQ(heard(chart), kThreeBars);
}

TEST_F(TrendChartTest, WithoutATitleTheBarsAreStillListedFromTheTop) {
  for (const id& title : {id(), id(string("Distance"))}) {
    const auto chart = makeChart(arrayWithObjects({number(0.0), number(1.0), number(2.0)}));
    chart->title = title;
    show(chart);
    const Ref<NSArray> elements = elementsOf(chart);
    EXPECT_EQ(elements->count(), 3U);
    EXPECT_EQ(frameOf((*elements)[0]), CGRect(10 + 100, 100, 100, 200));
  }
}

TEST_F(TrendChartTest, ARequestDuringTheBuildGetsTheSameListAndStartsNoOther) {
  const auto chart = shownChart();
  id seen;
  chart->quantity = [&, usual = chart->quantity](std::int64_t index) {
    seen = send<id>(chart, "accessibilityElements");
    return usual(index);
  };
  EXPECT_EQ(elementsOf(chart), seen);
  EXPECT_EQ(heard(chart), kThreeBars);
  EXPECT_EQ(chart->quantityReads, 3);
}

TEST_F(TrendChartTest, NothingIsBuiltBetweenLayouts) {
  const auto chart = shownChart();
  const Ref<NSArray> built = elementsOf(chart);
  EXPECT_EQ(heard(chart), kThreeBars);
  const std::size_t formatters = icuFormattersCreated();
  const std::int64_t reads = chart->quantityReads + chart->unitReads;
  chart->quantity = [](std::int64_t) { return meters(5); };
  EXPECT_EQ(elementsOf(chart), built);
  EXPECT_EQ(heard(chart), kThreeBars);
  EXPECT_EQ(icuFormattersCreated(), formatters);
  EXPECT_EQ(chart->quantityReads + chart->unitReads, reads);
  layOut(chart);
  EXPECT_NE(elementsOf(chart), built);
  EXPECT_EQ(heard(chart).back(), "January 3, 1970, 5 m");
  chart->stops = nullptr;
  layOut(chart);
  EXPECT_EQ(heard(chart), kTitleAlone) << "what is gone after a layout is not said any more";
}

TEST_F(TrendChartTest, AYearOfDaysNeedsOneFormatterOfEachKind) {
  std::vector<id> stops(365);
  std::ranges::generate(stops, [x = 0.0]() mutable { return number(x++); });
  const auto chart = makeChart(arrayWithObjects(stops));
  show(chart);
  const std::size_t formatters = icuFormattersCreated();
  EXPECT_EQ(elementsOf(chart)->count(), 366U);
  EXPECT_EQ(icuFormattersCreated() - formatters, 2U) << "one for spans of days, one for amounts";
  EXPECT_EQ(valueOf((*elementsOf(chart))[365]), "364 m");
}

}  // namespace
}  // namespace tavro
