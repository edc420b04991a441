#include "host/screens/workouts/WorkoutsListCells.h"

#include <algorithm>
#include <cmath>

#include "host/libraries/CHWorkoutFormattingManager.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using Row = CHWorkoutsListTableViewCell;
const Registered rowClass =
    defineClass<Row, UITableViewCell>()
        .method<&Row::init>("init")
        .method<&Row::workout>("workout")
        .method<&Row::setWorkout>("setWorkout:")
        .method<&Row::configureWithCurrentWorkout>("configureWithCurrentWorkout")
        .method<&Row::dateLabel>("dateLabel")
        .method<&Row::layoutSubviews>("layoutSubviews")
        .variable<&Row::_dateLabel>("_dateLabel");

using Figure = CHWorkoutSummaryTabbedLabelContainer;
const Registered figureClass = defineClass<Figure, UIView>()
                                   .method<&Figure::layoutSubviews>("layoutSubviews")
                                   .variable<&Figure::_titleText>("_titleText")
                                   .variable<&Figure::_totalText>("_totalText")
                                   .variable<&Figure::_averageText>("_averageText");

using Summary = CHListSummaryTableViewCell;
const Registered summaryClass =
    defineClass<Summary, UITableViewCell>()
        .method<&Summary::init>("init")
        .method<&Summary::layoutSubviews>("layoutSubviews")
        .variable<&Summary::_numberOfWorkoutsLabel>("_numberOfWorkoutsLabel")
        .variable<&Summary::_durationLabel>("_durationLabel")
        .variable<&Summary::_activeEnergyLabel>("_activeEnergyLabel")
        .variable<&Summary::_distanceLabel>("_distanceLabel")
        .variable<&Summary::_paceLabel>("_paceLabel");

using Header = CHListTableHeaderView;
const Registered headerClass = defineClass<Header, UIView>()
                                   .method<&Header::layoutSubviews>("layoutSubviews")
                                   .variable<&Header::_dateLabel>("_dateLabel")
                                   .variable<&Header::_detailLabel>("_detailLabel");

constexpr double kMargin = 16;
constexpr double kIconSize = 36;
constexpr double kLineHeight = 24;
constexpr double kDateWidth = 100;

/// What a list of workouts comes to. Pace counts those on foot only.
struct Totals {
  double duration = 0;
  double energy = 0;
  double distance = 0;
  double distanceCount = 0;
  double secondsOnFoot = 0;
  double metersOnFoot = 0;
};

Totals totalsOf(const std::vector<Ref<HKWorkout>>& workouts) {
  Totals totals;
  for (const Ref<HKWorkout>& workout : workouts) {
    const auto type = workout->workoutActivityType();
    const bool isOnFoot = type == HKWorkoutActivityType::running ||
                          type == HKWorkoutActivityType::walking ||
                          type == HKWorkoutActivityType::hiking;
    const auto distance = workout->totalDistance();
    const double meters = distance ? distance->doubleValueForUnit(HKUnit::meterUnit()) : 0;
    totals.duration += workout->duration();
    totals.energy += workout->totalEnergyBurned()->doubleValueForUnit(HKUnit::kilocalorieUnit());
    totals.distance += meters;
    totals.distanceCount += distance ? 1 : 0;
    if (isOnFoot && meters > 0) {
      totals.secondsOnFoot += workout->duration();
      totals.metersOnFoot += meters;
    }
  }
  return totals;
}

std::string hoursAndMinutes(double seconds) {
  constexpr double secondsPerMinute = 60;
  constexpr std::int64_t minutesPerHour = 60;
  const auto minutes = saturatingCast<std::int64_t>(std::round(seconds / secondsPerMinute));
  const std::string rest = std::to_string(minutes % minutesPerHour) + " min";
  return minutes < minutesPerHour ? rest : std::to_string(minutes / minutesPerHour) + " hr " + rest;
}

std::string minutesAndSeconds(double seconds) {
  constexpr std::int64_t secondsPerMinute = 60;
  const auto whole = saturatingCast<std::int64_t>(std::round(seconds));
  return std::to_string(whole / secondsPerMinute) + " min " +
         std::to_string(whole % secondsPerMinute) + " sec";
}

std::string amount(double value, int decimals, const DisplayUnit& unit) {
  return utf8(decimalString(value, decimals)) + " " + std::string(unit.symbol);
}

}  // namespace

id CHWorkoutsListTableViewCell::init() {
  setImageView(makeView<UIImageView>());
  setTextLabel(makeLabel(""));
  _dateLabel = makeLabel("");
  figureLabel_ = makeLabel("");
  addSubview(_dateLabel);
  addSubview(figureLabel_);
  return this;
}

void CHWorkoutsListTableViewCell::configureWithCurrentWorkout() {
  const Ref<HKWorkout>& shown = workout_;
  if (!shown) {
    imageView()->setImage(nullptr);
    for (UILabel* const label : {textLabel().get(), _dateLabel.get(), figureLabel_.get()}) {
      label->setText(nullptr);
    }
    return;
  }
  const auto revision = shown->sourceRevision();
  const auto icon = make<UIImage>();
  icon->name = revision && revision->source()->isOrlamWatch() ? "watch" : "application";
  imageView()->setImage(icon);
  textLabel()->setText(string(activityName(shown->workoutActivityType())));
  _dateLabel->setText(dateStringForFormat(shown->startDate(), "Mdyy"));
  const auto manager = make<CHWorkoutFormattingManager>();
  figureLabel_->setAttributedText(
      send<id>(manager,
               shown->totalDistance() ? Name("formattedDistanceForWorkout:workoutActivity:context:")
                                      : Name("formattedEnergyForWorkout:workoutActivity:context:"),
               shown, nullptr, nullptr));
}

void CHWorkoutsListTableViewCell::layoutSubviews() {
  const double width = frame().size.width;
  const double left = 2 * kMargin + kIconSize;
  const double right = width - kMargin - kDateWidth;
  imageView()->setFrame({kMargin, (height - kIconSize) / 2, kIconSize, kIconSize});
  textLabel()->setFrame({left, height / 2 - kLineHeight, right - left, kLineHeight});
  _dateLabel->setFrame({right, height / 2 - kLineHeight, kDateWidth, kLineHeight});
  figureLabel_->setFrame({left, height / 2, right - left, kLineHeight});
}

void CHWorkoutSummaryTabbedLabelContainer::setTexts(std::string_view title, std::string_view total,
                                                    std::string_view average) {
  _titleText = string(title);
  _totalText = string(total);
  _averageText = string(average);
  while (labels_.size() < 3) {
    labels_.push_back(makeLabel(""));
    addSubview(labels_.back());
  }
  labels_[0]->setText(_titleText);
  labels_[1]->setText(_totalText);
  labels_[2]->setText(_averageText);
}

void CHWorkoutSummaryTabbedLabelContainer::layoutSubviews() {
  const double width = frame().size.width / 3;
  double x = 0;
  for (const Ref<UILabel>& label : labels_) {
    label->setFrame({x, 0, width, frame().size.height});
    x += width;
  }
}

id CHListSummaryTableViewCell::init() {
  for (Ref<Figure>* const figure : {&_numberOfWorkoutsLabel, &_durationLabel, &_activeEnergyLabel,
                                    &_distanceLabel, &_paceLabel}) {
    *figure = makeView<Figure>();
    addSubview(*figure);
  }
  return this;
}

void CHListSummaryTableViewCell::setWorkouts(const std::vector<Ref<HKWorkout>>& workouts) {
  constexpr double metersPerKilometer = 1000;
  const Totals totals = totalsOf(workouts);
  const double count = std::max<double>(static_cast<double>(workouts.size()), 1);
  const double kilometers = totals.distance / metersPerKilometer;
  _numberOfWorkoutsLabel->setTexts(
      "Workouts", utf8(decimalString(static_cast<double>(workouts.size()), 0)), "");
  _durationLabel->setTexts("Duration", hoursAndMinutes(totals.duration),
                           hoursAndMinutes(totals.duration / count));
  _activeEnergyLabel->setTexts("Active Energy", amount(totals.energy, 0, kKilocalories),
                               amount(totals.energy / count, 0, kKilocalories));
  _distanceLabel->setHidden(totals.distanceCount == 0);
  _distanceLabel->setTexts(
      "Distance", amount(kilometers, 1, kKilometers),
      amount(kilometers / std::max<double>(totals.distanceCount, 1), 1, kKilometers));
  _paceLabel->setHidden(totals.metersOnFoot == 0);
  const double pace = totals.metersOnFoot == 0
                          ? 0
                          : totals.secondsOnFoot / totals.metersOnFoot * metersPerKilometer;
  _paceLabel->setTexts("Pace", "", minutesAndSeconds(pace) + " per km");
}

void CHListSummaryTableViewCell::layoutSubviews() {
  const double line = height / 5;
  double y = 0;
  for (const Ref<Figure>& figure :
       {_numberOfWorkoutsLabel, _durationLabel, _activeEnergyLabel, _distanceLabel, _paceLabel}) {
    figure->setFrame({kMargin, y, frame().size.width - 2 * kMargin, line});
    y += line;
  }
}

void CHListTableHeaderView::setTexts(const Ref<NSString>& date, std::size_t workouts) {
  if (!_dateLabel) {
    _dateLabel = makeLabel("");
    _detailLabel = makeView<UITableViewHeaderFooterViewLabel>();
    addSubview(_dateLabel);
    addSubview(_detailLabel);
  }
  _dateLabel->setText(date);
  _detailLabel->setText(
      string(std::to_string(workouts) + (workouts == 1 ? " workout" : " workouts")));
}

void CHListTableHeaderView::layoutSubviews() {
  if (_dateLabel) {
    const double half = frame().size.width / 2 - kMargin;
    _dateLabel->setFrame({kMargin, 0, half, frame().size.height});
    _detailLabel->setFrame({kMargin + half, 0, half, frame().size.height});
  }
}

}  // namespace tavro
