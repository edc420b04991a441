#include "platform/uikit/UIControls.h"

#include "platform/foundation/NSAttributedString.h"

namespace tavro {
namespace {

const Registered labelClass =
    defineClass<UILabel, UIView>()
        .method<&UILabel::text>("text")
        .method<&UILabel::setText>("setText:")
        .method<&UILabel::attributedText>("attributedText")
        .method<&UILabel::setAttributedText>("setAttributedText:")
        .method<&UILabel::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&UILabel::naturalLabel>("_naturalAccessibilityLabel")
        .method<&UILabel::naturalTraits>("_naturalAccessibilityTraits");

const Registered imageClass = defineClass<UIImage, NSObject>();

const Registered imageViewClass =
    defineClass<UIImageView, UIView>()
        .method<&UIImageView::image>("image")
        .method<&UIImageView::setImage>("setImage:")
        .method<&UIImageView::naturalTraits>("_naturalAccessibilityTraits");

const Registered controlClass =
    defineClass<UIControl, UIView>().method<&UIControl::naturalActivate>(
        "_naturalAccessibilityActivate");

const Registered buttonClass =
    defineClass<UIButton, UIControl>()
        .method<&UIButton::title>("title")
        .method<&UIButton::setTitle>("setTitle:")
        .method<&UIButton::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&UIButton::naturalLabel>("_naturalAccessibilityLabel")
        .method<&UIButton::naturalTraits>("_naturalAccessibilityTraits");

}  // namespace

void UILabel::setText(const Ref<NSString>& text) {
  text_ = text;
  attributedText_ = nullptr;
}

void UILabel::setAttributedText(const id& text) {
  text_ = plainText(text);
  attributedText_ = text;
}

bool UIControl::sendAction() {
  if (!action_) {
    return false;
  }
  // The action may put another screen in the place of the control's own.
  const Ref<UIControl> kept(this);
  const std::function<void()> action = action_;
  action();
  return true;
}

Ref<UILabel> makeLabel(std::string_view text, CGRect frame) {
  Ref<UILabel> label = makeView<UILabel>(frame);
  label->setText(string(text));
  return label;
}

}  // namespace tavro
