#include <cmath>
#include <limits>
#include <tuple>

#include "platform/foundation/Formatters.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::at;
using testing::FoundationTest;
using testing::heard;
using testing::utc;

constexpr double kInfinity = std::numeric_limits<double>::infinity();

class FormattersTest : public FoundationTest {};

TEST_F(FormattersTest, IntervalsSpeakTheSkeletonAsItStands) {
  const struct {
    std::string locale;
    std::string_view skeleton, start, end, expected;
  } cases[] = {
      // The thin and the narrow no-break spaces are ICU's.
      {"en_US", "hxa", "2026-03-02T00:00", "2026-03-02T03:00", "12\u2009–\u20093\u202fAM"},
      {"en_US", "MMMMdyyyy", "2026-03-02", "2026-03-02", "March 2, 2026"},
      {"en_GB", "MMMMdyyyy", "2026-03-02", "2026-05-01", "2 March\u2009–\u20091 May 2026"},
      {"ar_EG", "ha", "2026-03-02T09:00", "2026-03-02T10:00", "٩–١٠ ص"},
      // Across the hour that the clocks skip.
      {"en_US", "ha", "2026-03-08T01:00", "2026-03-08T03:00", "1\u2009–\u20093\u202fAM"},
  };
  for (const auto& each : cases) {
    settings_.locale = each.locale;
    const Ref<NSDateIntervalFormatter> formatter = make<NSDateIntervalFormatter>();
    formatter->setTimeStyle(NSDateFormatterStyle::none);
    formatter->setDateTemplate(each.skeleton);
    const Ref<NSDate> start = at(each.start);
    const Ref<NSDate> end = at(each.end);
    EXPECT_EQ(heard(formatter->stringFromDate(start, end)), each.expected);
    EXPECT_EQ(heard(formatter->stringFromDateInterval(dateInterval(start, end))), each.expected);
  }
}

TEST_F(FormattersTest, OneIntervalFormatterFollowsItsTemplateAndTheSettings) {
  const Ref<NSDateIntervalFormatter> formatter = make<NSDateIntervalFormatter>();
  const Ref<NSDate> start = at("2026-03-02T09:00");
  const Ref<NSDate> end = at("2026-03-02T10:00");
  formatter->setDateTemplate("MMMMd");
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "March 2");
  settings_.locale = "de_DE";
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "2. März");
  settings_.timeZone = "Pacific/Kiritimati";
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "3. März");
  settings_.calendar = "hebrew";
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "14. Adar");
  formatter->setDateTemplate("yyyy");
  EXPECT_NE(heard(formatter->stringFromDate(start, end)).find("5786"), std::string::npos);
}

TEST_F(FormattersTest, IntervalsWithoutATemplateFollowTheStyles) {
  const Ref<NSDateIntervalFormatter> formatter = make<NSDateIntervalFormatter>();
  const Ref<NSDate> start = at("2026-03-02T09:00");
  const Ref<NSDate> end = at("2026-03-02T10:30");
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)),
            "Mar 2, 2026, 9:00\u2009–\u200910:30\u202fAM");
  formatter->setTimeStyle(NSDateFormatterStyle::none);
  formatter->setDateStyle(NSDateFormatterStyle::full);
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "Monday, March 2, 2026");
  formatter->setDateStyle(NSDateFormatterStyle::none);
  EXPECT_EQ(heard(formatter->stringFromDate(start, end)), "");
}

TEST_F(FormattersTest, NoDateGivesNoText) {
  const Ref<NSDate> date = at("2026-03-02");
  const Ref<NSDateIntervalFormatter> interval = make<NSDateIntervalFormatter>();
  EXPECT_FALSE(interval->stringFromDate(nullptr, date));
  EXPECT_FALSE(interval->stringFromDate(date, nullptr));
  EXPECT_FALSE(interval->stringFromDateInterval(nullptr));
  EXPECT_FALSE(make<NSDateFormatter>()->stringFromDate(nullptr));
  EXPECT_FALSE(dateStringForFormat(nullptr, "dMMMM"));
  EXPECT_FALSE(make<NSNumberFormatter>()->stringFromNumber(nullptr));
}

TEST_F(FormattersTest, AbsurdDatesAreHarmless) {
  for (const double seconds : {std::nan(""), kInfinity, -kInfinity, 1e300}) {
    const Ref<NSDate> date = dateWithSeconds(seconds);
    EXPECT_NE(heard(dateStringForFormat(date, "dMMMM")), "");
    const Ref<NSDateIntervalFormatter> formatter = make<NSDateIntervalFormatter>();
    EXPECT_NE(heard(formatter->stringFromDate(date, dateWithSeconds(0))), "");
  }
}

TEST_F(FormattersTest, LettersAloneAreATemplateAndAnythingElseAPattern) {
  const Ref<NSDate> date = at("2026-06-05T14:07");
  const std::tuple<std::string, std::string_view, std::string_view> cases[] = {
      {"en_US", "dMMMM", "June 5"},
      {"de_DE", "dMMMM", "5. Juni"},
      {"ar_EG", "dMMMM", "٥ يونيو"},
      {"pl_PL", "dMMMM", "5 czerwca"},
      {"pl_PL", "MMMM", "czerwiec"},  // standing alone, not "of June"
      {"el_GR", "MMMM", "Ιούνιος"},
      {"de_DE", "EEEE, MMM d, yyyy", "Freitag, Juni 5, 2026"},
      {"en_US", "yyyy-MM-dd'T'HH:mm", "2026-06-05T14:07"},
      {"en_US", "", "(nil)"}};
  for (const auto& [locale, format, expected] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(heard(dateStringForFormat(date, format)), expected) << format;
  }
}

TEST_F(FormattersTest, DateFormattersTakeAPatternOrStyles) {
  settings_.locale = "de_DE";
  const Ref<NSDate> date = at("2026-06-05T14:07");
  const Ref<NSDateFormatter> formatter = make<NSDateFormatter>();
  EXPECT_EQ(heard(formatter->stringFromDate(date)), "");
  formatter->setDateStyle(NSDateFormatterStyle::longStyle);
  EXPECT_EQ(heard(formatter->stringFromDate(date)), "5. Juni 2026");
  formatter->setTimeStyle(NSDateFormatterStyle::shortStyle);
  EXPECT_EQ(heard(formatter->stringFromDate(date)), "5. Juni 2026 um 14:07");
  formatter->setDateFormat("dMMMM");
  EXPECT_EQ(heard(formatter->stringFromDate(date)), "5Juni");
}

TEST_F(FormattersTest, DateParsingIsStrict) {
  using Parsed = std::pair<std::string_view, std::string_view>;
  const std::pair<std::string_view, std::vector<Parsed>> formats[] = {
      {"MM",
       {{"06", "2000-06-01 04:00:00 +0000"},
        {"12", "2000-12-01 05:00:00 +0000"},
        {"٠٦", "2000-06-01 04:00:00 +0000"}}},
      {"MMMM d", {{"February 29", "2000-02-29 05:00:00 +0000"}}},
      {"yyyy-MM-dd", {{"2026-02-30", "(nil)"}, {"2026-02-03x", "(nil)"}}},
      {"yyyy-MM-dd HH:mm",
       {{"2026-07-02 08:15", "2026-07-02 12:15:00 +0000"},
        {"2026-03-08 02:30", "(nil)"}}},  // an hour that the clocks skip
      {"yyyy-MM-dd'T'HH:mmX", {{"2026-07-02T08:15Z", "2026-07-02 08:15:00 +0000"}}},
      {"", {{"06", "(nil)"}}},
  };
  const Ref<NSDateFormatter> formatter = make<NSDateFormatter>();
  for (const auto& [format, texts] : formats) {
    formatter->setDateFormat(format);
    for (const auto& [text, expected] : texts) {
      EXPECT_EQ(utc(formatter->dateFromString(string(text))), expected) << text;
    }
  }
  formatter->setDateFormat("MM");
  for (const char* const text :
       {"6", "13", "00", "Jun", "June", " 06", "06 ", " 6", "6 ", "006", "-6", ""}) {
    EXPECT_FALSE(formatter->dateFromString(string(text))) << text;
  }
}

TEST_F(FormattersTest, AMonthNumberNamesAMonthInEveryCalendar) {
  const Ref<NSDateFormatter> formatter = make<NSDateFormatter>();
  formatter->setDateFormat("MM");
  const std::pair<std::string, std::string_view> cases[] = {
      {"", "June"},         {"buddhist", "June"},     {"japanese", "June"},
      {"hebrew", "Adar I"}, {"persian", "Shahrivar"}, {"islamic", "Jumada II"},
  };
  for (const auto& [calendar, expected] : cases) {
    settings_.calendar = calendar;
    EXPECT_EQ(heard(dateStringForFormat(formatter->dateFromString(string("06")), "MMMM")), expected)
        << calendar;
  }
  EXPECT_FALSE(formatter->dateFromString(nullptr));
}

TEST_F(FormattersTest, WeekdaysBeginWithSundayInTheUsersLanguage) {
  const std::tuple<std::string, std::string_view, std::string_view, std::string_view> cases[] = {
      {"en_US", "Sunday", "Saturday", "Sunday"},
      {"fi_FI", "sunnuntaina", "lauantaina", "sunnuntai"},
  };
  const Ref<NSDateFormatter> formatter = make<NSDateFormatter>();
  for (const auto& [locale, sunday, saturday, standaloneSunday] : cases) {
    settings_.locale = locale;
    const Ref<NSArray> names = formatter->weekdaySymbols();
    ASSERT_EQ(names->count(), 7U);
    EXPECT_EQ(heard((*names)[0]), sunday);
    EXPECT_EQ(heard((*names)[6]), saturday);
    const Ref<NSArray> standalone = formatter->standaloneWeekdaySymbols();
    ASSERT_EQ(standalone->count(), 7U);
    EXPECT_EQ(heard((*standalone)[0]), standaloneSunday);
  }
}

TEST_F(FormattersTest, PlainNumbersAreWholeAndUngrouped) {
  const Ref<NSNumberFormatter> formatter = make<NSNumberFormatter>();
  EXPECT_EQ(heard(formatter->stringFromNumber(number(std::int64_t{1234567}))), "1234567");
  EXPECT_EQ(heard(formatter->stringFromNumber(number(485.4))), "485");
  EXPECT_EQ(heard(formatter->stringFromNumber(number(-0.2))), "0");
  settings_.locale = "ar_EG";
  EXPECT_EQ(heard(formatter->stringFromNumber(number(std::int64_t{485}))), "٤٨٥");
}

TEST_F(FormattersTest, ANumberIsAWholeText) {
  const std::tuple<std::string, std::string_view, std::string_view> cases[] = {
      {"en_US", "3", "3"},         {"en_US", "-3", "-3"},
      {"en_US", "3.5", "3.5"},     {"de_DE", "3,5", "3.5"},
      {"ar_EG", "٣", "3"},         {"ar_EG", "3", "3"},
      {"ar_EG", "٣٫٥", "3.5"},     {"en_US", "", "(nil)"},
      {"en_US", " 3", "(nil)"},    {"en_US", "3 ", "(nil)"},
      {"en_US", "3a", "(nil)"},    {"en_US", "a3", "(nil)"},
      {"en_US", "1e5", "(nil)"},   {"en_US", "1E5", "(nil)"},
      {"en_US", "∞", "(nil)"},     {"en_US", "NaN", "(nil)"},
      {"en_US", "1,234", "(nil)"}, {"en_US", "--", "(nil)"},
      {"en_US", "3.5.5", "(nil)"}, {"en_US", "9223372036854775807", "9223372036854775807"},
  };
  for (const auto& [locale, text, expected] : cases) {
    settings_.locale = locale;
    const Ref<NSNumber> read = make<NSNumberFormatter>()->numberFromString(string(text));
    EXPECT_EQ(read ? heard(send<id>(read, "description")) : "(nil)", expected) << text;
  }
  EXPECT_FALSE(make<NSNumberFormatter>()->numberFromString(nullptr));
}

TEST_F(FormattersTest, DecimalsAreGroupedAndShort) {
  const std::tuple<std::string, double, int, std::string_view> cases[] = {
      {"en_US", 412.64, 1, "412.6"},
      {"en_US", 1234567.891, 2, "1,234,567.89"},
      {"en_US", 0.5, 0, "0"},
      {"en_US", -0.04, 1, "0"},
      {"en_US", -1.5, 1, "-1.5"},
      {"ar_EG", 1234.5, 1, "١٬٢٣٤٫٥"},
      {"en_IN", 1234567, 0, "12,34,567"},
      {"en_US", kInfinity, 1, "(nil)"},
      {"en_US", std::nan(""), 1, "(nil)"}};
  for (const auto& [locale, value, decimals, expected] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(heard(decimalString(value, decimals)), expected) << value;
  }
}

TEST_F(FormattersTest, PercentagesStandInTheLocalesForm) {
  const std::tuple<std::string, double, std::string_view> cases[] = {
      {"en_US", 1, "100%"},        {"en_US", 0.456, "46%"},        {"en_US", 12.34, "1,234%"},
      {"en_US", -0.001, "0%"},     {"de_DE", 0.5, "50\u00a0%"},    {"tr_TR", 0.5, "%50"},
      {"ar_EG", 0.5, "٥٠٪\u061c"}, {"en_US", -kInfinity, "(nil)"},
  };
  for (const auto& [locale, fraction, expected] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(heard(percentString(fraction)), expected) << locale << fraction;
  }
}

TEST_F(FormattersTest, DurationsLeaveOutWhatIsZero) {
  const std::tuple<std::string, std::int64_t, std::string_view> cases[] = {
      {"en_US", 3723, "1 hour, 2 minutes, 3 seconds"},
      {"en_US", 7201, "2 hours, 1 second"},
      {"en_US", 0, "0 seconds"},
      {"en_US", -90, "-1 minute, 30 seconds"},
      {"de_DE", 3723, "1 Stunde, 2 Minuten und 3 Sekunden"},
      {"pl_PL", 125, "2 minuty i 5 sekund"},
      {"ar_EG", 120, "دقيقتان"},
      {"en_US", std::numeric_limits<std::int64_t>::min(),
       "-2,562,047,788,015,215 hours, 30 minutes, 8 seconds"},
  };
  for (const auto& [locale, seconds, expected] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(heard(durationInWords(seconds)), expected) << seconds;
  }
}

TEST_F(FormattersTest, PatternsYieldTheirGroupsInUnits) {
  const Ref<NSRegularExpression> pace = regularExpression("(\\d+)'\\s?([0-5]?[0-9])(?:''|\")");
  const std::optional<NSTextCheckingResult> match = pace->firstMatch(*string("😀 8'05\" 9'10\""));
  ASSERT_TRUE(match);
  EXPECT_EQ(match->ranges, (std::vector<NSRange>{{3, 5}, {3, 1}, {5, 2}}));
  EXPECT_FALSE(pace->firstMatch(*string("8'65\"")));
  EXPECT_FALSE(pace->firstMatch(*string("")));

  const std::optional<NSTextCheckingResult> absent =
      regularExpression("a(b)?(c)")->firstMatch(*string("ac"));
  ASSERT_TRUE(absent);
  EXPECT_EQ(absent->ranges[1], (NSRange{std::string::npos, 0}));
}

TEST_F(FormattersTest, MalformedPatternsRaiseAndHostileTextsEnd) {
  EXPECT_THROW(regularExpression("(unclosed"), NSException);
  EXPECT_FALSE(make<NSRegularExpression>()->firstMatch(*string("a")));
  const Ref<NSRegularExpression> explosive = regularExpression("(a+)+$");
  EXPECT_FALSE(explosive->firstMatch(*string(std::string(100, 'a') + "!")));
  const char16_t half[] = {0xD83D, u'1', u'\''};
  EXPECT_FALSE(explosive->firstMatch(*string(std::u16string_view(half, 3))));
}

}  // namespace
}  // namespace tavro
