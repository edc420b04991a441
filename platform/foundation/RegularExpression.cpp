#include <unicode/regex.h>

#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuSupport.h"

namespace tavro {
namespace {

// In ICU's unit, 10000 steps or about a millisecond each: a pattern that tries everything ends
// before anyone would notice, and a long text gets some twenty steps for each of its units.
constexpr std::int32_t kTimeLimit = 100;
constexpr std::int32_t kUnitsForEachLimit = 500;

}  // namespace

struct NSRegularExpression::Pattern {
  std::unique_ptr<icu::RegexPattern> compiled;
};

NSRegularExpression::~NSRegularExpression() { delete pattern; }

std::optional<NSTextCheckingResult> NSRegularExpression::firstMatch(const NSString& text) const {
  if (pattern == nullptr) {
    return std::nullopt;
  }
  UErrorCode status = U_ZERO_ERROR;
  const icu::UnicodeString searched = borrowed(text.text());  // outlives the matcher
  const std::unique_ptr<icu::RegexMatcher> matcher(pattern->compiled->matcher(searched, status));
  requireSuccess(status, "searching a text");
  matcher->setTimeLimit(kTimeLimit + searched.length() / kUnitsForEachLimit, status);
  if (!matcher->find(status) || U_FAILURE(status)) {
    return std::nullopt;
  }
  NSTextCheckingResult result;
  for (std::int32_t group = 0; group <= matcher->groupCount(); ++group) {
    const std::int32_t start = matcher->start(group, status);
    const std::int32_t end = matcher->end(group, status);
    result.ranges.push_back(start < 0 ? NSRange{std::u16string_view::npos, 0}
                                      : NSRange{static_cast<std::size_t>(start),
                                                static_cast<std::size_t>(end - start)});
  }
  return result;
}

Ref<NSRegularExpression> regularExpression(std::string_view pattern) {
  UErrorCode status = U_ZERO_ERROR;
  UParseError place{};
  std::unique_ptr<icu::RegexPattern> compiled(
      icu::RegexPattern::compile(unicode(pattern), place, status));
  requireSuccess(status, "compiling the pattern \"" + std::string(pattern) + "\"");
  Ref<NSRegularExpression> expression = make<NSRegularExpression>();
  expression->pattern = new NSRegularExpression::Pattern{std::move(compiled)};
  return expression;
}

namespace {

const Registered kRegularExpression = defineClass<NSRegularExpression, NSObject>();

}  // namespace
}  // namespace tavro
