#pragma once

#include <array>
#include <optional>
#include <vector>

#include "host/Diary.h"
#include "platform/healthkit/HKQuantity.h"
#include "platform/uikit/UIControls.h"

namespace tavro {

/// What the charts of a trend have in common: a title at the top, a row below it for the scale, and
/// columns that are drawn from there to the bottom.
class TrendChartView : public UIView {
 public:
  id titleLabel() { return titleLabel_; }
  /// The unit of every amount in the chart; nil until a trend is shown.
  id accessibilityUnit() { return unit_; }

 protected:
  static constexpr double kRowHeight = 24;

  void addTitleLabel();
  void setTitle(const Trend& trend, std::string_view what);
  void placeTitle();
  /// nil for what was not recorded.
  [[nodiscard]] id quantityOf(std::optional<double> amount) const;
  /// Shows the bars of these amounts; places follow by `placeBar`.
  void setAmounts(std::vector<std::optional<double>> amounts);
  /// Draws the bar of an amount in its column; the tallest bar reaches the scale.
  void placeBar(std::size_t index, double x, double width);
  [[nodiscard]] double maximum() const { return maximum_; }

 private:
  Ref<UILabel> titleLabel_;
  Ref<HKUnit> unit_;
  std::vector<std::optional<double>> amounts_;
  double maximum_ = 0;
  std::vector<Ref<CALayer>> bars_;
};

/// A trend over time, a bar for each span of days. Messages: `barStops` (numbers; a bar is drawn
/// one bar's width to the right of its stop), `titleLabel`, `chartMaxLabel`, `accessibilityUnit`,
/// `accessibilityQuantityForIndex:` and `accessibilityDateIntervalForIndex:` ("q"; nil for a bar
/// that does not exist, the quantity also for one without a record).
class TrendDetailChartView : public TrendChartView {
 public:
  static constexpr Name className = "TavroApp.TrendDetailChartView";
  static constexpr double height = 260;

  /// Makes the chart's labels.
  id init();
  void setTrend(const Trend& trend);

  id barStops() { return stops_; }
  id chartMaxLabel() { return chartMaxLabel_; }
  id accessibilityQuantityForIndex(std::int64_t index) { return barAt(index).quantity; }
  id accessibilityDateIntervalForIndex(std::int64_t index) { return barAt(index).interval; }
  void layoutSubviews();

 private:
  struct Bar {
    id quantity;
    id interval;
  };
  /// An empty bar for an index without one.
  [[nodiscard]] Bar barAt(std::int64_t index) const;

  std::vector<Bar> trendBars_;
  Ref<NSArray> stops_;
  Ref<UILabel> chartMaxLabel_;
};

/// A trend by weekday, a column for each, from the first day of the user's week on; in it a bar for
/// the average over a year and one over 90 days. Messages: `dayStops` (numbers: the columns' left
/// edges), `titleLabel`, `accessibilityUnit`, `accessibiliytQuantity90ForIndex:`,
/// `accessibiliytQuantity365ForIndex:` ("q"; nil where nothing was recorded) and
/// `accessibilityDayForStopIndex:` ("q"; a number, 1 is Sunday ... 7 is Saturday).
class TrendDetailDailyAverageView : public TrendChartView {
 public:
  static constexpr Name className = "TavroApp.TrendDetailDailyAverageView";
  static constexpr double height = 220;

  /// Makes the chart's title.
  id init();
  void setTrend(const Trend& trend);

  id dayStops() { return stops_; }
  id accessibiliytQuantity90ForIndex(std::int64_t index);
  id accessibiliytQuantity365ForIndex(std::int64_t index);
  id accessibilityDayForStopIndex(std::int64_t index);
  void layoutSubviews();

 private:
  std::array<TrendAverages, 7> weekdays_;
  Ref<NSArray> stops_;
};

}  // namespace tavro
