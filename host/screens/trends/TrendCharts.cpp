#include "host/screens/trends/TrendCharts.h"

#include <algorithm>

#include "host/Dates.h"
#include "host/screens/trends/TrendUnits.h"
#include "platform/foundation/NSValue.h"
#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

using Chart = TrendDetailChartView;
const Registered chartClass =
    defineClass<Chart, UIView>()
        .method<&Chart::init>("init")
        .method<&Chart::barStops>("barStops")
        .method<&Chart::titleLabel>("titleLabel")
        .method<&Chart::chartMaxLabel>("chartMaxLabel")
        .method<&Chart::accessibilityUnit>("accessibilityUnit")
        .method<&Chart::accessibilityQuantityForIndex>("accessibilityQuantityForIndex:")
        .method<&Chart::accessibilityDateIntervalForIndex>("accessibilityDateIntervalForIndex:")
        .method<&Chart::layoutSubviews>("layoutSubviews");

using Averages = TrendDetailDailyAverageView;
const Registered averagesClass =
    defineClass<Averages, UIView>()
        .method<&Averages::init>("init")
        .method<&Averages::dayStops>("dayStops")
        .method<&Averages::titleLabel>("titleLabel")
        .method<&Averages::accessibilityUnit>("accessibilityUnit")
        .method<&Averages::accessibiliytQuantity90ForIndex>("accessibiliytQuantity90ForIndex:")
        .method<&Averages::accessibiliytQuantity365ForIndex>("accessibiliytQuantity365ForIndex:")
        .method<&Averages::accessibilityDayForStopIndex>("accessibilityDayForStopIndex:")
        .method<&Averages::layoutSubviews>("layoutSubviews");

constexpr std::int64_t kWeekdays = 7;

/// 0 is Sunday; for a column of the chart by weekday.
std::int64_t weekdayOfColumn(std::int64_t column) {
  return (Settings::current().firstWeekday - 1 + column) % kWeekdays;
}

bool isColumn(std::int64_t index) { return index >= 0 && index < kWeekdays; }

}  // namespace

void TrendChartView::addTitleLabel() {
  titleLabel_ = makeLabel("");
  addSubview(titleLabel_);
}

void TrendChartView::setTitle(const Trend& trend, std::string_view what) {
  titleLabel_->setText(string(trend.title + " " + std::string(what)));
  unit_ = unitOfTrend(trend.type);
}

void TrendChartView::placeTitle() { titleLabel_->setFrame({0, 0, frame().size.width, kRowHeight}); }

id TrendChartView::quantityOf(std::optional<double> amount) const {
  return amount && unit_ ? id(HKQuantity::quantityWithUnit(unit_, *amount)) : id();
}

void TrendChartView::setAmounts(std::vector<std::optional<double>> amounts) {
  amounts_ = std::move(amounts);
  maximum_ = 0;
  for (const std::optional<double>& amount : amounts_) {
    maximum_ = std::max(maximum_, amount.value_or(0));
  }
  for (const Ref<CALayer>& bar : bars_) {
    bar->setFrame({});
  }
  while (bars_.size() < amounts_.size()) {
    bars_.push_back(tavro::make<CALayer>());
    layer()->addSublayer(bars_.back());
  }
  setNeedsLayout();
}

void TrendChartView::placeBar(std::size_t index, double x, double width) {
  if (index >= amounts_.size()) {
    return;
  }
  const double space = frame().size.height - 2 * kRowHeight;
  const double height = maximum_ > 0 ? space * amounts_[index].value_or(0) / maximum_ : 0;
  bars_[index]->setFrame({x, frame().size.height - height, width, height});
}

id TrendDetailChartView::init() {
  addTitleLabel();
  chartMaxLabel_ = makeLabel("");
  addSubview(chartMaxLabel_);
  return this;
}

void TrendDetailChartView::setTrend(const Trend& trend) {
  setTitle(trend, "Over the Year");
  trendBars_.clear();
  std::vector<std::optional<double>> amounts;
  for (const TrendBar& bar : trend.bars) {
    trendBars_.push_back({quantityOf(bar.value), dateInterval(noonOf(bar.start), noonOf(bar.end))});
    amounts.push_back(bar.value);
  }
  setAmounts(std::move(amounts));
  chartMaxLabel_->setText(string(shownAmount(trend.type, maximum())));
}

TrendDetailChartView::Bar TrendDetailChartView::barAt(std::int64_t index) const {
  const bool exists = index >= 0 && index < std::ssize(trendBars_);
  return exists ? trendBars_[static_cast<std::size_t>(index)] : Bar();
}

void TrendDetailChartView::layoutSubviews() {
  placeTitle();
  chartMaxLabel_->setFrame({0, kRowHeight, frame().size.width, kRowHeight});
  const double width = frame().size.width / static_cast<double>(trendBars_.size());
  std::vector<id> stops;
  for (std::size_t bar = 0; bar < trendBars_.size(); ++bar) {
    const double x = static_cast<double>(bar) * width;
    placeBar(bar, x, width);
    // The chart is scrubbed by the bar that a finger has passed, so a stop is where the bar before
    // begins: the first lies one width outside the chart.
    stops.emplace_back(number(x - width));
  }
  stops_ = arrayWithObjects(std::move(stops));
}

id TrendDetailDailyAverageView::init() {
  addTitleLabel();
  return this;
}

void TrendDetailDailyAverageView::setTrend(const Trend& trend) {
  setTitle(trend, "by Weekday");
  weekdays_ = trend.weekdays;
  std::vector<std::optional<double>> amounts;
  for (std::int64_t column = 0; column < kWeekdays; ++column) {
    const TrendAverages& averages = weekdays_.at(static_cast<std::size_t>(weekdayOfColumn(column)));
    amounts.insert(amounts.end(), {averages.average365, averages.average90});
  }
  setAmounts(std::move(amounts));
}

id TrendDetailDailyAverageView::accessibiliytQuantity90ForIndex(std::int64_t index) {
  return isColumn(index) ? quantityOf(weekdays_.at(weekdayOfColumn(index)).average90) : id();
}

id TrendDetailDailyAverageView::accessibiliytQuantity365ForIndex(std::int64_t index) {
  return isColumn(index) ? quantityOf(weekdays_.at(weekdayOfColumn(index)).average365) : id();
}

id TrendDetailDailyAverageView::accessibilityDayForStopIndex(std::int64_t index) {
  return isColumn(index) ? id(number(weekdayOfColumn(index) + 1)) : id();
}

void TrendDetailDailyAverageView::layoutSubviews() {
  placeTitle();
  const double width = frame().size.width / static_cast<double>(kWeekdays);
  std::vector<id> stops;
  for (std::size_t column = 0; column < weekdays_.size(); ++column) {
    const double x = static_cast<double>(column) * width;
    placeBar(2 * column, x, width / 2);
    placeBar(2 * column + 1, x + width / 2, width / 2);
    stops.emplace_back(number(x));
  }
  stops_ = arrayWithObjects(std::move(stops));
}

}  // namespace tavro
