#pragma once

#include "host/Diary.h"
#include "platform/foundation/NSDate.h"

namespace tavro {

/// Noon of a Gregorian day in the settings' time zone: a moment that any calendar puts on that day.
Ref<NSDate> noonOf(CalendarDay day);
/// The Gregorian day of a moment in the settings' time zone.
CalendarDay dayOf(const Ref<NSDate>& date);

}  // namespace tavro
