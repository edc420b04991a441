#include <functional>
#include <tuple>

#include "host/screens/trends/TrendCharts.h"
#include "platform/foundation/IcuCache.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Answer = std::function<id(std::int64_t)>;
constexpr Name kQuantity = "accessibilityQuantityForIndex:";
constexpr Name kInterval = "accessibilityDateIntervalForIndex:";
constexpr Name kUnit = "accessibilityUnit";

id raising(std::int64_t /*index*/) { raise(kInvalidArgumentException, "no such bar"); }

Ref<HKQuantity> meters(double amount) {
  return HKQuantity::quantityWithUnit(HKUnit::meterUnit(), amount);
}

id metersOfIndex(std::int64_t index) { return meters(static_cast<double>(index)); }
id dayOfIndex(std::int64_t index) {
  const Ref<NSDate> day = dateWithSeconds(static_cast<double>(index) * 86400);
  return dateInterval(day, day);
}

const Utterances kTitleAlone{"Distance, heading"};
const Utterances kThreeBars{"Distance, heading", "January 1, 1970, 0 m", "January 2, 1970, 1 m",
                            "January 3, 1970, 2 m"};

class TrendChartTest : public PluginTest {
 protected:
  static void answer(const id& chart, Name selector, const Answer& answer) {
    answers<id, std::int64_t>(chart, selector, answer);
  }
  /// A chart that says how many meters each day is after the first.
  static Ref<TrendDetailChartView> makeChart(const id& stops) {
    auto chart = makeView<TrendDetailChartView>({10, 100, 300, 200.7});
    as<UILabel>(chart->titleLabel())->setText(string("Distance"));
    answers(chart, "barStops", stops);
    answers(chart, kUnit, HKUnit::meterUnit());
    answer(chart, kQuantity, &metersOfIndex);
    answer(chart, kInterval, &dayOfIndex);
    return chart;
  }
  Ref<TrendDetailChartView> shownChart(const id& stops) {
    auto chart = makeChart(stops);
    show(chart);
    return chart;
  }
  Ref<TrendDetailChartView> shownChart() {
    return shownChart(arrayWithObjects({number(0.0), number(50.0), number(120.0)}));
  }
  static void layOut(const Ref<UIView>& chart) {
    chart->setNeedsLayout();
    chart->layoutIfNeeded();
  }
};

TEST_F(TrendChartTest, BarsSpeakTheirDaysAndAmountsInTheUsersCalendar) {
  Settings::current().calendar = "hebrew";
  Trend trend;
  trend.type = 3;
  trend.bars = {{{daysFromCivil(2025, 3, 1)}, {daysFromCivil(2025, 3, 31)}, 1234.567}};
  const auto chart = makeView<TrendDetailChartView>({0, 0, 300, 200});
  chart->setTrend(trend);
  show(chart);
  EXPECT_EQ(heard(chart).back(), "1 Adar\u2009–\u20092 Nisan 5785, 1,234.57 m");
}

TEST_F(TrendChartTest, ABarStandsOneWidthRightOfItsStopBelowTheTitle) {
  const auto chart = shownChart();
  as<UIView>(chart->titleLabel())->setFrame({0, 5, 300, 20});
  const Ref<NSArray> elements = elementsOf(chart);
  ASSERT_EQ(elements->count(), 4U);
  EXPECT_EQ((*elements)[0], chart->titleLabel());
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
  const auto atOne = [](const Answer& odd, const Answer& usual) -> Answer {
    return [odd, usual](std::int64_t index) { return index == 1 ? odd(index) : usual(index); };
  };
  const Answer nothing = [](std::int64_t) { return nullptr; };
  const Answer text = [](std::int64_t) { return string("1 m"); };
  const Answer minutes = [](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::minuteUnit(), 1);
  };
  for (const Answer& odd : {nothing, text, minutes, Answer(&raising)}) {
    const auto chart = shownChart();
    answer(chart, kQuantity, atOne(odd, &metersOfIndex));
    EXPECT_EQ(heard(chart), (Utterances{kThreeBars[0], kThreeBars[1], kThreeBars[3]}));
  }
  for (const Answer& odd : {nothing, text, Answer(&raising)}) {
    auto chart = shownChart();
    answer(chart, kInterval, atOne(odd, &dayOfIndex));
    EXPECT_EQ(heard(chart), (Utterances{kThreeBars[0], kThreeBars[1], kThreeBars[3]}));
    chart = shownChart();
    answers<id>(chart, kUnit, [odd] { return odd(0); });
    EXPECT_EQ(heard(chart), kTitleAlone);
  }
}

TEST_F(TrendChartTest, TheUnitIsReadForEveryBar) {
  const auto chart = shownChart();
  answer(chart, kQuantity, [](std::int64_t) { return meters(1500); });
  answers<id>(chart, kUnit, [read = 0]() mutable {
    return read++ == 1 ? HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix::kilo)
                       : HKUnit::meterUnit();
  });
  EXPECT_EQ(heard(chart), (Utterances{"Distance, heading", "January 1, 1970, 1,500 m",
                                      "January 2, 1970, 1.5 km", "January 3, 1970, 1,500 m"}));
}

TEST_F(TrendChartTest, WithoutUsableStopsThereIsTheTitleAlone) {
  for (const id& stops : {id(), id(arrayWithObjects({})), id(string("no array")),
                          id(arrayWithObjects({string("0"), number(1.0)}))}) {
    EXPECT_EQ(heard(shownChart(stops)), kTitleAlone);
  }
}

TEST_F(TrendChartTest, OnlyTheFirstStopIsChecked) {
  const auto chart = shownChart(arrayWithObjects({number(7.0), string("far"), number(9.0)}));
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
    answers(chart, "titleLabel", title);
    show(chart);
    const Ref<NSArray> elements = elementsOf(chart);
    EXPECT_EQ(elements->count(), 3U);
    EXPECT_EQ(frameOf((*elements)[0]), CGRect(10 + 100, 100, 100, 200));
  }
}

TEST_F(TrendChartTest, ARequestDuringTheBuildGetsTheSameListAndStartsNoOther) {
  const auto chart = shownChart();
  id seen;
  int reads = 0;
  answer(chart, kQuantity, [&](std::int64_t index) {
    ++reads;
    seen = send<id>(chart, "accessibilityElements");
    return metersOfIndex(index);
  });
  EXPECT_EQ(elementsOf(chart), seen);
  EXPECT_EQ(heard(chart), kThreeBars);
  EXPECT_EQ(reads, 3);
}

TEST_F(TrendChartTest, NothingIsBuiltBetweenLayouts) {
  const auto chart = shownChart();
  const Ref<NSArray> built = elementsOf(chart);
  EXPECT_EQ(heard(chart), kThreeBars);
  const std::size_t formatters = icuFormattersCreated();
  answer(chart, kQuantity, [](std::int64_t) { return meters(5); });
  EXPECT_EQ(elementsOf(chart), built);
  EXPECT_EQ(heard(chart), kThreeBars);
  EXPECT_EQ(icuFormattersCreated(), formatters);
  layOut(chart);
  EXPECT_NE(elementsOf(chart), built);
  EXPECT_EQ(heard(chart).back(), "January 3, 1970, 5 m");
  answers(chart, "barStops", nullptr);
  layOut(chart);
  EXPECT_EQ(heard(chart), kTitleAlone) << "what is gone after a layout is not said any more";
}

TEST_F(TrendChartTest, AYearOfDaysNeedsOneFormatterOfEachKind) {
  std::vector<id> stops(365);
  std::ranges::generate(stops, [x = 0.0]() mutable { return number(x++); });
  const auto chart = shownChart(arrayWithObjects(stops));
  const std::size_t formatters = icuFormattersCreated();
  EXPECT_EQ(elementsOf(chart)->count(), 366U);
  EXPECT_EQ(icuFormattersCreated() - formatters, 2U) << "one for spans of days, one for amounts";
  EXPECT_EQ(valueOf((*elementsOf(chart))[365]), "364 m");
}

}  // namespace
}  // namespace tavro
