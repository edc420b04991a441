#include "reader/Model.h"

#include <algorithm>

namespace tavro {

HeardElement readElement(const AccessibleElement& found) {
  const id& element = found.element;
  HeardElement heard;
  heard.element = element;
  heard.containers = found.containers;
  heard.facts = {
      .label = trySend<id>(element, "accessibilityLabel"),
      .value = trySend<id>(element, "accessibilityValue"),
      .hint = trySend<id>(element, "accessibilityHint"),
      .traits = trySend<UIAccessibilityTraits>(element, "accessibilityTraits"),
      .expandedStatus = trySend<std::int64_t>(element, "_accessibilityExpandedStatus"),
  };
  heard.frame = trySend<CGRect>(element, "accessibilityFrame");
  heard.activationPoint = trySend<CGPoint>(element, "accessibilityActivationPoint");
  heard.utterance = utteranceOf(heard.facts);
  return heard;
}

std::string utteranceAfterAdjusting(const HeardElement& element) {
  const std::string value = spokenText(element.facts.value);
  return value.empty() ? element.utterance : value;
}

std::vector<HeardElement> readElements(const id& root) {
  std::vector<HeardElement> heard;
  std::ranges::transform(accessibleElements(root), std::back_inserter(heard), &readElement);
  return heard;
}

}  // namespace tavro
