#pragma once

#include <string>
#include <vector>

#include "reader/Utterance.h"

namespace tavro {

/// One element as it can be heard and touched.
struct HeardElement {
  id element;
  ElementFacts facts;
  CGRect frame;             ///< screen coordinates
  CGPoint activationPoint;  ///< screen coordinates
  /// The class names of the objects whose element lists lead here, outermost first.
  std::vector<std::string> containers;
  std::string utterance;
};

/// Everything that can be heard at and below an object, in reading order. Never raises: what an
/// object cannot answer is left empty.
std::vector<HeardElement> readElements(const id& root);

}  // namespace tavro
