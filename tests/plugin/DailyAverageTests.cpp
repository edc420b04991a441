#include <functional>
#include <limits>

#include "host/screens/trends/TrendCharts.h"
#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuCache.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;
using Answer = std::function<id(std::int64_t)>;

id raising(std::int64_t /*index*/) { raise(kInvalidArgumentException, "no such column"); }
id nothing(std::int64_t /*index*/) { return nullptr; }

Answer kilocalories(double amount) {
  return [amount](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::kilocalorieUnit(), amount);
  };
}

/// A chart whose host answers what a test wants it to answer.
class OddWeek : public TrendDetailDailyAverageView {
 public:
  static constexpr Name className = "OddWeek";
  id stops;
  id title;
  id unit = HKUnit::kilocalorieUnit();
  Answer average90 = kilocalories(2);
  Answer average365 = kilocalories(1);
  Answer day = [](std::int64_t index) { return number(index + 1); };
  int asked = 0;

  id oddInit() {
    TrendDetailDailyAverageView::init();
    title = TrendDetailDailyAverageView::titleLabel();
    as<UILabel>(title)->setText(string("Move"));
    return this;
  }
  id oddStops() { return stops; }
  id oddTitle() { return title; }
  id oddUnit() { return unit; }
  id odd90(std::int64_t index) { return average90(index); }
  id odd365(std::int64_t index) { return average365(index); }
  id oddDay(std::int64_t index) {
    ++asked;
    return day(index);
  }
};

const Registered oddWeek = defineClass<OddWeek, TrendDetailDailyAverageView>()
                               .method<&OddWeek::oddInit>("init")
                               .method<&OddWeek::oddStops>("dayStops")
                               .method<&OddWeek::oddTitle>("titleLabel")
                               .method<&OddWeek::oddUnit>("accessibilityUnit")
                               .method<&OddWeek::odd90>("accessibiliytQuantity90ForIndex:")
                               .method<&OddWeek::odd365>("accessibiliytQuantity365ForIndex:")
                               .method<&OddWeek::oddDay>("accessibilityDayForStopIndex:");

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
  Ref<OddWeek> weekWith(const id& stops) {
    auto week = makeView<OddWeek>({0, 0, 300, 120.9});
    week->stops = stops;
    show(week);
    return week;
  }
  Ref<OddWeek> usualWeek() { return weekWith(stopsAt(7, 10, 40)); }
};

TEST_F(DailyAverageTest, ColumnsAreAsWideAsTheFirstTwoStopsAreApart) {
  const auto week = usualWeek();
  as<UIView>(week->title)->setFrame({0, 0, 300, 15});
  const Ref<NSArray> elements = elementsOf(week);
  ASSERT_EQ(elements->count(), 8U);
  EXPECT_EQ((*elements)[0], week->title);
  for (std::size_t column = 0; column < 7; ++column) {
    EXPECT_EQ(send<CGRect>((*elements)[column + 1], "accessibilityFrame"),
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
  const Ref<NSArray> drawn = week->layer()->sublayers();
  ASSERT_EQ(heardElements.size(), 8U);
  EXPECT_EQ(heardElements[1].utterance,
            "Saturday, 365-day average, 16 kcal, 90-day average, 26 kcal");
  EXPECT_EQ(heardElements[2].utterance,
            "Sunday, 365-day average, 10 kcal, 90-day average, 20 kcal");
  for (std::size_t column = 0; column < 7; ++column) {
    const CGRect frame = heardElements[column + 1].frame;
    const CGRect left = as<CALayer>((*drawn)[2 * column])->frame();
    const CGRect right = as<CALayer>((*drawn)[2 * column + 1])->frame();
    EXPECT_EQ(frame.origin.x, left.origin.x) << column;
    EXPECT_EQ(frame.maxX(), right.maxX()) << column;
    EXPECT_EQ(frame.maxY(), left.maxY()) << column;
    EXPECT_LE(frame.origin.y, right.origin.y) << column;
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
    week->unit = unit;
    EXPECT_EQ(heard(week), kTitleAlone);
    EXPECT_EQ(elementsOf(week)->count(), 1U) << "nothing silent stands in a column's place";
  }
}

TEST_F(DailyAverageTest, AveragesAreRoundedHalfUpToTwoDecimals) {
  const Answer minutes = [](std::int64_t) {
    return HKQuantity::quantityWithUnit(HKUnit::minuteUnit(), 30);
  };
  const Answer text = [](std::int64_t) { return string("30 kcal"); };
  struct Case {
    Answer answer;
    const char* spoken;
  };
  const Case cases[] = {
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
  for (const Case& each : cases) {
    const std::string spoken = each.spoken;
    auto week = usualWeek();
    week->average365 = each.answer;
    EXPECT_EQ(heard(week).back(),
              "Saturday, 365-day average, " + spoken + ", 90-day average, 2 kcal");
    week = usualWeek();
    week->average90 = each.answer;
    EXPECT_EQ(heard(week).back(), "Saturday, 365-day average, 1 kcal, 90-day average, " + spoken);
  }
  const auto week = usualWeek();
  week->average90 = kilocalories(std::numeric_limits<double>::infinity());
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
    week->day = day;
    EXPECT_EQ(heard(week)[1], kAverages);
  }
}

TEST_F(DailyAverageTest, WeekdaysAreNamedInTheUsersLanguageWhateverTheCalendar) {
  struct Case {
    const char* locale;
    const char* calendar;
    const char* sunday;
    const char* saturday;
  };
  const Case cases[] = {
      {"en_US", "", "Sunday", "Saturday"},        {"en_US", "hebrew", "Sunday", "Saturday"},
      {"fr_FR", "", "dimanche", "samedi"},        {"ar_SA", "islamic-umalqura", "الأحد", "السبت"},
      {"th_TH", "buddhist", "วันอาทิตย์", "วันเสาร์"},
  };
  for (const Case& each : cases) {
    Settings::current().locale = each.locale;
    Settings::current().calendar = each.calendar;
    const auto week = usualWeek();
    const Utterances spoken = heard(week);
    ASSERT_EQ(spoken.size(), 8U);
    EXPECT_EQ(spoken[1].substr(0, spoken[1].find(", ")), each.sunday) << each.locale;
    EXPECT_EQ(spoken[7].substr(0, spoken[7].find(", ")), each.saturday) << each.locale;
  }
}

TEST_F(DailyAverageTest, TheListIsBuiltOnceALayout) {
  const auto week = usualWeek();
  id seen;
  week->day = [&](std::int64_t index) {
    seen = send<id>(week, "accessibilityElements");
    return number(index + 1);
  };
  const Ref<NSArray> built = elementsOf(week);
  EXPECT_EQ(seen, built) << "a request during the build gets the list that is being built";
  const Utterances spoken = heard(week);
  const std::size_t formatters = icuFormattersCreated();
  week->average365 = kilocalories(9);
  EXPECT_EQ(elementsOf(week), built);
  EXPECT_EQ(heard(week), spoken);
  EXPECT_EQ(week->asked, 7);
  EXPECT_EQ(icuFormattersCreated(), formatters);
  week->setNeedsLayout();
  week->layoutIfNeeded();
  EXPECT_NE(elementsOf(week), built);
  EXPECT_EQ(heard(week)[1], "Sunday, 365-day average, 9 kcal, 90-day average, 2 kcal");
}

}  // namespace
}  // namespace tavro
