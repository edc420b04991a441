#include "host/screens/calendar/PaletteViewController.h"

#include "host/Dates.h"
#include "platform/foundation/Formatters.h"
#include "platform/foundation/NSValue.h"
#include "platform/healthkit/HKActivitySummary.h"

namespace tavro {
namespace {

using Header = PaletteWeekdayHeaderView;
const Registered headerClass =
    defineClass<Header, UIView>()
        .method<&Header::initWithNavigationPalette>("initWithNavigationPalette:")
        .method<&Header::highlightWeekdayLabelForDateAndSetDay>(
            "highlightWeekdayLabelForDateAndSetDay:")
        .method<&Header::layoutSubviews>("layoutSubviews")
        .variable<&Header::_weekdayLabels>("_weekdayLabels");

const Registered tappableClass =
    defineClass<ActivityTappableDay, UIControl>()
        .method<&ActivityTappableDay::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&ActivityTappableDay::naturalLabel>("_naturalAccessibilityLabel")
        .method<&ActivityTappableDay::naturalTraits>("_naturalAccessibilityTraits");

using Day = WeekPaletteTappableDay;
const Registered dayClass = defineClass<Day, ActivityTappableDay>()
                                .method<&Day::init>("init")
                                .method<&Day::layoutSubviews>("layoutSubviews")
                                .method<&Day::accessibilityPath>("accessibilityPath")
                                .variable<&Day::_circle>("_circle");

const Registered layerClass = defineClass<TavDayCellLayer, CALayer>();
const Registered weekClass = defineClass<WeekView, UIView>()
                                 .method<&WeekView::init>("init")
                                 .method<&WeekView::layoutSubviews>("layoutSubviews");
const Registered controllerClass =
    defineClass<PaletteViewController, UIViewController>()
        .method<&PaletteViewController::viewDidLoad>("viewDidLoad")
        .variable<&PaletteViewController::_paletteView>("_paletteView");

constexpr double kScreenWidth = 390;
constexpr double kDayHeight = 64;
constexpr double kLabelHeight = 24;
constexpr double kCircleSize = 36;
constexpr double kDimmed = 0.5;

CGRect columnFrame(std::size_t column, double width, double y, double height) {
  const double columnWidth = width / kDaysOfWeek;
  return {columnWidth * static_cast<double>(column), y, columnWidth, height};
}

/// The column of the date's weekday, in a week that begins on the first day of weekly goals.
std::int64_t columnOf(const Ref<NSDate>& date) {
  constexpr std::int64_t columns = kDaysOfWeek;
  const std::int64_t weekday = currentCalendar()->componentsFromDate(date)->weekday;
  return ((weekday - HKFirstDayOfWeekForWeeklyGoalCalculations()) % columns + columns) % columns;
}

/// The first day of the date's week.
Ref<NSDate> startOfWeek(const Ref<NSDate>& date) {
  return currentCalendar()->dateByAddingDays(date, -columnOf(date));
}

}  // namespace

id PaletteWeekdayHeaderView::initWithNavigationPalette(const Ref<UIView>& palette) {
  setFrame({0, 0, palette ? palette->frame().size.width : 0, height});
  _weekdayLabels = mutableArray(kDaysOfWeek);
  const Ref<NSDate> first = startOfWeek(dateNow());
  for (std::size_t column = 0; column < kDaysOfWeek; ++column) {
    const Ref<NSDate> date =
        currentCalendar()->dateByAddingDays(first, static_cast<std::int64_t>(column));
    const auto label = makeView<UILabel>();
    label->setText(dateStringForFormat(date, "EEEEE"));
    _weekdayLabels->addObject(label);
    addSubview(label);
  }
  return this;
}

void PaletteWeekdayHeaderView::highlightWeekdayLabelForDateAndSetDay(const Ref<NSDate>& date) {
  day_ = date;
  if (!date) {
    return;
  }
  const auto chosen = static_cast<std::size_t>(columnOf(date));
  for (std::size_t column = 0; column < _weekdayLabels->count(); ++column) {
    as<UILabel>((*_weekdayLabels)[column])->setAlpha(column == chosen ? 1 : kDimmed);
  }
}

void PaletteWeekdayHeaderView::layoutSubviews() {
  const CGSize size = frame().size;
  for (std::size_t column = 0; column < _weekdayLabels->count(); ++column) {
    as<UILabel>((*_weekdayLabels)[column])
        ->setFrame(columnFrame(column, size.width, (size.height - kLabelHeight) / 2, kLabelHeight));
  }
}

id ActivityTappableDay::naturalLabel() { return dateStringForFormat(date_, "d"); }

id WeekPaletteTappableDay::init() {
  _circle = makeView<UIView>();
  addSubview(_circle);
  return this;
}

void WeekPaletteTappableDay::setChosen(bool isChosen) { _circle->setAlpha(isChosen ? 1 : 0); }

void WeekPaletteTappableDay::layoutSubviews() {
  const CGSize size = frame().size;
  _circle->setFrame(
      {(size.width - kCircleSize) / 2, (size.height - kCircleSize) / 2, kCircleSize, kCircleSize});
}

id WeekPaletteTappableDay::accessibilityPath() {
  return value(UIAccessibilityConvertFrameToScreenCoordinates(_circle->frame(), Ref<UIView>(this)));
}

id WeekView::init() {
  for (Ref<TavDayCellLayer>& day : days_) {
    day = tavro::make<TavDayCellLayer>();
    layer()->addSublayer(day);
  }
  return this;
}

void WeekView::layoutSubviews() {
  for (std::size_t column = 0; column < kDaysOfWeek; ++column) {
    days_[column]->setFrame(columnFrame(column, frame().size.width, 0, frame().size.height));
  }
}

void PaletteViewController::viewDidLoad() {
  const auto palette = makeView<UIView>({0, 0, kScreenWidth, Header::height + kDayHeight});
  setView(palette);
  _paletteView = as<Header>(send<id>(tavro::make<Header>(), "initWithNavigationPalette:", palette));
  palette->addSubview(_paletteView);
  palette->addSubview(makeView<WeekView>({0, Header::height, kScreenWidth, kDayHeight}));
  for (std::size_t column = 0; column < kDaysOfWeek; ++column) {
    days_[column] = makeView<WeekPaletteTappableDay>(
        columnFrame(column, kScreenWidth, Header::height, kDayHeight));
    days_[column]->setAction([weak = Weak<PaletteViewController>(this), column] {
      if (const auto controller = weak.strong()) {
        controller->showDate(controller->day(column).date());
      }
    });
    palette->addSubview(days_[column]);
  }
  showDate(dateNow());
}

void PaletteViewController::showDate(const Ref<NSDate>& date) {
  // At noon, whole days away are on their days whatever the clocks do.
  const Ref<NSDate> noon = noonOf(dayOf(date));
  const Ref<NSDate> first = startOfWeek(noon);
  const auto chosen = static_cast<std::size_t>(columnOf(noon));
  for (std::size_t column = 0; column < kDaysOfWeek; ++column) {
    days_[column]->setDate(
        currentCalendar()->dateByAddingDays(first, static_cast<std::int64_t>(column)));
    days_[column]->setChosen(column == chosen);
  }
  send<void>(_paletteView, "highlightWeekdayLabelForDateAndSetDay:", noon);
  navigationItem()->title = dateStringForFormat(noon, "EEEEdMMMM");
}

}  // namespace tavro
