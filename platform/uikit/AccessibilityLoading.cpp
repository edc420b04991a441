#include "platform/uikit/UIViewController.h"

namespace tavro {
namespace {

void load(NSObject& object, bool again) {
  bool& loaded = accessibilityAttributes(object).informationLoaded;
  if (loaded && !again) {
    return;
  }
  loaded = true;
  trySend<void>(&object, "_accessibilityLoadAccessibilityInformation");
}

void loadTree(UIView& view, bool again) {
  if (UIViewController* const controller = view.controller()) {
    load(*controller, again);
  }
  load(view, again);
  const std::vector<Ref<UIView>> children = view.subviewList();
  for (const Ref<UIView>& child : children) {
    loadTree(*child, again);
  }
}

}  // namespace

void loadAccessibilityInformation(UIView& view) { loadTree(view, false); }

void forgetAccessibilityInformation(UIView& view) {
  if (UIViewController* const controller = view.controller()) {
    accessibilityAttributes(*controller).informationLoaded = false;
  }
  accessibilityAttributes(view).informationLoaded = false;
  for (const Ref<UIView>& child : view.subviewList()) {
    forgetAccessibilityInformation(*child);
  }
}

void reloadAccessibilityInformation() {
  if (UIWindow* const window = UIWindow::keyWindow()) {
    loadTree(*window, true);
  }
}

}  // namespace tavro
