#pragma once

#include <string>
#include <string_view>

#include "platform/uikit/UIAccessibility.h"

namespace tavro {

/// What the screen reader was told of one element.
struct ElementFacts {
  id label;
  id value;
  id hint;
  UIAccessibilityTraits traits = UIAccessibilityTraitNone;
  /// 0 none, 1 expanded, 2 collapsed.
  std::int64_t expandedStatus = 0;
};

/// A text as it is spoken: what speech attributes mark as a duration is said in words.
std::string spokenText(const id& text);
/// The whole utterance: label, value, traits in words, state, hint. Empty when there is nothing to
/// say.
std::string utteranceOf(const ElementFacts& facts);

/// Where the reader's own words are found; once, before the first utterance.
void setReaderResources(const std::string& folder);
/// A word of the reader's own in the user's language.
std::string readerWord(std::string_view key);

}  // namespace tavro
