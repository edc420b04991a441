#include "host/screens/workouts/WorkoutDetailCells.h"

#include "host/libraries/CHWorkoutFormattingManager.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using PaceCell = CHWorkoutDetailPaceTableViewCell;
const Registered paceClass = defineClass<PaceCell, UITableViewCell>()
                                 .method<&PaceCell::init>("init")
                                 .method<&PaceCell::configureWithWorkout>(
                                     "configureWithWorkout:workoutActivity:dataCalculator:")
                                 .method<&PaceCell::layoutSubviews>("layoutSubviews")
                                 .variable<&PaceCell::_titleLabel>("_titleLabel")
                                 .variable<&PaceCell::_valueLabel>("_valueLabel");

using SplitCell = CHWorkoutDetailSplitTableViewCell;
const Registered splitClass = defineClass<SplitCell, UITableViewCell>()
                                  .method<&SplitCell::init>("init")
                                  .method<&SplitCell::layoutSubviews>("layoutSubviews")
                                  .variable<&SplitCell::_unitLabel>("_unitLabel")
                                  .variable<&SplitCell::_distanceLabel>("_distanceLabel")
                                  .variable<&SplitCell::_paceLabel>("_paceLabel");

using TwoValueCell = CHWorkoutDetailTwoValueTableViewCell;
const Registered twoValueClass =
    defineClass<TwoValueCell, UITableViewCell>()
        .method<&TwoValueCell::init>("init")
        .method<&TwoValueCell::configureWithTitle1>("configureWithTitle1:value1:")
        .method<&TwoValueCell::configureWithTitle2>("configureWithTitle2:value2:")
        .method<&TwoValueCell::layoutSubviews>("layoutSubviews")
        .variable<&TwoValueCell::_titleLabel1>("_titleLabel1")
        .variable<&TwoValueCell::_valueLabel1>("_valueLabel1")
        .variable<&TwoValueCell::_titleLabel2>("_titleLabel2")
        .variable<&TwoValueCell::_valueLabel2>("_valueLabel2");

using Header = CHWorkoutDetailExpandingHeaderView;
const Registered headerClass = defineClass<Header, UIView>()
                                   .method<&Header::init>("init")
                                   .method<&Header::layoutSubviews>("layoutSubviews")
                                   .variable<&Header::_titleLabel>("_titleLabel")
                                   .variable<&Header::_expandButton>("_expandButton")
                                   .variable<&Header::_expanded>("_expanded");

constexpr double kMargin = 16;
constexpr double kMetersPerKilometer = 1000;

/// How the pace of an activity is told.
struct PaceUnit {
  double meters;
  std::string_view text;
};
constexpr PaceUnit kPerKilometer{kMetersPerKilometer, " per km"};
constexpr PaceUnit kPerLaps{100, " per 100 m"};

std::string speedText(double secondsPerMeter) {
  constexpr double kilometersPerHour = 3.6;
  return utf8(decimalString(kilometersPerHour / secondsPerMeter, 1)) + " km/h";
}

std::string figureText(HKWorkoutActivityType type, double secondsPerMeter) {
  if (secondsPerMeter <= 0) {
    return "--";
  }
  if (type == HKWorkoutActivityType::cycling) {
    return speedText(secondsPerMeter);
  }
  const PaceUnit& unit = type == HKWorkoutActivityType::swimming ? kPerLaps : kPerKilometer;
  return paceText(secondsPerMeter * unit.meters) + std::string(unit.text);
}

/// Puts a table's rows below each other, hidden ones taking no space.
void restackRows(const UIView& table) {
  double y = 0;
  for (const Ref<UIView>& row : table.subviewList()) {
    row->setFrame({0, y, row->frame().size.width, row->frame().size.height});
    y += row->isHidden() ? 0 : row->frame().size.height;
  }
}

}  // namespace

id CHWorkoutDetailPaceTableViewCell::init() {
  _titleLabel = makeLabel("");
  _valueLabel = makeLabel("");
  addSubview(_titleLabel);
  addSubview(_valueLabel);
  return this;
}

void CHWorkoutDetailPaceTableViewCell::configureWithWorkout(const Ref<HKWorkout>& workout,
                                                            const id& /*activity*/,
                                                            const id& dataCalculator) {
  const auto type = workout ? workout->workoutActivityType() : HKWorkoutActivityType::walking;
  _titleLabel->setText(
      string(type == HKWorkoutActivityType::cycling ? "Average Speed" : "Average Pace"));
  const auto pace = send<double>(dataCalculator, "averagePaceForWorkout:", workout);
  _valueLabel->setText(string(figureText(type, pace)));
}

void CHWorkoutDetailPaceTableViewCell::layoutSubviews() {
  const double half = frame().size.width / 2 - kMargin;
  _titleLabel->setFrame({kMargin, 0, half, frame().size.height});
  _valueLabel->setFrame({kMargin + half, 0, half, frame().size.height});
}

id CHWorkoutDetailSplitTableViewCell::init() {
  for (Ref<UILabel>* const label : {&_unitLabel, &_distanceLabel, &_paceLabel}) {
    *label = makeLabel("");
    addSubview(*label);
  }
  return this;
}

void CHWorkoutDetailSplitTableViewCell::setSplit(std::size_t number, double distance,
                                                 double duration) {
  const double kilometers = distance / kMetersPerKilometer;
  _unitLabel->setText(string("KM " + std::to_string(number)));
  _distanceLabel->setText(string(utf8(decimalString(kilometers, 2)) + " KM"));
  _distanceLabel->setHidden(distance == kMetersPerKilometer);
  _paceLabel->setText(string(kilometers > 0 ? paceText(duration / kilometers) : "--"));
}

void CHWorkoutDetailSplitTableViewCell::layoutSubviews() {
  const double width = (frame().size.width - 2 * kMargin) / 3;
  double x = kMargin;
  for (const Ref<UILabel>& label : {_unitLabel, _distanceLabel, _paceLabel}) {
    label->setFrame({x, 0, width, frame().size.height});
    x += width;
  }
}

id CHWorkoutDetailTwoValueTableViewCell::init() {
  for (Ref<UILabel>* const label : {&_titleLabel1, &_valueLabel1, &_titleLabel2, &_valueLabel2}) {
    *label = makeLabel("");
    addSubview(*label);
  }
  return this;
}

void CHWorkoutDetailTwoValueTableViewCell::configureWithTitle1(const Ref<NSString>& title,
                                                               const id& value) {
  _titleLabel1->setText(title);
  _valueLabel1->setAttributedText(value);
}

void CHWorkoutDetailTwoValueTableViewCell::configureWithTitle2(const Ref<NSString>& title,
                                                               const id& value) {
  _titleLabel2->setText(title);
  _valueLabel2->setAttributedText(value);
}

void CHWorkoutDetailTwoValueTableViewCell::layoutSubviews() {
  const double width = frame().size.width / 2 - kMargin;
  const double line = frame().size.height / 2;
  _titleLabel1->setFrame({kMargin, 0, width, line});
  _valueLabel1->setFrame({kMargin, line, width, line});
  _titleLabel2->setFrame({kMargin + width, 0, width, line});
  _valueLabel2->setFrame({kMargin + width, line, width, line});
}

id CHWorkoutDetailExpandingHeaderView::init() {
  _titleLabel = makeLabel("");
  _expandButton = makeView<UIButton>();
  _expandButton->setTitle(string("Hide"));
  _expandButton->setAction([header = Weak<Header>(this)] {
    if (const Ref<Header> shown = header.strong()) {
      shown->setExpanded(!shown->_expanded);
    }
  });
  addSubview(_titleLabel);
  addSubview(_expandButton);
  return this;
}

void CHWorkoutDetailExpandingHeaderView::setExpanded(bool expanded) {
  _expanded = expanded;
  _expandButton->setTitle(string(expanded ? "Hide" : "Show"));
  for (const Ref<UIView>& row : rows_) {
    row->setHidden(!expanded);
  }
  if (const Ref<UIView> table = superview()) {
    restackRows(*table);
  }
}

void CHWorkoutDetailExpandingHeaderView::layoutSubviews() {
  constexpr double buttonWidth = 60;
  const double left = frame().size.width - kMargin - buttonWidth;
  _titleLabel->setFrame({kMargin, 0, left - kMargin, frame().size.height});
  _expandButton->setFrame({left, 0, buttonWidth, frame().size.height});
}

}  // namespace tavro
