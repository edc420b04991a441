#pragma once

#include "platform/foundation/Formatters.h"

namespace tavro {

/// The number as spoken text in the user's locale: at most one decimal with option 0, at most two
/// with option 1, never trailing zeros. nil for what is not finite.
Ref<NSString> AXFormatFloat(std::int64_t option, float value);
/// The fraction as spoken per cent without decimals; 1.0 is one hundred per cent. nil for what is
/// not finite.
Ref<NSString> UIAXFormatFloatWithPercentage(std::int64_t option, float fraction);
/// The date by a template ("dMMMM"), or by exactly that pattern where it holds blanks or
/// punctuation. nil for nil.
Ref<NSString> AXDateStringForFormat(const Ref<NSDate>& date, std::string_view format);
/// The date that the whole text denotes; nil when it does not match strictly.
Ref<NSDate> AXDateFromStringWithFormat(const Ref<NSString>& text, std::string_view format);

}  // namespace tavro
