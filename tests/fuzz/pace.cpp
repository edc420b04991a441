// The pace text agrees with a plain reading of the label from left to right.

#include <unicode/uchar.h>
#include <unicode/utf16.h>

#include <optional>

#include "platform/accessibility/BundleLoader.h"
#include "platform/uikit/UIAccessibility.h"
#include "plugin/core/Exports.h"
#include "tests/fuzz/Fuzz.h"

namespace tavro::fuzz {
namespace {

struct Pace {
  NSRange range;
  std::int32_t seconds = 0;
};

/// The label read from a place on.
struct Reading {
  std::u16string_view text;
  std::size_t place = 0;

  [[nodiscard]] UChar32 next() const {
    UChar32 character = 0;
    std::size_t at = place;
    if (at < text.size()) {
      U16_NEXT(text.data(), at, text.size(), character);
    }
    return character;
  }
  bool passIf(bool isThere) {
    const UChar32 character = next();
    place += isThere && place < text.size() ? static_cast<std::size_t>(U16_LENGTH(character)) : 0;
    return isThere;
  }
  bool pass(std::u16string_view sign) {
    const bool isThere = text.substr(place).starts_with(sign);
    place += isThere ? sign.size() : 0;
    return isThere;
  }
  /// Minutes as far as they fit.
  std::int64_t passDigits() {
    std::int64_t number = 0;
    while (u_isdigit(next()) != 0 && place < text.size()) {
      const std::int64_t digit = u_charDigitValue(next());
      number = number > (INT64_MAX - digit) / 10 ? INT64_MAX : number * 10 + digit;
      passIf(true);
    }
    return number;
  }
};

/// The seconds and the two signs after them: two digits are tried before one.
std::optional<std::int64_t> passSeconds(Reading& reading) {
  for (const std::size_t digits : {2, 1}) {
    Reading tried = reading;
    std::int64_t seconds = 0;
    bool fits = true;
    for (std::size_t digit = digits; digit > 0; --digit) {
      const UChar32 most = digit == 2 ? u'5' : u'9';
      const UChar32 next = tried.next();
      fits = fits && tried.passIf(next >= u'0' && next <= most);
      seconds = seconds * 10 + (next - u'0');
    }
    if (fits && (tried.pass(u"''") || tried.pass(u"\""))) {
      reading = tried;
      return seconds;
    }
  }
  return std::nullopt;
}

std::optional<Pace> paceIn(std::u16string_view text) {
  bool follows = false;  // the character before is a digit
  for (std::size_t start = 0; start < text.size();) {
    Reading reading{text, start};
    const bool isDigit = u_isdigit(reading.next()) != 0;
    if (isDigit && !follows) {
      const std::int64_t minutes = reading.passDigits();
      if (reading.pass(u"'")) {
        reading.passIf(u_isUWhiteSpace(reading.next()) != 0);
        if (const auto seconds = passSeconds(reading)) {
          const auto total =
              static_cast<std::uint64_t>(minutes) * 60 + static_cast<std::uint64_t>(*seconds);
          return Pace{{start, reading.place - start}, static_cast<std::int32_t>(total)};
        }
      }
    }
    follows = isDigit;
    Reading step{text, start};
    step.passIf(true);
    start = step.place;
  }
  return std::nullopt;
}

using Function = Ref<AXAttributedString> (*)(const id&);

Function paceFunction() {
  static const LoadedBundle bundle =
      loadAccessibilityBundle(std::string(TAVRO_BUILD) + "/AXTavro.axbundle");
  return reinterpret_cast<Function>(
      bundle.symbol("accessibilityAttributedStringForPaceContainingString"));
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  static const auto pace = fuzz::paceFunction();
  const Ref<NSString> label = string(fuzz::textOf(data, size));
  const Ref<AXAttributedString> said = pace(label);
  const std::u16string text(label->text());
  if (text.empty()) {
    fuzz::require(!said, "nothing is said of an empty label");
    return 0;
  }
  const std::string shown = said->string()->utf8();
  if (text.find(u"--") != text.npos || text.find(u"\u2013\u2013") != text.npos) {
    fuzz::require(shown == "No data", "dashes are no data", shown);
    return 0;
  }
  const std::optional<fuzz::Pace> found = fuzz::paceIn(text);
  std::u16string expected = text;
  NSRange marked{0, 0};
  if (found) {
    const Ref<NSString> seconds = string(std::to_string(found->seconds));
    expected.replace(found->range.location, found->range.length, seconds->text());
    marked = {found->range.location, seconds->length()};
  }
  fuzz::require(said->string()->text() == expected, "the first pace becomes its seconds", shown);
  const auto runs = said->runs();
  fuzz::require(runs.size() == (found ? 1 : 0), "one pace is marked", shown);
  fuzz::require(!found || (runs.front().range == marked &&
                           runs.front().key == UIAccessibilityTokenDurationTimeMMSS),
                "the seconds are marked as a duration", shown);
  return 0;
}
