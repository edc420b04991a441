#include "host/screens/workouts/WorkoutsListController.h"

#include <algorithm>

#include "host/screens/workouts/WorkoutRecords.h"
#include "host/screens/workouts/WorkoutsListCells.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

const Registered controllerClass = defineClass<WorkoutsListController, UIViewController>()
                                       .method<&WorkoutsListController::viewDidLoad>("viewDidLoad");

/// Workouts that follow each other in one month.
struct Section {
  Ref<NSString> month;
  std::vector<Ref<HKWorkout>> workouts;
};

std::vector<Section> sectionsOf(const std::vector<Ref<HKWorkout>>& workouts) {
  std::vector<Section> sections;
  for (const Ref<HKWorkout>& workout : workouts) {
    const Ref<NSString> month = dateStringForFormat(workout->startDate(), "MMMMyyyy");
    if (sections.empty() || sections.back().month->text() != month->text()) {
      sections.push_back({month, {}});
    }
    sections.back().workouts.push_back(workout);
  }
  return sections;
}

void appendSection(UITableView& table, const Section& section) {
  const auto header = makeView<CHListTableHeaderView>();
  header->setTexts(section.month, section.workouts.size());
  table.appendRow(header, CHListTableHeaderView::height);
  for (const Ref<HKWorkout>& workout : section.workouts) {
    const auto row = makeView<CHWorkoutsListTableViewCell>();
    row->setWorkout(workout);
    send<void>(row, "configureWithCurrentWorkout");
    table.appendRow(row, CHWorkoutsListTableViewCell::height);
  }
}

}  // namespace

void WorkoutsListController::viewDidLoad() {
  constexpr CGRect content{0, 0, 390, 800};
  const auto table = makeView<UITableView>(content);
  setView(table);
  navigationItem()->title = string("Workouts");
  if (workouts_.empty()) {
    table->appendRow(makeLabel("No workouts were recorded."), CHListTableHeaderView::height);
    return;
  }
  std::vector<Ref<HKWorkout>> records;
  std::ranges::transform(workouts_, std::back_inserter(records),
                         [](const Workout* workout) { return workoutRecord(*workout); });
  const auto summary = makeView<CHListSummaryTableViewCell>();
  summary->setWorkouts(records);
  table->appendRow(summary, CHListSummaryTableViewCell::height);
  for (const Section& section : sectionsOf(records)) {
    appendSection(*table, section);
  }
}

}  // namespace tavro
