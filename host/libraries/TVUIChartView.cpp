#include "host/libraries/TVUIChartView.h"

#include <algorithm>
#include <cmath>

#include "platform/foundation/Formatters.h"
#include "platform/foundation/NSValue.h"

namespace tavro {
namespace {

const Registered sliceClass =
    defineClass<TVUIChartSlice, UIAccessibilityElement>()
        .method<&TVUIChartSlice::naturalLabel>("_naturalAccessibilityLabel")
        .method<&TVUIChartSlice::naturalValue>("_naturalAccessibilityValue")
        .method<&TVUIChartSlice::naturalFrame>("_naturalAccessibilityFrame");
const Registered containerClass =
    defineClass<TVUIChartContainerView, UIView>().method<&TVUIChartContainerView::naturalElements>(
        "_naturalAccessibilityElements");
const Registered chartClass = defineClass<TVUIChartView, UIView>()
                                  .method<&TVUIChartView::init>("init")
                                  .method<&TVUIChartView::dataSource>("dataSource")
                                  .method<&TVUIChartView::setDataSource>("setDataSource:")
                                  .method<&TVUIChartView::reloadData>("reloadData")
                                  .method<&TVUIChartView::layoutSubviews>("layoutSubviews")
                                  .variable<&TVUIChartView::_containerView>("_containerView");

constexpr double kLabelHeight = 20;
constexpr double kLabelWidth = 44;
constexpr double kMark = 4;
constexpr double kSecondsPerMinute = 60;

Ref<NSString> timeText(const Ref<NSDate>& moment) {
  const auto formatter = make<NSDateFormatter>();
  formatter->setTimeStyle(NSDateFormatterStyle::shortStyle);
  return formatter->stringFromDate(moment);
}

}  // namespace

Ref<TVUIChartView> TVUIChartSlice::chart() {
  const auto container = as<UIView>(send<id>(this, "accessibilityContainer"));
  return container ? as<TVUIChartView>(container->superview()) : nullptr;
}

id TVUIChartSlice::naturalLabel() {
  const Ref<TVUIChartView> shown = chart();
  return shown ? id(shown->timesOfSlice(index)) : id();
}

id TVUIChartSlice::naturalValue() {
  const Ref<TVUIChartView> shown = chart();
  return shown ? trySend<id>(shown->dataSource(), "_accessibilityQuantityForSliceAtIndex:", index)
               : id();
}

CGRect TVUIChartSlice::naturalFrame() {
  const Ref<TVUIChartView> shown = chart();
  if (!shown || shown->numberOfSlices() == 0) {
    return {};
  }
  const Ref<UIView> container = shown->_containerView;
  const CGSize size = container->frame().size;
  const double width = size.width / static_cast<double>(shown->numberOfSlices());
  return UIAccessibilityConvertFrameToScreenCoordinates(
      {width * static_cast<double>(index), 0, width, size.height}, container);
}

id TVUIChartContainerView::naturalElements() {
  const auto chart = as<TVUIChartView>(superview());
  const std::uint64_t count = chart ? chart->numberOfSlices() : 0;
  if (slices_.size() != count) {
    slices_.clear();
    for (std::uint64_t index = 0; index < count; ++index) {
      const auto slice = tavro::make<TVUIChartSlice>();
      send<id>(slice, "initWithAccessibilityContainer:", id(this));
      slice->index = index;
      slices_.push_back(slice);
    }
  }
  return arrayWithObjects({slices_.begin(), slices_.end()});
}

id TVUIChartView::init() {
  _containerView = makeView<TVUIChartContainerView>();
  addSubview(_containerView);
  for (Ref<UILabel>* const label : {&startLabel_, &endLabel_, &highestLabel_, &lowestLabel_}) {
    *label = makeLabel("");
    addSubview(*label);
  }
  return this;
}

void TVUIChartView::reloadData() {
  span_ = as<NSDateInterval>(send<id>(dataSource(), "chartDateIntervalForChartView:", id(this)));
  const auto points = as<NSArray>(send<id>(dataSource(), "chartPointsForChartView:", id(this)));
  points_.clear();
  if (span_ && points) {
    std::ranges::transform(*points, std::back_inserter(points_),
                           [](const id& point) { return send<CGPoint>(point, "CGPointValue"); });
  }
  const auto [lowest, highest] = std::ranges::minmax_element(points_, {}, &CGPoint::y);
  lowest_ = points_.empty() ? 0 : lowest->y;
  highest_ = points_.empty() ? 0 : highest->y;
  while (marks_.size() < points_.size()) {
    marks_.push_back(tavro::make<CALayer>());
    _containerView->layer()->addSublayer(marks_.back());
  }
  setAxisTexts();
  setNeedsLayout();
}

void TVUIChartView::setAxisTexts() {
  const bool hasAxes = !points_.empty();
  startLabel_->setText(hasAxes ? timeText(span_->startDate) : nullptr);
  endLabel_->setText(hasAxes ? timeText(span_->endDate) : nullptr);
  highestLabel_->setText(hasAxes ? decimalString(std::round(highest_), 0) : nullptr);
  lowestLabel_->setText(hasAxes ? decimalString(std::round(lowest_), 0) : nullptr);
}

void TVUIChartView::layoutSubviews() {
  const double width = std::max(0.0, frame().size.width - kLabelWidth);
  const double height = std::max(0.0, frame().size.height - kLabelHeight);
  _containerView->setFrame({0, 0, width, height});
  highestLabel_->setFrame({width, 0, kLabelWidth, kLabelHeight});
  lowestLabel_->setFrame({width, height - kLabelHeight, kLabelWidth, kLabelHeight});
  startLabel_->setFrame({0, height, width / 2, kLabelHeight});
  endLabel_->setFrame({width / 2, height, width / 2, kLabelHeight});
  const double seconds = span_ ? span_->duration() : 0;
  for (std::size_t index = 0; index < marks_.size(); ++index) {
    CGRect mark;  // a mark that stands for no point is nowhere
    if (index < points_.size()) {
      const CGPoint point = points_[index];
      const double x = seconds > 0 ? point.x / seconds : 0;
      const double y = highest_ > lowest_ ? (highest_ - point.y) / (highest_ - lowest_) : 0.5;
      mark = {x * width - kMark / 2, y * height - kMark / 2, kMark, kMark};
    }
    marks_[index]->setFrame(mark);
  }
}

std::uint64_t TVUIChartView::numberOfSlices() const {
  const id source = dataSource();
  // A data source need not know of slices.
  if (!respondsTo(source.get(), "_accessibilityShouldUseSlices") ||
      !trySend<bool>(source, "_accessibilityShouldUseSlices")) {
    return 0;
  }
  return trySend<std::uint64_t>(source, "_accessibilityNumberOfSlices");
}

Ref<NSString> TVUIChartView::timesOfSlice(std::uint64_t index) const {
  if (!span_) {
    return nullptr;
  }
  const auto seconds = trySend<double>(dataSource(), "_accessibilityTimeIntervalPerSlice");
  const auto position = static_cast<double>(index);
  const auto formatter = make<NSDateIntervalFormatter>();
  formatter->setDateStyle(NSDateFormatterStyle::none);
  // Slices shorter than a minute would all bear the same times without their seconds.
  formatter->setTimeStyle(seconds < kSecondsPerMinute ? NSDateFormatterStyle::medium
                                                      : NSDateFormatterStyle::shortStyle);
  return formatter->stringFromDate(
      dateByAddingTimeInterval(span_->startDate, seconds * position),
      dateByAddingTimeInterval(span_->startDate, seconds * (position + 1)));
}

}  // namespace tavro
