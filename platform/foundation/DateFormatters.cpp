#include <unicode/dtfmtsym.h>
#include <unicode/dtitvfmt.h>
#include <unicode/dtptngen.h>
#include <unicode/smpdtfmt.h>
#include <unicode/uchar.h>

#include <algorithm>

#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuSupport.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

// The kinds of date formats that are kept, one cache each.
struct PatternKind {};
struct TemplateKind {};
struct StyleKind {};
struct TemplateIntervalKind {};
struct StyleIntervalKind {};
struct GeneratorKind {};
struct SymbolsKind {};

icu::Locale userLocale() { return icuLocale(Settings::current().calendar); }

icu::DateTimePatternGenerator& patternGenerator() {
  return icuCache<GeneratorKind, icu::DateTimePatternGenerator>().get(userKey(), [] {
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<icu::DateTimePatternGenerator> generator(
        icu::DateTimePatternGenerator::createInstance(userLocale(), status));
    requireSuccess(status, "making a pattern generator");
    return generator;
  });
}

/// A format with a calendar to reckon in, where ICU alone would make one for every text.
struct MomentFormat {
  std::unique_ptr<icu::SimpleDateFormat> format;
  std::unique_ptr<icu::Calendar> moment;
};

/// Gives a format the user's time zone.
std::unique_ptr<MomentFormat> zoned(std::unique_ptr<icu::SimpleDateFormat> format) {
  format->adoptTimeZone(icuTimeZone(Settings::current().timeZone).release());
  std::unique_ptr<icu::Calendar> moment(format->getCalendar()->clone());
  return std::unique_ptr<MomentFormat>(new MomentFormat{std::move(format), std::move(moment)});
}

std::unique_ptr<MomentFormat> makePatternFormat(const icu::UnicodeString& pattern) {
  UErrorCode status = U_ZERO_ERROR;
  auto format = std::make_unique<icu::SimpleDateFormat>(pattern, userLocale(), status);
  requireSuccess(status, "making a date format");
  return zoned(std::move(format));
}

MomentFormat& patternFormat(std::string_view pattern) {
  return icuCache<PatternKind, MomentFormat>().get(
      userKey(pattern), [&] { return makePatternFormat(unicode(pattern)); });
}

MomentFormat& templateFormat(std::string_view skeleton) {
  return icuCache<TemplateKind, MomentFormat>().get(userKey(skeleton), [&] {
    // A month alone is named as one: some languages' pattern for it has the form it has in dates,
    // a genitive in Greek.
    if (skeleton.find_first_not_of('M') == std::string_view::npos) {
      return makePatternFormat(unicode(std::string(skeleton.size(), 'L')));
    }
    UErrorCode status = U_ZERO_ERROR;
    const icu::UnicodeString pattern = patternGenerator().getBestPattern(unicode(skeleton), status);
    requireSuccess(status, "choosing a date pattern");
    return makePatternFormat(pattern);
  });
}

icu::DateFormat::EStyle icuStyle(NSDateFormatterStyle style) {
  switch (style) {
    case NSDateFormatterStyle::shortStyle:
      return icu::DateFormat::kShort;
    case NSDateFormatterStyle::medium:
      return icu::DateFormat::kMedium;
    case NSDateFormatterStyle::longStyle:
      return icu::DateFormat::kLong;
    case NSDateFormatterStyle::full:
      return icu::DateFormat::kFull;
    case NSDateFormatterStyle::none:
      break;
  }
  return icu::DateFormat::kNone;
}

std::int64_t styleOption(NSDateFormatterStyle date, NSDateFormatterStyle time) {
  return static_cast<std::int64_t>(date) * 8 + static_cast<std::int64_t>(time);
}

/// The format of two styles, not both none.
MomentFormat& styleFormat(NSDateFormatterStyle date, NSDateFormatterStyle time) {
  return icuCache<StyleKind, MomentFormat>().get(userKey({}, styleOption(date, time)), [&] {
    std::unique_ptr<icu::DateFormat> format(
        icu::DateFormat::createDateTimeInstance(icuStyle(date), icuStyle(time), userLocale()));
    if (dynamic_cast<icu::SimpleDateFormat*>(format.get()) == nullptr) {
      requireSuccess(U_MISSING_RESOURCE_ERROR, "making a date format");
    }
    return zoned(std::unique_ptr<icu::SimpleDateFormat>(
        static_cast<icu::SimpleDateFormat*>(format.release())));
  });
}

/// An interval format with the calendars in which the ends of its last span were reckoned: spans
/// that follow each other share one.
struct IntervalFormat {
  std::unique_ptr<icu::DateIntervalFormat> format;
  std::unique_ptr<icu::Calendar> start;
  std::unique_ptr<icu::Calendar> end;
};

std::unique_ptr<IntervalFormat> makeIntervalFormat(const icu::UnicodeString& skeleton) {
  UErrorCode status = U_ZERO_ERROR;
  std::unique_ptr<icu::DateIntervalFormat> format(
      icu::DateIntervalFormat::createInstance(skeleton, userLocale(), status));
  requireSuccess(status, "making an interval format");
  format->adoptTimeZone(icuTimeZone(Settings::current().timeZone).release());
  const icu::Calendar& calendar =
      *static_cast<const icu::SimpleDateFormat&>(*format->getDateFormat()).getCalendar();
  std::unique_ptr<icu::Calendar> start(calendar.clone());
  std::unique_ptr<icu::Calendar> end(calendar.clone());
  return std::unique_ptr<IntervalFormat>(
      new IntervalFormat{std::move(format), std::move(start), std::move(end)});
}

IntervalFormat& intervalFormat(std::string_view skeleton) {
  return icuCache<TemplateIntervalKind, IntervalFormat>().get(
      userKey(skeleton), [&] { return makeIntervalFormat(unicode(skeleton)); });
}

IntervalFormat& intervalFormat(NSDateFormatterStyle date, NSDateFormatterStyle time) {
  return icuCache<StyleIntervalKind, IntervalFormat>().get(
      userKey({}, styleOption(date, time)), [&] {
        UErrorCode status = U_ZERO_ERROR;
        icu::UnicodeString pattern;
        styleFormat(date, time).format->toPattern(pattern);
        const icu::UnicodeString skeleton =
            icu::DateTimePatternGenerator::staticGetSkeleton(pattern, status);
        requireSuccess(status, "reading a date pattern");
        return makeIntervalFormat(skeleton);
      });
}

Ref<NSString> formatted(const MomentFormat& format, const NSDate& date) {
  UErrorCode status = U_ZERO_ERROR;
  icu::UnicodeString text;
  format.moment->setTime(icuMilliseconds(date.seconds), status);
  format.format->format(*format.moment, text, nullptr, status);
  requireSuccess(status, "formatting a date");
  return stringOf(text);
}

Ref<NSString> formatted(IntervalFormat& format, double start, double end) {
  UErrorCode status = U_ZERO_ERROR;
  if (format.end->getTime(status) == start) {
    std::swap(format.start, format.end);
  }
  if (format.start->getTime(status) != start) {
    format.start->setTime(start, status);
  }
  if (end != start) {
    format.end->setTime(end, status);
  }
  icu::UnicodeString text;
  icu::FieldPosition field;
  format.format->format(*format.start, end == start ? *format.start : *format.end, text, field,
                        status);
  requireSuccess(status, "formatting a date interval");
  return stringOf(text);
}

/// The text with every decimal digit as an ASCII one.
icu::UnicodeString withAsciiDigits(const icu::UnicodeString& text) {
  icu::UnicodeString folded;
  for (std::int32_t index = 0; index < text.length(); index = text.moveIndex32(index, 1)) {
    const UChar32 character = text.char32At(index);
    const std::int32_t digit = u_charDigitValue(character);
    folded.append(digit < 0 ? character : static_cast<UChar32>(U'0' + digit));
  }
  return folded;
}

/// A calendar that knows nothing but a year, which decides the months there are.
std::unique_ptr<icu::Calendar> unsetCalendar(const icu::SimpleDateFormat& format) {
  constexpr double kNoonOf20000101 = 946'728'000'000;
  std::unique_ptr<icu::Calendar> calendar(format.getCalendar()->clone());
  UErrorCode status = U_ZERO_ERROR;
  calendar->setTime(kNoonOf20000101, status);
  const std::int32_t year = calendar->get(UCAL_YEAR, status);
  requireSuccess(status, "setting a calendar");
  calendar->clear();
  calendar->set(UCAL_YEAR, year);
  return calendar;
}

Ref<NSDate> parsed(const MomentFormat& kept, const NSString& text) {
  const icu::SimpleDateFormat& format = *kept.format;
  const icu::UnicodeString whole = borrowed(text.text());
  const std::unique_ptr<icu::Calendar> calendar = unsetCalendar(format);
  icu::ParsePosition position;
  format.parse(whole, *calendar, position);
  UErrorCode status = U_ZERO_ERROR;
  const double milliseconds = calendar->getTime(status);
  // Even when told to be strict, ICU takes "6" and " 06" for "MM". So it may be as lenient as it
  // likes: only a text that it would write itself matches wholly.
  icu::UnicodeString written;
  icu::FieldPosition field;
  format.format(*calendar, written, field);
  if (position.getErrorIndex() >= 0 || U_FAILURE(status) ||
      withAsciiDigits(written) != withAsciiDigits(whole)) {
    return nullptr;
  }
  return dateWithSeconds(milliseconds / 1000);
}

Ref<NSArray> weekdayNames(icu::DateFormatSymbols::DtContextType context) {
  const icu::DateFormatSymbols& symbols =
      icuCache<SymbolsKind, icu::DateFormatSymbols>().get(userKey(), [] {
        UErrorCode status = U_ZERO_ERROR;
        auto made = std::make_unique<icu::DateFormatSymbols>(userLocale(), status);
        requireSuccess(status, "reading the names of weekdays");
        return made;
      });
  std::int32_t count = 0;
  const icu::UnicodeString* const names =
      symbols.getWeekdays(count, context, icu::DateFormatSymbols::WIDE);
  std::vector<id> weekdays;
  for (std::int32_t day = UCAL_SUNDAY; day < count; ++day) {
    weekdays.push_back(stringOf(names[day]));
  }
  return arrayWithObjects(std::move(weekdays));
}

bool isTemplate(std::string_view format) {
  return std::ranges::all_of(
      format, [](char c) { return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z'); });
}

}  // namespace

Ref<NSString> NSDateIntervalFormatter::stringFromDate(const Ref<NSDate>& start,
                                                      const Ref<NSDate>& end) const {
  return start && end ? stringFromMoments(start->seconds, end->seconds) : nullptr;
}

Ref<NSString> NSDateIntervalFormatter::stringFromMoments(double start, double end) const {
  const bool showsNothing = template_.empty() && dateStyle_ == NSDateFormatterStyle::none &&
                            timeStyle_ == NSDateFormatterStyle::none;
  if (showsNothing) {
    return string("");
  }
  return formatted(
      template_.empty() ? intervalFormat(dateStyle_, timeStyle_) : intervalFormat(template_),
      icuMilliseconds(start), icuMilliseconds(end));
}

Ref<NSString> NSDateIntervalFormatter::stringFromDateInterval(
    const Ref<NSDateInterval>& interval) const {
  return interval ? stringFromDate(interval->startDate, interval->endDate) : nullptr;
}

namespace {

/// The format that a formatter's settings choose; nullptr when they show nothing.
const MomentFormat* chosenFormat(std::string_view format, NSDateFormatterStyle date,
                                 NSDateFormatterStyle time) {
  if (!format.empty()) {
    return &patternFormat(format);
  }
  if (date == NSDateFormatterStyle::none && time == NSDateFormatterStyle::none) {
    return nullptr;
  }
  return &styleFormat(date, time);
}

}  // namespace

Ref<NSString> NSDateFormatter::stringFromDate(const Ref<NSDate>& date) const {
  if (!date) {
    return nullptr;
  }
  const MomentFormat* const format = chosenFormat(format_, dateStyle_, timeStyle_);
  return format == nullptr ? string("") : formatted(*format, *date);
}

Ref<NSDate> NSDateFormatter::dateFromString(const Ref<NSString>& text) const {
  const MomentFormat* const format = chosenFormat(format_, dateStyle_, timeStyle_);
  return text && format != nullptr ? parsed(*format, *text) : nullptr;
}

Ref<NSArray> NSDateFormatter::weekdaySymbols() const {
  return weekdayNames(icu::DateFormatSymbols::FORMAT);
}

Ref<NSArray> NSDateFormatter::standaloneWeekdaySymbols() const {
  return weekdayNames(icu::DateFormatSymbols::STANDALONE);
}

Ref<NSString> dateStringForFormat(const Ref<NSDate>& date, std::string_view format) {
  if (!date || format.empty()) {
    return nullptr;
  }
  return formatted(isTemplate(format) ? templateFormat(format) : patternFormat(format), *date);
}

namespace {

const Registered kDateFormatter = defineClass<NSDateFormatter, NSObject>();
const Registered kDateIntervalFormatter = defineClass<NSDateIntervalFormatter, NSObject>();

}  // namespace
}  // namespace tavro
