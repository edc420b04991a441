#pragma once

#include "host/screens/calendar/MonthScrollViewController.h"

namespace tavro {

/// Covers what is still loading.
class LoadingView : public UIView {
 public:
  static constexpr Name className = "LoadingView";

  /// Makes the label.
  id init();
  void layoutSubviews();

 private:
  Ref<UILabel> label_;
};

/// The month calendar: today's month as its title, a button with a picture that scrolls to today,
/// and the months. Message: `scrollToToday:`.
class MonthViewController : public UIViewController {
 public:
  static constexpr Name className = "MonthViewController";

  /// Set before the view is asked for.
  void setSpan(CalendarSpan span) { months_->setSpan(std::move(span)); }
  id init();
  void viewDidLoad();
  void scrollToToday(const id& /*item*/) { months_->scrollToToday(); }
  /// Covers the months by a loading view, or uncovers them.
  void setLoading(bool isLoading);
  [[nodiscard]] MonthScrollViewController& months() const { return *months_; }

 private:
  Ref<MonthScrollViewController> months_;
  Ref<LoadingView> loadingView_;
};

}  // namespace tavro
