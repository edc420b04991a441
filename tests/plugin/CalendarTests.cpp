#include <tuple>

#include "host/screens/calendar/MonthViewController.h"
#include "host/screens/calendar/PaletteViewController.h"
#include "platform/accessibility/SafeCategory.h"
#include "tests/support/Rings.h"

namespace tavro {
namespace {

/// A calendar whose bar has no button, and whose months have no scroll view.
class BareMonthViewController : public UIViewController {
 public:
  static constexpr Name className = "BareMonthViewController";
  id nothing() { return nullptr; }
};
const Registered bareController = defineClass<BareMonthViewController, UIViewController>()
                                      .method<&BareMonthViewController::nothing>("navigationItem");

const CalendarDay kToday{daysFromCivil(2026, 3, 11)};

struct DayState {
  bool isToday = false;
  bool isFuture = false;
  bool hasWorkout = false;
};

class CalendarTest : public RingsTest {
 protected:
  static Ref<MonthDayCellLayer> cellFor(std::string_view day, DayState state = {}) {
    auto cell = make<MonthDayCellLayer>();
    cell->setDate(at(day), state.isToday);
    cell->setFutureDay(state.isFuture);
    cell->_hasWorkout = state.hasWorkout;
    return cell;
  }

  Ref<MonthWeekView> rowWith(const std::vector<Ref<MonthDayCellLayer>>& cells) {
    const auto row = makeView<MonthWeekView>({0, 0, 350, 100});
    for (std::size_t column = 0; column < cells.size(); ++column) {
      row->addDayCell(cells[column], column);
    }
    show(row);
    return row;
  }

  static CalendarSpan span(CalendarDay first, CalendarDay today) {
    return {first, today, today, {}};
  }
};

TEST_F(CalendarTest, ADaySaysItsDateItsWorkoutAndItsRings) {
  record(daysFromCivil(2026, 3, 9), 0.5, 1, 0);
  record(daysFromCivil(2026, 3, 10), 1, -1, 1);
  record(daysFromCivil(2026, 3, 11), 1, 1, 1);
  record(daysFromCivil(2026, 3, 12), 1, 1, 1);
  const std::tuple<const char*, DayState, const char*> cases[] = {
      {"2026-03-11",
       {.isToday = true, .hasWorkout = true},
       "Today, March 11, Worked out, All goals completed"},
      {"2026-03-11", {.isToday = true}, "Today, March 11, All goals completed"},
      {"2026-03-09",
       {},
       "March 9, Calories burned, 50%, Exercise minutes, Goal completed, Stand hours, 0%"},
      {"2026-03-12", {.isFuture = true, .hasWorkout = true}, "March 12, No data"},
      {"2026-03-08", {.hasWorkout = true}, "March 8, Worked out"},
      {"2026-03-10", {.hasWorkout = true}, "March 10, Worked out"},  // a ring without data
      {"2026-03-10", {}, "March 10, No data"},
      {"2026-03-08", {}, "March 8, No data"},
  };
  for (const auto& [day, state, expected] : cases) {
    EXPECT_EQ(heard(rowWith({cellFor(day, state)})), Utterances{expected});
  }
}

TEST_F(CalendarTest, ADaySaysItsWeekdayUntilAMonthRowHasListedIt) {
  const std::tuple<const char*, const char*, const char*, const char*> cases[] = {
      {"en_US", "", "Today, Wednesday", "Today, March 11, All goals completed"},
      {"he_IL", "", "היום, יום רביעי", "היום, 11 במרץ, כל היעדים הושגו"},
      // The cache's day is Gregorian.
      {"en_US", "hebrew", "Today, Wednesday", "Today, 22 Adar, All goals completed"},
  };
  record(daysFromCivil(2026, 3, 11), 1, 1, 1);
  for (const auto& [locale, calendar, alone, inMonth] : cases) {
    Settings::current().locale = locale;
    Settings::current().calendar = calendar;
    const auto cell = cellFor("2026-03-11", {.isToday = true});
    const auto row = rowWith({cell});
    EXPECT_EQ(labelOf(cell), alone);
    EXPECT_EQ(heard(row), Utterances{inMonth});
  }
  const auto elsewhere = cellFor("2026-03-11");
  send<void>(elsewhere, "setAccessibilityContainer:", makeView<HKCalendarWeekView>());
  Settings::current().calendar = "";
  EXPECT_EQ(labelOf(elsewhere), "Wednesday");
}

TEST_F(CalendarTest, WhatADayCannotAnswerIsLeftOut) {
  const auto cell = cellFor("2026-03-11", {.isToday = true, .hasWorkout = true});
  answers<bool>(cell, "isFutureDay", [] { return raise("Odd", "on purpose"), false; });
  answers(cell, "date", string("2026-03-10"));
  EXPECT_EQ(heard(rowWith({cell})), Utterances{"Today, Worked out"});
  cell->_hasWorkout = false;
  EXPECT_EQ(valueOf(cell), "No data");
}

TEST_F(CalendarTest, ADaysFrameHoldsItsRings) {
  const auto cell = cellFor("2026-03-11");
  EXPECT_EQ(frameOf(cell), CGRect(-10, 0, 20, 70)) << "no view above it";
  const auto row = rowWith({cell});
  cell->setFrame({100, 40, 30, 30});
  static_cast<void>(elementsOf(row));
  EXPECT_EQ(frameOf(cell), CGRect(90, 40, 50, 100));
  row->setFrame({5, 200, 350, 100});
  EXPECT_EQ(frameOf(cell), CGRect(95, 240, 50, 100));
}

TEST_F(CalendarTest, ARowIsReadInTheDirectionOfTheLanguage) {
  const auto titledRow = [this](const char* locale) {
    Settings::current().locale = locale;
    const auto row = makeView<MonthWeekView>({0, 0, 350, 140});
    row->addDayCell(cellFor("2026-06-02"), 3);  // added out of order
    row->addDayCell(cellFor("2026-06-01"), 2);
    row->layer()->addSublayer(make<CALayer>());
    row->layer()->addSublayer(make<TavDayCellLayer>());
    const auto title = makeView<TavroMonthTitleLabel>();
    title->setText(string("06"));
    row->setMonthTitleView(title);
    show(row);
    return row;
  };
  EXPECT_EQ(heard(titledRow("en_US")),
            (Utterances{"June, heading", "June 1, No data", "June 2, No data"}));
  EXPECT_EQ(heard(titledRow("he_IL")),
            (Utterances{"יוני, כותרת", "1 ביוני, אין נתונים", "2 ביוני, אין נתונים"}));
  const auto row = titledRow("en_US");
  as<UIView>(row->monthTitleView())->setFrame({300, 40, 50, 40});
  EXPECT_EQ(heard(row), (Utterances{"June 1, No data", "June 2, No data", "June, heading"}))
      << "the title stands where its position puts it";
  EXPECT_EQ(heard(rowWith({})), Utterances());
}

TEST_F(CalendarTest, AMonthTitleSaysTheMonthOrNothing) {
  const std::tuple<const char*, const char*, const char*, const char*> cases[] = {
      {"en_US", "", "06", "June"},  {"de_DE", "", "03", "März"},
      {"he_IL", "", "12", "דצמבר"}, {"pl_PL", "", "06", "czerwiec"},
      {"ar_EG", "", "٠٦", "يونيو"}, {"en_US", "hebrew", "01", "Tishri"},
      {"en_US", "", "13", ""},      {"en_US", "", "00", ""},
      {"en_US", "", "Jun", ""},     {"en_US", "", " 6", ""},
      {"en_US", "", "6", ""},       {"en_US", "", "06 ", ""},
      {"en_US", "", "2026-06", ""},
  };
  const auto title = makeView<TavroMonthTitleLabel>();
  for (const auto& [locale, calendar, text, label] : cases) {
    Settings::current().locale = locale;
    Settings::current().calendar = calendar;
    title->setText(string(text));
    EXPECT_EQ(labelOf(title), label) << locale << " \"" << text << "\"";
  }
  title->setText(string("06"));
  setLabel(title, "What the label would say");
  EXPECT_EQ(labelOf(title), "June");
  for (const Ref<NSString>& nothing : {string(""), Ref<NSString>()}) {
    title->setText(nothing);
    EXPECT_EQ(labelOf(title), "What the label would say");
  }
}

TEST_F(CalendarTest, TheScreenNamesItsScrollView) {
  const auto controller = makeController<MonthViewController>();
  controller->setSpan(span(kToday, kToday));
  static_cast<void>(controller->view());
  const id scrollView = controller->months()._scrollView;
  EXPECT_EQ(utf8(send<id>(scrollView, "accessibilityIdentification")), "WorstScrollViewEver")
      << "known before it is on screen";
  window->setRootViewController(controller);
  send<void>(scrollView, "accessibilitySetIdentification:", string("other"));
  reloadAccessibilityInformation();
  EXPECT_EQ(utf8(send<id>(scrollView, "accessibilityIdentification")), "WorstScrollViewEver");
}

TEST_F(CalendarTest, AScreenWithoutButtonAndScrollViewStillLoads) {
  // The categories' methods on a host that has changed.
  Class* const bare = classOf<BareMonthViewController>();
  bare->setMethod(*classOf<MonthViewController>()->method("viewDidLoad"));
  const auto controller = make<BareMonthViewController>();
  EXPECT_NO_THROW(send<void>(controller, "viewDidLoad"));
  bare->setMethod(
      *classOf<MonthScrollViewController>()->method("_accessibilityLoadAccessibilityInformation"));
  EXPECT_NO_THROW(load(controller));
}

TEST_F(CalendarTest, OnceItHasLoadedTheMonthIsHeard) {
  const auto controller = makeController<MonthViewController>();
  controller->setSpan(span(kToday, kToday));
  controller->setLoading(true);
  EXPECT_EQ(heardOn(controller).back(), "Loading…");
  controller->setLoading(false);
  EXPECT_EQ(heard(window).size(), 34U) << "title, button, month and 31 days";
}

TEST_F(CalendarTest, MonthsAreHeardWhereTheyAreScrolledTo) {
  const auto controller = makeController<MonthViewController>();
  controller->setSpan(span({daysFromCivil(2025, 3, 20)}, kToday));
  EXPECT_EQ(heardOn(controller).size(), 63U) << "title, button, February and March";
  controller->months().months().scrollTo(0);
  EXPECT_EQ(heard(window)[3], "March 1, No data") << "months are whole";
  controller->scrollToToday(nullptr);
  EXPECT_EQ(heard(window)[2], "February, heading");
}

TEST_F(CalendarTest, AWholeYearIsReadWithOneLookupADay) {
  const auto months = makeView<MonthScrollView>();
  months->setSpan(span({daysFromCivil(2025, 3, 1)}, kToday));
  months->setFrame({0, 0, 390, months->contentHeight()});
  show(months);
  const std::size_t before = lookups();
  EXPECT_EQ(heard(months).size(), 396U + 13U) << "the days and titles of thirteen months";
  EXPECT_EQ(lookups() - before, 376U) << "a day to come is not looked up";
}

TEST_F(CalendarTest, ClassesThatAreOnlyKnownByNameKeepTheirBehaviour) {
  for (const Name target : {Name("WeekView"), Name("TavDayCellLayer")}) {
    Class* const category = Class::named(Name::make(std::string(target.text()) + "Accessibility"));
    ASSERT_NE(category, nullptr);
    EXPECT_EQ(utf8(send<id>(category, "safeCategoryTargetClassName")), target.text());
    for (const Name selector : {Name("isAccessibilityElement"), Name("accessibilityElements")}) {
      EXPECT_EQ(interceptingCategory(Class::named(target), selector), nullptr);
    }
  }
}

}  // namespace
}  // namespace tavro
