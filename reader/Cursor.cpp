#include "reader/Cursor.h"

#include <algorithm>
#include <tuple>

#include "reader/Touch.h"

namespace tavro {
namespace {

constexpr int kDeepestNesting = 200;  // containers may form a cycle

bool isInside(const AccessibleElement& element, const id& container) {
  if (std::ranges::find(element.containers, container) != element.containers.end()) {
    return true;
  }
  id each = element.element;
  for (int depth = 0; each && depth < kDeepestNesting; ++depth) {
    if (each == container) {
      return true;
    }
    each = trySend<id>(each, "accessibilityContainer");
  }
  return false;
}

/// Whether an element took the place of an earlier one when its container was built anew.
bool replaces(const AccessibleElement& later, const AccessibleElement& earlier) {
  const auto facts = [](const id& element) {
    return std::tuple(element.get()->isa(), trySend<CGRect>(element, "accessibilityFrame"),
                      spokenText(trySend<id>(element, "accessibilityLabel")));
  };
  return facts(later.element) == facts(earlier.element);
}

/// Where an earlier element is now.
std::optional<std::size_t> placeOf(const std::vector<AccessibleElement>& elements,
                                   const AccessibleElement& earlier) {
  auto found = std::ranges::find(elements, earlier.element, &AccessibleElement::element);
  if (found == elements.end()) {
    found = std::ranges::find_if(
        elements, [&](const AccessibleElement& later) { return replaces(later, earlier); });
  }
  return found == elements.end() ? std::nullopt
                                 : std::optional<std::size_t>(found - elements.begin());
}

/// Whether an element takes an activation itself. One that raises took it, and failed.
bool activatesItself(const id& element) {
  try {
    return respondsTo(element.get(), "accessibilityActivate") &&
           send<bool>(element, "accessibilityActivate");
  } catch (...) {
    return true;
  }
}

bool isAudible(const HeardElement& element) { return !element.utterance.empty(); }

}  // namespace

Cursor::Cursor(const Ref<UIView>& root) : root_(root), elements_(accessibleElements(root)) {
  setAccessibilityNotificationObserver(
      [this](UIAccessibilityNotification notification, const id& argument) {
        // Posted in the midst of a change; followed when it is over.
        posted_.emplace_back(notification, argument);
      });
  seekAudible(0, 1);
}

Cursor::~Cursor() { setAccessibilityNotificationObserver({}); }

std::optional<HeardElement> Cursor::current() const {
  if (index_ >= elements_.size()) {
    return std::nullopt;
  }
  HeardElement element = readElement(elements_[index_]);
  return isAudible(element) ? std::optional(std::move(element)) : std::nullopt;
}

template <class Test>
bool Cursor::seek(std::ptrdiff_t start, std::ptrdiff_t step, const Test& test) {
  const std::ptrdiff_t count = std::ssize(elements_);
  for (std::ptrdiff_t index = start; index >= 0 && index < count; index += step) {
    if (test(readElement(elements_[static_cast<std::size_t>(index)]))) {
      index_ = static_cast<std::size_t>(index);
      return true;
    }
  }
  return false;
}

bool Cursor::seekAudible(std::ptrdiff_t start, std::ptrdiff_t step) {
  return seek(start, step, &isAudible);
}

bool Cursor::move(Move move) {
  const auto here = static_cast<std::ptrdiff_t>(index_);
  switch (move) {
    case Move::next:
      return seekAudible(here + 1, 1);
    case Move::previous:
      return seekAudible(here - 1, -1);
    case Move::nextHeading:
      return seek(here + 1, 1, &isHeading);
    case Move::previousHeading:
      return seek(here - 1, -1, &isHeading);
    case Move::first:
      return seekAudible(0, 1);
    case Move::last:
      return seekAudible(std::ssize(elements_) - 1, -1);
  }
  return false;
}

bool Cursor::touch(CGPoint point) {
  const auto index = elementAt(elements_, *root_, point);
  if (!index || !isAudible(readElement(elements_[*index]))) {
    return false;
  }
  index_ = *index;
  return true;
}

bool Cursor::find(std::string_view beginning) {
  return seek(0, 1, [&](const HeardElement& element) {
    return isAudible(element) && (spokenText(element.facts.label).starts_with(beginning) ||
                                  element.utterance.starts_with(beginning));
  });
}

bool Cursor::activate() {
  const auto element = current();
  if (!element) {
    return false;
  }
  const bool handled = activatesItself(element->element) || tap(*root_, element->activationPoint);
  update();
  return handled;
}

bool Cursor::adjust(Name selector) {
  const auto element = current();
  if (!element || (element->facts.traits & UIAccessibilityTraitAdjustable) == 0) {
    return false;
  }
  trySend<void>(element->element, selector);
  update();
  return true;
}

void Cursor::update() {
  const std::vector<AccessibleElement> before = std::move(elements_);
  const std::size_t previous = index_;
  elements_ = accessibleElements(root_);
  index_ = 0;
  bool survived = false;
  for (std::size_t back = 0; back <= previous && previous < before.size(); ++back) {
    if (const auto place = placeOf(elements_, before[previous - back])) {
      index_ = *place;
      survived = back == 0;
      break;
    }
  }
  for (const auto& [notification, argument] : std::exchange(posted_, {})) {
    follow(notification, argument, survived);
  }
  const auto here = static_cast<std::ptrdiff_t>(index_);
  static_cast<void>(seekAudible(here, 1) || seekAudible(here, -1));
}

void Cursor::follow(UIAccessibilityNotification notification, const id& argument, bool& survived) {
  if (argument) {
    const auto found = std::ranges::find_if(
        elements_, [&](const AccessibleElement& element) { return isInside(element, argument); });
    if (found != elements_.end()) {
      index_ = static_cast<std::size_t>(found - elements_.begin());
      survived = true;
      return;
    }
  }
  if (notification == UIAccessibilityScreenChangedNotification || !survived) {
    index_ = 0;
    survived = true;
  }
}

}  // namespace tavro
