#pragma once

#include "host/screens/trends/TrendCharts.h"
#include "host/screens/trends/TrendListViews.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// The trends, those that go down first, each with what to do about it. A tap opens a trend.
class TrendsViewController : public UIViewController {
 public:
  static constexpr Name className = "TavroApp.TrendsViewController";

  /// Set before the view is asked for. The trends must outlive the controller and what it opens.
  void setTrends(const std::vector<Trend>* trends) { trends_ = trends; }
  void viewDidLoad();

 private:
  void appendSection(UITableView& table, TrendDirection direction) const;

  const std::vector<Trend>* trends_ = nullptr;
};

/// What a trend comes to: how it develops, and its averages over 90 and 365 days.
class TrendDetailSummaryView : public UIView {
 public:
  static constexpr Name className = "TavroApp.TrendDetailSummaryView";
  static constexpr double height = 132;

  /// Once.
  void setTrend(const Trend& trend);
};

/// One trend: its summary, its course, and its weekdays where they are known.
class TrendDetailViewController : public UIViewController {
 public:
  static constexpr Name className = "TavroApp.TrendDetailViewController";

  /// Set before the view is asked for. The trend must outlive the controller.
  void setTrend(const Trend* trend) { trend_ = trend; }
  void viewDidLoad();

 private:
  const Trend* trend_ = nullptr;
};

}  // namespace tavro
