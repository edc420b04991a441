#include <functional>
#include <limits>
#include <tuple>

#include "host/screens/trends/TrendCharts.h"
#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuCache.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Answer = std::function<id(std::int64_t)>;
constexpr Name kAverage90 = "accessibiliytQuantity90ForIndex:";
constexpr Name kAverage365 = "accessibiliytQuantity365ForIndex:";
constexpr Name kDay = "accessibilityDayForStopIndex:";

id raising(std::int64_t /*index*/) { raise(kInvalidArgumentException, "no such column"); }
id nothing(std::int64_t /*index*/) { return nullptr; }

Answer kilocalories(double amount) {
  return [amount](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::kilocalorieUnit(), amount);
  };
}

const Utterances kTitleAlone{"Move, heading"};
constexpr std::string_view kAverages = "365-day average, 1 kcal, 90-day average, 2 kcal";

class DailyAverageTest : public PluginTest {
 protected:
  static Ref<NSArray> stopsAt(std::size_t count, double first, double width) {
    std::vector<id> stops;
    for (std::size_t column = 0; column < count; ++column) {
      stops.emplace_back(number(first + width * static_cast<double>(column)));
    }
    return arrayWithObjects(std::move(stops));
  }
  static void answer(const id& week, Name selector, const Answer& answer) {
    answers<id, std::int64_t>(week, selector, answer);
  }
  /// A chart whose averages are 1 and 2 kilocalories.
  Ref<TrendDetailDailyAverageView> weekWith(const id& stops) {
    auto week = makeView<TrendDetailDailyAverageView>({0, 0, 300, 120.9});
    as<UILabel>(week->titleLabel())->setText(string("Move"));
    answers(week, "dayStops", stops);
    answers(week, "accessibilityUnit", HKUnit::kilocalorieUnit());
    answer(week, kAverage365, kilocalories(1));
    answer(week, kAverage90, kilocalories(2));
    answer(week, kDay, [](std::int64_t index) { return number(index + 1); });
    show(week);
    return week;
  }
  Ref<TrendDetailDailyAverageView> usualWeek() { return weekWith(stopsAt(7, 10, 40)); }
};

TEST_F(DailyAverageTest, ColumnsAreAsWideAsTheFirstTwoStopsAreApart) {
  const auto week = usualWeek();
  as<UIView>(week->titleLabel())->setFrame({0, 0, 300, 15});
  const Ref<NSArray> elements = elementsOf(week);
  ASSERT_EQ(elements->count(), 8U);
  EXPECT_EQ((*elements)[0], week->titleLabel());
  for (std::size_t column = 0; column < 7; ++column) {
    EXPECT_EQ(frameOf((*elements)[column + 1]),
              CGRect(10 + 40 * static_cast<double>(column), 30, 40, 90));
  }
}

TEST_F(DailyAverageTest, AnElementCoversTheColumnThatTheHostDrew) {
  Settings::current().firstWeekday = 7;
  Trend trend;
  for (std::size_t day = 0; day < 7; ++day) {
    trend.weekdays.at(day) = {10.0 + static_cast<double>(day), 20.0 + static_cast<double>(day)};
  }
  const auto week = makeView<TrendDetailDailyAverageView>({0, 0, 350, 220});
  week->setTrend(trend);
  show(week);
  const auto heardElements = readElements(week);
  ASSERT_EQ(heardElements.size(), 8U);
  EXPECT_EQ(heardElements[1].utterance,
            "Saturday, 365-day average, 16 kcal, 90-day average, 26 kcal");
  EXPECT_EQ(heardElements[2].utterance,
            "Sunday, 365-day average, 10 kcal, 90-day average, 20 kcal");
  const Ref<NSArray> drawn = week->layer()->sublayers();
  for (std::size_t column = 0; column < 7; ++column) {
    const CGRect frame = heardElements[column + 1].frame;
    EXPECT_EQ(frame.origin.x, as<CALayer>((*drawn)[2 * column])->frame().origin.x);
    EXPECT_EQ(frame.maxX(), as<CALayer>((*drawn)[2 * column + 1])->frame().maxX());
  }
}

TEST_F(DailyAverageTest, WithoutSevenUsableStopsOrAUnitThereIsTheTitleAlone) {
  std::vector<id> textFirst(7, number(1.0));
  textFirst.front() = string("0");
  for (const id& stops : {id(), id(stopsAt(0, 0, 1)), id(stopsAt(6, 0, 1)), id(stopsAt(8, 0, 1)),
                          id(arrayWithObjects(textFirst)), id(string("no array"))}) {
    EXPECT_EQ(heard(weekWith(stops)), kTitleAlone);
  }
  for (const id& unit : {id(), id(string("kcal"))}) {
    const auto week = usualWeek();
    answers(week, "accessibilityUnit", unit);
    EXPECT_EQ(heard(week), kTitleAlone);
    EXPECT_EQ(elementsOf(week)->count(), 1U) << "nothing silent stands in a column's place";
  }
}

TEST_F(DailyAverageTest, AveragesAreRoundedHalfUpToTwoDecimals) {
  const Answer minutes = [](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::minuteUnit(), 30);
  };
  const Answer text = [](std::int64_t) { return string("30 kcal"); };
  const std::pair<Answer, const char*> cases[] = {
      {kilocalories(7.456), "7.46 kcal"},
      {kilocalories(7.454), "7.45 kcal"},
      {kilocalories(0.125), "0.13 kcal"},  // to even would be 0.12
      {kilocalories(1234), "1,234 kcal"},
      // What cannot be said in the unit is said as nothing recorded is: as 0.
      {&nothing, "0 kcal"},
      {&raising, "0 kcal"},
      {minutes, "0 kcal"},
      {text, "0 kcal"},
  };
  for (const auto& [average, expected] : cases) {
    const std::string spoken = expected;
    auto week = usualWeek();
    answer(week, kAverage365, average);
    EXPECT_EQ(heard(week).back(),
              "Saturday, 365-day average, " + spoken + ", 90-day average, 2 kcal");
    week = usualWeek();
    answer(week, kAverage90, average);
    EXPECT_EQ(heard(week).back(), "Saturday, 365-day average, 1 kcal, 90-day average, " + spoken);
  }
  const auto week = usualWeek();
  answer(week, kAverage90, kilocalories(std::numeric_limits<double>::infinity()));
  EXPECT_EQ(heard(week).back(), "Saturday, 365-day average, 1 kcal, 90-day average");
}

TEST_F(DailyAverageTest, AColumnWithoutAWeekdayStillSaysItsAverages) {
  const Answer days[] = {
      [](std::int64_t) { return number(std::int64_t{0}); },
      [](std::int64_t) { return number(std::int64_t{8}); },
      [](std::int64_t) { return number(std::int64_t{-1}); },
      [](std::int64_t) { return string("Monday"); },
      &nothing,
      &raising,
  };
  for (const Answer& day : days) {
    const auto week = usualWeek();
    answer(week, kDay, day);
    EXPECT_EQ(heard(week)[1], kAverages);
  }
}

TEST_F(DailyAverageTest, WeekdaysAreNamedWhateverTheCalendar) {
  for (const char* const calendar : {"hebrew", "islamic-umalqura", "buddhist"}) {
    Settings::current().calendar = calendar;
    const Utterances spoken = heard(usualWeek());
    ASSERT_EQ(spoken.size(), 8U);
    EXPECT_TRUE(spoken[1].starts_with("Sunday, ")) << calendar;
    EXPECT_TRUE(spoken[7].starts_with("Saturday, ")) << calendar;
  }
}

TEST_F(DailyAverageTest, TheListIsBuiltOnceALayout) {
  const auto week = usualWeek();
  id seen;
  int asked = 0;
  answer(week, kDay, [&](std::int64_t index) {
    ++asked;
    seen = send<id>(week, "accessibilityElements");
    return number(index + 1);
  });
  const Ref<NSArray> built = elementsOf(week);
  EXPECT_EQ(seen, built) << "a request during the build gets the list that is being built";
  const Utterances spoken = heard(week);
  const std::size_t formatters = icuFormattersCreated();
  answer(week, kAverage365, kilocalories(9));
  EXPECT_EQ(elementsOf(week), built);
  EXPECT_EQ(heard(week), spoken);
  EXPECT_EQ(asked, 7);
  EXPECT_EQ(icuFormattersCreated(), formatters);
  week->setNeedsLayout();
  week->layoutIfNeeded();
  EXPECT_NE(elementsOf(week), built);
  EXPECT_EQ(heard(week)[1], "Sunday, 365-day average, 9 kcal, 90-day average, 2 kcal");
}

}  // namespace
}  // namespace tavro
