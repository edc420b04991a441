#pragma once

#include <functional>
#include <vector>

#include "host/Diary.h"
#include "platform/uikit/UITables.h"

namespace tavro {

/// What a tap on a trend does.
using TrendAction = std::function<void()>;

/// How a trend develops, in words.
std::string_view textOfDirection(TrendDirection direction);

/// A metric: its title, an arrow for how it develops, its average over 90 days. A tap on it goes to
/// what it lies in. Messages: `titleLabel`, `trendString` (the arrow's meaning), `valueLabel`.
class TrendListMetricView : public UIView {
 public:
  static constexpr Name className = "TavroApp.TrendListMetricView";

  /// Makes the view's parts.
  id init();
  void setTrend(const Trend& trend);

  id titleLabel() { return titleLabel_; }
  id trendString() { return trendString_; }
  id valueLabel() { return valueLabel_; }
  bool naturalActivate();
  void layoutSubviews();

 private:
  Ref<UILabel> titleLabel_;
  Ref<UIImageView> arrow_;
  Ref<UILabel> valueLabel_;
  Ref<NSString> trendString_;
};

/// The row of one or two trends side by side in reading direction, each a button with a metric on
/// it.
class TrendPairTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "TavroApp.TrendPairTableViewCell";
  static constexpr double height = 96;
  static constexpr std::size_t kTrends = 2;

  /// At most `kTrends` times.
  void addTrend(const Trend& trend, TrendAction action);
  void layoutSubviews();
};

/// The row of a trend that goes down. Messages: `view` (its metric), `detailLabel` (what to do).
class TrendingDownTableViewCell : public UITableViewCell {
 public:
  static constexpr Name className = "TavroApp.TrendingDownTableViewCell";
  static constexpr double height = 136;

  /// Makes the row's parts.
  id init();
  void setTrend(const Trend& trend, TrendAction action);

  id view() { return view_; }
  id detailLabel() { return detailLabel_; }
  bool naturalActivate();
  void layoutSubviews();

 private:
  Ref<TrendListMetricView> view_;
  Ref<UILabel> detailLabel_;
  TrendAction action_;
};

/// The heading of a part of the list, with the arrow of its direction.
class TrendListHeaderView : public UIView {
 public:
  static constexpr Name className = "TavroApp.TrendListHeaderView";
  static constexpr double height = 44;

  /// Once.
  void setDirection(TrendDirection direction);
};

}  // namespace tavro
