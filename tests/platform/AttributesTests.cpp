#include <functional>

#include "platform/accessibility/Validation.h"
#include "platform/foundation/NSAttributedString.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

using testing::holds;
using testing::raisedBy;

std::string said(const id& object, Name attribute) {
  const id text = send<id>(object, attribute);
  return text ? utf8(text) : "(nil)";
}

/// Has a natural answer to everything.
class Natural : public UIView {
 public:
  static constexpr Name className = "AttributesTestNatural";
  int activations = 0;

  id naturalLabel() { return string("natural"); }
  UIAccessibilityTraits naturalTraits() { return UIAccessibilityTraitButton; }
  bool naturalIsElement() { return true; }
  id naturalElements() { return arrayWithObjects({string("natural")}); }
  bool naturalActivate() { return ++activations > 0; }
};
const Registered naturalClass =
    defineClass<Natural, UIView>()
        .method<&Natural::naturalLabel>("_naturalAccessibilityLabel")
        .method<&Natural::naturalLabel>("_naturalAccessibilityValue")
        .method<&Natural::naturalTraits>("_naturalAccessibilityTraits")
        .method<&Natural::naturalIsElement>("_naturalIsAccessibilityElement")
        .method<&Natural::naturalElements>("_naturalAccessibilityElements")
        .method<&Natural::naturalActivate>("_naturalAccessibilityActivate");

TEST(AttributesTests, TextsComeFromTheBlockThenWhatWasSetThenTheClass) {
  const struct {
    Name get;
    Name set;
    Name setBlock;
  } attributes[] = {
      {"accessibilityLabel", "setAccessibilityLabel:", "_setAccessibilityLabelBlock:"},
      {"accessibilityValue", "setAccessibilityValue:", "_setAccessibilityValueBlock:"},
  };
  for (const auto& each : attributes) {
    const auto view = makeView<Natural>();
    EXPECT_EQ(said(view, each.get), "natural");
    send<void>(view, each.set, string("set"));
    EXPECT_EQ(said(view, each.get), "set");
    send<void>(view, each.setBlock, LabelBlock([] { return string("block"); }));
    EXPECT_EQ(said(view, each.get), "block");
    send<void>(view, each.setBlock, LabelBlock([] { return id(); }));
    EXPECT_EQ(said(view, each.get), "(nil)") << "a block's nil is an answer";
    send<void>(view, each.setBlock, LabelBlock());
    EXPECT_EQ(said(view, each.get), "set");
    send<void>(view, each.set, string(""));
    EXPECT_EQ(said(view, each.get), "") << "an empty text is a value";
    send<void>(view, each.set, nullptr);
    EXPECT_EQ(said(view, each.get), "natural");
    const id attributed = axAttributedString(string("1:02"));
    send<void>(view, each.set, attributed);
    EXPECT_EQ(send<id>(view, each.get), attributed);
  }
}

TEST(AttributesTests, OnlyALabelThatWasSetIsUserDefined) {
  const auto label = makeLabel("natural");
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "(nil)");
  send<void>(label, "_setAccessibilityLabelBlock:", LabelBlock([] { return string("block"); }));
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "(nil)");
  send<void>(label, "setAccessibilityLabel:", string("set"));
  EXPECT_EQ(said(label, "accessibilityUserDefinedLabel"), "set");
}

TEST(AttributesTests, ABlockMayReplaceOrRemoveItself) {
  const auto view = makeView<Natural>();
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
  const auto view = makeView<Natural>();
  EXPECT_TRUE(send<bool>(view, "isAccessibilityElement"));
  send<void>(view, "setIsAccessibilityElement:", false);
  EXPECT_FALSE(send<bool>(view, "isAccessibilityElement"));
  send<void>(view, "_setIsAccessibilityElementBlock:", FlagBlock([] { return true; }));
  EXPECT_TRUE(send<bool>(view, "isAccessibilityElement"));

  EXPECT_EQ(send<UIAccessibilityTraits>(view, "accessibilityTraits"), UIAccessibilityTraitButton);
  send<void>(view, "_accessibilityAddTrait:", UIAccessibilityTraitSelected);
  EXPECT_EQ(send<UIAccessibilityTraits>(view, "accessibilityTraits"),
            UIAccessibilityTraitButton | UIAccessibilityTraitSelected);
  send<void>(view, "setAccessibilityTraits:", UIAccessibilityTraitNone);
  EXPECT_EQ(send<UIAccessibilityTraits>(view, "accessibilityTraits"), 0U)
      << "no traits are a value";

  EXPECT_EQ(as<NSArray>(send<id>(view, "accessibilityElements"))->count(), 1U);
  send<void>(view, "setAccessibilityElements:", arrayWithObjects({}));
  EXPECT_EQ(as<NSArray>(send<id>(view, "accessibilityElements"))->count(), 0U);
  send<void>(view, "setAccessibilityElements:", nullptr);
  EXPECT_EQ(as<NSArray>(send<id>(view, "accessibilityElements"))->count(), 1U);

  EXPECT_TRUE(send<bool>(view, "accessibilityActivate"));
  send<void>(view, "_setAccessibilityActivateBlock:", FlagBlock([] { return false; }));
  EXPECT_FALSE(send<bool>(view, "accessibilityActivate"));
  EXPECT_EQ(view->activations, 1) << "the block's NO is final";
}

TEST(AttributesTests, WhatHasNoNaturalAnswerIsSilent) {
  const id objects[] = {string("text"),     axAttributedString(string("text")),
                        make<UIImage>(),    make<CALayer>(),
                        makeView<UIView>(), make<NSObject>()};
  for (const id& object : objects) {
    EXPECT_EQ(said(object, "accessibilityLabel"), "(nil)");
    EXPECT_EQ(said(object, "accessibilityValue"), "(nil)");
    EXPECT_EQ(said(object, "accessibilityHint"), "(nil)");
    EXPECT_FALSE(send<bool>(object, "isAccessibilityElement"));
    EXPECT_FALSE(send<bool>(object, "accessibilityActivate"));
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

CGRect frameOf(const id& object) { return send<CGRect>(object, "accessibilityFrame"); }

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
  const auto top = makeView<UIView>();
  const auto middle = makeView<UIView>();
  const auto view = makeView<UIView>();
  top->addSubview(middle);
  middle->addSubview(view);
  const auto isVisible = [&] { return send<bool>(view, "_accessibilityViewIsVisible"); };
  EXPECT_TRUE(isVisible()) << "no window is needed";
  const struct {
    const char* what;
    std::function<void(UIView&, bool)> hide;
  } ways[] = {
      {"hidden", [](UIView& each, bool hides) { each.setHidden(hides); }},
      {"transparent", [](UIView& each, bool hides) { each.setAlpha(hides ? 0 : 0.01); }},
  };
  for (const auto& way : ways) {
    for (const auto& each : {top, middle, view}) {
      way.hide(*each, true);
      EXPECT_FALSE(isVisible()) << way.what;
      send<void>(view, "_accessibilitySetOverridesInvisibility:", true);
      EXPECT_TRUE(isVisible()) << way.what;
      send<void>(view, "_accessibilitySetOverridesInvisibility:", false);
      way.hide(*each, false);
      EXPECT_TRUE(isVisible()) << way.what;
    }
  }
  top->setHidden(true);
  send<void>(view, "_accessibilitySetViewIsVisible:", true);
  EXPECT_TRUE(isVisible());
  top->setHidden(false);
  send<void>(view, "_accessibilitySetViewIsVisible:", false);
  EXPECT_FALSE(isVisible());
}

/// Counts its load hooks, and raises when it is told to.
class Loading : public UIView {
 public:
  static constexpr Name className = "AttributesTestLoading";
  int loads = 0;
  bool raises = false;
  Ref<UIView> added;  // by its hook

  void load() {
    ++loads;
    if (added && loads == 1) {
      addSubview(added);
    }
    if (raises) {
      throw 1;
    }
  }
};
const Registered loadingClass = defineClass<Loading, UIView>().method<&Loading::load>(
    "_accessibilityLoadAccessibilityInformation");

class LoadingController : public UIViewController {
 public:
  static constexpr Name className = "AttributesTestLoadingController";
  int loads = 0;
  void load() { ++loads; }
};
const Registered loadingControllerClass =
    defineClass<LoadingController, UIViewController>().method<&LoadingController::load>(
        "_accessibilityLoadAccessibilityInformation");

class LoadHookTests : public ::testing::Test {
 protected:
  static Ref<UIWindow> makeKeyWindow() {
    const auto window = makeView<UIWindow>({0, 0, 100, 100});
    window->makeKey();
    return window;
  }
};

TEST_F(LoadHookTests, TheHookIsSentOnceWhenAnObjectAppears) {
  const auto window = makeKeyWindow();
  const auto parent = makeView<Loading>();
  const auto child = makeView<Loading>();
  parent->addSubview(child);
  EXPECT_EQ(child->loads, 0) << "off screen";
  window->addSubview(parent);
  const auto late = makeView<Loading>();
  child->addSubview(late);
  EXPECT_EQ(parent->loads, 1);
  EXPECT_EQ(child->loads, 1);
  EXPECT_EQ(late->loads, 1);
  window->addSubview(parent);  // to the front
  parent->removeFromSuperview();
  window->addSubview(parent);
  send<id>(parent, "accessibilityElements");
  send<bool>(parent, "isAccessibilityElement");
  EXPECT_EQ(parent->loads + child->loads + late->loads, 3) << "once in a life on one screen";
  reloadAccessibilityInformation();
  EXPECT_EQ(parent->loads + child->loads + late->loads, 6);
}

TEST_F(LoadHookTests, AViewThatAHookAddsIsLoadedOnceToo) {
  const auto window = makeKeyWindow();
  const auto parent = makeView<Loading>();
  const auto added = makeView<Loading>();
  parent->added = added;
  window->addSubview(parent);
  EXPECT_EQ(added->loads, 1);
}

TEST_F(LoadHookTests, AHookThatRaisesKeepsNobodyFromTheirs) {
  const auto window = makeKeyWindow();
  const auto raising = makeView<Loading>();
  raising->raises = true;
  const auto child = makeView<Loading>();
  const auto sibling = makeView<Loading>();
  const auto all = makeView<UIView>();
  raising->addSubview(child);
  all->addSubview(raising);
  all->addSubview(sibling);
  window->addSubview(all);
  EXPECT_EQ(raising->loads, 1);
  EXPECT_EQ(child->loads, 1);
  EXPECT_EQ(sibling->loads, 1);
}

TEST_F(LoadHookTests, AWindowThatBecomesKeyBringsItsContentOnScreen) {
  const auto window = makeView<UIWindow>({0, 0, 100, 100});
  const auto view = makeView<Loading>();
  window->addSubview(view);
  EXPECT_EQ(view->loads, 0);
  window->makeKey();
  EXPECT_EQ(view->loads, 1);
}

TEST_F(LoadHookTests, AScreenIsLoadedEachTimeItIsShown) {
  const auto window = makeKeyWindow();
  const auto first = makeController<LoadingController>();
  const auto view = makeView<Loading>();
  first->setView(view);
  const auto second = makeController<LoadingController>();
  window->setRootViewController(first);
  EXPECT_EQ(first->loads, 1);
  EXPECT_EQ(view->loads, 1);
  window->setRootViewController(second);
  EXPECT_EQ(second->loads, 1);
  EXPECT_EQ(view->loads, 1) << "what left the screen is not loaded";
  window->setRootViewController(first);
  EXPECT_EQ(first->loads, 2);
  EXPECT_EQ(view->loads, 2);
}

TEST_F(LoadHookTests, AnInstallationLoadsWhatIsOnScreenAgain) {
  const auto window = makeKeyWindow();
  const auto view = makeView<Loading>();
  window->addSubview(view);
  const auto offScreen = makeView<Loading>();
  AXValidationManager::sharedInstance()->performValidations({}, {}, {}, {});
  EXPECT_EQ(view->loads, 2);
  EXPECT_EQ(offScreen->loads, 0);
}

}  // namespace
}  // namespace tavro
