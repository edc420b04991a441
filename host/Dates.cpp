#include "host/Dates.h"

namespace tavro {

Ref<NSDate> noonOf(CalendarDay day) {
  const auto components = make<NSDateComponents>();
  components->era = 1;
  components->year = 1970;
  components->month = 1;
  components->day = 1 + day.number;  // days beyond the month carry over
  components->hour = 12;
  return calendarWithIdentifier(NSCalendarIdentifierGregorian)->dateFromComponents(*components);
}

CalendarDay dayOf(const Ref<NSDate>& date) {
  const auto components =
      calendarWithIdentifier(NSCalendarIdentifierGregorian)->componentsFromDate(date);
  return {daysFromCivil(components->year, components->month, components->day)};
}

}  // namespace tavro
