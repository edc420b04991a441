#include "host/screens/calendar/CalendarScreens.h"

#include "host/screens/calendar/MonthViewController.h"
#include "host/screens/calendar/PaletteViewController.h"

namespace tavro {
namespace {

Ref<MonthViewController> calendarOf(const Application& application) {
  auto controller = makeController<MonthViewController>();
  controller->setSpan(calendarSpanOf(application.diary()));
  return controller;
}

}  // namespace

Ref<UIViewController> makeCalendar(const Application& application) {
  return calendarOf(application);
}

Ref<UIViewController> makeLoadingCalendar(const Application& application) {
  const auto controller = calendarOf(application);
  controller->setLoading(true);
  return controller;
}

Ref<UIViewController> makeWeek(const Application& /*application*/) {
  return makeController<PaletteViewController>();
}

}  // namespace tavro
