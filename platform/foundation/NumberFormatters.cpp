#include <unicode/dcfmtsym.h>
#include <unicode/decimfmt.h>
#include <unicode/listformatter.h>
#include <unicode/measunit.h>
#include <unicode/numberformatter.h>
#include <unicode/plurrule.h>

#include <cmath>

#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuSupport.h"

namespace tavro {
namespace {

using icu::number::LocalizedNumberFormatter;
using icu::number::Precision;
using icu::number::UnlocalizedNumberFormatter;

// The kinds of number formats that are kept, one cache each.
struct PlainIntegerKind {};
struct GroupedIntegerKind {};
struct DecimalKind {};
struct PercentKind {};
struct DurationPartKind {};
struct ParsingKind {};
struct DurationListKind {};
struct PluralKind {};

/// The kept number format for an option in the user's locale; `configure` describes a new one.
template <class Kind, class Configure>
const LocalizedNumberFormatter& numberFormat(std::int64_t option, const Configure& configure) {
  return icuCache<Kind, LocalizedNumberFormatter>().get(localeKey({}, option), [&] {
    // What rounds to zero has no sign: nobody wants to hear "minus zero".
    const UnlocalizedNumberFormatter format =
        icu::number::NumberFormatter::with().sign(UNUM_SIGN_NEGATIVE);
    return std::make_unique<LocalizedNumberFormatter>(configure(format).locale(icuLocale()));
  });
}

icu::UnicodeString textOf(const icu::number::FormattedNumber& formatted) {
  UErrorCode status = U_ZERO_ERROR;
  icu::UnicodeString text = formatted.toString(status);
  requireSuccess(status, "formatting a number");
  return text;
}

template <class T>
icu::UnicodeString formatted(const LocalizedNumberFormatter& format, T number) {
  UErrorCode status = U_ZERO_ERROR;
  if constexpr (std::is_floating_point_v<T>) {
    return textOf(format.formatDouble(number, status));
  } else {
    return textOf(format.formatInt(number, status));
  }
}

const LocalizedNumberFormatter& plainIntegerFormat() {
  return numberFormat<PlainIntegerKind>(0, [](const UnlocalizedNumberFormatter& format) {
    return format.grouping(UNUM_GROUPING_OFF).precision(Precision::integer());
  });
}

/// A format that also parses: whole texts, without grouping.
const icu::DecimalFormat& parsingFormat() {
  return icuCache<ParsingKind, icu::DecimalFormat>().get(localeKey(), [] {
    UErrorCode status = U_ZERO_ERROR;
    auto format = std::make_unique<icu::DecimalFormat>("0.#", status);
    std::unique_ptr<icu::DecimalFormatSymbols> symbols(
        new icu::DecimalFormatSymbols(icuLocale(), status));
    requireSuccess(status, "making a number format");
    format->adoptDecimalFormatSymbols(symbols.release());
    format->setGroupingUsed(false);
    format->setLenient(false);
    format->setParseNoExponent(true);
    return format;
  });
}

struct DurationPart {
  icu::MeasureUnit (*unit)();
  std::uint64_t seconds;
};

constexpr DurationPart kDurationParts[] = {
    {&icu::MeasureUnit::getHour, 3600},
    {&icu::MeasureUnit::getMinute, 60},
    {&icu::MeasureUnit::getSecond, 1},
};

icu::UnicodeString durationPartText(const DurationPart& part, double amount) {
  const auto option = static_cast<std::int64_t>(part.seconds);
  const auto& format =
      numberFormat<DurationPartKind>(option, [&](const UnlocalizedNumberFormatter& plain) {
        return plain.unit(part.unit()).unitWidth(UNUM_UNIT_WIDTH_FULL_NAME);
      });
  return formatted(format, amount);
}

const icu::ListFormatter& durationListFormat() {
  return icuCache<DurationListKind, icu::ListFormatter>().get(localeKey(), [] {
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<icu::ListFormatter> format(icu::ListFormatter::createInstance(
        icuLocale(), ULISTFMT_TYPE_UNITS, ULISTFMT_WIDTH_WIDE, status));
    requireSuccess(status, "making a list format");
    return format;
  });
}

}  // namespace

Ref<NSString> NSNumberFormatter::stringFromNumber(const Ref<NSNumber>& number) const {
  if (!number) {
    return nullptr;
  }
  const LocalizedNumberFormatter& format = plainIntegerFormat();
  if (const double* const real = std::get_if<double>(&number->number)) {
    return stringOf(formatted(format, *real));
  }
  return stringOf(formatted(format, number->longLongValue()));
}

Ref<NSNumber> NSNumberFormatter::numberFromString(const Ref<NSString>& text) const {
  if (!text || text->length() == 0) {
    return nullptr;
  }
  const icu::UnicodeString whole = borrowed(text->text());
  icu::Formattable result;
  icu::ParsePosition position;
  parsingFormat().parse(whole, result, position);
  if (position.getErrorIndex() >= 0 || position.getIndex() != whole.length()) {
    return nullptr;
  }
  if (result.getType() != icu::Formattable::kDouble) {
    return tavro::number(static_cast<std::int64_t>(result.getInt64()));
  }
  const double real = result.getDouble();
  return std::isfinite(real) ? tavro::number(real) : nullptr;
}

Ref<NSString> decimalString(double value, int maximumDecimals) {
  if (!std::isfinite(value)) {
    return nullptr;
  }
  const auto& format =
      numberFormat<DecimalKind>(maximumDecimals, [&](const UnlocalizedNumberFormatter& plain) {
        return plain.precision(Precision::maxFraction(maximumDecimals));
      });
  return stringOf(formatted(format, value));
}

Ref<NSString> percentString(double fraction) {
  if (!std::isfinite(fraction)) {
    return nullptr;
  }
  const auto& format = numberFormat<PercentKind>(0, [](const UnlocalizedNumberFormatter& plain) {
    return plain.unit(icu::MeasureUnit::getPercent())
        .scale(icu::number::Scale::powerOfTen(2))
        .precision(Precision::integer());
  });
  return stringOf(formatted(format, fraction));
}

icu::UnicodeString groupedInteger(std::int64_t integer) {
  return formatted(numberFormat<GroupedIntegerKind>(
                       0, [](const UnlocalizedNumberFormatter& plain) { return plain; }),
                   integer);
}

Ref<NSString> durationInWords(std::int64_t seconds) {
  const bool isNegative = seconds < 0;
  std::uint64_t rest =
      isNegative ? 0 - static_cast<std::uint64_t>(seconds) : static_cast<std::uint64_t>(seconds);
  icu::UnicodeString parts[std::size(kDurationParts)];
  std::int32_t count = 0;
  for (const DurationPart& part : kDurationParts) {
    const std::uint64_t whole = rest / part.seconds;
    const auto amount = static_cast<double>(whole);
    rest %= part.seconds;
    const bool isLastChance = part.seconds == 1 && count == 0;
    if (amount != 0 || isLastChance) {
      parts[count] = durationPartText(part, isNegative && count == 0 ? -amount : amount);
      ++count;
    }
  }
  UErrorCode status = U_ZERO_ERROR;
  icu::UnicodeString joined;
  durationListFormat().format(parts, count, joined, status);
  requireSuccess(status, "joining the parts of a duration");
  return stringOf(joined);
}

std::string pluralCategory(std::string_view language, std::int64_t integer) {
  const icu::PluralRules& rules =
      icuCache<PluralKind, icu::PluralRules>().get({.detail = language}, [&] {
        UErrorCode status = U_ZERO_ERROR;
        std::unique_ptr<icu::PluralRules> made(
            icu::PluralRules::forLocale(icu::Locale(std::string(language).c_str()), status));
        requireSuccess(status, "making plural rules");
        return made;
      });
  std::string category;
  rules.select(static_cast<double>(integer)).toUTF8String(category);
  return category;
}

namespace {

const Registered kNumberFormatter = defineClass<NSNumberFormatter, NSObject>();

}  // namespace
}  // namespace tavro
