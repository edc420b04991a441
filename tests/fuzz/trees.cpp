// Trees of views, layers, elements and lists as no sane host builds them, walked with every gesture
// of the reader. The first byte counts the steps that build; the rest are gestures.

#include <algorithm>
#include <limits>
#include <set>

#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "reader/Containers.h"
#include "reader/Cursor.h"
#include "reader/Output.h"
#include "tests/fuzz/Fuzz.h"

namespace tavro::fuzz {
namespace {

constexpr double kInfinity = std::numeric_limits<double>::infinity();
constexpr double kLengths[] = {0,   10,   40,    100,  390,       844,        -1,
                               -50, 1e-9, 1e300, -1e9, kInfinity, -kInfinity, NAN};

class Tree;

/// A view that answers as its mood is: with nothing of the expected kind, or by raising.
class MoodyView : public UIButton {
 public:
  static constexpr Name className = "FuzzMoodyView";
  std::size_t mood = 0;

  id object() { return mood == 0 ? throw 1 : mood == 1 ? id(this) : id(arrayWithObjects({this})); }
  bool flag() { return mood == 0 ? throw 2 : true; }
  CGRect rect() { return mood == 0 ? throw 3 : CGRect{NAN, -kInfinity, kInfinity, -1}; }
  UIAccessibilityTraits traits() { return mood == 0 ? throw 4 : ~UIAccessibilityTraits{0}; }
};
const Registered moodyView = defineClass<MoodyView, UIButton>()
                                 .method<&MoodyView::object>("accessibilityLabel")
                                 .method<&MoodyView::object>("accessibilityValue")
                                 .method<&MoodyView::object>("accessibilityElements")
                                 .method<&MoodyView::object>("accessibilityContainer")
                                 .method<&MoodyView::flag>("isAccessibilityElement")
                                 .method<&MoodyView::flag>("accessibilityActivate")
                                 .method<&MoodyView::rect>("accessibilityFrame")
                                 .method<&MoodyView::traits>("accessibilityTraits");

template <class T>
id made() {
  return send<id>(classOf<T>(), "new");
}
constexpr id (*kKinds[])() = {&made<UIView>,
                              &made<UILabel>,
                              &made<UIButton>,
                              &made<UITableViewCell>,
                              &made<UIScrollView>,
                              &made<UIImageView>,
                              &made<CALayer>,
                              &made<NSObject>,
                              &made<UIAccessibilityElement>,
                              &made<UIAccessibilityAggregateElement>,
                              &made<MoodyView>};

class Tree {
 public:
  explicit Tree(Bytes& bytes) : bytes_(bytes) {
    window->makeKey();
    for (std::size_t steps = bytes.next() * 4; steps > 0 && !bytes.empty(); --steps) {
      step();
    }
  }
  ~Tree() {
    // Lists may form circles, which are the host's own to break.
    for (const id& node : nodes_) {
      send<void>(node, "setAccessibilityElements:", id());
      if (const auto aggregate = as<UIAccessibilityAggregateElement>(node)) {
        aggregate->representedElements = nullptr;
      }
    }
  }
  Tree(const Tree&) = delete;
  Tree& operator=(const Tree&) = delete;

  /// One change of the tree. What is misuse raises, and changes nothing.
  void step() {
    constexpr std::size_t mostNodes = 600;
    constexpr void (Tree::*changes[])() = {&Tree::nest,   &Tree::list,    &Tree::place,
                                           &Tree::flag,   &Tree::contain, &Tree::represent,
                                           &Tree::remove, &Tree::act,     &Tree::text};
    const std::size_t choice = bytes_.next();
    try {
      if (choice < 128 && nodes_.size() < mostNodes) {
        addNode(choice);
      } else {
        (this->*changes[choice % std::size(changes)])();
      }
    } catch (const NSException&) {
      misuses_++;
    }
  }

  double length() { return kLengths[bytes_.below(std::size(kLengths))]; }

  /// Whether the tree is one of views alone, which each have one place.
  bool isPlain = true;
  const Ref<UIWindow> window = makeView<UIWindow>({0, 0, 390, 844});

 private:
  const id& any() { return nodes_[bytes_.below(nodes_.size())]; }

  /// Every second node goes into the latest one, which makes deep trees; the others into any.
  void addNode(std::size_t choice) {
    const id node = kKinds[choice % std::size(kKinds)]();
    isPlain = isPlain && isA<UIView>(node.get()) && !isA<MoodyView>(node.get());
    const id parent = choice < 64 ? nodes_.back() : any();
    nodes_.push_back(node);
    const double top = static_cast<double>(nodes_.size()) * 5;
    trySend<void>(node, "setFrame:", CGRect{0, top, 200, 40});
    if (isA<UIView>(node.get())) {
      trySend<void>(node, "setText:", string("node " + std::to_string(nodes_.size())));
      trySend<void>(parent, "addSubview:", node);
    } else {
      send<void>(node, "setAccessibilityLabel:", string("drawn"));
      send<void>(node, "setAccessibilityContainer:", parent);
      trySend<void>(parent, "addSublayer:", node);
      trySend<void>(trySend<id>(parent, "layer"), "addSublayer:", node);
    }
  }
  void nest() { send<void>(any(), "addSubview:", any()); }
  void list() {
    isPlain = false;
    std::vector<id> elements;
    const id& owner = any();
    for (std::size_t count = bytes_.below(8); count > 0; --count) {
      elements.push_back(any());
    }
    send<void>(owner, "setAccessibilityElements:", arrayWithObjects(std::move(elements)));
  }
  void place() {
    const id& node = any();
    const CGRect frame{length(), length(), length(), length()};
    switch (bytes_.below(4)) {
      case 0:
        return send<void>(node, "setAccessibilityFrame:", frame);
      case 1:
        return send<void>(node, "setAccessibilityFrameInContainerSpace:", frame);
      case 2:
        return send<void>(node, "setAccessibilityActivationPoint:", frame.origin);
      default:
        return send<void>(node, "setFrame:", frame);
    }
  }
  void flag() {
    constexpr Name flags[] = {"setAccessibilityElementsHidden:",
                              "setAccessibilityViewIsModal:",
                              "_accessibilitySetOverridesInvisibility:",
                              "_accessibilitySetViewIsVisible:",
                              "setIsAccessibilityElement:",
                              "setHidden:"};
    const std::size_t choice = bytes_.below(std::size(flags) + 1);
    const id& node = any();
    isPlain = isPlain && choice >= 4;
    if (choice < std::size(flags)) {
      return send<void>(node, flags[choice], bytes_.below(3) != 0);
    }
    if (const auto moody = as<MoodyView>(node)) {
      moody->mood = bytes_.below(3);
    }
    send<void>(node, "setAccessibilityTraits:", UIAccessibilityTraits{bytes_.next()});
  }
  void contain() { send<void>(any(), "setAccessibilityContainer:", any()); }
  void represent() {
    if (const auto aggregate = as<UIAccessibilityAggregateElement>(any())) {
      const id first = any();
      aggregate->representedElements = arrayWithObjects({first, any()});
    }
  }
  void remove() { send<void>(any(), "removeFromSuperview"); }
  /// Makes a control change the tree, or raise, while the reader taps it.
  void act() {
    if (const auto control = as<UIControl>(any())) {
      control->setAction([this] {
        for (std::size_t count = bytes_.below(4); count > 0; --count) {
          step();
        }
        const id argument = bytes_.below(2) == 0 ? id() : any();
        UIAccessibilityPostNotification(bytes_.below(2) == 0
                                            ? UIAccessibilityLayoutChangedNotification
                                            : UIAccessibilityScreenChangedNotification,
                                        argument);
        if (bytes_.below(8) == 1) {
          throw 5;
        }
      });
    }
  }
  void text() {
    constexpr std::string_view texts[] = {"", "heading", "\xF0\x9F\x8F\x83", "\u202e", "a\nb"};
    send<void>(any(), "setAccessibilityLabel:", string(texts[bytes_.below(std::size(texts))]));
  }

  Bytes& bytes_;
  std::vector<id> nodes_{id(window)};
  std::size_t misuses_ = 0;
};

void collectHeard(const Ref<UIView>& view, std::set<Object*>& into) {
  if (view->isHidden() || view->alpha() <= 0) {
    return;
  }
  if (send<bool>(view, "isAccessibilityElement")) {
    into.insert(view.get());
    return;
  }
  for (const Ref<UIView>& child : view->subviewList()) {
    collectHeard(child, into);
  }
}

/// Each element has one place; of a tree of plain views none is left out.
void requireEachOnce(const Tree& tree, const Cursor& cursor) {
  std::set<Object*> found;
  for (const AccessibleElement& element : cursor.elements()) {
    require(found.insert(element.element.get()).second, "a walk finds each element once");
  }
  if (tree.isPlain) {
    std::set<Object*> expected;
    collectHeard(tree.window, expected);
    require(found == expected, "a walk finds every element");
  }
}

/// Goes all the way; each step comes nearer to the end.
void travel(Cursor& cursor, Move first, Move step) {
  cursor.move(first);
  for (std::size_t before = cursor.index(); cursor.move(step); before = cursor.index()) {
    require(before != cursor.index() &&
                (before < cursor.index()) == (step == Move::next || step == Move::nextHeading),
            "a step goes one way");
    require(cursor.current().has_value() || step != Move::next, "a step ends where words are");
  }
}

void readEverything(const Cursor& cursor, const Tree& tree) {
  const std::vector<HeardElement> heard = readElements(id(tree.window));
  const std::string text =
      transcript(heard, Verbosity::containers) + treeText(heard) + treeJson("tree", heard);
  require(string(text)->utf8() == text, "what is said is valid text");
  const ContainerSpeech containers(Verbosity::containers, cursor.elements());
  for (std::size_t index = 0; index < cursor.elements().size(); ++index) {
    static_cast<void>(containers.whereabouts(index));
  }
}

void gesture(Cursor& cursor, Tree& tree, Bytes& bytes) {
  const std::size_t choice = bytes.below(11);
  switch (choice) {
    case 0:
      return travel(cursor, Move::first, Move::next);
    case 1:
      return travel(cursor, Move::last, Move::previous);
    case 2:
      return travel(cursor, Move::first, Move::nextHeading);
    case 3:
      return travel(cursor, Move::last, Move::previousHeading);
    case 4: {
      const double x = tree.length();
      cursor.touch({x, tree.length()});
      return;
    }
    case 5:
      cursor.increment();
      return;
    case 6:
      cursor.decrement();
      return;
    case 7:
      cursor.find("heading");
      return;
    case 8:
      tree.step();
      return cursor.update();
    case 9:
      cursor.move(Move::next);
      return;
    default:
      cursor.activate();
      return requireEachOnce(tree, cursor);
  }
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  constexpr int mostGestures = 60;
  setReaderResources(std::string(TAVRO_SOURCE) + "/reader/resources");
  fuzz::Bytes bytes(fuzz::textOf(data, size));
  fuzz::Tree tree(bytes);
  Cursor cursor{Ref<UIView>(tree.window)};
  fuzz::requireEachOnce(tree, cursor);
  fuzz::readEverything(cursor, tree);
  for (int count = 0; count < mostGestures && !bytes.empty(); ++count) {
    fuzz::gesture(cursor, tree, bytes);
    fuzz::require(cursor.index() <= cursor.elements().size(), "the position is within the screen");
  }
  fuzz::readEverything(cursor, tree);
  return 0;
}
