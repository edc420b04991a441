#include "host/screens/day/DayViewController.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "host/Dates.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

const Registered ringsCellClass = defineClass<DayViewActivityRingsTableViewCell, UITableViewCell>();
const Registered controllerClass =
    defineClass<DayViewController, UIViewController>().method<&DayViewController::viewDidLoad>(
        "viewDidLoad");

constexpr double kScreenWidth = 390;

std::string amount(std::optional<double> value) {
  return value ? utf8(decimalString(std::round(*value), 0)) : "--";
}

std::string progress(std::optional<double> value, double goal, std::string_view unit) {
  return amount(value) + "/" + amount(goal) + std::string(unit);
}

std::string remaining(std::optional<double> value, double goal, std::string_view unit) {
  if (!value) {
    return "--";
  }
  return *value >= goal ? "GOAL REACHED"
                        : amount(std::ceil(goal - *value)) + std::string(unit) + " TO GO";
}

Ref<UIView> moveRow(const Day& day, const Hours& hours) {
  const auto row = makeView<DayViewMoveAndExerciseChartTableViewCell>();
  row->pair().setTexts("Move", progress(day.move, day.moveGoal, "KCAL"));
  row->chart().setAmounts(MoveAndExerciseChartType::activeEnergy, hours.move);
  const std::string total =
      day.move && day.resting ? amount(*day.move + *day.resting) : amount(std::nullopt);
  row->auxiliary().setText(string("TOTAL " + total + " KCAL"));
  return row;
}

Ref<UIView> exerciseRow(const Day& day, const Hours& hours) {
  const auto row = makeView<DayViewMoveAndExerciseChartTableViewCell>();
  row->pair().setTexts("Exercise", progress(day.exercise, day.exerciseGoal, "MIN"));
  row->chart().setAmounts(MoveAndExerciseChartType::exerciseMinutes, hours.exercise);
  row->auxiliary().setText(string(remaining(day.exercise, day.exerciseGoal, " MIN")));
  return row;
}

/// The hours of the day that have begun by now and do not count.
std::size_t idleHours(const Day& day, const Hours& hours) {
  constexpr std::size_t hoursOfDay = 24;
  const bool isToday = day.date == dayOf(dateNow());
  const std::int64_t present = currentCalendar()->componentsFromDate(dateNow())->hour;
  const std::size_t begun = isToday ? static_cast<std::size_t>(present) + 1 : hoursOfDay;
  return static_cast<std::size_t>(std::count(
      hours.stand.begin(), hours.stand.begin() + static_cast<std::ptrdiff_t>(begun), false));
}

Ref<UIView> standRow(const Day& day, const Hours& hours) {
  const auto row = makeView<DayViewStandChartTableViewCell>();
  row->pair().setTexts("Stand", progress(day.stand, day.standGoal, "HRS"));
  row->chart().setHours(hours.stand);
  const std::size_t idle = idleHours(day, hours);
  row->idleHours().setText(
      string(std::to_string(idle) + (idle == 1 ? " IDLE HOUR" : " IDLE HOURS")));
  return row;
}

}  // namespace

Ref<HKActivitySummary> summaryOf(const Rings& rings) {
  auto summary = make<HKActivitySummary>();
  summary->activeEnergy = {rings.move, rings.moveGoal};
  summary->exerciseTime = {rings.exercise, rings.exerciseGoal};
  summary->standHours = {rings.stand, rings.standGoal};
  return summary;
}

void DayViewActivityRingsTableViewCell::setDay(const Day& day) {
  const auto rings = makeView<ARUIRingsView>({20, 20, 180, 180});
  rings->setSummary(summaryOf(day));
  addSubview(rings);
  const std::array texts{"MOVE " + progress(day.move, day.moveGoal, "KCAL"),
                         "EXERCISE " + progress(day.exercise, day.exerciseGoal, "MIN"),
                         "STAND " + progress(day.stand, day.standGoal, "HRS")};
  double y = 60;
  for (const std::string& text : texts) {
    addSubview(makeLabel(text, {220, y, 160, 24}));
    y += 40;
  }
}

void DayViewController::viewDidLoad() {
  const auto table = makeView<UITableView>({0, 0, kScreenWidth, 800});
  setView(table);
  if (day_ == nullptr) {
    table->appendRow(makeLabel("Nothing was recorded on this day."), 44);
    return;
  }
  navigationItem()->title = dateStringForFormat(noonOf(day_->date), "EEEEdMMMM");
  const auto rings = makeView<DayViewActivityRingsTableViewCell>();
  rings->setDay(*day_);
  table->appendRow(rings, DayViewActivityRingsTableViewCell::height);
  const Hours hours = day_->hours.value_or(Hours());
  table->appendRow(moveRow(*day_, hours), DayViewMoveAndExerciseChartTableViewCell::height);
  table->appendRow(exerciseRow(*day_, hours), DayViewMoveAndExerciseChartTableViewCell::height);
  table->appendRow(standRow(*day_, hours), DayViewStandChartTableViewCell::height);
}

}  // namespace tavro
