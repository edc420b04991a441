#include <limits>

#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::FoundationTest;
using testing::heard;

class StringTest : public FoundationTest {};

TEST_F(StringTest, TextsSurviveBothEncodings) {
  const struct {
    std::string_view utf8;
    std::size_t length;
  } cases[] = {{"", 0}, {"a", 1}, {"é", 1}, {"–", 1}, {"😀", 2}, {"مرحبا", 5}};
  for (const auto& each : cases) {
    const Ref<NSString> text = string(each.utf8);
    EXPECT_EQ(text->length(), each.length) << each.utf8;
    EXPECT_EQ(text->utf8(), each.utf8);
  }
}

TEST_F(StringTest, BrokenEncodingsBecomeReplacementCharacters) {
  EXPECT_EQ(string("a\xFFz")->utf8(), "a\uFFFDz");
  EXPECT_EQ(string("a\xE2\x80")->utf8(), "a\uFFFD");
  const char16_t high[] = {u'a', 0xD83D, u'z'};
  const char16_t low[] = {0xDE00};
  EXPECT_EQ(string(std::u16string_view(high, 3))->utf8(), "a\uFFFDz");
  EXPECT_EQ(string(std::u16string_view(low, 1))->utf8(), "\uFFFD");
  EXPECT_EQ(string(std::u16string_view(high, 3))->length(), 3U);
}

TEST_F(StringTest, OnlyTextsHaveText) {
  const Ref<NSString> plain = string("abc");
  EXPECT_EQ(utf8(number(std::int64_t{3})), "");
  EXPECT_EQ(utf8(nullptr), "");
  EXPECT_EQ(lengthOfText(plain), 3U);
  EXPECT_EQ(lengthOfText(attributedString(plain)), 3U);
  EXPECT_EQ(lengthOfText(number(true)), 0U);
  EXPECT_EQ(lengthOfText(nullptr), 0U);
  EXPECT_EQ(plainText(axAttributedString(plain)), plain);
  EXPECT_EQ(plainText(plain), plain);
  EXPECT_FALSE(plainText(number(true)));
  EXPECT_FALSE(attributedString(nullptr));
  EXPECT_FALSE(axAttributedString(nullptr));
}

TEST_F(StringTest, EveryNewlineSeparates) {
  const Ref<NSArray> pieces = componentsSeparatedByNewlines(
      *string("one\ntwo\r\nthree\u2028four\u2029five\u0085six\vseven\feight\n"));
  std::vector<std::string> texts;
  for (const id& piece : *pieces) {
    texts.push_back(utf8(piece));
  }
  EXPECT_EQ(texts, (std::vector<std::string>{"one", "two", "", "three", "four", "five", "six",
                                             "seven", "eight", ""}));
  EXPECT_EQ(componentsSeparatedByNewlines(*string(""))->count(), 1U);
}

TEST_F(StringTest, SearchAndReplacementGoUnitByUnit) {
  EXPECT_TRUE(containsString(*string("a––b"), u"––"));
  EXPECT_FALSE(containsString(*string("a–b"), u"––"));
  EXPECT_FALSE(containsString(*string("a"), u""));
  const struct {
    std::string_view text;
    std::u16string_view part;
    std::u16string_view replacement;
    std::string_view expected;
  } cases[] = {
      {"aXbXXc", u"X", u"", "abc"},     {"aaa", u"aa", u"b", "ba"}, {"aa", u"a", u"aa", "aaaa"},
      {"abc", u"", u"x", "abc"},        {"abc", u"z", u"x", "abc"}, {"", u"a", u"x", ""},
      {"8'05\"", u"'", u"–", "8–05\""},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(stringByReplacing(*string(each.text), each.part, each.replacement)->utf8(),
              each.expected)
        << each.text;
  }
}

struct FormatCase {
  std::string_view format;
  std::string_view expected;
};

/// With the arguments "left", 1234567, "right".
class FormatTest : public FoundationTest, public ::testing::WithParamInterface<FormatCase> {};

TEST_P(FormatTest, Fills) {
  const Ref<NSString> filled = stringWithFormat(
      string(GetParam().format), {string("left"), std::int64_t{1234567}, string("right")});
  EXPECT_EQ(heard(filled), GetParam().expected) << GetParam().format;
}

INSTANTIATE_TEST_SUITE_P(Placeholders, FormatTest,
                         ::testing::Values(FormatCase{"%@ %d %@", "left 1234567 right"},
                                           FormatCase{"%@ %lld", "left 1234567"},
                                           FormatCase{"%3$@ %2$d %1$@", "right 1234567 left"},
                                           FormatCase{"%1$@%1$@", "leftleft"},
                                           FormatCase{"%2$lld", "1234567"},
                                           FormatCase{"%3$@ %@", "right left"},
                                           FormatCase{"%%@ 100%%", "%@ 100%"}, FormatCase{"", ""}));

INSTANTIATE_TEST_SUITE_P(FaultyTranslations, FormatTest,
                         ::testing::Values(FormatCase{"%d|%@|%@", "||right"},
                                           FormatCase{"%@ %d %@ %@ %d", "left 1234567 right  "},
                                           FormatCase{"%4$@|%0$@|%99999999999999999999$@", "||"},
                                           FormatCase{"50% of %@", "50% of left"},
                                           FormatCase{"%@ 100%", "left 100%"},
                                           FormatCase{"%s %ld %5 %$@ %1$", "%s %ld %5 %$@ %1$"},
                                           FormatCase{"%1@", "%1@"}));

TEST_F(StringTest, TheWholeNumberThatATextBeginsWith) {
  using Limits = std::numeric_limits<std::int64_t>;
  const struct {
    std::string text;
    std::int64_t number;
  } cases[] = {
      {"", 0},
      {"12", 12},
      {" \u00a0-12.9 kg", -12},
      {"+7", 7},
      {"- 7", 0},
      {"--7", 0},
      {"kg 7", 0},
      {"٤٢", 42},
      {"1𝟠x", 18},
      {"9223372036854775807", Limits::max()},
      {"9223372036854775808", Limits::max()},
      {"-9223372036854775808", Limits::min()},
      {"-9223372036854775809", Limits::min()},
      {std::string(100'000, '9'), Limits::max()},
      {"-" + std::string(100'000, '9'), Limits::min()},
      {std::string(100'000, '0') + "8", 8},
      {"-", 0},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(integerValue(*string(each.text)), each.number) << each.text.substr(0, 30);
  }
}

TEST_F(StringTest, FormattedObjectsDescribeThemselves) {
  const Ref<NSString> format = string("<%@>");
  EXPECT_EQ(heard(stringWithFormat(format, {number(std::int64_t{-7})})), "<-7>");
  EXPECT_EQ(heard(stringWithFormat(format, {make<NSObject>()})), "<NSObject>");
  EXPECT_EQ(heard(stringWithFormat(format, {attributedString(string("é%@"))})), "<é%@>");
}

TEST_F(StringTest, NothingIsFormattedWithNil) {
  EXPECT_FALSE(stringWithFormat(nullptr, {}));
  EXPECT_FALSE(stringWithFormat(string("no placeholder"), {id()}));
  EXPECT_FALSE(localizedStringWithFormat(string("%@ %@"), {string("a"), id()}));
}

TEST_F(StringTest, OnlyLocalizedFormatsUseTheDigitsOfTheUser) {
  const struct {
    std::string locale;
    std::string_view localized;
  } cases[] = {{"en_US", "1,234,567"}, {"de_DE", "1.234.567"}, {"ar_EG", "١٬٢٣٤٬٥٦٧"}};
  for (const auto& each : cases) {
    settings_.locale = each.locale;
    EXPECT_EQ(heard(localizedStringWithFormat(string("%d"), {std::int64_t{1234567}})),
              each.localized);
    EXPECT_EQ(heard(stringWithFormat(string("%d"), {std::int64_t{1234567}})), "1234567");
  }
  constexpr auto kLowest = std::numeric_limits<std::int64_t>::min();
  EXPECT_EQ(heard(stringWithFormat(string("%lld"), {kLowest})), "-9223372036854775808");
}

struct PluralCase {
  std::string language;
  std::int64_t integer;
  std::string_view category;
};

class PluralTest : public FoundationTest, public ::testing::WithParamInterface<PluralCase> {};

TEST_P(PluralTest, ChoosesTheForm) {
  const Ref<NSPluralFormat> format = make<NSPluralFormat>();
  format->language = GetParam().language;
  format->initWithText(u"other");
  format->forms = {{"zero", u"zero"}, {"one", u"one"},   {"two", u"two"},
                   {"few", u"few"},   {"many", u"many"}, {"other", u"other"}};
  EXPECT_EQ(heard(stringWithFormat(format, {GetParam().integer})), GetParam().category)
      << GetParam().language << GetParam().integer;
}

INSTANTIATE_TEST_SUITE_P(
    Languages, PluralTest,
    ::testing::Values(
        PluralCase{"en", 1, "one"}, PluralCase{"en", 2, "other"}, PluralCase{"en", 0, "other"},
        PluralCase{"fr", 0, "one"}, PluralCase{"ja", 1, "other"}, PluralCase{"pl", 1, "one"},
        PluralCase{"pl", 3, "few"}, PluralCase{"pl", 5, "many"}, PluralCase{"pl", 12, "many"},
        PluralCase{"pl", 22, "few"}, PluralCase{"ru", 21, "one"}, PluralCase{"ru", 11, "many"},
        PluralCase{"ar", 0, "zero"}, PluralCase{"ar", 1, "one"}, PluralCase{"ar", 2, "two"},
        PluralCase{"ar", 3, "few"}, PluralCase{"ar", 11, "many"}, PluralCase{"ar", 100, "other"},
        PluralCase{"pt_PT", 0, "other"}, PluralCase{"pt_BR", 0, "one"}));

TEST_F(StringTest, PluralFormatsFollowTheirFirstIntegerAndElseSayOther) {
  const Ref<NSPluralFormat> format = make<NSPluralFormat>();
  format->language = "ru";
  format->initWithText(u"%@: %d other");
  format->forms = {{"one", u"%@: %d one"}, {"other", u"%@: %d other"}};
  const Ref<NSString> name = string("n");
  EXPECT_EQ(heard(stringWithFormat(format, {name, std::int64_t{21}})), "n: 21 one");
  // Russian has "few" for 3, which this translation lacks.
  EXPECT_EQ(heard(stringWithFormat(format, {name, std::int64_t{3}})), "n: 3 other");
  EXPECT_EQ(heard(stringWithFormat(format, {name})), "n:  other");
  EXPECT_EQ(heard(format), "%@: %d other");
}

TEST_F(StringTest, AttributesStayInsideTheText) {
  const Ref<AXAttributedString> text = axAttributedString(string("abcdef"));
  text->setAttribute(kCFBooleanTrue(), "whole");
  text->setAttribute(kCFBooleanTrue(), "cut", {4, 10});
  text->setAttribute(kCFBooleanTrue(), "huge", {1, std::numeric_limits<std::size_t>::max()});
  text->setAttribute(kCFBooleanTrue(), "outside", {6, 1});
  text->setAttribute(kCFBooleanTrue(), "empty", {2, 0});
  text->setAttribute(nullptr, "nil");
  std::vector<std::pair<std::string, NSRange>> runs;
  for (const NSAttributedString::Run& run : text->runs()) {
    runs.emplace_back(run.key.text(), run.range);
  }
  EXPECT_EQ(runs, (std::vector<std::pair<std::string, NSRange>>{
                      {"whole", {0, 6}}, {"cut", {4, 2}}, {"huge", {1, 5}}}));
}

}  // namespace
}  // namespace tavro
