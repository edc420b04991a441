#include <optional>

#include "host/libraries/CHWorkoutFormattingManager.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

class PaceTest : public PluginTest {
 protected:
  Ref<NSAttributedString> pace(const id& text) {
    using Function = Ref<AXAttributedString> (*)(const id&);
    return reinterpret_cast<Function>(
        bundle.symbol("accessibilityAttributedStringForPaceContainingString"))(text);
  }

  /// The text with what is marked as minutes and seconds between square brackets.
  static std::string marked(const Ref<NSAttributedString>& text) {
    std::u16string shown(text->string()->text());
    for (const NSAttributedString::Run& run : text->runs()) {
      EXPECT_EQ(run.key.text(), UIAccessibilityTokenDurationTimeMMSS.text());
      shown.insert(run.range.location + run.range.length, u"]");
      shown.insert(run.range.location, u"[");
    }
    return string(shown)->utf8();
  }

  std::string markedPace(const std::string& text) { return marked(pace(string(text))); }
};

std::string repeated(std::string_view text, int times) {
  std::string all;
  for (int time = 0; time < times; ++time) {
    all += text;
  }
  return all;
}

TEST_F(PaceTest, APaceBecomesMarkedSeconds) {
  const std::pair<const char*, const char*> cases[] = {
      {"8'05''", "[485]"},
      {"8'05\"", "[485]"},
      {"10'5''", "[605]"},
      {"0'00''", "[0]"},
      {"8'05'' per kilometre", "[485] per kilometre"},
      {"8'05'' or 9'00''", "[485] or 9'00''"},
      {"485 at 8'05''", "485 at [485]"},  // the same number stands before it
      {"1'65'05''", "1'[3905]"},
      {"🏃 8'05''", "🏃 [485]"},  // two units of text
      // One blank of any kind.
      {"7' 30''", "[450]"},
      {"7'\u202f30''", "[450]"},
      {"7'\n30''", "[450]"},
      // Minutes are digits of any script.
      {"８'05''", "[485]"},
      {"1𝟠'05''", "[1085]"},
      {"8'05''\u0301", "[485]\u0301"},
      // Beyond 32 bits the low ones remain; minutes beyond 64 bits are the nearest that fit.
      {"35791394'07''", "[2147483647]"},
      {"35791394'08''", "[-2147483648]"},
      {"71582788'16''", "[0]"},
      {"9223372036854775807'05''", "[-55]"},
      {"99999999999999999999999'05''", "[-55]"},
  };
  for (const auto& [text, expected] : cases) {
    EXPECT_EQ(markedPace(text), expected) << text;
  }
}

TEST_F(PaceTest, WhatOnlyLooksLikeAPaceIsLeftAsItIs) {
  for (const char* const text :
       {"7'  30''", "8'60''", "8'65''", "8'059''", "8'05'", "8 '05''", "'05''", "8’05’’", "6.58 KM",
        "'''''''", "8'٠٥''", "½'05''", "8\u0301'05''", "\u0301\u0301"}) {
    EXPECT_EQ(markedPace(text), text);
  }
}

TEST_F(PaceTest, DashesAreNoDataWhateverStandsBesideThem) {
  for (const char* const text : {"--", "––", "-- per km", "8'05'' --", "––8'05''", "a---b"}) {
    EXPECT_EQ(markedPace(text), "No data") << text;
  }
  for (const char* const text : {"-", "–", "-–", "- -", "—", "−−"}) {
    EXPECT_EQ(markedPace(text), text);
  }
}

TEST_F(PaceTest, TextsOfAnyLengthAreReadInOneGo) {
  // Each of these would take hours, or be given up, if every digit were a new beginning.
  constexpr int kMany = 200'000;
  const std::string digits = repeated("7", kMany);
  EXPECT_EQ(markedPace(digits + "'05''"), "[-55]");
  EXPECT_EQ(markedPace(digits), digits);
  EXPECT_EQ(markedPace(digits + " 8'05''"), digits + " [485]");
  for (const char* const part : {"'", "7'", "7' ", "7'7'", "\u0301", "7\u0301"}) {
    const std::string text = repeated(part, kMany);
    EXPECT_EQ(markedPace(text), text) << part;
    EXPECT_EQ(markedPace(text + " 8'05''"), text + " [485]") << part;
  }
}

TEST_F(PaceTest, WhatIsNoTextIsAbsent) {
  EXPECT_EQ(pace(nullptr), nullptr);
  EXPECT_EQ(pace(string("")), nullptr);
  EXPECT_EQ(pace(makeView<UIView>()), nullptr);
  EXPECT_EQ(marked(pace(attributedString(string("8'05''")))), "[485]");
}

TEST_F(PaceTest, AValueIsSaidWithTheNameOfItsUnit) {
  struct Case {
    const char* value;
    const char* unit;
    std::optional<const char*> name;
    const char* shown;
    const char* said;  ///< "" for no label at all
  };
  const Case cases[] = {
      {"5", "KM", "kilometers", "5 KM", "5 kilometers"},
      {"5", "KM", std::nullopt, "5 KM", ""},
      {"5", "", "beats", "5 ", "5 beats"},
  };
  for (const Case& each : cases) {
    const Ref<NSString> unit = string(each.unit);
    if (each.name) {
      setLabel(unit, *each.name);
    }
    const id made =
        send<id>(Class::named("NSString"), "attrStringWithValue:unit:", string(each.value), unit);
    EXPECT_EQ(utf8(plainText(made)), each.shown);
    EXPECT_EQ(spokenText(send<id>(made, "accessibilityUserDefinedLabel")), each.said);
  }
  const id bare =
      send<id>(Class::named("NSString"), "attrStringWithValue:unit:", string("5"), nullptr);
  EXPECT_EQ(utf8(plainText(bare)), "5");
  EXPECT_EQ(send<id>(bare, "accessibilityUserDefinedLabel"), nullptr);
}

}  // namespace
}  // namespace tavro
