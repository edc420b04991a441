#include "host/screens/calendar/MonthScrollViewController.h"

#include <algorithm>

#include "host/Dates.h"
#include "platform/foundation/Formatters.h"
#include "platform/healthkit/HKActivitySummary.h"

namespace tavro {
namespace {

const Registered dayClass = defineClass<MonthDayCellLayer, HKCalendarDayCell>()
                                .method<&MonthDayCellLayer::isFutureDay>("isFutureDay")
                                .variable<&MonthDayCellLayer::_hasWorkout>("_hasWorkout");
const Registered weekClass = defineClass<MonthWeekView, HKCalendarWeekView>();
const Registered titleClass = defineClass<TavroMonthTitleLabel, UILabel>();
const Registered monthClass =
    defineClass<MonthView, UIView>().method<&MonthView::layoutSubviews>("layoutSubviews");
const Registered monthsClass =
    defineClass<MonthScrollView, UIScrollView>().method<&MonthScrollView::layoutSubviews>(
        "layoutSubviews");
const Registered controllerClass =
    defineClass<MonthScrollViewController, UIViewController>()
        .method<&MonthScrollViewController::loadView>("loadView")
        .method<&MonthScrollViewController::viewDidLoad>("viewDidLoad")
        .variable<&MonthScrollViewController::_scrollView>("_scrollView");

std::size_t columnOfWeekday(std::int64_t weekday) {
  constexpr std::int64_t columns = HKCalendarWeekView::kColumns;
  const std::int64_t fromFirst = weekday - HKFirstDayOfWeekForWeeklyGoalCalculations();
  return static_cast<std::size_t>((fromFirst % columns + columns) % columns);
}

Ref<MonthDayCellLayer> cellFor(CalendarDay day, const Ref<NSDate>& noon, const CalendarSpan& span) {
  auto cell = make<MonthDayCellLayer>();
  cell->setDate(noon, day == span.today);
  cell->setFutureDay(day > span.today);
  cell->_hasWorkout = std::ranges::binary_search(span.workoutDays, day);
  return cell;
}

}  // namespace

CalendarSpan calendarSpanOf(const Diary& diary) {
  const CalendarDay today = dayOf(dateNow());
  CalendarSpan span{diary.days.empty() ? today : diary.days.front().date, today, today, {}};
  for (const Workout& workout : diary.workouts) {
    if (const auto start = secondsFromIso(workout.start.iso)) {
      span.workoutDays.push_back(dayOf(dateWithSeconds(*start)));
    }
  }
  std::ranges::sort(span.workoutDays);
  return span;
}

void MonthView::appendDay(const Ref<MonthDayCellLayer>& day, std::size_t column) {
  if (weeks_.empty() || column == 0) {
    weeks_.push_back(makeView<MonthWeekView>());
    addSubview(weeks_.back());
    if (weeks_.size() == 1) {
      const auto title = makeView<TavroMonthTitleLabel>();
      title->setText(title_);
      weeks_.back()->setMonthTitleView(title);
    }
  }
  weeks_.back()->addDayCell(day, column);
}

double MonthView::height() const {
  double height = 0;
  for (const Ref<MonthWeekView>& week : weeks_) {
    height += week->height();
  }
  return height;
}

void MonthView::layoutSubviews() {
  double y = 0;
  for (const Ref<MonthWeekView>& week : weeks_) {
    week->setFrame({0, y, frame().size.width, week->height()});
    y += week->height();
  }
}

void MonthScrollView::setSpan(const CalendarSpan& span) {
  const auto monthNumber = make<NSDateFormatter>();
  monthNumber->setDateFormat("MM");
  const Ref<NSCalendar> calendar = currentCalendar();
  const Ref<NSDate> noon = noonOf(span.first);
  const std::int64_t daysBefore = calendar->componentsFromDate(noon)->day - 1;
  for (std::int64_t number = span.first.number - daysBefore;; ++number) {
    const CalendarDay day{number};
    const Ref<NSDate> date = calendar->dateByAddingDays(noon, number - span.first.number);
    const auto components = calendar->componentsFromDate(date);
    if (months_.empty() || components->day == 1) {
      if (day > span.last) {
        break;
      }
      months_.push_back(makeView<MonthView>());
      months_.back()->setTitle(monthNumber->stringFromDate(date));
      addSubview(months_.back());
    }
    months_.back()->appendDay(cellFor(day, date, span), columnOfWeekday(components->weekday));
  }
}

double MonthScrollView::contentHeight() const {
  double height = 0;
  for (const Ref<MonthView>& month : months_) {
    height += month->height();
  }
  return height;
}

void MonthScrollView::scrollTo(double y) {
  const double furthest = std::max(0.0, contentHeight() - frame().size.height);
  setContentOffset({0, std::clamp(y, 0.0, furthest)});
  for (const Ref<MonthView>& month : months_) {
    const CGRect place = month->frame();
    month->setHidden(place.maxY() <= bounds().origin.y || place.origin.y >= bounds().maxY());
  }
}

void MonthScrollView::layoutSubviews() {
  double y = 0;
  for (const Ref<MonthView>& month : months_) {
    month->setFrame({0, y, frame().size.width, month->height()});
    y += month->height();
  }
  scrollTo(y);  // as far as it goes
}

void MonthScrollViewController::loadView() {
  months_ = makeView<MonthScrollView>();
  _scrollView = months_;
  setView(months_);
}

void MonthScrollViewController::viewDidLoad() { months_->setSpan(span_); }

void MonthScrollViewController::scrollToToday() { months_->scrollTo(months_->contentHeight()); }

}  // namespace tavro
