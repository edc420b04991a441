#pragma once

#include "host/Application.h"

namespace tavro {

/// The screen "heart-rate": the heart-rate row of the latest workout.
Ref<UIViewController> makeHeartRate(const Application& application);
/// The screen "map": the map and the weather of the latest workout.
Ref<UIViewController> makeMap(const Application& application);

}  // namespace tavro
