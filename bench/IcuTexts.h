#pragma once

#include <benchmark/benchmark.h>
#include <unicode/dtitvfmt.h>
#include <unicode/numberformatter.h>

#include <memory>

#include "platform/foundation/NSDate.h"

namespace tavro::bench {

/// Formats what a chart says with ICU alone, by formatters that are ready: the least that the texts
/// can cost.
class IcuTexts {
 public:
  using IntervalFormat = std::unique_ptr<icu::DateIntervalFormat>;

  [[nodiscard]] IntervalFormat intervalFormat(const char16_t* skeleton) {
    IntervalFormat made(icu::DateIntervalFormat::createInstance(skeleton, locale_, status_));
    made->setTimeZone(*icu::TimeZone::getGMT());
    return made;
  }

  /// From `start` to `end`, in seconds since 1970.
  void formatInterval(const IntervalFormat& format, double start, double end) {
    const icu::DateInterval span(start * kMilliseconds, end * kMilliseconds);
    icu::UnicodeString text;
    icu::FieldPosition position;
    format->format(&span, text, position, status_);
    benchmark::DoNotOptimize(text);
  }

  void formatNumber(double value) {
    icu::UnicodeString text = numbers_.formatDouble(value, status_).toString(status_);
    benchmark::DoNotOptimize(text);
  }

 private:
  static constexpr double kMilliseconds = 1000;
  UErrorCode status_ = U_ZERO_ERROR;
  icu::Locale locale_{"en_US"};
  icu::number::LocalizedNumberFormatter numbers_ =
      icu::number::NumberFormatter::withLocale(locale_).precision(
          icu::number::Precision::maxFraction(2));
};

/// Seconds since 1970 at which the settings' present day begins.
inline double midnight() { return currentCalendar()->startOfDayForDate(dateNow())->seconds; }

}  // namespace tavro::bench
