#include "host/screens/workouts/WorkoutRowScreens.h"

#include "host/screens/workouts/HeartRateChart.h"
#include "host/screens/workouts/MapAndWeather.h"

namespace tavro {
namespace {

constexpr CGRect kTable{0, 0, 390, 800};
constexpr double kTextHeight = 44;

/// A screen with one row of the latest workout, or a text in its place.
Ref<UIViewController> screenOfRow(const Application& application, std::string_view title,
                                  Ref<UIView> (*makeRow)(const Workout&), double height,
                                  std::string_view absence) {
  const Workout* const workout = application.diary().latestWorkout();
  const Ref<UIView> row = workout == nullptr ? nullptr : makeRow(*workout);
  const auto table = makeView<UITableView>(kTable);
  if (row) {
    table->appendRow(row, height);
  } else {
    table->appendRow(makeLabel(absence), kTextHeight);
  }
  auto controller = makeController<UIViewController>();
  controller->navigationItem()->title = string(title);
  controller->setView(table);
  return controller;
}

}  // namespace

Ref<UIViewController> makeHeartRate(const Application& application) {
  return screenOfRow(application, "Workout Heart Rate", &heartRateRow,
                     CHWorkoutDetailHeartRateChartTableViewCell::height,
                     "There are no workouts yet.");
}

Ref<UIViewController> makeMap(const Application& application) {
  return screenOfRow(application, "Workout Map", &mapAndWeatherRow,
                     CHWorkoutDetailMapAndWeatherTableViewCell::height, "No route was recorded.");
}

}  // namespace tavro
