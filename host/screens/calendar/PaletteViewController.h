#pragma once

#include <array>

#include "platform/foundation/NSDate.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

inline constexpr std::size_t kDaysOfWeek = 7;

/// The initials of the weekdays in seven columns, the first day of the week on the left whatever
/// the language. Messages: `initWithNavigationPalette:`, `highlightWeekdayLabelForDateAndSetDay:`.
class PaletteWeekdayHeaderView : public UIView {
 public:
  static constexpr Name className = "PaletteWeekdayHeaderView";
  static constexpr double height = 40;

  /// Makes the labels, as wide together as the palette, which is a view.
  id initWithNavigationPalette(const Ref<UIView>& palette);
  /// Makes the label of the date's weekday stand out.
  void highlightWeekdayLabelForDateAndSetDay(const Ref<NSDate>& date);
  [[nodiscard]] Ref<NSDate> day() const { return day_; }
  void layoutSubviews();

  Ref<NSMutableArray> _weekdayLabels;

 private:
  Ref<NSDate> day_;
};

/// A day that can be tapped: naturally a button that says its number.
class ActivityTappableDay : public UIControl {
 public:
  static constexpr Name className = "ActivityTappableDay";

  [[nodiscard]] Ref<NSDate> date() const { return date_; }
  void setDate(const Ref<NSDate>& date) { date_ = date; }

  bool naturalIsElement() { return true; }
  id naturalLabel();
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitButton; }

 private:
  Ref<NSDate> date_;
};

/// A day of the week palette. Its circle is opaque while it is the chosen day.
class WeekPaletteTappableDay : public ActivityTappableDay {
 public:
  static constexpr Name className = "WeekPaletteTappableDay";

  /// Makes the circle.
  id init();
  void setChosen(bool isChosen);
  void layoutSubviews();
  /// The circle's rectangle on screen.
  id accessibilityPath();

  Ref<UIView> _circle;
};

/// A day in the drawing of a week.
class TavDayCellLayer : public CALayer {
 public:
  static constexpr Name className = "TavDayCellLayer";
};

/// Draws the rings of a week behind its tappable days.
class WeekView : public UIView {
 public:
  static constexpr Name className = "WeekView";

  /// Makes the seven days.
  id init();
  void layoutSubviews();

 private:
  std::array<Ref<TavDayCellLayer>, kDaysOfWeek> days_;
};

/// A week at a glance: the weekdays, and below them the days, of which one is chosen. Opens on
/// today; tapping a day chooses it.
class PaletteViewController : public UIViewController {
 public:
  static constexpr Name className = "PaletteViewController";

  void viewDidLoad();
  /// Shows the date's week and chooses the date.
  void showDate(const Ref<NSDate>& date);
  [[nodiscard]] PaletteWeekdayHeaderView& header() const { return *_paletteView; }
  [[nodiscard]] WeekPaletteTappableDay& day(std::size_t column) const { return *days_[column]; }

  Ref<PaletteWeekdayHeaderView> _paletteView;

 private:
  std::array<Ref<WeekPaletteTappableDay>, kDaysOfWeek> days_;
};

}  // namespace tavro
