#pragma once

#include "platform/foundation/NSDate.h"
#include "platform/uikit/UIControls.h"

namespace tavro {

class TVUIChartView;

/// What a chart draws comes from its data source, an object that adopts the protocol
/// "TVUIChartDataSource". Messages, each with the chart as its argument:
///   `chartDateIntervalForChartView:`  the span that the chart shows, or nil
///   `chartPointsForChartView:`        an array of values of points: seconds after the span's
///                                     start, the value
/// For a screen reader, a data source may describe the chart in slices of equal time:
///   `_accessibilityShouldUseSlices` "B", `_accessibilityNumberOfSlices` "Q",
///   `_accessibilityTimeIntervalPerSlice` "d" (seconds),
///   `_accessibilityQuantityForSliceAtIndex:` "@,Q" (a text, or nil)
inline constexpr Name kTVUIChartDataSource = "TVUIChartDataSource";

/// One slice of a chart as an element: its times are its label, what the data source says of it is
/// its value. A slice without a quantity says its times alone: a listener hears that the chart goes
/// on and that nothing was measured there, and a finger on it is not met with silence. Everything
/// is asked when it is needed, so that the element is never out of date.
class TVUIChartSlice : public UIAccessibilityElement {
 public:
  static constexpr Name className = "TVUIChartSlice";

  std::uint64_t index = 0;

  id naturalLabel();
  id naturalValue();
  CGRect naturalFrame();

 private:
  [[nodiscard]] Ref<TVUIChartView> chart();
};

/// The drawn part of a chart. Its elements are the slices of its data source, which has none unless
/// it answers `_accessibilityShouldUseSlices` with YES.
class TVUIChartContainerView : public UIView {
 public:
  static constexpr Name className = "TVUIChartContainerView";

  id naturalElements();

 private:
  std::vector<Ref<TVUIChartSlice>> slices_;
};

/// A chart of values over time: the drawn points, and labels at its axes. Messages: `dataSource`,
/// `setDataSource:`, `reloadData`.
class TVUIChartView : public UIView {
 public:
  static constexpr Name className = "TVUIChartView";

  Ref<TVUIChartContainerView> _containerView;

  id init();
  /// Held weakly.
  [[nodiscard]] id dataSource() const { return dataSource_.strong(); }
  void setDataSource(const id& source) { dataSource_ = Weak<>(source.get()); }
  /// Asks the data source for the span and the points, and draws them.
  void reloadData();
  void layoutSubviews();

  [[nodiscard]] const Ref<NSDateInterval>& span() const { return span_; }
  /// How many slices the data source describes; 0 when it describes none.
  [[nodiscard]] std::uint64_t numberOfSlices() const;
  /// The times of a slice as the user writes them; nil without a span.
  [[nodiscard]] Ref<NSString> timesOfSlice(std::uint64_t index) const;

 private:
  void setAxisTexts();

  Weak<> dataSource_;
  Ref<NSDateInterval> span_;
  std::vector<CGPoint> points_;
  double lowest_ = 0;
  double highest_ = 0;
  std::vector<Ref<CALayer>> marks_;
  Ref<UILabel> startLabel_;
  Ref<UILabel> endLabel_;
  Ref<UILabel> highestLabel_;
  Ref<UILabel> lowestLabel_;
};

}  // namespace tavro
