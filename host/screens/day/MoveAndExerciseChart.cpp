#include "host/screens/day/MoveAndExerciseChart.h"

#include <algorithm>

#include "platform/foundation/NSValue.h"

namespace tavro {
namespace {

using Chart = ActivityMoveAndExerciseChartView;
const Registered chartClass =
    defineClass<Chart, UIView>()
        .method<&Chart::moveAndExerciseChartPoints>("moveAndExerciseChartPoints")
        .method<&Chart::moveAndExerciseChartMaxYValue>("moveAndExerciseChartMaxYValue")
        .method<&Chart::moveAndExerciseChartViewType>("moveAndExerciseChartViewType")
        .method<&Chart::accessibilityReloadData>("accessibilityReloadData")
        .method<&Chart::layoutSubviews>("layoutSubviews");

using Cell = DayViewMoveAndExerciseChartTableViewCell;
const Registered cellClass = defineClass<Cell, UITableViewCell>()
                                 .method<&Cell::init>("init")
                                 .method<&Cell::labelPair>("labelPair")
                                 .method<&Cell::chartView>("chartView")
                                 .method<&Cell::auxiliaryLabel>("auxiliaryLabel")
                                 .method<&Cell::layoutSubviews>("layoutSubviews");

constexpr double kMargin = 16;
constexpr double kLabelHeight = 24;

}  // namespace

void ActivityMoveAndExerciseChartView::setAmounts(MoveAndExerciseChartType type,
                                                  std::span<const double> amounts) {
  type_ = type;
  maximum_ = amounts.empty() ? 0 : *std::ranges::max_element(amounts);
  std::vector<id> points;
  for (std::size_t hour = 0; hour < amounts.size(); ++hour) {
    points.emplace_back(value(CGPoint{static_cast<double>(hour), amounts[hour]}));
  }
  points_ = arrayWithObjects(std::move(points));
  while (bars_.size() < amounts.size()) {
    bars_.push_back(tavro::make<CALayer>());
    layer()->addSublayer(bars_.back());
  }
  setNeedsLayout();
  send<void>(this, "accessibilityReloadData");
}

void ActivityMoveAndExerciseChartView::layoutSubviews() {
  const CGSize size = frame().size;
  const std::size_t hours = points_ ? points_->count() : 0;
  const double width = hours == 0 ? 0 : size.width / static_cast<double>(hours);
  for (std::size_t bar = 0; bar < bars_.size(); ++bar) {
    if (bar >= hours) {
      bars_[bar]->setFrame({});  // left from a longer day
      continue;
    }
    const double amount = as<NSValue>((*points_)[bar])->CGPointValue().y;
    const double height = maximum_ > 0 ? size.height * amount / maximum_ : 0;
    bars_[bar]->setFrame({static_cast<double>(bar) * width, size.height - height, width, height});
  }
}

id DayViewMoveAndExerciseChartTableViewCell::init() {
  labelPair_ = makeView<DayViewTitleAndValueLabelPair>();
  chartView_ = makeView<ActivityMoveAndExerciseChartView>();
  auxiliaryLabel_ = makeLabel("");
  addSubview(labelPair_);
  addSubview(chartView_);
  addSubview(auxiliaryLabel_);
  return this;
}

void DayViewMoveAndExerciseChartTableViewCell::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin;
  const double bottom = frame().size.height - kLabelHeight;
  labelPair_->setFrame({kMargin, 0, width, kLabelHeight});
  // The auxiliary label stands over the chart's upper right corner.
  auxiliaryLabel_->setFrame({kMargin + width / 2, kLabelHeight, width / 2, kLabelHeight});
  chartView_->setFrame({kMargin, kLabelHeight * 2, width, bottom - kLabelHeight});
}

}  // namespace tavro
