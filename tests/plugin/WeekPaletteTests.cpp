#include <tuple>

#include "host/screens/calendar/PaletteViewController.h"
#include "platform/foundation/NSValue.h"
#include "tests/support/Rings.h"

namespace tavro {
namespace {

/// Says of three fractions the first in per cent: each day is told apart by a number.
id describeByMove(Object* /*self*/, double move, double, double, bool) {
  return string(std::to_string(saturatingCast<std::int64_t>(move * 100 + 0.5)));
}

class WeekPaletteTest : public RingsTest {
 protected:
  // March 2026: the 11th, which is today, is a Wednesday, and the 1st a Sunday. The day of the
  // month is what a day's rings say.
  void SetUp() override {
    RingsTest::SetUp();
    classOf<HKActivitySummary>()->setMethod(
        methodOf<&describeByMove>("accessibilityDescriptionForPercentages:exercisingPercentage:"
                                  "standingPercentage:arePercentagesCapped:"));
    for (int day = 1; day <= 20; ++day) {
      record(daysFromCivil(2026, 3, day), day / 100.0, 0, 0);
    }
  }

  Ref<PaletteWeekdayHeaderView> header(double width = 350) {
    auto made = as<PaletteWeekdayHeaderView>(
        send<id>(make<PaletteWeekdayHeaderView>(),
                 "initWithNavigationPalette:", makeView<UIView>({0, 0, width, 100})));
    show(made);
    return made;
  }

  static void highlight(const id& header, std::string_view date) {
    send<void>(header, "highlightWeekdayLabelForDateAndSetDay:", at(date));
  }

  static id hit(const id& header, double x) {
    return send<id>(header, "_accessibilityHitTest:withEvent:", CGPoint{x, 5}, nullptr);
  }

  static Ref<NSMutableArray> labels(std::size_t count) {
    Ref<NSMutableArray> made = mutableArray();
    for (std::size_t index = 0; index < count; ++index) {
      made->addObject(makeLabel("x", {50.0 * static_cast<double>(index), 8, 50, 24}));
    }
    return made;
  }
};

TEST_F(WeekPaletteTest, EachDayStandsUnderItsOwnWeekday) {
  const std::tuple<std::int64_t, const char*, const char*> cases[] = {
      {2, "2026-03-11T15:00", "Monday, 9 10 (11) 12 13 14 15"},
      // The marker stands at today's weekday, whichever week is shown.
      {2, "2026-03-04T00:00", "Monday, 2 3 (4) 5 6 7 8"},
      // A Sunday belongs to the Monday six days earlier, a Monday begins its week.
      {2, "2026-03-08T23:00", "Monday, 2 3 (4) 5 6 7 8"},
      {2, "2026-03-16T00:00", "Monday, 16 17 (18) 19 20 data data"},
      {1, "2026-03-08T12:00", "Sunday, 8 2 3 (4) 5 6 7"},
      {7, "2026-03-11T12:00", "Saturday, 14 15 9 10 (11) 12 13"},
  };
  for (const auto& [firstWeekday, shown, expected] : cases) {
    Settings::current().firstWeekday = firstWeekday;
    const auto week = header();
    highlight(week, shown);
    const Utterances spoken = heard(week);
    std::string days = spoken.front().substr(0, spoken.front().find(' '));
    for (const std::string& day : spoken) {
      const std::string value = day.substr(day.rfind(' ') + 1);
      days += day.starts_with("Today, ") ? " (" + value + ")" : " " + value;
    }
    EXPECT_EQ(days, expected) << shown << " from " << firstWeekday;
  }
}

TEST_F(WeekPaletteTest, BeforeAnyDateIsHighlightedThePresentWeekIsHeard) {
  EXPECT_EQ(heard(header()).front(), "Monday, 9");
}

TEST_F(WeekPaletteTest, WeekdaysAreTheUsersAndTheCachesDaysGregorian) {
  const std::tuple<const char*, const char*, const char*, const char*> cases[] = {
      {"de_DE", "", "Montag, 9", "Heute, Mittwoch, 11"},
      {"he_IL", "", "יום שני, 9", "היום, יום רביעי, 11"},
      {"he_IL", "hebrew", "יום שני, 9", "היום, יום רביעי, 11"},
      {"en_US", "islamic", "Monday, 9", "Today, Wednesday, 11"},
  };
  for (const auto& [locale, calendar, first, today] : cases) {
    Settings::current().locale = locale;
    Settings::current().calendar = calendar;
    const auto week = header();
    highlight(week, "2026-03-11T12:00");
    const Utterances spoken = heard(week);
    ASSERT_EQ(spoken.size(), 7U);
    EXPECT_EQ(spoken[0], first) << locale << " " << calendar;
    EXPECT_EQ(spoken[2], today) << locale << " " << calendar;
  }
}

TEST_F(WeekPaletteTest, ValuesAreWorkedOutOnceAReload) {
  const auto week = header();
  highlight(week, "2026-03-04");
  const std::pair<const char*, std::function<void()>> cases[] = {
      {"highlight", [&] { highlight(week, "2026-03-11"); }},
      {"layout", [&] { send<void>(week, "layoutSubviews"); }},
      {"load", [&] { load(week); }},
  };
  static_cast<void>(heard(week));
  for (const auto& [what, change] : cases) {
    change();
    const std::size_t before = lookups();
    for (int request = 0; request < 3; ++request) {
      EXPECT_EQ(heard(week).front(), "Monday, 9") << what;
      EXPECT_EQ(send<id>(hit(week, 5), "accessibilityContainer"), week);
    }
    EXPECT_EQ(lookups() - before, 7U) << what;
  }
  Settings::current().now = secondsFromIso("2026-03-13").value();
  EXPECT_EQ(heard(week)[2], "Today, Wednesday, 11") << "nothing changes without a reload";
  send<void>(week, "layoutSubviews");
  EXPECT_EQ(heard(week)[4], "Today, Friday, 13");
}

TEST_F(WeekPaletteTest, LabelsFillTheirColumns) {
  const auto week = header();
  week->setFrame({0, 100, 350, 40});
  const id second = (*elementsOf(week))[1];
  as<UIView>(second)->setFrame({65, 8, 20, 24});
  load(week);
  EXPECT_EQ(frameOf(second), CGRect(50, 108, 50, 40));
  EXPECT_EQ(send<id>(second, "accessibilityContainer"), week);
  for (const CGRect& empty : {CGRect(0, 0, 0, 40), CGRect(0, 0, 350, 0)}) {
    week->setFrame(empty);
    load(week);
    EXPECT_EQ(frameOf(second), CGRect(50, 108, 50, 40));
  }
}

TEST_F(WeekPaletteTest, TouchFindsTheColumn) {
  const auto week = header();
  const Ref<NSArray> elements = elementsOf(week);
  const std::pair<double, int> cases[] = {{120, 2}, {-5, 0},   {0, 0},    {49.9, 0},  {50, 1},
                                          {349, 6}, {350, -1}, {400, -1}, {1e300, -1}};
  for (const auto& [x, column] : cases) {
    const id expected = column < 0 ? id() : (*elements)[static_cast<std::size_t>(column)];
    EXPECT_EQ(hit(week, x), expected) << x;
  }
  EXPECT_EQ(valueOf(hit(week, 120)), "11");
}

TEST_F(WeekPaletteTest, OtherNumbersOfLabelsAreFilledAsFarAsTheyGo) {
  const auto week = header();
  week->_weekdayLabels = labels(3);
  load(week);
  EXPECT_EQ(heard(week), (Utterances{"Monday, 9", "Tuesday, 10", "Today, Wednesday, 11"}));
  EXPECT_FALSE(hit(week, 170));

  week->_weekdayLabels = labels(8);
  load(week);
  const std::size_t before = lookups();
  static_cast<void>(heard(week));
  EXPECT_EQ(heard(week).back(), "x") << "an eighth label stands for no weekday";
  EXPECT_EQ(send<id>((*week->_weekdayLabels)[7], "accessibilityContainer"), week);
  EXPECT_EQ(lookups() - before, 7U);

  week->_weekdayLabels = mutableArray();
  EXPECT_EQ(elementsOf(week), week->_weekdayLabels);
  EXPECT_FALSE(hit(week, 5));
  week->_weekdayLabels = nullptr;
  EXPECT_NO_THROW(load(week));
  EXPECT_FALSE(elementsOf(week));
  EXPECT_FALSE(hit(week, 5));
}

TEST_F(WeekPaletteTest, AnElementThatIsNoViewKeepsItsFrame) {
  const auto week = header();
  const auto element = accessibilityElementWithContainer(nullptr);
  send<void>(element, "setAccessibilityFrame:", CGRect(1, 2, 3, 4));
  week->_weekdayLabels = mutableArray();
  week->_weekdayLabels->addObject(element);
  load(week);
  EXPECT_EQ(heard(week), Utterances{"Monday, 9"});
  EXPECT_EQ(frameOf(element), CGRect(1, 2, 3, 4));
}

TEST_F(WeekPaletteTest, TheScreenIsItsHeaderAlone) {
  const auto palette = makeController<PaletteViewController>();
  window->setRootViewController(palette);
  EXPECT_EQ(heard(window).size(), 8U) << "the title and the weekdays";
  palette->day(0).sendAction();
  palette->showDate(at("2026-03-03"));
  EXPECT_EQ(heard(palette->view()).front(), "Monday, 2");

  const auto bare = makeController<PaletteViewController>();
  answers(bare, "_paletteView", nullptr);
  EXPECT_EQ(heard(bare->view()), Utterances()) << "an empty list, not the days";
}

TEST_F(WeekPaletteTest, TheChosenDayIsSelected) {
  const auto palette = makeController<PaletteViewController>();
  window->setRootViewController(palette);
  EXPECT_EQ(heard(&palette->day(2)), Utterances{"11, selected, button"});
  EXPECT_EQ(heard(&palette->day(3)), Utterances{"12, button"});
  palette->day(3).sendAction();
  EXPECT_EQ(heard(&palette->day(2)), Utterances{"11, button"});
  EXPECT_EQ(heard(&palette->day(3)), Utterances{"12, selected, button"});
  EXPECT_FALSE(send<id>(&palette->day(3), "accessibilityPath")) << "the frame outlines the day";
  palette->day(3)._circle->setAlpha(0.99);
  EXPECT_EQ(heard(&palette->day(3)), Utterances{"12, button"});
  palette->day(3)._circle->setAlpha(1);
  palette->day(3)._circle = nullptr;
  EXPECT_EQ(heard(&palette->day(3)), Utterances{"12, button"});
}

}  // namespace
}  // namespace tavro
