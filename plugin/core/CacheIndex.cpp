#include "platform/healthkit/HKActivitySummary.h"
#include "platform/runtime/Dispatch.h"
#include "plugin/core/Exports.h"

using namespace tavro;

std::int64_t CHCacheIndexForDate(const Ref<NSDate>& date) {
  static OnceToken token;
  static Ref<NSCalendar> gregorian;
  dispatchOnce(token, [] { gregorian = calendarWithIdentifier(NSCalendarIdentifierGregorian); });
  return _HKCacheIndexFromDateComponents(_HKActivityCacheDateComponentsFromDate(date, gregorian));
}
