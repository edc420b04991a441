#pragma once

#include <unicode/dtitvfmt.h>
#include <unicode/numberformatter.h>
#include <unicode/plurrule.h>
#include <unicode/smpdtfmt.h>

#include <memory>
#include <utility>
#include <vector>

namespace tavro::bench {

/// Formats what the plug-in says with ICU alone: the least that the texts can cost. A formatter is
/// made when it is first used.
class IcuTexts {
 public:
  static constexpr double kMilliseconds = 1000;

  /// From `start` to `end`, in seconds since 1970.
  void interval(const char16_t* skeleton, double start, double end) {
    const auto& format = kept(intervals_, skeleton, [&] {
      return icu::DateIntervalFormat::createInstance(skeleton, locale_, status_);
    });
    const icu::DateInterval span(start * kMilliseconds, end * kMilliseconds);
    icu::UnicodeString text;
    icu::FieldPosition position;
    format.format(&span, text, position, status_);
    keep(text);
  }

  void date(const char16_t* skeleton, double seconds) {
    const auto& format = kept(dates_, skeleton, [&] {
      return icu::DateFormat::createInstanceForSkeleton(skeleton, locale_, status_);
    });
    icu::UnicodeString text;
    format.format(seconds * kMilliseconds, text);
    keep(text);
  }

  void decimal(float value, int decimals) {
    auto& format = decimals == 1 ? tenths_ : hundredths_;
    if (!format) {
      format =
          std::make_unique<Numbers>(icu::number::NumberFormatter::withLocale(locale_)
                                        .sign(UNUM_SIGN_NEGATIVE)
                                        .precision(icu::number::Precision::maxFraction(decimals)));
    }
    keep(format->formatDouble(value, status_).toString(status_));
  }

  void percent(float fraction) {
    if (!percents_) {
      percents_ = std::make_unique<Numbers>(icu::number::NumberFormatter::withLocale(locale_)
                                                .sign(UNUM_SIGN_NEGATIVE)
                                                .unit(icu::MeasureUnit::getPercent())
                                                .scale(icu::number::Scale::powerOfTen(2))
                                                .precision(icu::number::Precision::integer()));
    }
    keep(percents_->formatDouble(fraction, status_).toString(status_));
  }

  void plural(double number) {
    if (!plurals_) {
      plurals_.reset(icu::PluralRules::forLocale(locale_, status_));
    }
    keep(plurals_->select(number));
  }

 private:
  using Numbers = icu::number::LocalizedNumberFormatter;
  template <class Format>
  using Kept = std::vector<std::pair<const char16_t*, std::unique_ptr<Format>>>;

  template <class Format, class Create>
  Format& kept(Kept<Format>& formats, const char16_t* skeleton, const Create& create) {
    for (const auto& [name, format] : formats) {
      if (name == skeleton) {
        return *format;
      }
    }
    formats.emplace_back(skeleton, create());
    formats.back().second->adoptTimeZone(icu::TimeZone::createTimeZone("America/New_York"));
    return *formats.back().second;
  }

  static void keep(const icu::UnicodeString& text) {
    asm volatile("" : : "r"(text.getBuffer()) : "memory");
  }

  UErrorCode status_ = U_ZERO_ERROR;
  icu::Locale locale_{"en_US"};
  Kept<icu::DateIntervalFormat> intervals_;
  Kept<icu::DateFormat> dates_;
  std::unique_ptr<Numbers> tenths_;
  std::unique_ptr<Numbers> hundredths_;
  std::unique_ptr<Numbers> percents_;
  std::unique_ptr<icu::PluralRules> plurals_;
};

// The texts of the charts, from the day's first moment where they have to do with a day.

inline constexpr double kMidnight = 1773201600;  ///< of 2026-03-11 in New York
inline constexpr int kHours = 24;
inline constexpr int kSlices = 8;
inline constexpr int kBars = 365;
inline constexpr double kFirstBar = 1735750800;  ///< noon of 2025-01-01 in New York
inline constexpr double kSecondsPerDay = 86400;

inline double energyOfHour(int hour) { return hour * 7.3; }
inline double amountOfBar(int bar) { return 312.25 + bar * 1.37; }

/// The span of a part of the day, the last one to the minute.
inline void formatPart(IcuTexts& icu, int part, int parts, const char16_t* skeleton) {
  const double length = kSecondsPerDay / parts;
  const bool isLast = part == parts - 1;
  const double start = kMidnight + part * length;
  icu.interval(isLast ? u"h:mma" : skeleton, start, start + length - (isLast ? 1 : 0));
}
inline void formatHours(IcuTexts& icu) {
  for (int hour = 0; hour < kHours; ++hour) {
    formatPart(icu, hour, kHours, u"ha");
  }
}
inline void formatSlices(IcuTexts& icu) {
  for (int slice = 0; slice < kSlices; ++slice) {
    formatPart(icu, slice, kSlices, u"hxa");
    float sum = 0;
    for (int hour = 3 * slice; hour < 3 * slice + 3; ++hour) {
      sum += static_cast<float>(energyOfHour(hour));
    }
    icu.decimal(sum, 1);
  }
}
inline void formatBars(IcuTexts& icu) {
  for (int bar = 0; bar < kBars; ++bar) {
    const double noon = kFirstBar + bar * kSecondsPerDay;
    icu.interval(u"MMMMdyyyy", noon, noon);
    icu.decimal(static_cast<float>(amountOfBar(bar)), 2);
  }
}

}  // namespace tavro::bench
