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
#include "tests/support/Elements.h"

namespace tavro {

using Utterances = std::vector<std::string>;

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
  static Utterances heard(const id& root) {
    Utterances utterances;
    for (const HeardElement& element : readElements(root)) {
      if (!element.utterance.empty()) {
        utterances.push_back(element.utterance);
      }
    }
    return utterances;
  }

  /// The whole screen of a controller.
  Utterances heardOn(const Ref<UIViewController>& controller) {
    window->setRootViewController(controller);
    return heard(window);
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
