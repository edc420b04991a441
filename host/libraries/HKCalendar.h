#pragma once

#include "platform/foundation/NSDate.h"
#include "platform/uikit/UIView.h"

namespace tavro {

/// One day of a calendar: a layer that draws its number. Messages: `date`, `representsToday`.
class HKCalendarDayCell : public CALayer {
 public:
  static constexpr Name className = "HKCalendarDayCell";

  /// A moment of the day; nil until it is set.
  [[nodiscard]] Ref<NSDate> date() const { return date_; }
  [[nodiscard]] bool representsToday() const { return representsToday_; }
  void setDate(const Ref<NSDate>& date, bool representsToday);

 private:
  Ref<NSDate> date_;
  bool representsToday_ = false;
};

/// A week of a calendar: a row of seven columns, in the reading direction of the user's language,
/// with a cell for each day of it. Message: `monthTitleView` (nil in a row that begins no month).
class HKCalendarWeekView : public UIView {
 public:
  static constexpr Name className = "HKCalendarWeekView";
  static constexpr std::size_t kColumns = 7;
  static constexpr double kTitleHeight = 40;
  static constexpr double kDaySize = 30;

  /// Adds a day in a column, 0 for the first day of the week.
  void addDayCell(const Ref<HKCalendarDayCell>& cell, std::size_t column);
  [[nodiscard]] bool isEmpty() const { return days_.empty(); }
  [[nodiscard]] id monthTitleView() const { return monthTitleView_; }
  /// Stands above the row's first day and makes the row higher.
  void setMonthTitleView(const Ref<UIView>& view);
  /// The height that the row wants: its title, its numbers, and below them what each day shows.
  [[nodiscard]] double height() const;
  void layoutSubviews();

 private:
  struct PlacedDay {
    Ref<HKCalendarDayCell> cell;
    std::size_t column;
  };
  [[nodiscard]] double columnX(std::size_t column) const;

  std::vector<PlacedDay> days_;
  Ref<UIView> monthTitleView_;
};

}  // namespace tavro
