#include <gtest/gtest.h>

#include "platform/foundation/Settings.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "reader/Containers.h"
#include "reader/Output.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

/// A table's row with a title, a named chart of drawn elements, and a list of one.
class ContainerTest : public testing::Test {
 protected:
  void SetUp() override {
    setReaderResources(std::string(TAVRO_SOURCE) + "/reader/resources");
    Settings::current().locale = "en_US";
    setLabel(chart, "Steps");
    fill(chart, {"Mon", "Tue", "Wed"});
    fill(alone, {"Only"});
    setElements(row, {makeLabel("Title"), chart, alone});
    window->makeKey();
    window->addSubview(row);
    window->addSubview(makeLabel("After", {0, 500, 390, 40}));
  }

  static void fill(const Ref<UIView>& container, const std::vector<std::string>& labels) {
    std::vector<id> elements;
    for (const std::string& label : labels) {
      elements.emplace_back(drawnElement(container, label));
    }
    setElements(container, std::move(elements));
  }

  Ref<UIWindow> window = makeView<UIWindow>({0, 0, 390, 844});
  Ref<UITableViewCell> row = makeView<UITableViewCell>({0, 0, 390, 100});
  Ref<UIView> chart = makeView<UIView>();
  Ref<UIView> alone = makeView<UIView>();
};

TEST_F(ContainerTest, AreHeardOnEnteringAndLeaving) {
  EXPECT_EQ(transcript(readElements(window)), "Title\nMon\nTue\nWed\nOnly\nAfter\n");
  EXPECT_EQ(transcript(readElements(window), Verbosity::containers),
            "row\nTitle\n"
            "Steps, chart\nMon, 1 of 3\nTue, 2 of 3\nWed, 3 of 3\nend of chart\n"
            "group\nOnly\nend of group\n"
            "end of row\nAfter\n");
}

TEST_F(ContainerTest, AnElementThatStandsForOthersIsNotDrawn) {
  const auto pair = make<UIAccessibilityAggregateElement>();
  pair->initWithContainerAndElements(chart, nullptr);
  setLabel(pair, "Pair");
  setElements(chart, {pair, pair});
  const auto elements = accessibleElements(chart);
  EXPECT_EQ(ContainerSpeech(Verbosity::containers, elements).whereabouts(0), "Steps, group");
}

TEST_F(ContainerTest, WhereaboutsUseTheUsersDigits) {
  Settings::current().locale = "ar_EG";
  const auto elements = accessibleElements(window);
  const ContainerSpeech speech(Verbosity::elements, elements);
  EXPECT_EQ(speech.whereabouts(2), "٢ من ٣\u200f, Steps, رسم بياني, صف");
  EXPECT_EQ(speech.whereabouts(5), "");
}

}  // namespace
}  // namespace tavro
