#include "host/screens/workouts/WorkoutDetailController.h"

#include <algorithm>

#include "host/screens/workouts/HeartRateChart.h"
#include "host/screens/workouts/MapAndWeather.h"
#include "host/screens/workouts/WorkoutDetailCells.h"
#include "host/screens/workouts/WorkoutRecords.h"

namespace tavro {
namespace {

const Registered controllerClass =
    defineClass<WorkoutDetailController, UIViewController>()
        .method<&WorkoutDetailController::viewDidLoad>("viewDidLoad");

struct Figure {
  std::string_view title;
  id value;
};

void appendFigures(UITableView& table, const Figure& first, const Figure& second) {
  const auto row = makeView<CHWorkoutDetailTwoValueTableViewCell>();
  send<void>(row, "configureWithTitle1:value1:", string(first.title), first.value);
  send<void>(row, "configureWithTitle2:value2:", string(second.title), second.value);
  table.appendRow(row, CHWorkoutDetailTwoValueTableViewCell::height);
}

/// The average and the highest heart rate; nothing without readings.
struct HeartRates {
  std::optional<double> average;
  std::optional<double> highest;
};

HeartRates heartRatesOf(const Workout& workout) {
  if (workout.heartRate.empty()) {
    return {};
  }
  double sum = 0;
  double highest = 0;
  for (const HeartRateReading& reading : workout.heartRate) {
    sum += reading.beatsPerMinute;
    highest = std::max(highest, reading.beatsPerMinute);
  }
  return {sum / static_cast<double>(workout.heartRate.size()), highest};
}

void appendTotals(UITableView& table, const WorkoutDetail& detail) {
  const auto formatted = [&](Name selector) {
    return send<id>(detail.formatting, selector, detail.record, nullptr, nullptr);
  };
  appendFigures(table,
                {"Total Time", formatted("formattedDurationForWorkout:workoutActivity:context:")},
                {"Distance", formatted("formattedDistanceForWorkout:workoutActivity:context:")});
  appendFigures(table,
                {"Active Energy", formatted("formattedEnergyForWorkout:workoutActivity:context:")},
                {"Elevation Gain", valueWithUnit(detail.entry.elevation, kMeters)});
  const HeartRates rates = heartRatesOf(detail.entry);
  appendFigures(table, {"Average Heart Rate", valueWithUnit(rates.average, kBeatsPerMinute)},
                {"Highest Heart Rate", valueWithUnit(rates.highest, kBeatsPerMinute)});
}

void appendPace(UITableView& table, const WorkoutDetail& detail) {
  if (!detail.entry.distance) {
    return;
  }
  const auto row = makeView<CHWorkoutDetailPaceTableViewCell>();
  send<void>(row, "configureWithWorkout:workoutActivity:dataCalculator:", detail.record, nullptr,
             make<CHWorkoutDataCalculator>());
  table.appendRow(row, CHWorkoutDetailPaceTableViewCell::height);
}

void appendSplits(UITableView& table, const WorkoutDetail& detail) {
  if (detail.entry.splits.empty()) {
    return;
  }
  const auto header = makeView<CHWorkoutDetailExpandingHeaderView>();
  header->setTitle("Splits");
  table.appendRow(header, CHWorkoutDetailExpandingHeaderView::height);
  std::size_t number = 0;
  for (const Split& split : detail.entry.splits) {
    const auto row = makeView<CHWorkoutDetailSplitTableViewCell>();
    row->setSplit(++number, split.distance, split.duration);
    table.appendRow(row, CHWorkoutDetailSplitTableViewCell::height);
    header->addRow(row);
  }
}

void appendHeartRate(UITableView& table, const WorkoutDetail& detail) {
  table.appendRow(heartRateRow(detail.entry), CHWorkoutDetailHeartRateChartTableViewCell::height);
}

void appendMapAndWeather(UITableView& table, const WorkoutDetail& detail) {
  if (const Ref<UIView> row = mapAndWeatherRow(detail.entry)) {
    table.appendRow(row, CHWorkoutDetailMapAndWeatherTableViewCell::height);
  }
}

/// From top to bottom.
constexpr WorkoutDetailSection kSections[] = {
    &appendTotals, &appendPace, &appendSplits, &appendHeartRate, &appendMapAndWeather,
};

}  // namespace

void WorkoutDetailController::viewDidLoad() {
  constexpr CGRect content{0, 0, 390, 800};
  const auto table = makeView<UITableView>(content);
  setView(table);
  if (workout_ == nullptr) {
    table->appendRow(makeLabel("No workouts were recorded."),
                     CHWorkoutDetailPaceTableViewCell::height);
    return;
  }
  navigationItem()->title = string(activityName(workout_->type));
  const WorkoutDetail detail{*workout_, workoutRecord(*workout_),
                             make<CHWorkoutFormattingManager>()};
  for (const WorkoutDetailSection append : kSections) {
    append(*table, detail);
  }
}

}  // namespace tavro
