#include "host/libraries/ActivitySharing.h"

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

const Registered friendClass = defineClass<ASFriend, NSObject>();
const Registered scoreClass =
    defineClass<ASCompetitionScoreView, UIView>()
        .method<&ASCompetitionScoreView::init>("init")
        .method<&ASCompetitionScoreView::layoutSubviews>("layoutSubviews")
        .method<&ASCompetitionScoreView::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&ASCompetitionScoreView::naturalLabel>("_naturalAccessibilityLabel");

Ref<NSString> scoreText(std::string_view name, double score) {
  return string(std::string(name) + " " + utf8(decimalString(score, 0)));
}

}  // namespace

id ASCompetitionScoreView::init() {
  myLabel_ = makeLabel("");
  friendLabel_ = makeLabel("");
  addSubview(myLabel_);
  addSubview(friendLabel_);
  return this;
}

void ASCompetitionScoreView::setScores(double mine, std::string_view friendName, double theirs) {
  myLabel_->setText(scoreText("You", mine));
  friendLabel_->setText(scoreText(friendName, theirs));
}

void ASCompetitionScoreView::layoutSubviews() {
  const CGSize size = frame().size;
  myLabel_->setFrame({0, 0, size.width / 2, size.height});
  friendLabel_->setFrame({size.width / 2, 0, size.width / 2, size.height});
}

id ASCompetitionScoreView::naturalLabel() {
  return AXLabelForElements(axArrayByIgnoringNilElements({myLabel_, friendLabel_}));
}

}  // namespace tavro
