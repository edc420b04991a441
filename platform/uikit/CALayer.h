#pragma once

#include "platform/foundation/Geometry.h"
#include "platform/foundation/NSArray.h"

namespace tavro {

class UIView;

/// Something drawn. A view's own layer follows the view; other layers lie below it as sublayers.
/// Messages: `frame`, `setFrame:`, `sublayers`, `addSublayer:`, `superlayer`.
class CALayer : public NSObject {
 public:
  static constexpr Name className = "CALayer";
  ~CALayer() override;

  /// In the superlayer's coordinates.
  [[nodiscard]] CGRect frame() const;
  void setFrame(CGRect frame) { frame_ = frame; }
  /// In drawing order; never nil.
  [[nodiscard]] Ref<NSArray> sublayers() const;
  void addSublayer(const Ref<CALayer>& layer);
  [[nodiscard]] Ref<CALayer> superlayer() const { return superlayer_; }
  /// The view whose layer this is, or nil.
  [[nodiscard]] Ref<UIView> view() const;
  void setView(UIView* view) { view_ = view; }

  /// Screen coordinates.
  CGRect naturalFrame();

 private:
  CGRect frame_;
  std::vector<Ref<CALayer>> sublayers_;
  CALayer* superlayer_ = nullptr;
  UIView* view_ = nullptr;
};

}  // namespace tavro
