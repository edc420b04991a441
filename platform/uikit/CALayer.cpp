#include "platform/uikit/CALayer.h"

#include "platform/uikit/UIView.h"

namespace tavro {
namespace {

const Registered layerClass = defineClass<CALayer, NSObject>()
                                  .method<&CALayer::frame>("frame")
                                  .method<&CALayer::setFrame>("setFrame:")
                                  .method<&CALayer::sublayers>("sublayers")
                                  .method<&CALayer::addSublayer>("addSublayer:")
                                  .method<&CALayer::superlayer>("superlayer")
                                  .method<&CALayer::naturalFrame>("_naturalAccessibilityFrame");

}  // namespace

CALayer::~CALayer() {
  for (const Ref<CALayer>& layer : sublayers_) {
    layer->superlayer_ = nullptr;
  }
}

CGRect CALayer::frame() const { return view_ == nullptr ? frame_ : view_->frame(); }

Ref<NSArray> CALayer::sublayers() const {
  return arrayWithObjects({sublayers_.begin(), sublayers_.end()});
}

void CALayer::addSublayer(const Ref<CALayer>& layer) {
  bool isInside = false;
  for (const CALayer* above = this; above != nullptr; above = above->superlayer_) {
    isInside = isInside || above == layer.get();
  }
  if (!layer || layer->superlayer_ != nullptr || isInside) {
    raise(kInvalidArgumentException, "a layer is added once, to one other layer");
  }
  layer->superlayer_ = this;
  sublayers_.push_back(layer);
}

Ref<UIView> CALayer::view() const { return Ref<UIView>(view_); }

CGRect CALayer::naturalFrame() {
  if (view_ != nullptr) {
    return view_->naturalFrame();
  }
  CGRect rect = frame_;
  for (CALayer* above = superlayer_; above != nullptr; above = above->superlayer_) {
    if (above->view_ != nullptr) {
      return UIAccessibilityConvertFrameToScreenCoordinates(rect, above->view());
    }
    rect.origin.x += above->frame_.origin.x;
    rect.origin.y += above->frame_.origin.y;
  }
  return rect;
}

}  // namespace tavro
