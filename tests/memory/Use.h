#pragma once

#include <string_view>

#include "platform/foundation/Settings.h"
#include "platform/runtime/Dispatch.h"
#include "reader/Cursor.h"
#include "reader/Output.h"
#include "reader/Session.h"
#include "tests/memory/LiveMemory.h"

namespace tavro {

inline SessionOptions memoryOptions(bool withPlugin = true) {
  SessionOptions options;
  options.diary = std::string(TAVRO_SOURCE) + "/host/data/diary.json";
  options.bundle = std::string(TAVRO_BUILD) + "/AXTavro.axbundle";
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  options.withPlugin = withPlugin;
  return options;
}

/// Shows a screen, hears it all, makes every gesture at every element, and takes the screen away.
inline void useScreen(Session& session, std::string_view screen) {
  session.show(screen);
  UIWindow& window = session.application().window();
  {
    Cursor cursor{Ref<UIView>(&window)};
    static_cast<void>(treeJson(screen, readElements(id(&window))));
    for (bool more = cursor.move(Move::first); more; more = cursor.move(Move::next)) {
      const std::size_t place = cursor.index();
      const CGPoint point = cursor.current()->activationPoint;
      cursor.increment();
      cursor.decrement();
      cursor.activate();
      cursor.touch(point);
      while (cursor.index() < place && cursor.move(Move::next)) {
      }
    }
    cursor.move(Move::nextHeading);
    cursor.move(Move::previousHeading);
  }
  window.setRootViewController(nullptr);
  GlobalQueue::shared().drain();
}

}  // namespace tavro
