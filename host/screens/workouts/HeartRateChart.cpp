#include "host/screens/workouts/HeartRateChart.h"

#include "host/screens/workouts/NoHeartRateData.h"
#include "platform/foundation/NSValue.h"
#include "platform/healthkit/HKWorkout.h"

namespace tavro {
namespace {

using Chart = CHWorkoutDetailHeartRateChartView;
const Registered chartClass =
    defineClass<Chart, UIView>()
        .protocol(kTVUIChartDataSource)
        .method<&Chart::init>("init")
        .method<&Chart::dateInterval>("_dateInterval")
        .method<&Chart::chartDateInterval>("chartDateIntervalForChartView:")
        .method<&Chart::chartPoints>("chartPointsForChartView:")
        .method<&Chart::layoutSubviews>("layoutSubviews")
        .variable<&Chart::_heartRateReadings>("_heartRateReadings")
        .variable<&Chart::_heartRateChartPoints>("_heartRateChartPoints")
        .variable<&Chart::_chartView>("_chartView")
        .variable<&Chart::_hasAdequateDataForDisplay>("_hasAdequateDataForDisplay");

using Cell = CHWorkoutDetailHeartRateChartTableViewCell;
const Registered cellClass =
    defineClass<Cell, UITableViewCell>()
        .method<&Cell::init>("init")
        .method<&Cell::createAndConstraintNoDataOverlay>("_createAndConstraintNoDataOverlay")
        .method<&Cell::layoutSubviews>("layoutSubviews")
        .variable<&Cell::_noDataOverlayView>("_noDataOverlayView");

constexpr std::size_t kLeastReadings = 2;
/// More points than this could not be told apart on the screen.
constexpr std::size_t kMostPoints = 300;
constexpr double kMargin = 16;
constexpr double kTitleHeight = 32;
constexpr double kLineHeight = 24;
constexpr double kButtonHeight = 44;

const Ref<HKUnit>& beatsPerMinuteUnit() {
  static const auto* const unit =
      new Ref<HKUnit>(HKUnit::countUnit()->unitDividedByUnit(HKUnit::minuteUnit()));
  return *unit;
}

double beatsPerMinute(HKQuantity* quantity) {
  return quantity->doubleValueForUnit(beatsPerMinuteUnit());
}

/// The application's own word for a heart rate.
const Registered quantityAdditions =
    extendClass(HKQuantity::className).method<&beatsPerMinute>("ch_beatsPerMinute");

id readingAt(const Ref<NSDate>& start, const HeartRateReading& measured) {
  auto reading = make<HKHeartRateSummaryReading>();
  reading->moment = dateByAddingTimeInterval(start, measured.offset);
  reading->heartRate = HKQuantity::quantityWithUnit(beatsPerMinuteUnit(), measured.beatsPerMinute);
  return reading;
}

}  // namespace

id CHWorkoutDetailHeartRateChartView::init() {
  _heartRateReadings = arrayWithObjects({});
  _heartRateChartPoints = mutableArray();
  _chartView = makeView<TVUIChartView>();
  _chartView->setDataSource(this);
  addSubview(_chartView);
  return this;
}

void CHWorkoutDetailHeartRateChartView::setWorkout(const Workout& workout) {
  const Ref<NSDate> start = dateWithSeconds(secondsFromIso(workout.start.iso).value_or(0));
  interval_ = tavro::dateInterval(start, dateByAddingTimeInterval(start, workout.duration));
  const std::vector<HeartRateReading>& measured = workout.heartRate;
  std::vector<id> readings;
  readings.reserve(measured.size());
  _heartRateChartPoints = mutableArray();
  const std::size_t step = measured.size() / kMostPoints + 1;
  for (std::size_t index = 0; index < measured.size(); ++index) {
    readings.push_back(readingAt(start, measured[index]));
    if (index % step == 0) {
      _heartRateChartPoints->addObject(
          value(CGPoint{measured[index].offset, measured[index].beatsPerMinute}));
    }
  }
  _heartRateReadings = arrayWithObjects(std::move(readings));
  _hasAdequateDataForDisplay = measured.size() >= kLeastReadings;
  _chartView->setHidden(!_hasAdequateDataForDisplay);
  send<void>(_chartView, "reloadData");
}

void CHWorkoutDetailHeartRateChartView::layoutSubviews() {
  _chartView->setFrame({0, 0, frame().size.width, frame().size.height});
}

id CHWorkoutDetailHeartRateChartTableViewCell::init() {
  titleLabel_ = makeLabel("Heart Rate");
  chartView_ = makeView<CHWorkoutDetailHeartRateChartView>();
  addSubview(titleLabel_);
  addSubview(chartView_);
  return this;
}

void CHWorkoutDetailHeartRateChartTableViewCell::setWorkout(const Workout& workout) {
  chartView_->setWorkout(workout);
  const bool isMissing = !chartView_->_hasAdequateDataForDisplay;
  if (isMissing && !_noDataOverlayView) {
    send<void>(this, "_createAndConstraintNoDataOverlay");
  }
  if (_noDataOverlayView) {
    _noDataOverlayView->setHidden(!isMissing);
  }
}

void CHWorkoutDetailHeartRateChartTableViewCell::createAndConstraintNoDataOverlay() {
  const auto explain = makeView<UIButton>();
  explain->setTitle(string("Learn More"));
  explain->setAction([] {
    if (UIWindow* const window = UIWindow::keyWindow()) {
      window->setRootViewController(makeController<CHNoHeartRateDataViewController>());
    }
  });
  _noDataOverlayView = makeView<UIView>();
  _noDataOverlayView->addSubview(makeLabel("No heart rate was recorded"));
  _noDataOverlayView->addSubview(explain);
  addSubview(_noDataOverlayView);
  setNeedsLayout();
}

void CHWorkoutDetailHeartRateChartTableViewCell::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin;
  const CGRect below{kMargin, kTitleHeight, width, frame().size.height - kTitleHeight};
  titleLabel_->setFrame({kMargin, 0, width, kTitleHeight});
  chartView_->setFrame(below);
  if (_noDataOverlayView) {
    _noDataOverlayView->setFrame(below);
    const auto& parts = _noDataOverlayView->subviewList();
    const double middle = below.size.height / 2;
    parts[0]->setFrame({0, middle - kLineHeight, width, kLineHeight});
    parts[1]->setFrame({0, middle, width, kButtonHeight});
  }
}

Ref<UIView> heartRateRow(const Workout& workout) {
  auto row = makeView<CHWorkoutDetailHeartRateChartTableViewCell>();
  row->setWorkout(workout);
  return row;
}

}  // namespace tavro
