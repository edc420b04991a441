#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSValue.h"

namespace tavro {

// A formatter is a light handle: ICU's own objects are kept by the platform, by kind, locale, time
// zone, calendar and template, and shared. Formatters without settings of their own use the
// settings' locale, calendar and time zone at each use.

/// How much of a date or time a style shows.
enum class NSDateFormatterStyle : std::int64_t { none = 0, shortStyle, medium, longStyle, full };

/// Spans of time as people write them. With a template, ICU's interval format for that skeleton;
/// without one, the two styles.
class NSDateIntervalFormatter : public NSObject {
 public:
  static constexpr Name className = "NSDateIntervalFormatter";

  void setDateTemplate(std::string_view skeleton) { template_ = skeleton; }
  void setDateStyle(NSDateFormatterStyle style) { dateStyle_ = style; }
  void setTimeStyle(NSDateFormatterStyle style) { timeStyle_ = style; }

  /// nil when either date is nil; an empty text when both styles are none and there is no template.
  [[nodiscard]] Ref<NSString> stringFromDate(const Ref<NSDate>& start,
                                             const Ref<NSDate>& end) const;
  /// The same for two moments, in seconds since 1970-01-01 00:00 UTC.
  [[nodiscard]] Ref<NSString> stringFromMoments(double start, double end) const;
  /// nil for nil.
  [[nodiscard]] Ref<NSString> stringFromDateInterval(const Ref<NSDateInterval>& interval) const;

 private:
  std::string template_;
  NSDateFormatterStyle dateStyle_ = NSDateFormatterStyle::medium;
  NSDateFormatterStyle timeStyle_ = NSDateFormatterStyle::shortStyle;
};

class NSDateFormatter : public NSObject {
 public:
  static constexpr Name className = "NSDateFormatter";

  /// A literal pattern. Takes the place of the styles.
  void setDateFormat(std::string_view format) { format_ = format; }
  void setDateStyle(NSDateFormatterStyle style) { dateStyle_ = style; }
  void setTimeStyle(NSDateFormatterStyle style) { timeStyle_ = style; }

  /// By the format, else by the two styles; nothing set gives an empty text. nil for nil. Raises
  /// when ICU refuses the format.
  [[nodiscard]] Ref<NSString> stringFromDate(const Ref<NSDate>& date) const;
  /// Strict: the text must be what this formatter would write for some date, in digits of any
  /// script, else nil. "MM" takes "06", and none of "6", " 06", "13" and "Jun". What the format
  /// leaves out is the first moment of what it says, in the year of 2000-01-01's number.
  [[nodiscard]] Ref<NSDate> dateFromString(const Ref<NSString>& text) const;
  /// The full weekday names as they stand in a sentence; Sunday first.
  [[nodiscard]] Ref<NSArray> weekdaySymbols() const;
  /// The full weekday names as they stand alone; Sunday first.
  [[nodiscard]] Ref<NSArray> standaloneWeekdaySymbols() const;

 private:
  std::string format_;
  NSDateFormatterStyle dateStyle_ = NSDateFormatterStyle::none;
  NSDateFormatterStyle timeStyle_ = NSDateFormatterStyle::none;
};

/// With default settings: whole numbers without grouping, in the locale's digits.
class NSNumberFormatter : public NSObject {
 public:
  static constexpr Name className = "NSNumberFormatter";

  /// nil for nil.
  [[nodiscard]] Ref<NSString> stringFromNumber(const Ref<NSNumber>& number) const;
  /// The number that the whole text is, in the locale's signs and in digits of any script; nil for
  /// anything else, grouping, blanks and exponents included.
  [[nodiscard]] Ref<NSNumber> numberFromString(const Ref<NSString>& text) const;
};

/// The date by a template ("dMMMM") that the locale orders and separates, or, where it holds
/// anything but letters, by exactly that pattern. nil for nil and for an empty format.
Ref<NSString> dateStringForFormat(const Ref<NSDate>& date, std::string_view format);

/// The locale's decimal format with grouping and at most that many decimals, no trailing zeros.
/// nil for what is not finite.
Ref<NSString> decimalString(double value, int maximumDecimals);
/// The locale's per cent format without decimals; 1.0 is one hundred per cent. nil for what is not
/// finite.
Ref<NSString> percentString(double fraction);

/// Hours, minutes and seconds in the user's words ("1 hour, 2 minutes, 3 seconds"); parts that are
/// 0 are left out, unless all are. The sign of a negative duration
/// stands where ICU puts it, on the first part.
Ref<NSString> durationInWords(std::int64_t seconds);

/// The first match of a pattern in a text.
struct NSTextCheckingResult {
  /// The whole match, then each group; a group that took no part has the location `npos`.
  std::vector<NSRange> ranges;
};

/// A compiled pattern of ICU's dialect; read-only once made.
class NSRegularExpression : public NSObject {
 public:
  static constexpr Name className = "NSRegularExpression";
  ~NSRegularExpression() override;

  /// Nothing when there is no match, or when matching would take more than ICU's bound.
  [[nodiscard]] std::optional<NSTextCheckingResult> firstMatch(const NSString& text) const;

  struct Pattern;
  Pattern* pattern = nullptr;
};

/// Raises when the pattern is malformed.
Ref<NSRegularExpression> regularExpression(std::string_view pattern);

}  // namespace tavro
