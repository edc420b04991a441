#include "host/screens/trends/TrendListViews.h"

#include "host/screens/trends/TrendUnits.h"
#include "platform/foundation/Language.h"

namespace tavro {
namespace {

using Metric = TrendListMetricView;
const Registered metricClass =
    defineClass<Metric, UIView>()
        .method<&Metric::init>("init")
        .method<&Metric::titleLabel>("titleLabel")
        .method<&Metric::trendString>("trendString")
        .method<&Metric::valueLabel>("valueLabel")
        .method<&Metric::naturalActivate>("_naturalAccessibilityActivate")
        .method<&Metric::layoutSubviews>("layoutSubviews");

const Registered pairClass = defineClass<TrendPairTableViewCell, UITableViewCell>()
                                 .method<&TrendPairTableViewCell::layoutSubviews>("layoutSubviews");

using Down = TrendingDownTableViewCell;
const Registered downClass = defineClass<Down, UITableViewCell>()
                                 .method<&Down::init>("init")
                                 .method<&Down::view>("view")
                                 .method<&Down::detailLabel>("detailLabel")
                                 .method<&Down::naturalActivate>("_naturalAccessibilityActivate")
                                 .method<&Down::layoutSubviews>("layoutSubviews");

const Registered headerClass = defineClass<TrendListHeaderView, UIView>();

constexpr double kMargin = 16;
constexpr double kLine = 28;
constexpr double kMetricHeight = 72;

Ref<UIImageView> arrowView(TrendDirection direction) {
  const auto image = make<UIImage>();
  image->name = std::string("arrow ") + std::string(textOfDirection(direction));
  auto view = makeView<UIImageView>({0, 0, kLine, kLine});
  view->setImage(image);
  return view;
}

}  // namespace

std::string_view textOfDirection(TrendDirection direction) {
  switch (direction) {
    case TrendDirection::up:
      return "Trending up";
    case TrendDirection::down:
      return "Trending down";
    case TrendDirection::steady:
      break;
  }
  return "Holding steady";
}

id TrendListMetricView::init() {
  titleLabel_ = makeLabel("");
  valueLabel_ = makeLabel("");
  addSubview(titleLabel_);
  addSubview(valueLabel_);
  return this;
}

void TrendListMetricView::setTrend(const Trend& trend) {
  titleLabel_->setText(string(trend.title));
  trendString_ = string(textOfDirection(trend.direction));
  valueLabel_->setText(string(shownAmount(trend.type, trend.averages.average90)));
  if (arrow_) {
    arrow_->removeFromSuperview();
  }
  arrow_ = arrowView(trend.direction);
  addSubview(arrow_);
}

bool TrendListMetricView::naturalActivate() {
  return send<bool>(superview(), "accessibilityActivate");
}

void TrendListMetricView::layoutSubviews() {
  const double width = frame().size.width - 2 * kMargin - kLine;
  titleLabel_->setFrame({kMargin, 8, width, kLine});
  valueLabel_->setFrame({kMargin, 8 + kLine, width, kLine});
  if (arrow_) {
    arrow_->setFrame({kMargin + width, 8, kLine, kLine});
  }
}

void TrendPairTableViewCell::addTrend(const Trend& trend, TrendAction action) {
  const auto button = makeView<UIButton>();
  button->setAction(std::move(action));
  const auto metric = makeView<TrendListMetricView>();
  metric->setTrend(trend);
  button->addSubview(metric);
  addSubview(button);
}

void TrendPairTableViewCell::layoutSubviews() {
  const double width = frame().size.width / kTrends;
  const bool startsAtRight = userInterfaceIsRightToLeft();
  double x = startsAtRight ? frame().size.width - width : 0;
  for (const Ref<UIView>& button : subviewList()) {
    button->setFrame({x, 0, width, frame().size.height});
    for (const Ref<UIView>& metric : button->subviewList()) {
      metric->setFrame({0, 0, width, kMetricHeight});
    }
    x += startsAtRight ? -width : width;
  }
}

id TrendingDownTableViewCell::init() {
  view_ = makeView<TrendListMetricView>();
  detailLabel_ = makeLabel("");
  addSubview(view_);
  addSubview(detailLabel_);
  return this;
}

void TrendingDownTableViewCell::setTrend(const Trend& trend, TrendAction action) {
  view_->setTrend(trend);
  detailLabel_->setText(string(trend.advice));
  action_ = std::move(action);
}

bool TrendingDownTableViewCell::naturalActivate() {
  if (!action_) {
    return false;
  }
  const Ref<TrendingDownTableViewCell> kept(this);  // the action may show another screen
  const TrendAction action = action_;
  action();
  return true;
}

void TrendingDownTableViewCell::layoutSubviews() {
  const double width = frame().size.width;
  view_->setFrame({0, 0, width, kMetricHeight});
  detailLabel_->setFrame({kMargin, kMetricHeight, width - 2 * kMargin, 2 * kLine});
}

void TrendListHeaderView::setDirection(TrendDirection direction) {
  const auto title = makeLabel(textOfDirection(direction), {kMargin + kLine, 8, 300, kLine});
  send<void>(title, "setAccessibilityTraits:", UIAccessibilityTraitHeader);
  addSubview(title);
  const auto arrow = arrowView(direction);
  arrow->setFrame({kMargin, 8, kLine, kLine});
  addSubview(arrow);
}

}  // namespace tavro
