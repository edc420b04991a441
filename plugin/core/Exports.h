#pragma once

#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"
#include "platform/healthkit/HKUnit.h"

// The functions that the bundle exports, found by exactly these symbols. They take and yield the
// platform's references, which C cannot spell; only C++ calls them.
#if defined(__clang__)
#pragma clang diagnostic push
#pragma clang diagnostic ignored "-Wreturn-type-c-linkage"
#endif

extern "C" {

/// The plug-in's text for a key of its table "Accessibility", in the user's language: the key
/// itself when the table lacks it, nil when the plug-in's bundle cannot be found.
tavro::Ref<tavro::NSString> accessibilityLocalizedString(const tavro::Ref<tavro::NSString>& key);

/// The index of the date's day in the host's activity cache. Always a day of the Gregorian
/// calendar, whatever the user's calendar is.
std::int64_t CHCacheIndexForDate(const tavro::Ref<tavro::NSDate>& date);

/// The unit in which a trend of that type (0 to 8) is measured; nil for any other type.
tavro::Ref<tavro::HKUnit> accessibilityHKUnitForTrendType(std::int64_t trendType);

/// The title of an `ACHAchievement` for the user's name and wheelchair setting, both taken at the
/// first call of the process; nil for any other object.
tavro::Ref<tavro::NSString> accessibilityLocalizedStringForAchievement(
    const tavro::id& achievement);

/// The description of the date's three rings: what the day's summary in the host's activity cache
/// answers for its fractions. nil when there is no summary, when one of its fractions is negative
/// or not a number, and when nobody answers for the summary. `isCapped` is handed on.
tavro::Ref<tavro::NSString> accessibilityTavroStringForDate(const tavro::Ref<tavro::NSDate>& date,
                                                            bool isCapped);

/// Three fractions as one sentence: each ring's name, then its per cent, where 1.0 is one hundred;
/// what is below 0 or not a number counts as 0. When the fractions are capped, exactly 1.0 is said
/// as a goal completed, and three of them as all goals completed.
tavro::Ref<tavro::NSString> accessibilityDescriptionForPercentages(double move, double exercise,
                                                                   double stand, bool isCapped);

/// A label's text, given as a string or an attributed string, with its first pace (8'05'') replaced
/// by its whole seconds and those marked as a duration of minutes and seconds. The text for "no
/// data" when a dash placeholder is anywhere in it; the text as it is when it holds no pace; nil
/// for nil and for an empty text. Attributes of the text itself are not kept.
tavro::Ref<tavro::AXAttributedString> accessibilityAttributedStringForPaceContainingString(
    const tavro::id& text);

}  // extern "C"

#if defined(__clang__)
#pragma clang diagnostic pop
#endif

namespace tavro {

/// Whether the user is a wheelchair user, while the screen reader runs. The first call with the
/// screen reader on asks the health store; later ones answer with what the store said last and ask
/// again in the background. With the screen reader off nothing is asked.
bool _userIsWheelchairUserWithNarrelOn();

/// `accessibilityLocalizedString` of a key that is written out.
Ref<NSString> localized(std::string_view key);

}  // namespace tavro
