#include "host/screens/day/DayViewLabels.h"

#include "platform/foundation/Language.h"

namespace tavro {
namespace {

const Registered pairClass =
    defineClass<DayViewTitleAndValueLabelPair, UIView>()
        .method<&DayViewTitleAndValueLabelPair::titleLabel>("titleLabel")
        .method<&DayViewTitleAndValueLabelPair::valueLabel>("valueLabel")
        .method<&DayViewTitleAndValueLabelPair::layoutSubviews>("layoutSubviews");

}  // namespace

void DayViewTitleAndValueLabelPair::setTexts(std::string_view title, std::string_view value) {
  if (!titleLabel_) {
    titleLabel_ = makeLabel("");
    valueLabel_ = makeLabel("");
    addSubview(titleLabel_);
    addSubview(valueLabel_);
  }
  titleLabel_->setText(string(title));
  valueLabel_->setText(string(value));
}

void DayViewTitleAndValueLabelPair::layoutSubviews() {
  if (titleLabel_) {
    const double half = frame().size.width / 2;
    const bool isMirrored = userInterfaceIsRightToLeft();
    titleLabel_->setFrame({isMirrored ? half : 0, 0, half, frame().size.height});
    valueLabel_->setFrame({isMirrored ? 0 : half, 0, half, frame().size.height});
  }
}

}  // namespace tavro
