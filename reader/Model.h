#pragma once

#include <string>
#include <vector>

#include "platform/accessibility/Traversal.h"
#include "reader/Utterance.h"

namespace tavro {

/// One element as it can be heard and touched.
struct HeardElement : AccessibleElement {
  ElementFacts facts;
  CGRect frame;             ///< screen coordinates
  CGPoint activationPoint;  ///< screen coordinates
  std::string utterance;
};

/// What an element answers now. Never raises: what it cannot answer is left empty.
HeardElement readElement(const AccessibleElement& found);

/// Whether an element carries the header trait.
inline bool isHeading(const HeardElement& element) {
  return (element.facts.traits & UIAccessibilityTraitHeader) != 0;
}

/// What is said of an element after its value was changed: the value, or everything where there is
/// none.
std::string utteranceAfterAdjusting(const HeardElement& element);

/// Everything that can be heard at and below an object, in reading order.
std::vector<HeardElement> readElements(const id& root);

}  // namespace tavro
