#include <gtest/gtest.h>

#include <tuple>

#include "host/Dates.h"
#include "host/screens/calendar/MonthScrollViewController.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

std::string textOf(const id& label) { return utf8(as<UILabel>(label)->text()); }

Ref<MonthScrollView> monthsOf(const CalendarSpan& span, double height) {
  auto months = makeView<MonthScrollView>();
  months->setSpan(span);
  months->setFrame({0, 0, 350, height});
  months->layoutIfNeeded();
  return months;
}

/// The rows of a month, each as its days' places from the left.
std::vector<std::vector<int>> columnsOf(const MonthView& month) {
  std::vector<std::vector<int>> rows;
  for (const Ref<UIView>& row : month.subviewList()) {
    std::vector<int>& columns = rows.emplace_back();
    const Ref<NSArray> days = row->layer()->sublayers();
    for (const id& day : *days) {
      columns.push_back(static_cast<int>(as<CALayer>(day)->frame().origin.x / 50));
    }
  }
  return rows;
}

const CalendarDay kToday{daysFromCivil(2026, 3, 11)};

TEST(MonthCalendarTest, MonthsAreWholeAndTheUsers) {
  const std::tuple<const char*, CalendarDay, std::vector<std::string>, std::size_t> cases[] = {
      {"", kToday, {"03"}, 31},
      {"", {daysFromCivil(2025, 12, 31)}, {"12", "01", "02", "03"}, 31},
      {"hebrew", {daysFromCivil(2026, 2, 17)}, {"05", "06"}, 30},  // 30 Shevat
  };
  for (const auto& [calendar, first, expected, daysOfTheFirst] : cases) {
    Settings::current().calendar = calendar;
    const auto months = monthsOf({first, kToday, kToday, {}}, 800);
    std::vector<std::string> titles;
    for (const Ref<MonthView>& month : months->months()) {
      const auto firstWeek = as<MonthWeekView>(month->subviewList().front());
      titles.push_back(textOf(firstWeek->monthTitleView()));
    }
    EXPECT_EQ(titles, expected) << calendar;
    std::size_t days = 0;
    for (const auto& row : columnsOf(*months->months().front())) {
      days += row.size();
    }
    EXPECT_EQ(days, daysOfTheFirst) << calendar;
  }
}

TEST(MonthCalendarTest, WeeksBeginWhereTheUsersDo) {
  const std::tuple<std::int64_t, const char*, std::vector<int>, std::size_t> cases[] = {
      {2, "en_US", {6}, 6},
      {1, "en_US", {0, 1, 2, 3, 4, 5, 6}, 5},
      {7, "en_US", {1, 2, 3, 4, 5, 6}, 5},
      {1, "he_IL", {6, 5, 4, 3, 2, 1, 0}, 5},
      {2, "ar_EG", {0}, 6},
  };
  for (const auto& [firstWeekday, locale, firstRow, expected] : cases) {
    Settings::current().firstWeekday = firstWeekday;
    Settings::current().locale = locale;
    const auto months = monthsOf({kToday, kToday, kToday, {}}, 800);
    const auto rows = columnsOf(*months->months().front());
    EXPECT_EQ(rows.front(), firstRow) << locale << " " << firstWeekday;
    EXPECT_EQ(rows.size(), expected) << locale << " " << firstWeekday;
  }
}

TEST(MonthCalendarTest, DaysKnowTodayTheFutureAndTheirWorkouts) {
  Diary diary;
  diary.days.emplace_back().date = {daysFromCivil(2026, 3, 10)};
  diary.workouts.emplace_back().start = {"2026-03-10T23:30"};
  Settings::current().timeZone = "America/New_York";
  Settings::current().now = secondsFromIso("2026-03-11T20:20").value();
  const auto months = monthsOf(calendarSpanOf(diary), 800);
  const auto week = months->months().front()->subviewList()[2];  // the 9th to the 15th
  const Ref<NSArray> days = week->layer()->sublayers();
  for (std::size_t index = 0; index < days->count(); ++index) {
    const auto day = as<MonthDayCellLayer>((*days)[index]);
    EXPECT_EQ(dayOf(day->date()).number, kToday.number - 2 + static_cast<std::int64_t>(index));
    EXPECT_EQ(day->representsToday(), index == 2) << index;
    EXPECT_EQ(day->isFutureDay(), index > 2) << index;
    EXPECT_EQ(day->_hasWorkout, index == 1) << index;
  }
}

TEST(MonthCalendarTest, OnlyMonthsOnScreenAreShown) {
  const auto months = monthsOf({{daysFromCivil(2025, 3, 1)}, kToday, kToday, {}}, 600);
  const auto shown = [&] {
    std::vector<std::size_t> indexes;
    for (std::size_t index = 0; index < months->months().size(); ++index) {
      if (!months->months()[index]->isHidden()) {
        indexes.push_back(index);
      }
    }
    return indexes;
  };
  EXPECT_EQ(shown(), (std::vector<std::size_t>{11, 12})) << "it opens at the end";
  months->scrollTo(0);
  EXPECT_EQ(shown(), (std::vector<std::size_t>{0, 1}));
  months->scrollTo(1e9);
  EXPECT_EQ(shown(), (std::vector<std::size_t>{11, 12}));
  EXPECT_EQ(months->bounds().maxY(), months->contentHeight());
  months->setFrame({0, 0, 350, months->contentHeight()});
  months->layoutIfNeeded();
  EXPECT_EQ(shown().size(), 13U);
}

}  // namespace
}  // namespace tavro
