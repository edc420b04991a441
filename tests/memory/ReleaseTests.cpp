#include <gtest/gtest.h>

#include "tests/memory/Use.h"

namespace tavro {
namespace {

/// A screen, heard through the plug-in or as the application is on its own.
using Case = std::tuple<std::string_view, bool>;

class ReleasedScreen : public testing::TestWithParam<Case> {};

// Views, elements, what is kept on them: all came from `operator new`. Whatever a screen leaves
// once is what the process keeps (classes, formatters, texts); what it leaves each time is a leak.
TEST_P(ReleasedScreen, LeavesNothing) {
  const auto& [screen, withPlugin] = GetParam();
  Session session(memoryOptions(withPlugin));
  useScreen(session, screen);
  useScreen(session, screen);
  const LiveMemory before = LiveMemory::now();
  useScreen(session, screen);
  const LiveMemory after = LiveMemory::now();
  EXPECT_EQ(after.blocks, before.blocks);
}

INSTANTIATE_TEST_SUITE_P(Screens, ReleasedScreen,
                         testing::Combine(testing::ValuesIn(Application::screenNames()),
                                          testing::Bool()),
                         [](const auto& info) {
                           std::string name(std::get<0>(info.param));
                           std::erase(name, '-');
                           return name + (std::get<1>(info.param) ? "" : "Alone");
                         });

// The controller, its views and what they keep are gone with the screen, not only uncounted.
TEST(ReleasedScreens, TheirObjectsAreGone) {
  Session session(memoryOptions());
  UIWindow& window = session.application().window();
  for (const std::string_view screen : Application::screenNames()) {
    std::vector<Weak<>> objects;
    for (const HeardElement& heard : session.read(screen)) {
      objects.emplace_back(heard.element.get());
      for (const id& container : heard.containers) {
        objects.emplace_back(container.get());
      }
    }
    objects.emplace_back(window.rootViewController().get());
    EXPECT_FALSE(objects.size() < 2 && screen != "loading") << screen;
    window.setRootViewController(nullptr);
    for (const Weak<>& object : objects) {
      EXPECT_EQ(object.get(), nullptr)
          << screen << " keeps a " << object.get()->isa()->name().text();
    }
  }
}

// An element is held by its container and never the other way round.
TEST(ReleasedScreens, AContainerGoesThoughItsElementsStay) {
  const auto container = makeView<UIView>();
  const auto drawn = accessibilityElementWithContainer(container);
  const auto aggregate = make<UIAccessibilityAggregateElement>();
  aggregate->initWithContainerAndElements(container, arrayWithObjects({id(drawn)}));
  const auto plain = makeView<UIView>();
  send<void>(plain, "setAccessibilityContainer:", id(container));
  EXPECT_EQ(container->referenceCount(), 1U);
  send<void>(container,
             "setAccessibilityElements:", arrayWithObjects({id(drawn), id(aggregate), id(plain)}));
  EXPECT_EQ(container->referenceCount(), 1U);
}

}  // namespace
}  // namespace tavro
