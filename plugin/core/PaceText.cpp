#include "platform/accessibility/KeyAccess.h"
#include "platform/foundation/Formatters.h"
#include "platform/runtime/Dispatch.h"
#include "platform/uikit/UIAccessibility.h"
#include "plugin/core/Exports.h"
#include "plugin/core/NoData.h"

using namespace tavro;

namespace {

constexpr std::size_t kRangesOfPace = 3;

/// Minutes, an apostrophe, at most one blank, seconds, then two apostrophes or one quote. Digits of
/// every script count as minutes, seconds are ASCII.
///
/// A run of digits is tried from its beginning only: it cannot match otherwise, and a label of
/// nothing but digits then costs one look at each instead of one at each pair. Digits after the
/// first are a set, which the engine repeats without remembering each.
const NSRegularExpression& pacePattern() {
  static OnceToken token;
  static Ref<NSRegularExpression> pattern;
  dispatchOnce(token, [] {
    pattern = regularExpression(R"re((?<!\d)(\d[\d]*)'\s?([0-5]?[0-9])(?:''|"))re");
  });
  return *pattern;
}

/// Minutes of any length count as the nearest 64-bit number, and the total keeps its low 32 bits:
/// a pace that nobody runs is said as some number, never as an error.
std::int32_t totalSeconds(std::int64_t minutes, std::int64_t seconds) {
  constexpr std::uint32_t secondsPerMinute = 60;
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(minutes) * secondsPerMinute +
                                   static_cast<std::uint32_t>(seconds));
}

std::int64_t integerIn(const NSString& text, NSRange range) {
  return integerValue(*string(text.text().substr(range.location, range.length)));
}

}  // namespace

Ref<AXAttributedString> accessibilityAttributedStringForPaceContainingString(const id& label) {
  const Ref<NSString> text = plainText(label);
  if (!text || text->length() == 0) {
    return nullptr;
  }
  if (showsNoData(text)) {
    return axAttributedString(localized("no.data"));
  }
  const auto match = pacePattern().firstMatch(*text);
  if (!match || match->ranges.size() != kRangesOfPace) {
    return axAttributedString(text);
  }
  const NSRange whole = match->ranges[0];
  const std::int32_t total =
      totalSeconds(integerIn(*text, match->ranges[1]), integerIn(*text, match->ranges[2]));
  const Ref<NSString> formatted =
      make<NSNumberFormatter>()->stringFromNumber(number(std::int64_t{total}));
  std::u16string spoken(text->text());
  spoken.replace(whole.location, whole.length, formatted ? formatted->text() : u"");
  Ref<AXAttributedString> pace = axAttributedString(string(spoken));
  pace->setAttribute(kCFBooleanTrue(), UIAccessibilityTokenDurationTimeMMSS,
                     {whole.location, lengthOfText(formatted)});
  return pace;
}
