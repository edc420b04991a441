#include <limits>
#include <tuple>

#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSValue.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::FoundationTest;
using testing::heard;

class StringTest : public FoundationTest {};

TEST_F(StringTest, TextsSurviveBothEncodings) {
  const std::pair<std::string_view, std::size_t> cases[] = {{"", 0},  {"a", 1}, {"é", 1},
                                                            {"–", 1}, {"😀", 2}, {"مرحبا", 5}};
  for (const auto& [utf8, length] : cases) {
    const Ref<NSString> text = string(utf8);
    EXPECT_EQ(text->length(), length) << utf8;
    EXPECT_EQ(text->utf8(), utf8);
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
  const std::tuple<std::string_view, std::u16string_view, std::u16string_view, std::string_view>
      cases[] = {
          {"aXbXXc", u"X", u"", "abc"},     {"aaa", u"aa", u"b", "ba"}, {"aa", u"a", u"aa", "aaaa"},
          {"abc", u"", u"x", "abc"},        {"abc", u"z", u"x", "abc"}, {"", u"a", u"x", ""},
          {"8'05\"", u"'", u"–", "8–05\""},
      };
  for (const auto& [text, part, replacement, expected] : cases) {
    EXPECT_EQ(stringByReplacing(*string(text), part, replacement)->utf8(), expected) << text;
  }
}

TEST_F(StringTest, FormatsAreFilledHoweverTheyAreTranslated) {
  const std::pair<std::string_view, std::string_view> cases[] = {
      {"%@ %d %@", "left 1234567 right"},
      {"%@ %lld", "left 1234567"},
      {"%3$@ %2$d %1$@", "right 1234567 left"},
      {"%1$@%1$@", "leftleft"},
      {"%2$lld", "1234567"},
      {"%3$@ %@", "right left"},
      {"%%@ 100%%", "%@ 100%"},
      {"", ""},
      // Faulty translations.
      {"%d|%@|%@", "||right"},
      {"%@ %d %@ %@ %d", "left 1234567 right  "},
      {"%4$@|%0$@|%99999999999999999999$@", "||"},
      {"50% of %@", "50% of left"},
      {"%@ 100%", "left 100%"},
      {"%s %ld %5 %$@ %1$", "%s %ld %5 %$@ %1$"},
      {"%1@", "%1@"}};
  for (const auto& [format, expected] : cases) {
    EXPECT_EQ(heard(stringWithFormat(string(format),
                                     {string("left"), std::int64_t{1234567}, string("right")})),
              expected)
        << format;
  }
}

TEST_F(StringTest, TheWholeNumberThatATextBeginsWith) {
  using Limits = std::numeric_limits<std::int64_t>;
  const std::pair<std::string, std::int64_t> cases[] = {
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
      {"-", 0}};
  for (const auto& [text, number] : cases) {
    EXPECT_EQ(integerValue(*string(text)), number) << text.substr(0, 30);
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
  const std::pair<std::string, std::string_view> cases[] = {
      {"en_US", "1,234,567"}, {"de_DE", "1.234.567"}, {"ar_EG", "١٬٢٣٤٬٥٦٧"}};
  for (const auto& [locale, localized] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(heard(localizedStringWithFormat(string("%d"), {std::int64_t{1234567}})), localized);
    EXPECT_EQ(heard(stringWithFormat(string("%d"), {std::int64_t{1234567}})), "1234567");
  }
  constexpr auto kLowest = std::numeric_limits<std::int64_t>::min();
  EXPECT_EQ(heard(stringWithFormat(string("%lld"), {kLowest})), "-9223372036854775808");
}

TEST_F(StringTest, ThePluralFormIsTheLanguages) {
  const std::tuple<const char*, std::int64_t, const char*> cases[] = {
      {"en", 1, "one"},     {"en", 2, "other"},    {"en", 0, "other"}, {"fr", 0, "one"},
      {"ja", 1, "other"},   {"pl", 3, "few"},      {"pl", 5, "many"},  {"pl", 12, "many"},
      {"pl", 22, "few"},    {"ru", 21, "one"},     {"ru", 11, "many"}, {"ar", 0, "zero"},
      {"ar", 1, "one"},     {"ar", 2, "two"},      {"ar", 3, "few"},   {"ar", 11, "many"},
      {"ar", 100, "other"}, {"pt_PT", 0, "other"}, {"pt_BR", 0, "one"}};
  for (const auto& [language, integer, category] : cases) {
    const Ref<NSPluralFormat> format = make<NSPluralFormat>();
    format->language = language;
    format->initWithText(u"other");
    format->forms = {{"zero", u"zero"}, {"one", u"one"},   {"two", u"two"},
                     {"few", u"few"},   {"many", u"many"}, {"other", u"other"}};
    EXPECT_EQ(heard(stringWithFormat(format, {integer})), category) << language << integer;
  }
}

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
