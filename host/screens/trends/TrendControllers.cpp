#include "host/screens/trends/TrendControllers.h"

#include <algorithm>

#include "host/screens/trends/TrendUnits.h"

namespace tavro {
namespace {

const Registered listClass = defineClass<TrendsViewController, UIViewController>()
                                 .method<&TrendsViewController::viewDidLoad>("viewDidLoad");
const Registered summaryClass = defineClass<TrendDetailSummaryView, UIView>();
const Registered detailClass = defineClass<TrendDetailViewController, UIViewController>()
                                   .method<&TrendDetailViewController::viewDidLoad>("viewDidLoad");

constexpr CGRect kContent{0, 0, 390, 800};
constexpr double kMargin = 16;
constexpr double kLine = 30;

TrendAction opening(const Trend& trend) {
  return [&trend] {
    UIWindow* const window = UIWindow::keyWindow();
    if (window != nullptr) {
      const auto controller = makeController<TrendDetailViewController>();
      controller->setTrend(&trend);
      window->setRootViewController(controller);
    }
  };
}

bool hasWeekdays(const Trend& trend) {
  return std::ranges::any_of(trend.weekdays, [](const TrendAverages& averages) {
    return averages.average365 || averages.average90;
  });
}

}  // namespace

void TrendsViewController::viewDidLoad() {
  navigationItem()->title = string("Trends");
  const auto table = makeView<UITableView>(kContent);
  setView(table);
  if (trends_ == nullptr || trends_->empty()) {
    table->appendRow(makeLabel("Trends appear after 180 days of activity."), 44);
    return;
  }
  appendSection(*table, TrendDirection::down);
  appendSection(*table, TrendDirection::up);
  appendSection(*table, TrendDirection::steady);
}

void TrendsViewController::appendSection(UITableView& table, TrendDirection direction) const {
  Ref<TrendPairTableViewCell> pair;
  bool isFirst = true;
  for (const Trend& trend : *trends_) {
    if (trend.direction != direction) {
      continue;
    }
    if (std::exchange(isFirst, false)) {
      const auto header = makeView<TrendListHeaderView>();
      header->setDirection(direction);
      table.appendRow(header, TrendListHeaderView::height);
    }
    if (direction == TrendDirection::down) {
      const auto cell = makeView<TrendingDownTableViewCell>();
      cell->setTrend(trend, opening(trend));
      table.appendRow(cell, TrendingDownTableViewCell::height);
      continue;
    }
    if (!pair || pair->subviewList().size() == TrendPairTableViewCell::kTrends) {
      pair = makeView<TrendPairTableViewCell>();
      table.appendRow(pair, TrendPairTableViewCell::height);
    }
    pair->addTrend(trend, opening(trend));
  }
}

void TrendDetailSummaryView::setTrend(const Trend& trend) {
  const std::string texts[] = {
      trend.title, std::string(textOfDirection(trend.direction)),
      "Last 90 days: " + shownAmount(trend.type, trend.averages.average90),
      "Last 365 days: " + shownAmount(trend.type, trend.averages.average365)};
  double y = 0;
  for (const std::string& text : texts) {
    addSubview(makeLabel(text, {kMargin, y, kContent.size.width - 2 * kMargin, kLine}));
    y += kLine;
  }
  send<void>(subviewList().front(), "setAccessibilityTraits:", UIAccessibilityTraitHeader);
}

void TrendDetailViewController::viewDidLoad() {
  const auto table = makeView<UITableView>(kContent);
  setView(table);
  if (trend_ == nullptr) {
    table->appendRow(makeLabel("There is no trend yet."), 44);
    return;
  }
  navigationItem()->title = string(trend_->title);
  const auto summary = makeView<TrendDetailSummaryView>();
  summary->setTrend(*trend_);
  table->appendRow(summary, TrendDetailSummaryView::height);
  const auto chart = makeView<TrendDetailChartView>();
  chart->setTrend(*trend_);
  table->appendRow(chart, TrendDetailChartView::height);
  if (hasWeekdays(*trend_)) {
    const auto averages = makeView<TrendDetailDailyAverageView>();
    averages->setTrend(*trend_);
    table->appendRow(averages, TrendDetailDailyAverageView::height);
  }
}

}  // namespace tavro
