#include "reader/Containers.h"

#include <algorithm>

#include "platform/accessibility/Labels.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"
#include "reader/Utterance.h"

namespace tavro {
namespace {

/// Whether an element stands for something drawn, and not for other elements.
bool isDrawn(const id& element) {
  return isKindOf(element.get(), classOf<UIAccessibilityElement>()) &&
         !isKindOf(element.get(), classOf<UIAccessibilityAggregateElement>());
}

bool isDirectlyIn(const AccessibleElement& element, const id& container) {
  return !element.containers.empty() && element.containers.back() == container;
}

std::string positionText(std::int64_t place, std::int64_t count) {
  return utf8(localizedStringWithFormat(string(readerWord("position.format")), {place, count}));
}

std::string joined(std::vector<id> parts) {
  return utf8(AXLabelForElements(arrayWithObjects(std::move(parts))));
}

}  // namespace

std::vector<std::string> ContainerSpeech::passage(const std::vector<id>& from,
                                                  const std::vector<id>& to) const {
  std::vector<std::string> texts;
  if (verbosity_ != Verbosity::containers) {
    return texts;
  }
  const auto shared = static_cast<std::size_t>(std::ranges::mismatch(from, to).in1 - from.begin());
  for (std::size_t depth = from.size(); depth > shared; --depth) {
    texts.push_back(readerWord("leave." + kindOf(from[depth - 1])));
  }
  for (std::size_t depth = shared; depth < to.size(); ++depth) {
    texts.push_back(nameOf(to[depth]));
  }
  return texts;
}

std::string ContainerSpeech::withPosition(const std::string& utterance, std::size_t index) const {
  const auto position = verbosity_ == Verbosity::containers ? positionInChart(index) : std::nullopt;
  return position
             ? joined({string(utterance), string(positionText(position->place, position->count))})
             : utterance;
}

std::string ContainerSpeech::whereabouts(std::size_t index) const {
  std::vector<id> parts;
  if (const auto position = positionInChart(index)) {
    parts.emplace_back(string(positionText(position->place, position->count)));
  }
  const std::vector<id>& containers = elements_[index].containers;
  for (auto container = containers.rbegin(); container != containers.rend(); ++container) {
    parts.emplace_back(string(nameOf(*container)));
  }
  return joined(std::move(parts));
}

std::optional<ContainerSpeech::Position> ContainerSpeech::positionInChart(std::size_t index) const {
  const std::vector<id>& containers = elements_[index].containers;
  if (containers.empty() || kindOf(containers.back()) != "chart") {
    return std::nullopt;
  }
  Position position{0, 0};
  for (std::size_t other = 0; other < elements_.size(); ++other) {
    if (isDirectlyIn(elements_[other], containers.back())) {
      ++position.count;
      position.place = other == index ? position.count : position.place;
    }
  }
  return position;
}

/// The kind as the keys of the reader's table name it.
std::string ContainerSpeech::kindOf(const id& container) const {
  if (as<UINavigationBar>(container)) {
    return "bar";
  }
  if (as<UICellView>(container)) {
    return "row";
  }
  std::size_t drawn = 0;
  for (const AccessibleElement& element : elements_) {
    if (isDirectlyIn(element, container)) {
      if (!isDrawn(element.element)) {
        return "group";
      }
      ++drawn;
    }
  }
  return drawn > 1 ? "chart" : "group";
}

std::string ContainerSpeech::nameOf(const id& container) const {
  // Only a label that was set is a name; a natural one repeats what the elements say.
  return joined({trySend<id>(container, "accessibilityUserDefinedLabel"),
                 string(readerWord("enter." + kindOf(container)))});
}

}  // namespace tavro
