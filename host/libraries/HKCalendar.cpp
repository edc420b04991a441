#include "host/libraries/HKCalendar.h"

#include "platform/foundation/Language.h"

namespace tavro {
namespace {

constexpr double kRingsHeight = 46;

const Registered dayClass = defineClass<HKCalendarDayCell, CALayer>()
                                .method<&HKCalendarDayCell::date>("date")
                                .method<&HKCalendarDayCell::representsToday>("representsToday");

const Registered weekClass = defineClass<HKCalendarWeekView, UIView>()
                                 .method<&HKCalendarWeekView::monthTitleView>("monthTitleView")
                                 .method<&HKCalendarWeekView::layoutSubviews>("layoutSubviews");

}  // namespace

void HKCalendarDayCell::setDate(const Ref<NSDate>& date, bool representsToday) {
  date_ = date;
  representsToday_ = representsToday;
}

void HKCalendarWeekView::addDayCell(const Ref<HKCalendarDayCell>& cell, std::size_t column) {
  days_.push_back({cell, column});
  layer()->addSublayer(cell);
  setNeedsLayout();
}

void HKCalendarWeekView::setMonthTitleView(const Ref<UIView>& view) {
  monthTitleView_ = view;
  addSubview(view);
}

double HKCalendarWeekView::height() const {
  return (monthTitleView_ ? kTitleHeight : 0) + kDaySize + kRingsHeight;
}

double HKCalendarWeekView::columnX(std::size_t column) const {
  const std::size_t fromLeft = userInterfaceIsRightToLeft() ? kColumns - 1 - column : column;
  return frame().size.width / kColumns * static_cast<double>(fromLeft);
}

void HKCalendarWeekView::layoutSubviews() {
  const double columnWidth = frame().size.width / kColumns;
  const double top = monthTitleView_ ? kTitleHeight : 0;
  for (const PlacedDay& day : days_) {
    day.cell->setFrame(
        {columnX(day.column) + (columnWidth - kDaySize) / 2, top, kDaySize, kDaySize});
  }
  if (monthTitleView_ && !days_.empty()) {
    monthTitleView_->setFrame({columnX(days_.front().column), 0, columnWidth, kTitleHeight});
  }
}

}  // namespace tavro
