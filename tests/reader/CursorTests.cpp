#include <gtest/gtest.h>

#include <stdexcept>
#include <tuple>

#include "platform/foundation/Settings.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "reader/Cursor.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

using Utterances = std::vector<std::string>;

class CursorTest : public testing::Test {
 protected:
  void SetUp() override {
    setReaderResources(std::string(TAVRO_SOURCE) + "/reader/resources");
    Settings::current().locale = "en_US";
    window->makeKey();
    window->addSubview(screen);
  }

  Ref<UILabel> add(const std::string& text, UIAccessibilityTraits traits = 0) {
    const auto label = makeLabel(text, {0, nextY_, 390, 40});
    setTraits(label, traits);
    screen->addSubview(label);
    nextY_ += 40;
    return label;
  }

  Ref<UIButton> addButton(const std::string& title, std::function<void()> action) {
    const auto button = makeView<UIButton>({0, nextY_, 390, 40});
    button->setTitle(string(title));
    button->setAction(std::move(action));
    screen->addSubview(button);
    nextY_ += 40;
    return button;
  }

  /// Elements of one container, a width apart; frames in screen coordinates.
  static void draw(const Ref<UIView>& container, const Utterances& labels, CGRect frame) {
    std::vector<id> elements;
    for (const std::string& label : labels) {
      elements.emplace_back(drawnElement(container, label));
      send<void>(elements.back(), "setAccessibilityFrame:", frame);
      frame.origin.x += frame.size.width;
    }
    setElements(container, std::move(elements));
  }

  Ref<UIView> addChart(const Utterances& labels) {
    const auto chart = makeView<UIView>({0, nextY_, 390, 40});
    screen->addSubview(chart);
    draw(chart, labels, {0, nextY_, 50, 40});
    nextY_ += 40;
    return chart;
  }

  static std::string here(const Cursor& cursor) {
    const auto element = cursor.current();
    return element ? element->utterance : "(nothing)";
  }

  Ref<UIWindow> window = makeView<UIWindow>({0, 0, 390, 844});
  Ref<UIView> screen = makeView<UIView>({0, 0, 390, 844});

 private:
  double nextY_ = 0;
};

TEST_F(CursorTest, MovesOverWhatCanBeHeard) {
  add("");  // kept out of the way: it has nothing to say
  add("Title", UIAccessibilityTraitHeader);
  add("First");
  add("");
  add("Second");
  add("Section", UIAccessibilityTraitHeader);
  add("Last");
  struct Step {
    Move move;
    bool moved;
    const char* heard;
  };
  constexpr Step steps[] = {
      {Move::previous, false, "Title"},
      {Move::previousHeading, false, "Title"},
      {Move::next, true, "First"},
      {Move::next, true, "Second"},
      {Move::previous, true, "First"},
      {Move::nextHeading, true, "Section"},
      {Move::nextHeading, false, "Section"},
      {Move::previousHeading, true, "Title"},
      {Move::last, true, "Last"},
      {Move::next, false, "Last"},
      {Move::previousHeading, true, "Section"},
      {Move::first, true, "Title"},
  };
  Cursor cursor(screen);
  int number = 0;
  for (const Step& step : steps) {
    SCOPED_TRACE(++number);
    EXPECT_EQ(cursor.move(step.move), step.moved);
    EXPECT_EQ(spokenText(cursor.current()->facts.label), step.heard);
  }
}

TEST_F(CursorTest, AnEmptyScreenHasNoPosition) {
  add("");
  Cursor cursor(screen);
  EXPECT_FALSE(cursor.current());
  for (const Move move : {Move::next, Move::previous, Move::first, Move::last}) {
    EXPECT_FALSE(cursor.move(move));
  }
  EXPECT_FALSE(cursor.activate());
  EXPECT_FALSE(cursor.increment());
  EXPECT_FALSE(cursor.touch({10, 10}));
  EXPECT_FALSE(cursor.find(""));
}

TEST_F(CursorTest, StaysOnWhatItIsOnWhenTheScreenChanges) {
  const auto title = add("Title");
  const auto chart = addChart({"one", "two", "three"});
  const auto last = add("Last");
  Cursor cursor(screen);
  ASSERT_TRUE(cursor.find("two"));

  draw(chart, {"one", "two", "three"}, {0, 40, 50, 40});
  cursor.update();
  EXPECT_EQ(here(cursor), "two") << "a chart that was built anew";

  const auto above = makeLabel("Above", {0, -40, 390, 40});
  screen->addSubview(above);
  cursor.update();
  EXPECT_EQ(here(cursor), "two") << "something new before it";

  draw(chart, {"one", "three"}, {0, 40, 50, 40});
  cursor.update();
  EXPECT_EQ(here(cursor), "one") << "gone: the nearest earlier one that is left";

  chart->removeFromSuperview();
  cursor.update();
  EXPECT_EQ(here(cursor), "Title");

  last->setHidden(true);
  title->setHidden(true);
  above->setHidden(true);
  cursor.update();
  EXPECT_EQ(here(cursor), "(nothing)");

  last->setHidden(false);
  cursor.update();
  EXPECT_EQ(here(cursor), "Last") << "what appears on an empty screen";
}

TEST_F(CursorTest, FollowsNotifications) {
  const auto layout = UIAccessibilityLayoutChangedNotification;
  const auto other = UIAccessibilityScreenChangedNotification;
  add("Title");
  const auto chart = addChart({"one", "two"});
  const auto panel = makeView<UIView>({0, 200, 390, 80});
  panel->addSubview(makeView<UIImageView>({0, 0, 390, 20}));
  panel->addSubview(makeLabel("Inside", {0, 40, 390, 40}));
  screen->addSubview(panel);
  const auto last = add("Last");
  const auto elsewhere = makeLabel("Elsewhere");
  struct Case {
    const char* name;
    UIAccessibilityNotification notification;
    id argument;
    bool focusGoes;
    const char* heard;
  };
  const Case cases[] = {
      {"to an element", layout, last, false, "Last"},
      {"into a list of drawn elements", layout, chart, false, "one"},
      {"into a view", layout, panel, false, "Inside"},
      {"stays", layout, nullptr, false, "two"},
      {"what is not on screen counts as none", layout, elsewhere, false, "two"},
      {"its element is gone", layout, nullptr, true, "Title"},
      {"an element, its own being gone", layout, last, true, "Last"},
      {"a new screen", other, nullptr, false, "Title"},
      {"a new screen that names an element", other, last, false, "Last"},
  };
  for (const Case& each : cases) {
    SCOPED_TRACE(each.name);
    draw(chart, {"one", "two"}, {0, 40, 50, 40});
    Cursor cursor(screen);
    ASSERT_TRUE(cursor.find("two"));
    UIAccessibilityPostNotification(each.notification, each.argument);
    EXPECT_EQ(here(cursor), "two") << "followed when the change is over";
    if (each.focusGoes) {
      draw(chart, {"one"}, {0, 40, 50, 40});
    }
    cursor.update();
    EXPECT_EQ(here(cursor), each.heard);
    if (each.argument == id(last)) {
      UIAccessibilityPostNotification(layout, nullptr);
      cursor.update();
      EXPECT_EQ(here(cursor), "Last") << "each is followed once";
    }
  }
}

TEST_F(CursorTest, TheLaterOfTwoNotificationsCountsFromTheEarlier) {
  const auto first = add("First");
  add("Second");
  const auto target = add("Target");
  Cursor cursor(screen);
  first->setHidden(true);
  UIAccessibilityPostNotification(UIAccessibilityLayoutChangedNotification, target);
  UIAccessibilityPostNotification(UIAccessibilityLayoutChangedNotification, nullptr);
  cursor.update();
  EXPECT_EQ(here(cursor), "Target");
}

TEST_F(CursorTest, ATouchHearsWhatLiesThere) {
  // Two weeks; the days of the first reach far over the second.
  const auto upper = makeView<UIView>({0, 0, 390, 60});
  const auto lower = makeView<UIView>({0, 60, 390, 60});
  screen->addSubview(upper);
  screen->addSubview(lower);
  draw(upper, {"1", "2", "3"}, {0, 0, 100, 130});
  draw(lower, {"8", "9", "10"}, {0, 60, 100, 130});
  const auto columns = makeView<UIView>({50, 300, 300, 40});  // told by its hit test alone
  answers<id, CGPoint, const id&>(
      columns, "_accessibilityHitTest:withEvent:", [&](CGPoint point, const id& /*event*/) {
        const auto column = static_cast<std::size_t>(point.x / 100);
        return column < 2 ? (*elementsOf(columns))[column] : id();
      });
  screen->addSubview(columns);
  draw(columns, {"Mon", "Tue"}, {0, 0, 0, 0});
  const auto cell = makeView<UITableViewCell>({0, 400, 390, 40});
  cell->addSubview(makeLabel("Runs", {10, 10, 100, 20}));
  screen->addSubview(cell);
  const auto veil = makeView<UIView>({0, 400, 390, 40});
  veil->setHidden(true);
  screen->addSubview(veil);
  const auto pair = makeView<UIView>({0, 600, 390, 40});
  draw(pair, {"left", "right"}, {0, 600, 100, 40});
  screen->addSubview(pair);
  const auto silent = makeLabel("", {0, 700, 390, 40});
  screen->addSubview(silent);

  const std::pair<CGPoint, const char*> cases[] = {
      {{50, 30}, "1"},
      {{150, 30}, "2"},
      {{150, 65}, "9"},  // nearer to the centre of 2, but in the row of 9
      {{150, 125}, "9"},
      {{150, 185}, "9"},
      {{160, 310}, "Tue"},
      {{60, 310}, "Mon"},
      {{50, 415}, "Runs"},
      {{300, 405}, "Runs"},
      {{99, 610}, "left"},
      {{100, 610}, "right"},
      {{100, 710}, "(nothing)"},
      {{100, 520}, "(nothing)"},
      {{500, 2000}, "(nothing)"},
      {{-1, 30}, "(nothing)"},
  };
  for (const auto& [point, expected] : cases) {
    SCOPED_TRACE(testing::Message() << point.x << "," << point.y);
    Cursor cursor(window);
    ASSERT_TRUE(cursor.move(Move::first));
    const bool touched = cursor.touch(point);
    EXPECT_EQ(touched ? here(cursor) : "(nothing)", expected);
  }
}

TEST_F(CursorTest, ABarsItemsCanBeTouchedAndTapped) {
  const auto controller = makeController<UIViewController>();
  const auto back = makeController<UIBarButtonItem>();
  back->setTitle(string("Back"));
  const auto custom = makeController<UIBarButtonItem>();
  const auto face = makeView<UIButton>();
  face->setTitle(string("Face"));
  int taps = 0;
  face->setAction([&] { ++taps; });
  custom->setCustomView(face);
  controller->navigationItem()->title = string("Friends");
  controller->navigationItem()->leftItems = {back};
  controller->navigationItem()->rightItems = {custom};
  window->setRootViewController(controller);
  Cursor cursor(window);
  for (const auto& [x, heard] :
       {std::pair(10.0, "Back, button"), {195.0, "Friends, heading"}, {380.0, "Face, button"}}) {
    EXPECT_TRUE(cursor.touch({x, 20}));
    EXPECT_EQ(here(cursor), heard);
  }
  EXPECT_TRUE(cursor.activate());
  EXPECT_EQ(taps, 1);
  EXPECT_TRUE(cursor.touch({10, 20}));
  EXPECT_FALSE(cursor.activate()) << "without a target";

  Settings::current().locale = "ar_EG";
  window->setRootViewController(controller);
  cursor.update();
  EXPECT_TRUE(cursor.touch({380, 20}));
  EXPECT_EQ(here(cursor), "Back, زر") << "a bar begins on the right";
}

TEST_F(CursorTest, ActivationReachesWhatTakesIt) {
  int taps = 0;
  const auto count = [&] { ++taps; };
  addButton("Button", count);
  const auto header = add("Header");  // its button lies elsewhere, and says nothing
  const auto hidden = addButton("", count);
  send<void>(header, "setAccessibilityActivationPoint:", CGPoint{200, 100});
  hidden->addSubview(makeLabel("", {0, 0, 390, 40}));
  addButton("Raises", [&] {
    count();
    throw std::runtime_error("a fault of the application");
  });
  addButton("Empty", {});
  add("Text");
  const auto block = add("Block");
  send<void>(block, "_setAccessibilityActivateBlock:", FlagBlock([&] {
               count();
               return true;
             }));
  const std::tuple<const char*, bool, int> cases[] = {{"Button", true, 1}, {"Header", true, 1},
                                                      {"Raises", true, 1}, {"Empty", false, 0},
                                                      {"Text", false, 0},  {"Block", true, 1}};
  for (const auto& [label, handled, expected] : cases) {
    SCOPED_TRACE(label);
    Cursor cursor(window);
    ASSERT_TRUE(cursor.find(label));
    taps = 0;
    EXPECT_EQ(cursor.activate(), handled);
    EXPECT_EQ(taps, expected);
  }
}

TEST_F(CursorTest, AnActivationThatChangesTheScreenIsFollowed) {
  const auto panel = makeLabel("Panel", {0, 400, 390, 40});
  addButton("Open", [&] {
    UIAccessibilityPostNotification(UIAccessibilityLayoutChangedNotification, panel);
    screen->addSubview(panel);  // posted before the panel is there
  });
  Cursor cursor(screen);
  EXPECT_TRUE(cursor.activate());
  EXPECT_EQ(here(cursor), "Panel");
}

TEST_F(CursorTest, AdjustingSpeaksTheNewValue) {
  int goal = 2;  // from 0 to 3
  const auto stepper = add("Goal");
  answers<void>(stepper, "accessibilityIncrement", [&] { goal = std::min(goal + 1, 3); });
  answers<void>(stepper, "accessibilityDecrement", [&] { goal = std::max(goal - 1, 0); });
  answers<id>(stepper, "accessibilityValue", [&] { return string(std::to_string(goal)); });
  Cursor cursor(screen);
  EXPECT_FALSE(cursor.increment()) << "it does not say that it is adjustable";
  EXPECT_EQ(goal, 2);
  setTraits(stepper, UIAccessibilityTraitAdjustable);
  Utterances heard;
  const auto note = [&](bool adjusted) {
    heard.push_back(adjusted ? utteranceAfterAdjusting(*cursor.current()) : "(refused)");
  };
  note(cursor.increment());
  note(cursor.increment());
  note(cursor.decrement());
  EXPECT_EQ(heard, (Utterances{"3", "3", "2"}));
  EXPECT_EQ(here(cursor), "Goal, 2, adjustable");
}

}  // namespace
}  // namespace tavro
