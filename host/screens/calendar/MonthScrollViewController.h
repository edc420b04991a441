#pragma once

#include "host/Diary.h"
#include "host/libraries/HKCalendar.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// What a month calendar shows: the whole months from the first day's to the last day's.
struct CalendarSpan {
  CalendarDay first;
  CalendarDay last;
  CalendarDay today;
  std::vector<CalendarDay> workoutDays;  ///< in order
};
/// From the diary's first day to today.
CalendarSpan calendarSpanOf(const Diary& diary);

/// A day of a month: its number with its rings below. Messages: `isFutureDay`.
class MonthDayCellLayer : public HKCalendarDayCell {
 public:
  static constexpr Name className = "MonthDayCellLayer";

  [[nodiscard]] bool isFutureDay() const { return isFutureDay_; }
  void setFutureDay(bool isFutureDay) { isFutureDay_ = isFutureDay; }

  bool _hasWorkout = false;

 private:
  bool isFutureDay_ = false;
};

/// A week of a month.
class MonthWeekView : public HKCalendarWeekView {
 public:
  static constexpr Name className = "MonthWeekView";
};

/// Shows a month's number in two digits.
class TavroMonthTitleLabel : public UILabel {
 public:
  static constexpr Name className = "_TavroMonthTitleLabel";
};

/// A month: its weeks one below the other, the first of them with the title.
class MonthView : public UIView {
 public:
  static constexpr Name className = "MonthView";

  void setTitle(const Ref<NSString>& title) { title_ = title; }
  /// Adds the next day of the month, in a column of the week, 0 for the week's first.
  void appendDay(const Ref<MonthDayCellLayer>& day, std::size_t column);
  [[nodiscard]] double height() const;
  void layoutSubviews();

 private:
  std::vector<Ref<MonthWeekView>> weeks_;
  Ref<NSString> title_;
};

/// All months of a span from top to bottom. It opens at the last of them; months outside the part
/// that is on screen are hidden.
class MonthScrollView : public UIScrollView {
 public:
  static constexpr Name className = "MonthScrollView";

  /// Builds the months of the user's calendar; takes time in proportion to the days. Once.
  void setSpan(const CalendarSpan& span);
  [[nodiscard]] double contentHeight() const;
  [[nodiscard]] const std::vector<Ref<MonthView>>& months() const { return months_; }
  /// Scrolls so that this is at the top, or as near as the content allows.
  void scrollTo(double y);
  void layoutSubviews();

 private:
  std::vector<Ref<MonthView>> months_;
};

/// Owns the scrolling months.
class MonthScrollViewController : public UIViewController {
 public:
  static constexpr Name className = "MonthScrollViewController";

  /// Set before the view is asked for.
  void setSpan(CalendarSpan span) { span_ = std::move(span); }
  void loadView();
  void viewDidLoad();
  [[nodiscard]] MonthScrollView& months() const { return *months_; }
  /// Brings the span's last month, which is today's, on screen.
  void scrollToToday();

  Ref<UIScrollView> _scrollView;

 private:
  CalendarSpan span_;
  Ref<MonthScrollView> months_;
};

}  // namespace tavro
