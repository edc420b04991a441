#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "platform/accessibility/BundleLoader.h"
#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UIViewController.h"
#include "reader/Model.h"

namespace tavro {

inline std::string bundlePath() { return std::string(TAVRO_BUILD) + "/AXTavro.axbundle"; }

/// Opens the built bundle as the reader does, in a process whose settings stand still.
class PluginTest : public testing::Test {
 protected:
  void SetUp() override {
    setReaderResources(std::string(TAVRO_SOURCE) + "/reader/resources");
    Settings& settings = Settings::current();
    settings.timeZone = "UTC";
    settings.screenReaderRuns = true;
    settings.now = secondsFromIso("2026-03-11T15:20").value();
    bundle = loadAccessibilityBundle(bundlePath());
    window = makeView<UIWindow>({0, 0, 390, 844});
    window->makeKey();
  }

  /// Puts a view on screen, where it is laid out and the load hook reaches it.
  void show(const Ref<UIView>& view) { window->addSubview(view); }

  /// Everything that is said at and below an object, silent elements left out.
  static std::vector<std::string> heard(const id& root) {
    std::vector<std::string> utterances;
    for (const HeardElement& element : readElements(root)) {
      if (!element.utterance.empty()) {
        utterances.push_back(element.utterance);
      }
    }
    return utterances;
  }

  static Ref<NSArray> elementsOf(const id& container) {
    return as<NSArray>(send<id>(container, "accessibilityElements"));
  }
  static std::string labelOf(const id& object) {
    return spokenText(send<id>(object, "accessibilityLabel"));
  }
  static std::string valueOf(const id& object) {
    return spokenText(send<id>(object, "accessibilityValue"));
  }

  LoadedBundle bundle;
  Ref<UIWindow> window;
};

}  // namespace tavro
