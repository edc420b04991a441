#include "host/screens/day/StandChart.h"

#include "platform/foundation/NSValue.h"

namespace tavro {
namespace {

using Chart = ActivityStandChartView;
const Registered chartClass = defineClass<Chart, UIView>()
                                  .method<&Chart::standChartPoints>("standChartPoints")
                                  .method<&Chart::layoutSubviews>("layoutSubviews");

using Cell = DayViewStandChartTableViewCell;
const Registered cellClass = defineClass<Cell, UITableViewCell>()
                                 .method<&Cell::init>("init")
                                 .method<&Cell::chartView>("chartView")
                                 .method<&Cell::idleHoursLabel>("idleHoursLabel")
                                 .method<&Cell::layoutSubviews>("layoutSubviews");

constexpr double kMargin = 16;
constexpr double kLabelHeight = 24;

}  // namespace

void ActivityStandChartView::setHours(std::span<const bool> hours) {
  std::vector<id> points;
  for (std::size_t hour = 0; hour < hours.size(); ++hour) {
    points.emplace_back(value(CGPoint{static_cast<double>(hour), hours[hour] ? 1.0 : 0.0}));
  }
  points_ = arrayWithObjects(std::move(points));
  while (marks_.size() < hours.size()) {
    marks_.push_back(tavro::make<CALayer>());
    layer()->addSublayer(marks_.back());
  }
  setNeedsLayout();
}

void ActivityStandChartView::layoutSubviews() {
  constexpr double idleShare = 0.25;
  const CGSize size = frame().size;
  const std::size_t hours = points_ ? points_->count() : 0;
  for (std::size_t hour = 0; hour < hours; ++hour) {
    const bool counts = as<NSValue>((*points_)[hour])->CGPointValue().y > 0;
    const double width = size.width / static_cast<double>(hours);
    const double mark = counts ? size.height : size.height * idleShare;
    marks_[hour]->setFrame({static_cast<double>(hour) * width, size.height - mark, width, mark});
  }
}

id DayViewStandChartTableViewCell::init() {
  pair_ = makeView<DayViewTitleAndValueLabelPair>();
  chartView_ = makeView<ActivityStandChartView>();
  idleHoursLabel_ = makeLabel("");
  addSubview(pair_);
  addSubview(chartView_);
  addSubview(idleHoursLabel_);
  return this;
}

void DayViewStandChartTableViewCell::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin;
  pair_->setFrame({kMargin, 0, width, kLabelHeight});
  // The idle hours stand over the chart's upper right corner.
  idleHoursLabel_->setFrame({kMargin + width / 2, kLabelHeight, width / 2, kLabelHeight});
  chartView_->setFrame({kMargin, 2 * kLabelHeight, width, frame().size.height - 2 * kLabelHeight});
}

}  // namespace tavro
