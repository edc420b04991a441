#pragma once

#include "platform/healthkit/HKActivitySummary.h"
#include "platform/uikit/UIView.h"

namespace tavro {

/// Draws a day's three rings, and says them: the library that draws them made them accessible.
/// Message: `summary`, `setSummary:`.
class ARUIRingsView : public UIView {
 public:
  static constexpr Name className = "ARUIRingsView";

  [[nodiscard]] Ref<HKActivitySummary> summary() const { return summary_; }
  void setSummary(const Ref<HKActivitySummary>& summary) { summary_ = summary; }

  bool naturalIsElement() { return true; }
  id naturalLabel();
  id naturalValue();
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitImage; }

 private:
  Ref<HKActivitySummary> summary_;
};

}  // namespace tavro
