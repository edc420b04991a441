#include <algorithm>
#include <cmath>
#include <limits>
#include <random>

#include "platform/accessibility/Labels.h"
#include "platform/accessibility/Traversal.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "tests/platform/RuntimeTesting.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

using Heard = std::vector<std::string>;

Heard labelsOf(const std::vector<id>& elements) {
  Heard labels;
  for (const id& element : elements) {
    labels.push_back(utf8(plainText(accessibilityLabelOf(element))));
  }
  return labels;
}

Heard heard(const id& root) {
  Heard labels;
  for (const AccessibleElement& found : accessibleElements(root)) {
    labels.push_back(utf8(plainText(accessibilityLabelOf(found.element))));
  }
  return labels;
}

template <class View>
Ref<View> hidden(const Ref<View>& view) {
  view->setHidden(true);
  return view;
}
template <class View>
Ref<View> transparent(const Ref<View>& view) {
  view->setAlpha(0);
  return view;
}
template <class View>
Ref<View> modal(const Ref<View>& view) {
  send<void>(view, "setAccessibilityViewIsModal:", true);
  return view;
}
template <class View>
Ref<View> withHiddenElements(const Ref<View>& view) {
  send<void>(view, "setAccessibilityElementsHidden:", true);
  return view;
}
template <class View>
Ref<View> listing(const Ref<View>& view, std::vector<id> elements) {
  send<void>(view, "setAccessibilityElements:", arrayWithObjects(std::move(elements)));
  return view;
}

/// A label that raises at one question.
template <class R>
Ref<UILabel> raising(const char* text, Name question) {
  const auto label = makeLabel(text, {0, 0, 10, 10});
  answers<R>(label, question, []() -> R { throw 1; });
  return label;
}

TEST(TraversalTests, OneTreeOfEverythingThatSilences) {
  const auto root = group({
      makeLabel("kFirst", {0, 0, 50, 10}),
      hidden(makeLabel("kHiddenSoSilent", {0, 10, 50, 10})),
      transparent(group({makeLabel("kInTransparentSoSilent")}, {0, 20, 50, 10})),
      withHiddenElements(group({makeLabel("kElementsHiddenSoSilent")}, {0, 30, 50, 10})),
      group({makeLabel("kNested", {0, 0, 50, 10})}, {0, 40, 50, 10}),
      makeView<UIImageView>({0, 50, 50, 10}),
      listing(group({makeLabel("kNotListedSoSilent")}, {0, 60, 50, 10}), {}),
      group(
          {hidden(modal(makeLabel("kHiddenModalSilencesNobody"))), makeLabel("kBesideHiddenModal")},
          {0, 70, 50, 10}),
      group({modal(makeLabel("kModal")), makeLabel("kBesideModalSoSilent")}, {0, 80, 50, 10}),
      makeLabel("kLast", {0, 90, 50, 10}),
  });
  EXPECT_EQ(heard(root), (Heard{"kFirst", "kNested", "kBesideHiddenModal", "kModal", "kLast"}));
  EXPECT_EQ(labelsOf(accessibleDescendants(root)), heard(root));
  root->setHidden(true);
  EXPECT_EQ(heard(root), Heard());
  EXPECT_EQ(accessibleDescendants(nullptr).size() + accessibleElements(nullptr).size(), 0U);
}

TEST(TraversalTests, OfTwoModalViewsTheFrontmostIsHeard) {
  // The dialog behind lies further down the screen than the one in front of it.
  const auto behind = modal(makeLabel("behind", {0, 90, 50, 10}));
  const auto front = modal(makeLabel("front", {0, 0, 50, 10}));
  const auto root = group({behind, makeLabel("page"), front});
  EXPECT_EQ(heard(root), Heard{"front"});
  front->setHidden(true);
  EXPECT_EQ(heard(root), Heard{"behind"});
}

TEST(TraversalTests, ListsAreHeardInTheirOrderAndElementsAreLeaves) {
  const auto low = makeLabel("low", {0, 90, 10, 10});
  const auto high = makeLabel("high", {0, 0, 10, 10});
  const auto drawn = accessibilityElementWithContainer(low);
  setLabel(drawn, "drawn");
  const auto root = group({high, low, makeLabel("not listed")});
  listing(root, {low, drawn, high, low, string("a text is no element")});
  EXPECT_EQ(heard(root), (Heard{"low", "drawn", "high"})) << "the second time is none";
  const std::vector<AccessibleElement> elements = accessibleElements(group({root}));
  ASSERT_FALSE(elements.empty());
  EXPECT_EQ(elements[0].containers, std::vector<id>{root})
      << "only objects with a list of their own";
  send<void>(root, "setIsAccessibilityElement:", true);
  setLabel(root, "leaf");
  EXPECT_EQ(heard(root), Heard{"leaf"});
  EXPECT_EQ(labelsOf(accessibleDescendants(root)).size(), 3U) << "whatever the root itself is";
}

TEST(TraversalTests, CirclesEnd) {
  const auto first = group({makeLabel("unlisted")});
  const auto second = group({makeLabel("unlisted")});
  const auto label = makeLabel("once");
  listing(first, {first, second, label});
  listing(second, {first, second, label});
  EXPECT_EQ(heard(first), Heard{"once"}) << "at its first place only";
  listing(first, {});
  listing(second, {});
}

TEST(TraversalTests, NestingDoesNotMultiply) {
  // Each level names the next one twice; cells ask what is inside before they answer.
  constexpr int kLevels = 60;
  const auto leaf = makeLabel("leaf");
  id lists = leaf;
  id cells = group({makeView<UIButton>(), makeLabel("beside")});
  id aggregates = leaf;
  for (int level = 0; level < kLevels; ++level) {
    lists = listing(group({}), {lists, lists});
    const auto cell = makeView<UITableViewCell>();
    cell->addSubview(as<UIView>(cells));
    cells = cell;
    const auto aggregate = make<UIAccessibilityAggregateElement>();
    aggregate->representedElements = arrayWithObjects({aggregates, aggregates});
    aggregates = aggregate;
  }
  EXPECT_EQ(heard(lists), Heard{"leaf"});
  EXPECT_EQ(heard(cells), (Heard{"", "beside"}));
  EXPECT_EQ(utf8(textForSubhierarchy(lists, true, true, nullptr)), "leaf");
  EXPECT_EQ(trySend<CGRect>(aggregates, "accessibilityFrame"),
            trySend<CGRect>(leaf, "accessibilityFrame"));
}

TEST(TraversalTests, WhatIsMadeForTheAskingIsHeardWhereverItsAddressWas) {
  // Each of the views lists a fresh group, which is gone once it was walked.
  const auto root = group({});
  for (int view = 0; view < 8; ++view) {
    const auto asked = group({}, {0, 10.0 * view, 10, 10});
    const auto label = makeLabel("heard");
    answers<id>(asked, "accessibilityElements", [label, isEmpty = view % 2 == 0] {
      const auto fresh = isEmpty ? group({}) : group({label});
      return id(arrayWithObjects({fresh}));
    });
    root->addSubview(asked);
  }
  EXPECT_EQ(heard(root), (Heard{"heard", "heard", "heard", "heard"}));
}

TEST(TraversalTests, WhatHoldsItselfAnswers) {
  const auto cell = makeView<UITableViewCell>();
  const auto inside = listing(group({}), {cell});
  cell->addSubview(inside);
  EXPECT_FALSE(send<bool>(cell, "isAccessibilityElement"));
  const auto aggregate = make<UIAccessibilityAggregateElement>();
  const auto label = makeLabel("beside", {1, 2, 3, 4});
  aggregate->representedElements = arrayWithObjects({id(aggregate), id(label)});
  EXPECT_EQ(send<CGRect>(aggregate, "accessibilityFrame"), CGRect(1, 2, 3, 4));
  aggregate->representedElements = nullptr;
  listing(inside, {});
}

TEST(TraversalTests, DeepTreesAreHeardToTheBottom) {
  const auto root = group({});
  Ref<UIView> deepest = root;
  for (int depth = 0; depth < 150; ++depth) {
    const auto next = group({});
    deepest->addSubview(next);
    deepest = next;
  }
  deepest->addSubview(makeLabel("bottom"));
  EXPECT_EQ(heard(root), Heard{"bottom"});
}

TEST(TraversalTests, ObjectsThatRaiseAreSilentAndTheOthersSpeak) {
  const auto root = group({makeLabel("before", {0, 0, 10, 10}),
                           raising<bool>("kRaisesSoSilent", "isAccessibilityElement"),
                           raising<id>("kElementSoNeverAskedForItsList", "accessibilityElements"),
                           raising<CGRect>("kWithoutFrameSoFirst", "accessibilityFrame"),
                           raising<bool>("kRaisesSoSilent", "_accessibilityViewIsVisible"),
                           raising<bool>("kHeard", "accessibilityElementsHidden"),
                           raising<bool>("kHeard", "accessibilityViewIsModal"),
                           makeLabel("after", {0, 90, 10, 10})});
  const Heard all = heard(root);
  ASSERT_EQ(all.size(), 6U);
  EXPECT_EQ(std::ranges::count(all, "kRaisesSoSilent"), 0);
  EXPECT_EQ(all.back(), "after");
  listing(root, {raising<bool>("silent", "isAccessibilityElement"), classOf<UIView>(),
                 makeLabel("heard")});
  EXPECT_EQ(heard(root), Heard{"heard"});
}

TEST(TraversalTests, CellsOfLabelsAndPicturesAreOneElement) {
  const auto cell = makeView<UITableViewCell>({0, 0, 300, 44});
  EXPECT_EQ(heard(cell), Heard()) << "an empty cell says nothing";
  cell->setDetailTextLabel(makeLabel("detail", {0, 20, 300, 20}));
  cell->setTextLabel(makeLabel("title", {0, 0, 300, 20}));
  cell->setImageView(makeView<UIImageView>());
  EXPECT_EQ(heard(cell), Heard{"title, detail"});
  const auto button = makeView<UIButton>({280, 0, 20, 44});
  button->setTitle(string("more"));
  cell->addSubview(button);
  EXPECT_EQ(heard(cell), (Heard{"title", "detail", "more"})) << "read apart beside a button";
  button->setHidden(true);
  EXPECT_EQ(heard(cell), Heard{"title, detail"});
  const auto empty = makeView<UICollectionViewCell>();
  cell->addSubview(empty);
  EXPECT_EQ(heard(cell), Heard{"title, detail"}) << "an empty cell makes no difference";
  listing(cell, {cell->textLabel()});
  EXPECT_EQ(heard(cell), Heard{"title"}) << "a list of its own";
  const auto collectionCell = makeView<UICollectionViewCell>();
  collectionCell->addSubview(makeLabel("badge"));
  EXPECT_EQ(heard(collectionCell), Heard{"badge"});
}

TEST(TraversalTests, SubviewsAreFoundInTreeOrder) {
  const auto inner = makeLabel("inner");
  const auto root = group({group({inner}), makeLabel("outer")});
  const ViewTest isLabel = [](const id& view) { return bool(as<UILabel>(view)); };
  EXPECT_EQ(send<id>(root, "_accessibilityFindSubviewDescendant:", isLabel), inner);
  EXPECT_FALSE(send<id>(inner, "_accessibilityFindSubviewDescendant:", isLabel))
      << "a view is no descendant of itself";
  for (const Name selector : {Name("_accessibilityFindSubviewDescendantsPassingTest:"),
                              Name("_accessibilityFindUnsortedDescendantsPassingTest:")}) {
    const auto found = as<NSArray>(send<id>(root, selector, isLabel));
    ASSERT_EQ(found->count(), 2U);
    EXPECT_EQ((*found)[0], inner);
  }
}

// Reading order.

constexpr double kInfinity = std::numeric_limits<double>::infinity();
const double kNaN = std::nan("");

TEST(GeometryTests, RowsThenTheReadingDirection) {
  const struct {
    const char* what;
    CGRect left;
    CGRect right;
    int order;  // left to right
    int rightToLeftOrder;
  } cases[] = {
      {"one row", {0, 0, 10, 10}, {20, 0, 10, 10}, -1, 1},
      {"two rows", {20, 0, 10, 10}, {0, 10, 10, 10}, -1, -1},
      {"half of the smaller height is a row", {20, 0, 10, 10}, {0, 5, 10, 10}, 1, -1},
      {"less than half is none", {20, 0, 10, 10}, {0, 5.1, 10, 10}, -1, -1},
      {"a small one beside a tall one", {20, 0, 10, 100}, {0, 90, 10, 10}, 1, -1},
      {"a small one that half sticks out", {20, 0, 10, 100}, {0, 95, 10, 10}, 1, -1},
      {"a line on the upper edge", {20, 10, 10, 0}, {0, 10, 10, 10}, 1, -1},
      {"a line on the lower edge", {20, 20, 10, 0}, {0, 10, 10, 10}, 1, -1},
      {"a line below", {20, 20.1, 10, 0}, {0, 10, 10, 10}, 1, 1},
      {"two lines at one height", {20, 5, 10, 0}, {0, 5, 10, 0}, 1, -1},
      {"right to left goes by the right edges", {0, 0, 100, 10}, {50, 0, 10, 10}, -1, -1},
      {"the same place", {5, 5, 5, 5}, {5, 5, 5, 5}, 0, 0},
      {"nowhere", {kNaN, kNaN, kNaN, kNaN}, {0, 0, 10, 10}, 0, 0},
      {"without an end", {0, 0, kInfinity, kInfinity}, {10, 10, 10, 10}, -1, -1},
      {"above all", {0, -kInfinity, 10, 10}, {0, 0, 10, 10}, -1, -1},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(compareGeometry(each.left, each.right, false), each.order) << each.what;
    EXPECT_EQ(compareGeometry(each.right, each.left, false), -each.order) << each.what;
    EXPECT_EQ(compareGeometry(each.left, each.right, true), each.rightToLeftOrder) << each.what;
    EXPECT_EQ(compareGeometry(each.right, each.left, true), -each.rightToLeftOrder) << each.what;
  }
}

TEST(GeometryTests, TheLanguageDecidesTheDirection) {
  const auto root = group({makeLabel("left", {0, 0, 40, 20}), makeLabel("right", {50, 5, 40, 20}),
                           makeLabel("below", {20, 40, 40, 20})});
  const std::pair<const char*, Heard> cases[] = {
      {"en_US", {"left", "right", "below"}},
      {"ar_EG", {"right", "left", "below"}},
  };
  for (const auto& [locale, order] : cases) {
    Settings::current().locale = locale;
    EXPECT_EQ(heard(root), order) << locale;
    const auto sorted = sortedArrayUsingSelector(root->subviews(), "accessibilityCompareGeometry:");
    EXPECT_EQ(labelsOf({sorted->begin(), sorted->end()}), order) << locale;
    EXPECT_EQ(send<std::int64_t>(root->subviewList()[0],
                                 "accessibilityCompareGeometry:", root->subviewList()[1]),
              order[0] == "left" ? -1 : 1);
  }
}

TEST(GeometryTests, EqualPlacesKeepTheirOrder) {
  std::vector<id> labels;
  for (int index = 0; index < 33; ++index) {
    labels.push_back(makeLabel(std::to_string(index), {double(index % 2), 0, 10, 10}));
  }
  const Heard sorted = labelsOf(sortedByGeometry(labels));
  for (std::size_t index = 0; index < sorted.size(); ++index) {
    const std::size_t evens = 17;
    const std::size_t expected = index < evens ? 2 * index : 2 * (index - evens) + 1;
    EXPECT_EQ(sorted[index], std::to_string(expected));
  }
}

TEST(GeometryTests, ContradictoryFramesAreSortedWithoutLosingAny) {
  // Each of the three stands beside the next, and the last is a row below the first.
  const CGRect triple[] = {{20, 0, 10, 10}, {10, 5, 10, 10}, {0, 10, 10, 10}};
  EXPECT_LT(compareGeometry(triple[0], triple[2], false), 0);
  EXPECT_GT(compareGeometry(triple[0], triple[1], false), 0);
  EXPECT_GT(compareGeometry(triple[1], triple[2], false), 0);

  std::mt19937 random(7);
  const double values[] = {0, 5, 10, 15, 20, -5, kInfinity, -kInfinity, kNaN};
  const auto any = [&] { return values[random() % std::size(values)]; };
  for (int round = 0; round < 50; ++round) {
    std::vector<id> views;
    for (std::size_t count = random() % 40; count > 0; --count) {
      const auto& chosen = triple[random() % 3];
      views.push_back(
          makeView<UIView>(round % 2 == 0 ? chosen : CGRect(any(), any(), any(), any())));
    }
    std::vector<id> sorted = sortedByGeometry(views);
    ASSERT_TRUE(std::ranges::is_permutation(sorted, views)) << round;
  }
}

std::int64_t compareTexts(NSString* self, const Ref<NSString>& other) {
  return self->utf8().compare(other->utf8());
}
const Registered comparing = extendClass("NSString").method<&compareTexts>("traversalTestCompare:");

TEST(GeometryTests, SortingByAnotherSelectorAsksThePairs) {
  EXPECT_EQ(sortedArrayUsingSelector(nullptr, "accessibilityCompareGeometry:"), nullptr);
  EXPECT_EQ(sortedArrayUsingSelector(arrayWithObjects({}), "compare:")->count(), 0U);
  const auto sorted = sortedArrayUsingSelector(
      arrayWithObjects({string("c"), string("a"), string("b")}), "traversalTestCompare:");
  EXPECT_EQ(utf8((*sorted)[0]) + utf8((*sorted)[1]) + utf8((*sorted)[2]), "abc");
}

}  // namespace
}  // namespace tavro
