#include "tests/drift/Reading.h"

#include <algorithm>
#include <sstream>

#include "reader/Containers.h"
#include "reader/Cursor.h"
#include "reader/Output.h"

namespace tavro::drift {
namespace {

/// The other traits have no words, and may differ unheard.
constexpr UIAccessibilityTraits kSpokenTraits =
    UIAccessibilityTraitButton | UIAccessibilityTraitHeader | UIAccessibilityTraitAdjustable |
    UIAccessibilityTraitSelected;

std::string textOfRect(const CGRect& rect) {
  std::ostringstream text;
  text << rect.origin.x << "," << rect.origin.y << "," << rect.size.width << ","
       << rect.size.height;
  return text.str();
}

std::string joined(const Words& words) {
  std::string text;
  for (const std::string& word : words) {
    text += (text.empty() ? "" : "|") + word;
  }
  return text;
}

/// The path of the nearest view that an object is or lies in; empty without one.
std::string pathOf(const id& object) {
  constexpr int deepest = 50;
  id each = object;
  for (int depth = 0; each && depth < deepest; ++depth) {
    if (auto view = as<UIView>(each)) {
      std::string path = "/";
      for (Ref<UIView> above = view->superview(); above; above = view->superview()) {
        const auto& siblings = above->subviewList();
        const auto index = std::ranges::find(siblings, view) - siblings.begin();
        path.insert(0, "/" + std::to_string(index));
        view = above;
      }
      return path;
    }
    each = trySend<id>(each, "accessibilityContainer");
  }
  return {};
}

/// One part of what an element says; an answer that raises is noted and empty.
std::string ask(const id& element, Part part, std::vector<std::string>& raised) {
  try {
    switch (part) {
      case label:
        return spokenText(send<id>(element, "accessibilityLabel"));
      case value:
        return spokenText(send<id>(element, "accessibilityValue"));
      case hint:
        return spokenText(send<id>(element, "accessibilityHint"));
      case traits:
        return std::to_string(send<UIAccessibilityTraits>(element, "accessibilityTraits") &
                              kSpokenTraits);
      case status:
        return std::to_string(send<std::int64_t>(element, "_accessibilityExpandedStatus"));
      case presence:
      case told:
        break;
    }
  } catch (const std::exception& error) {
    raised.emplace_back(error.what());
  }
  return {};
}

void draw(const Ref<UIView>& view, const std::string& path, Drawing& drawing) {
  std::string text = std::string(view->isa()->name().text()) + " " + textOfRect(view->frame()) +
                     (view->isHidden() ? " hidden " : " ") +
                     (trySend<bool>(view, "isAccessibilityElement") ? "element " : "") +
                     spokenText(trySend<id>(view, "accessibilityLabel")) + "|" +
                     spokenText(trySend<id>(view, "accessibilityValue")) + "|" +
                     std::to_string(trySend<UIAccessibilityTraits>(view, "accessibilityTraits"));
  if (const auto elements = as<NSArray>(trySend<id>(view, "accessibilityElements"))) {
    for (const id& element : *elements) {
      text += "; " + spokenText(trySend<id>(element, "accessibilityLabel")) + "|" +
              spokenText(trySend<id>(element, "accessibilityValue"));
    }
  }
  drawing[path] = text;
  std::size_t index = 0;
  for (const Ref<UIView>& child : view->subviewList()) {
    draw(child, path + std::to_string(index++) + "/", drawing);
  }
}

/// Goes through the elements from the first on, whatever becomes of the screen meanwhile.
template <class Gesture>
void atEveryElement(Cursor& cursor, const Gesture& gesture) {
  cursor.move(Move::first);
  for (std::size_t step = cursor.elements().size() + 1; step > 0; --step) {
    gesture();
    if (!cursor.move(Move::next)) {
      return;
    }
  }
}

bool saysInOrder(const std::string& words, const std::vector<std::string>& pieces) {
  auto next = pieces.begin();
  for (const std::string& piece : piecesOf(words)) {
    next += next != pieces.end() && piece == *next ? 1 : 0;
  }
  return next == pieces.end();
}

bool matches(const Expected& expected, const Words& words) {
  for (std::size_t part = 0; part < kParts; ++part) {
    const bool isOpen = (expected.open & (1U << part)) != 0;
    if (isOpen ? !saysInOrder(words[part], expected.rest[part])
               : expected.words[part] != words[part]) {
      return false;
    }
  }
  return true;
}

}  // namespace

std::vector<std::string> piecesOf(const std::string& words) {
  constexpr std::string_view separator = ", ";
  std::vector<std::string> pieces;
  for (std::size_t start = 0; start < words.size();) {
    const std::size_t end = std::min(words.find(separator, start), words.size());
    pieces.push_back(words.substr(start, end - start));
    start = end + separator.size();
  }
  return pieces;
}

std::string show(Session& session, std::string_view screen) {
  try {
    session.show(screen);
  } catch (const std::exception& error) {
    return error.what();
  }
  return {};
}

void release(Session& session) { session.application().window().setRootViewController(nullptr); }

Heard hear(Session& session) {
  Heard heard;
  Recording* const recording = Recording::current;
  if (recording != nullptr) {
    recording->setPhase(Recording::Phase::walking);
  }
  const auto elements = accessibleElements(id(&session.application().window()));
  if (recording != nullptr) {
    recording->setElements(elements);
  }
  for (std::size_t index = 0; index < elements.size(); ++index) {
    Words& words = heard.elements.emplace_back();
    for (std::size_t part = 0; part < kParts; ++part) {
      if (recording != nullptr) {
        recording->ask(index, static_cast<Part>(part));
      }
      words[part] = ask(elements[index].element, static_cast<Part>(part), heard.raised);
    }
    heard.paths.push_back(pathOf(elements[index].element));
  }
  if (recording != nullptr) {
    recording->setPhase(Recording::Phase::gesturing);
  }
  return heard;
}

void gestureEverywhere(Session& session) {
  constexpr int columns = 6;
  constexpr int rows = 13;
  UIWindow& window = session.application().window();
  transcript(readElements(id(&window)), Verbosity::containers);
  Cursor cursor((Ref<UIView>(&window)));
  const CGSize size = window.frame().size;
  for (int row = 0; row < rows; ++row) {
    for (int column = 0; column < columns; ++column) {
      cursor.touch({size.width * (column + 0.5) / columns, size.height * (row + 0.5) / rows});
    }
  }
  cursor.move(Move::first);
  while (cursor.move(Move::nextHeading)) {
  }
  const ContainerSpeech containers(Verbosity::containers, cursor.elements());
  for (std::size_t index = 0; index < cursor.elements().size(); ++index) {
    static_cast<void>(containers.whereabouts(index));
  }
  atEveryElement(cursor, [&] {
    cursor.increment();
    cursor.decrement();
  });
  atEveryElement(cursor, [&] { cursor.activate(); });
  cursor.move(Move::last);
  while (cursor.move(Move::previous)) {
  }
  reloadAccessibilityInformation();
  cursor.update();
}

Drawing drawingOf(Session& session) {
  Drawing drawing;
  draw(Ref<UIView>(&session.application().window()), "/", drawing);
  return drawing;
}

std::vector<std::string> changedPaths(const Drawing& before, const Drawing& after) {
  std::vector<std::string> changed;
  const auto compare = [&](const Drawing& left, const Drawing& right) {
    for (const auto& [path, text] : left) {
      const auto found = right.find(path);
      if (found == right.end() || found->second != text) {
        changed.push_back(path);
      }
    }
  };
  compare(before, after);
  compare(after, before);
  return changed;
}

bool isTouched(const std::string& path, const std::vector<std::string>& changed) {
  return std::ranges::any_of(changed, [&](const std::string& each) {
    return path.starts_with(each) || each.starts_with(path);
  });
}

std::string difference(const std::vector<Expected>& expected, const std::vector<Words>& heard) {
  // reached[i]: the elements so far can be what the first i expectations ask for.
  const auto skip = [&](std::vector<bool>& reached) {
    for (std::size_t index = 0; index < expected.size(); ++index) {
      reached[index + 1] = reached[index + 1] || (reached[index] && expected[index].isAnything);
    }
  };
  std::vector<bool> reached(expected.size() + 1);
  reached[0] = true;
  skip(reached);
  for (const Words& words : heard) {
    std::vector<bool> next(expected.size() + 1);
    std::size_t furthest = 0;
    for (std::size_t index = 0; index < expected.size(); ++index) {
      if (!reached[index]) {
        continue;
      }
      furthest = index;
      if (expected[index].isAnything) {
        next[index] = true;
      } else if (matches(expected[index], words)) {
        next[index + 1] = true;
      }
    }
    skip(next);
    if (std::ranges::find(next, true) == next.end()) {
      return "heard \"" + joined(words) + "\" where \"" + joined(expected[furthest].words) +
             "\" was expected";
    }
    reached = next;
  }
  if (reached.back()) {
    return {};
  }
  const auto last = std::find(reached.rbegin(), reached.rend(), true);
  const auto index = static_cast<std::size_t>(reached.rend() - last) - 1;
  return "nothing was heard where \"" + joined(expected[index].words) + "\" was expected";
}

}  // namespace tavro::drift
