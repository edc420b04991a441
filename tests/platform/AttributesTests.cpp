#include <functional>
#include <tuple>

#include "platform/accessibility/Validation.h"
#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "tests/platform/RuntimeTesting.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

using testing::holds;
using testing::raisedBy;

std::string said(const id& object, Name attribute) {
  const id text = send<id>(object, attribute);
  return text ? utf8(text) : "(nil)";
}

/// A view with a natural answer to everything.
Ref<UIView> naturalView() {
  const auto view = makeView<UIView>();
  answers(view, "_naturalAccessibilityLabel", string("natural"));
  answers(view, "_naturalAccessibilityValue", string("natural"));
  answers<UIAccessibilityTraits>(view, "_naturalAccessibilityTraits",
                                 [] { return UIAccessibilityTraitButton; });
  answers<bool>(view, "_naturalIsAccessibilityElement", [] { return true; });
  answers(view, "_naturalAccessibilityElements", arrayWithObjects({string("natural")}));
  return view;
}

TEST(AttributesTests, TextsComeFromTheBlockThenWhatWasSetThenTheClass) {
  const struct {
    Name get, set, setBlock;
  } attributes[] = {
      {"accessibilityLabel", "setAccessibilityLabel:", "_setAccessibilityLabelBlock:"},
      {"accessibilityValue", "setAccessibilityValue:", "_setAccessibilityValueBlock:"},
  };
  for (const auto& [get, set, setBlock] : attributes) {
    const auto view = naturalView();
    EXPECT_EQ(said(view, get), "natural");
    send<void>(view, set, string("set"));
    EXPECT_EQ(said(view, get), "set");
    send<void>(view, setBlock, LabelBlock([] { return string("block"); }));
    EXPECT_EQ(said(view, get), "block");
    send<void>(view, setBlock, LabelBlock([] { return id(); }));
    EXPECT_EQ(said(view, get), "(nil)") << "a block's nil is an answer";
    send<void>(view, setBlock, LabelBlock());
    EXPECT_EQ(said(view, get), "set");
    send<void>(view, set, string(""));
    EXPECT_EQ(said(view, get), "") << "an empty text is a value";
    send<void>(view, set, nullptr);
    EXPECT_EQ(said(view, get), "natural");
    const id attributed = axAttributedString(string("1:02"));
    send<void>(view, set, attributed);
    EXPECT_EQ(send<id>(view, get), attributed);
  }
}

TEST(AttributesTests, OnlyALabelThatWasSetIsUserDefined) {
  const auto label = makeLabel("natural");
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "(nil)");
  send<void>(label, "_setAccessibilityLabelBlock:", LabelBlock([] { return string("block"); }));
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "(nil)");
  setLabel(label, "set");
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "set");
}

TEST(AttributesTests, ABlockMayReplaceOrRemoveItself) {
  const auto view = naturalView();
  const Weak<UIView> weak(view.get());
  send<void>(view,
             "_setAccessibilityLabelBlock:", LabelBlock([weak, text = string("block")]() -> id {
               send<void>(weak.strong(), "_setAccessibilityLabelBlock:", LabelBlock());
               return text;
             }));
  EXPECT_EQ(said(view, "accessibilityLabel"), "block");
  EXPECT_EQ(said(view, "accessibilityLabel"), "natural");
}

TEST(AttributesTests, FlagsTraitsAndElementsFollowTheSameOrder) {
  const auto view = naturalView();
  EXPECT_TRUE(isElement(view));
  send<void>(view, "setIsAccessibilityElement:", false);
  EXPECT_FALSE(isElement(view));
  send<void>(view, "_setIsAccessibilityElementBlock:", FlagBlock([] { return true; }));
  EXPECT_TRUE(isElement(view));

  EXPECT_EQ(traitsOf(view), UIAccessibilityTraitButton);
  send<void>(view, "_accessibilityAddTrait:", UIAccessibilityTraitSelected);
  EXPECT_EQ(traitsOf(view), UIAccessibilityTraitButton | UIAccessibilityTraitSelected);
  setTraits(view, UIAccessibilityTraitNone);
  EXPECT_EQ(traitsOf(view), 0U) << "no traits are a value";

  EXPECT_EQ(elementsOf(view)->count(), 1U);
  setElements(view, {});
  EXPECT_EQ(elementsOf(view)->count(), 0U);
  send<void>(view, "setAccessibilityElements:", nullptr);
  EXPECT_EQ(elementsOf(view)->count(), 1U);

  int activations = 0;
  answers<bool>(view, "_naturalAccessibilityActivate", [&] { return ++activations > 0; });
  EXPECT_TRUE(activate(view));
  send<void>(view, "_setAccessibilityActivateBlock:", FlagBlock([] { return false; }));
  EXPECT_FALSE(activate(view));
  EXPECT_EQ(activations, 1) << "the block's NO is final";
}

TEST(AttributesTests, WhatHasNoNaturalAnswerIsSilent) {
  const id objects[] = {string("text"),     axAttributedString(string("text")),
                        make<UIImage>(),    make<CALayer>(),
                        makeView<UIView>(), make<NSObject>()};
  for (const id& object : objects) {
    EXPECT_EQ(said(object, "accessibilityLabel"), "(nil)");
    EXPECT_EQ(said(object, "accessibilityValue"), "(nil)");
    EXPECT_EQ(said(object, "accessibilityHint"), "(nil)");
    EXPECT_FALSE(isElement(object));
    EXPECT_FALSE(activate(object));
    EXPECT_FALSE(send<id>(object, "accessibilityContainer"));
    EXPECT_EQ(send<std::int64_t>(object, "_accessibilityExpandedStatus"), 0);
    EXPECT_NO_THROW(send<void>(object, "accessibilityIncrement"));
  }
}

TEST(AttributesTests, ContainersAreHeldWeakly) {
  Ref<UIView> container = makeView<UIView>();
  const auto element = accessibilityElementWithContainer(container);
  const auto view = makeView<UIView>();
  const auto parent = makeView<UIView>();
  parent->addSubview(view);
  EXPECT_EQ(send<id>(view, "accessibilityContainer"), parent) << "naturally the superview";
  send<void>(view, "setAccessibilityContainer:", container);
  EXPECT_EQ(send<id>(view, "accessibilityContainer"), container);
  EXPECT_EQ(send<id>(element, "accessibilityContainer"), container);
  EXPECT_EQ(container->referenceCount(), 1U);
  container = nullptr;
  EXPECT_FALSE(send<id>(element, "accessibilityContainer"));
  EXPECT_EQ(send<id>(view, "accessibilityContainer"), parent);
}

TEST(AttributesTests, AncestorsAreFoundAlongContainers) {
  const auto table = makeView<UITableView>();
  const auto cell = makeView<UITableViewCell>();
  table->addSubview(cell);
  const auto element = accessibilityElementWithContainer(cell);
  const auto ancestor = [](const id& object, Class* isa) {
    return send<id>(object, "_accessibilityAncestorIsKindOf:", isa);
  };
  EXPECT_EQ(ancestor(element, classOf<UIScrollView>()), table);
  EXPECT_EQ(ancestor(element, classOf<UIView>()), cell);
  EXPECT_EQ(ancestor(cell, classOf<UIView>()), table) << "an object is no ancestor of itself";
  EXPECT_FALSE(ancestor(element, classOf<UIButton>()));
  EXPECT_FALSE(ancestor(element, nullptr));
  send<void>(table, "setAccessibilityContainer:", element);
  EXPECT_FALSE(ancestor(element, classOf<UIButton>())) << "a circle of containers ends";
}

TEST(FrameTests, FramesInContainerSpaceFollowTheirContainer) {
  const auto scroll = makeView<UIScrollView>({10, 20, 300, 400});
  const auto chart = makeView<UIView>({5, 6, 100, 50});
  scroll->addSubview(chart);
  const auto element = accessibilityElementWithContainer(chart);
  EXPECT_EQ(frameOf(element), CGRect());
  send<void>(element, "setAccessibilityFrameInContainerSpace:", CGRect(1, 2, 3, 4));
  EXPECT_EQ(frameOf(element), CGRect(16, 28, 3, 4));
  scroll->setContentOffset({0, 100});
  EXPECT_EQ(frameOf(element), CGRect(16, -72, 3, 4));
  EXPECT_EQ(frameOf(chart), CGRect(15, -74, 100, 50));
  EXPECT_EQ(frameOf(scroll), CGRect(10, 20, 300, 400)) << "scrolling moves what is inside";
  chart->setFrame({0, 0, 100, 50});
  EXPECT_EQ(frameOf(element), CGRect(11, -78, 3, 4));
  const auto nested = accessibilityElementWithContainer(element);
  send<void>(nested, "setAccessibilityFrameInContainerSpace:", CGRect(1, 2, 3, 4));
  EXPECT_EQ(frameOf(nested), CGRect(11, -78, 3, 4)) << "the nearest view is the space";
  send<void>(element, "setAccessibilityFrame:", CGRect(7, 7, 7, 7));
  EXPECT_EQ(frameOf(element), CGRect(7, 7, 7, 7)) << "what was set last counts";
  EXPECT_EQ(send<CGPoint>(element, "accessibilityActivationPoint"), (CGPoint{10.5, 10.5}));
  send<void>(element, "setAccessibilityActivationPoint:", CGPoint{1, 1});
  EXPECT_EQ(send<CGPoint>(element, "accessibilityActivationPoint"), (CGPoint{1, 1}));
}

TEST(FrameTests, LayersFollowTheirViewsAndSuperlayers) {
  const auto window = makeView<UIView>({0, 50, 400, 400});
  const auto row = makeView<UIView>({10, 20, 300, 40});
  window->addSubview(row);
  const auto cell = make<CALayer>();
  cell->setFrame({40, 0, 40, 40});
  const auto dot = make<CALayer>();
  dot->setFrame({1, 2, 3, 4});
  row->layer()->addSublayer(cell);
  cell->addSublayer(dot);
  EXPECT_EQ(frameOf(cell), CGRect(50, 70, 40, 40));
  EXPECT_EQ(frameOf(dot), CGRect(51, 72, 3, 4));
  EXPECT_EQ(frameOf(row->layer()), frameOf(row));
  row->setFrame({10, 120, 300, 40});
  EXPECT_EQ(frameOf(dot), CGRect(51, 172, 3, 4));
  for (const Ref<CALayer>& wrong : {dot, cell, row->layer(), Ref<CALayer>()}) {
    EXPECT_TRUE(holds(raisedBy([&] { dot->addSublayer(wrong); }), "a layer is added once"));
  }
}

TEST(VisibilityTests, HiddenOrTransparentAncestorsHideWhatIsBelow) {
  const auto view = makeView<UIView>();
  const auto middle = group({view});
  const auto top = group({middle});
  const auto isVisible = [&] { return send<bool>(view, "_accessibilityViewIsVisible"); };
  EXPECT_TRUE(isVisible()) << "no window is needed";
  const std::pair<const char*, std::function<void(UIView&, bool)>> ways[] = {
      {"hidden", [](UIView& each, bool hides) { each.setHidden(hides); }},
      {"transparent", [](UIView& each, bool hides) { each.setAlpha(hides ? 0 : 0.01); }},
  };
  for (const auto& [what, hide] : ways) {
    for (const auto& each : {top, middle, view}) {
      hide(*each, true);
      EXPECT_FALSE(isVisible()) << what;
      send<void>(view, "_accessibilitySetOverridesInvisibility:", true);
      EXPECT_TRUE(isVisible()) << what;
      send<void>(view, "_accessibilitySetOverridesInvisibility:", false);
      hide(*each, false);
      EXPECT_TRUE(isVisible()) << what;
    }
  }
  top->setHidden(true);
  send<void>(view, "_accessibilitySetViewIsVisible:", true);
  EXPECT_TRUE(isVisible());
  top->setHidden(false);
  send<void>(view, "_accessibilitySetViewIsVisible:", false);
  EXPECT_FALSE(isVisible());
}

/// A view that counts its load hooks.
Ref<UIView> loading(int& loads) {
  const auto view = makeView<UIView>();
  answers<void>(view, "_accessibilityLoadAccessibilityInformation", [&] { ++loads; });
  return view;
}

Ref<UIWindow> makeKeyWindow() {
  const auto window = makeView<UIWindow>({0, 0, 100, 100});
  window->makeKey();
  return window;
}

TEST(LoadHookTests, TheHookIsSentOnceWhenAnObjectAppears) {
  const auto window = makeKeyWindow();
  int loads = 0;
  const auto parent = loading(loads);
  const auto child = loading(loads);
  parent->addSubview(child);
  EXPECT_EQ(loads, 0) << "off screen";
  window->addSubview(parent);
  EXPECT_EQ(loads, 2);
  child->addSubview(loading(loads));
  EXPECT_EQ(loads, 3);
  window->addSubview(parent);  // to the front
  parent->removeFromSuperview();
  window->addSubview(parent);
  send<id>(parent, "accessibilityElements");
  send<bool>(parent, "isAccessibilityElement");
  EXPECT_EQ(loads, 3) << "once in a life on one screen";
  reloadAccessibilityInformation();
  EXPECT_EQ(loads, 6);
}

TEST(LoadHookTests, WhatAHookAddsIsLoadedAndOneThatRaisesKeepsNobodyFromTheirs) {
  const auto window = makeKeyWindow();
  int loads = 0;
  const auto raising = group({loading(loads)});
  const auto added = loading(loads);
  answers<void>(raising, "_accessibilityLoadAccessibilityInformation", [&] {
    raising->addSubview(added);
    throw 1;
  });
  window->addSubview(group({raising, loading(loads)}));
  EXPECT_EQ(loads, 3) << "the view in it, the added one and the one beside it";
}

TEST(LoadHookTests, AWindowThatBecomesKeyBringsItsContentOnScreen) {
  const auto window = makeView<UIWindow>({0, 0, 100, 100});
  int loads = 0;
  window->addSubview(loading(loads));
  EXPECT_EQ(loads, 0);
  window->makeKey();
  EXPECT_EQ(loads, 1);
}

TEST(LoadHookTests, AScreenIsLoadedEachTimeItIsShown) {
  const auto window = makeKeyWindow();
  const auto first = makeController<UIViewController>();
  const auto second = makeController<UIViewController>();
  int loads = 0;
  int viewLoads = 0;
  answers<void>(first, "_accessibilityLoadAccessibilityInformation", [&] { ++loads; });
  first->setView(loading(viewLoads));
  window->setRootViewController(first);
  EXPECT_EQ(std::pair(loads, viewLoads), std::pair(1, 1));
  window->setRootViewController(second);
  EXPECT_EQ(viewLoads, 1) << "what left the screen is not loaded";
  window->setRootViewController(first);
  EXPECT_EQ(std::pair(loads, viewLoads), std::pair(2, 2));
}

TEST(LoadHookTests, AnInstallationLoadsWhatIsOnScreenAgain) {
  const auto window = makeKeyWindow();
  int loads = 0;
  int loadsOffScreen = 0;
  window->addSubview(loading(loads));
  const auto offScreen = loading(loadsOffScreen);
  AXValidationManager::sharedInstance()->performValidations({}, {}, {}, {});
  EXPECT_EQ(loads, 2);
  EXPECT_EQ(loadsOffScreen, 0);
}

}  // namespace
}  // namespace tavro
