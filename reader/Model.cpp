#include "reader/Model.h"

#include <algorithm>

#include "platform/accessibility/Traversal.h"

namespace tavro {
namespace {

HeardElement read(const AccessibleElement& found) {
  const id& element = found.element;
  HeardElement heard;
  heard.element = element;
  heard.facts = {
      .label = trySend<id>(element, "accessibilityLabel"),
      .value = trySend<id>(element, "accessibilityValue"),
      .hint = trySend<id>(element, "accessibilityHint"),
      .traits = trySend<UIAccessibilityTraits>(element, "accessibilityTraits"),
      .expandedStatus = trySend<std::int64_t>(element, "_accessibilityExpandedStatus"),
  };
  heard.frame = trySend<CGRect>(element, "accessibilityFrame");
  heard.activationPoint = trySend<CGPoint>(element, "accessibilityActivationPoint");
  for (const id& container : found.containers) {
    heard.containers.emplace_back(container.get()->isa()->name().text());
  }
  heard.utterance = utteranceOf(heard.facts);
  return heard;
}

}  // namespace

std::vector<HeardElement> readElements(const id& root) {
  std::vector<HeardElement> heard;
  std::ranges::transform(accessibleElements(root), std::back_inserter(heard), &read);
  return heard;
}

}  // namespace tavro
