#include <functional>

#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Labels.h"
#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIControls.h"
#include "tests/platform/RuntimeTesting.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

constexpr Name kToken = "JoinerTestToken";

id plain(const char* text) { return string(text); }
/// An attributed text whose token lies over [start, start + length).
id marked(std::u16string_view text, std::size_t start, std::size_t length) {
  const auto attributed = axAttributedString(string(text));
  attributed->setAttribute(kCFBooleanTrue(), kToken, {start, length});
  return attributed;
}
std::string heard(const id& text) { return text ? utf8(plainText(text)) : "(nil)"; }

/// The texts under the token, each in brackets.
std::string markedParts(const id& text) {
  std::string parts;
  if (const auto attributed = as<NSAttributedString>(text)) {
    const std::u16string_view whole = attributed->string()->text();
    for (const NSAttributedString::Run& run : attributed->runs()) {
      EXPECT_EQ(run.key, kToken);
      EXPECT_EQ(run.value, kCFBooleanTrue());
      parts += "[" + string(whole.substr(run.range.location, run.range.length))->utf8() + "]";
    }
  }
  return parts;
}

/// Answers nothing without raising.
Ref<UIView> grumpy() {
  auto view = makeView<UIView>();
  raises(view, "accessibilityLabel");
  answers<CGRect>(view, "accessibilityFrame", []() -> CGRect { throw 1; });
  return view;
}

TEST(JoinerTests, EveryJoinerKeepsWhatIsThereInItsOrder) {
  const struct {
    std::vector<id> parts;
    const char* joined;
  } cases[] = {
      {{}, "(nil)"},
      {{nullptr, nullptr}, "(nil)"},
      {{plain(""), nullptr, marked(u"", 0, 0)}, "(nil)"},
      {{plain("a")}, "a"},
      {{plain("a"), nullptr, plain("b")}, "a, b"},
      {{nullptr, plain(""), plain("a"), plain(""), nullptr, plain("b"), nullptr}, "a, b"},
      {{plain(" "), plain("b")}, " , b"},
      {{plain("a, b"), plain("c")}, "a, b, c"},
      {{marked(u"a", 0, 1), nullptr, plain("b")}, "a, b"},
      {{number(1.0), plain("a")}, "a"},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(heard(AXLabelForElements(arrayWithObjects(each.parts))), each.joined);
    EXPECT_EQ(heard(UIAXLabelForElements(arrayWithObjects(each.parts))), each.joined);
    const std::vector<id>& parts = each.parts;
    const auto at = [&](std::size_t index) { return index < parts.size() ? parts[index] : id(); };
    const id end = string(kVariablesSentinel);
    for (const auto joiner : {&__UIAXStringForVariables, &__AXStringForVariables}) {
      EXPECT_EQ(heard(joiner({at(0), at(1), at(2), at(3), at(4), at(5), at(6), end})), each.joined);
    }
  }
  EXPECT_EQ(AXLabelForElements(nullptr), id());
}

TEST(JoinerTests, TheSentinelEndsTheListAndNothingElseDoes) {
  const id sentinel = string(kVariablesSentinel);
  EXPECT_EQ(heard(__UIAXStringForVariables({plain("a"), sentinel, plain("b")})), "a");
  EXPECT_EQ(heard(__UIAXStringForVariables({sentinel})), "(nil)");
  EXPECT_EQ(heard(__UIAXStringForVariables({plain("a"), plain("b")})), "a, b");
}

TEST(JoinerTests, AttributesStayOverTheirParts) {
  const struct {
    std::vector<id> parts;
    const char* joined;
    const char* marks;
  } cases[] = {
      {{marked(u"65", 0, 2)}, "65", "[65]"},
      {{plain("Pace"), marked(u"390 per km", 0, 3), plain("end")},
       "Pace, 390 per km, end",
       "[390]"},
      {{marked(u"ab", 1, 1), nullptr, marked(u"cd", 0, 1)}, "ab, cd", "[b][c]"},
      {{plain("🏃🏽 é"), marked(u"👟 75", 3, 2)}, "🏃🏽 é, 👟 75", "[75]"},
      {{marked(u"🏃", 0, 2), plain("x"), marked(u"🚴", 0, 2)}, "🏃, x, 🚴", "[🏃][🚴]"},
      {{plain("a"), axAttributedString(string("b"))}, "a, b", ""},
      {{plain(""), marked(u"5", 0, 1)}, "5", "[5]"},
  };
  for (const auto& each : cases) {
    const id joined = AXLabelForElements(arrayWithObjects(each.parts));
    EXPECT_EQ(heard(joined), each.joined);
    EXPECT_EQ(markedParts(joined), each.marks) << each.joined;
    EXPECT_TRUE(as<AXAttributedString>(joined)) << each.joined;
  }
  EXPECT_TRUE(as<NSString>(AXLabelForElements(arrayWithObjects({plain("a"), plain("b")}))));
}

TEST(JoinerTests, ElementsSpeakTheirLabelsAndInvisibleViewsNothing) {
  const auto shown = makeLabel("shown");
  const auto kHiddenSoSilent = makeLabel("hidden");
  kHiddenSoSilent->setHidden(true);
  const auto kTransparentSoSilent = makeLabel("transparent");
  kTransparentSoSilent->setAlpha(0);
  const auto parent = makeView<UIView>();
  const auto kInsideHiddenSoSilent = makeLabel("inside hidden");
  parent->addSubview(kInsideHiddenSoSilent);
  parent->setHidden(true);
  const auto kOverriddenSoHeard = makeLabel("overridden");
  kOverriddenSoHeard->setHidden(true);
  send<void>(kOverriddenSoHeard, "_accessibilitySetOverridesInvisibility:", true);
  const auto kUnlabelled = makeView<UIView>();
  const auto element = accessibilityElementWithContainer(parent);
  send<void>(element, "setAccessibilityLabel:", marked(u"75", 0, 2));
  const id joined = AXLabelForElements(arrayWithObjects(
      {shown, grumpy(), kHiddenSoSilent, plain("text"), kTransparentSoSilent, kInsideHiddenSoSilent,
       kUnlabelled, kOverriddenSoHeard, element, id(classOf<UIView>())}));
  EXPECT_EQ(heard(joined), "shown, text, overridden, 75");
  EXPECT_EQ(markedParts(joined), "[75]");
}

TEST(JoinerTests, LabelKeysSpeakWhatIsUnderThem) {
  const auto card = makeView<UIView>();
  const auto title = makeLabel("Title");
  answers(card, "_title", title);
  answers(card, "_detail", makeLabel("Detail"));
  answers(card, "_text", string("text"));
  answers(card, "_none", nullptr);
  answers<std::int64_t>(card, "_count", [] { return 3; });
  const std::pair<const char*, const char*> cases[] = {
      {"_title, _detail", "Title, Detail"},
      {"detail, title", "Detail, Title"},
      {"_title, noSuchKey, _none, _detail", "Title, Detail"},
      {"_text, _title", "text, Title"},
      {"_count", "(nil)"},
      {"_title,_detail", "(nil)"},
      {"_title", "Title"},
      {"", "(nil)"},
      {", ", "(nil)"},
      {"_title, ", "Title"},
  };
  const auto labels = [&](const char* keys) {
    return heard(send<id>(card, "_accessibilityStringForLabelKeyValues:", string(keys)));
  };
  for (const auto& [keys, expected] : cases) {
    EXPECT_EQ(labels(keys), expected) << keys;
  }
  title->setHidden(true);
  EXPECT_EQ(labels("_title, _detail"), "Detail");
}

TEST(JoinerTests, FramesAreJoinedOnScreen) {
  const auto parent = makeView<UIView>({100, 200, 50, 50});
  const auto left = makeView<UIView>({0, 10, 5, 5});
  const auto right = makeView<UIView>({40, 0, 20, 5});
  parent->addSubview(left);
  parent->addSubview(right);
  const auto unionOf = [](std::vector<id> views) {
    return UIAXFrameForElements(arrayWithObjects(std::move(views)));
  };
  EXPECT_EQ(unionOf({left, right}), CGRect(100, 200, 60, 15));
  EXPECT_EQ(unionOf({right, left}), CGRect(100, 200, 60, 15));
  EXPECT_EQ(unionOf({right}), CGRect(140, 200, 20, 5));
  EXPECT_EQ(unionOf({grumpy(), right, grumpy()}), CGRect(140, 200, 20, 5))
      << "an object that raises does not stretch the frame to the corner of the screen";
  EXPECT_EQ(unionOf({}), CGRect());
  EXPECT_EQ(UIAXFrameForElements(nullptr), CGRect());
  const auto aggregate = make<UIAccessibilityAggregateElement>();
  send<id>(aggregate, "initWithAccessibilityContainer:representedElements:", parent,
           arrayWithObjects({left, right}));
  EXPECT_EQ(frameOf(aggregate), CGRect(100, 200, 60, 15));
  left->setFrame({0, 45, 5, 5});
  EXPECT_EQ(frameOf(aggregate), CGRect(100, 200, 60, 50));
}

/// Everything that the text of a subhierarchy tells apart, each at its own height.
class SubhierarchyTests : public ::testing::Test {
 protected:
  void SetUp() override {
    heading = add(makeLabel("heading"));
    send<void>(heading, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
    button = add(makeView<UIButton>());
    button->setTitle(string("button"));
    plainText = add(makeLabel("plain"));
    send<void>(plainText, "setIsAccessibilityElement:", false);
    hidden = add(makeLabel("hidden"));
    hidden->setHidden(true);
    group = add(makeView<UIView>());
    group->addSubview(makeLabel("inside"));
    root->addSubview(grumpy());
  }
  template <class View>
  Ref<View> add(const Ref<View>& view) {
    view->setFrame({0, top, 100, 10});
    top += 20;
    root->addSubview(view);
    return view;
  }
  std::string text(bool headers, bool focusable, const Ref<NSArray>& exclusions = nullptr) {
    return heard(send<id>(
        root, "_accessibilityTextForSubhierarchyIncludingHeaders:focusableItems:exclusions:",
        headers, focusable, exclusions));
  }

  double top = 0;
  Ref<UIView> root = makeView<UIView>({0, 0, 100, 200});
  Ref<UILabel> heading, plainText, hidden;
  Ref<UIButton> button;
  Ref<UIView> group;
};

TEST_F(SubhierarchyTests, TheFlagsChooseWhatIsIncluded) {
  EXPECT_EQ(text(true, true), "heading, button, plain, inside");
  EXPECT_EQ(text(true, false), "heading, plain");
  EXPECT_EQ(text(false, true), "button, plain, inside");
  EXPECT_EQ(text(false, false), "plain");
}

TEST_F(SubhierarchyTests, TheRootsOwnNatureAndPlaceDoNotMatter) {
  send<void>(root, "setIsAccessibilityElement:", true);
  setLabel(root, "root");
  send<void>(root, "_accessibilityAddTrait:", UIAccessibilityTraitHeader);
  EXPECT_EQ(text(false, true), "button, plain, inside");
}

TEST_F(SubhierarchyTests, ExclusionsAreLeftOutWithAllBelowThem) {
  EXPECT_EQ(text(true, true, arrayWithObjects({button, group})), "heading, plain");
  EXPECT_EQ(text(true, true, arrayWithObjects({root})), "heading, button, plain, inside");
}

TEST_F(SubhierarchyTests, AnElementIsALeafAndListsAreFollowed) {
  send<void>(group, "setIsAccessibilityElement:", true);
  setLabel(group, "group");
  EXPECT_EQ(text(false, true), "button, plain, group");
  setElements(root, {group, plainText});
  EXPECT_EQ(text(true, true), "group, plain");
  setElements(root, {});
  EXPECT_EQ(text(true, true), "(nil)");
}

TEST_F(SubhierarchyTests, AllChildrenSpeakTheirLabels) {
  EXPECT_EQ(heard(UIAXStringForAllChildren(root)), "heading, button, inside");
  EXPECT_EQ(UIAXStringForAllChildren(makeView<UIView>()), id());
  EXPECT_EQ(UIAXStringForAllChildren(nullptr), id());
}

}  // namespace
}  // namespace tavro
