#pragma once

#include "host/Application.h"

namespace tavro {

/// The month calendar of the whole diary.
Ref<UIViewController> makeCalendar(const Application& application);
/// The same while it is still loading.
Ref<UIViewController> makeLoadingCalendar(const Application& application);
/// The present week.
Ref<UIViewController> makeWeek(const Application& application);

}  // namespace tavro
