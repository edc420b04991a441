#pragma once

#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include "reader/Model.h"

namespace tavro {

enum class Move { next, previous, nextHeading, previousHeading, first, last };

/// The screen reader's reading position, and the gestures that are made from it. Elements with
/// nothing to say are passed over.
///
/// After each gesture the screen is read anew. The position stays on its object, or on one of the
/// same class, frame and label that took its place; where it is gone, it falls back to the nearest
/// earlier element that is left. A layout-changed notification moves it to its argument, or to the
/// first element inside; without an argument it stays where its element still exists, and else
/// goes to the first. A screen-changed notification does the same, but without an argument always
/// goes to the first. One cursor a process: it is the observer of notifications.
class Cursor {
 public:
  /// Starts at the first element at and below a view.
  explicit Cursor(const Ref<UIView>& root);
  ~Cursor();
  Cursor(const Cursor&) = delete;
  Cursor& operator=(const Cursor&) = delete;

  /// What is there, in reading order, silent elements included.
  [[nodiscard]] const std::vector<AccessibleElement>& elements() const { return elements_; }
  /// Where the position is among the elements.
  [[nodiscard]] std::size_t index() const { return index_; }
  /// The element at the position, as it answers now; nothing when nothing can be heard.
  [[nodiscard]] std::optional<HeardElement> current() const;

  /// NO, without moving, where there is nothing further that way.
  bool move(Move move);
  /// Goes to what a finger at that point (screen coordinates) hears; NO where there is nothing.
  bool touch(CGPoint point);
  /// Goes to the first element whose label or utterance begins with the text; NO without one.
  bool find(std::string_view beginning);

  /// Activates the element: its own action, else a tap at its activation point. NO when nothing
  /// takes it.
  bool activate();
  /// Asks the element for its next larger or smaller value; NO when it is not adjustable.
  bool increment() { return adjust("accessibilityIncrement"); }
  bool decrement() { return adjust("accessibilityDecrement"); }

  /// Reads the screen anew after something other than the cursor's gestures changed it, and
  /// follows the notifications that were posted meanwhile.
  void update();

 private:
  bool adjust(Name selector);
  /// Goes to the nearest element that way, from `start` on, that passes the test.
  template <class Test>
  bool seek(std::ptrdiff_t start, std::ptrdiff_t step, const Test& test);
  bool seekAudible(std::ptrdiff_t start, std::ptrdiff_t step);
  /// `survived` tells whether the position is on an element that it was meant to be on.
  void follow(UIAccessibilityNotification notification, const id& argument, bool& survived);

  Ref<UIView> root_;
  std::vector<AccessibleElement> elements_;
  std::size_t index_ = 0;
  std::vector<std::pair<UIAccessibilityNotification, id>> posted_;
};

}  // namespace tavro
