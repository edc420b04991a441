#include "reader/Utterance.h"

#include <algorithm>
#include <optional>
#include <vector>

#include "platform/accessibility/Labels.h"
#include "platform/foundation/Formatters.h"
#include "platform/foundation/NSBundle.h"

namespace tavro {
namespace {

std::string& resourcesFolder() {
  static std::string folder;
  return folder;
}

struct TraitWord {
  UIAccessibilityTraits trait;
  std::string_view key;
};
constexpr TraitWord kTraitWords[] = {
    {UIAccessibilityTraitSelected, "trait.selected"},
    {UIAccessibilityTraitButton, "trait.button"},
    {UIAccessibilityTraitHeader, "trait.header"},
    {UIAccessibilityTraitAdjustable, "trait.adjustable"},
};

/// The number that a text is, in any script's digits.
std::optional<std::int64_t> wholeNumber(std::u16string_view text) {
  const auto formatter = make<NSNumberFormatter>();
  const Ref<NSNumber> number = formatter->numberFromString(string(text));
  return number ? std::optional(number->longLongValue()) : std::nullopt;
}

/// "1:02:03", "2:03" or "3" as seconds.
std::optional<std::int64_t> clockSeconds(std::u16string_view text) {
  constexpr int kMostParts = 3;
  std::int64_t seconds = 0;
  for (int part = 0; part < kMostParts; ++part) {
    const std::size_t colon = text.find(u':');
    const auto number = wholeNumber(text.substr(0, colon));
    if (!number || *number < 0 || *number > 1'000'000'000) {
      return std::nullopt;
    }
    seconds = seconds * 60 + *number;
    if (colon == std::u16string_view::npos) {
      return seconds;
    }
    text.remove_prefix(colon + 1);
  }
  return std::nullopt;
}

/// The words for a marked text; nil when the mark means nothing to the reader or does not fit.
Ref<NSString> wordsFor(Name key, std::u16string_view marked) {
  std::optional<std::int64_t> seconds;
  if (key == UIAccessibilityTokenDurationTimeMMSS) {
    seconds = wholeNumber(marked);
  } else if (key == UIAccessibilityTokenDurationTimeHHMMSS) {
    seconds = clockSeconds(marked);
  }
  return seconds ? durationInWords(*seconds) : nullptr;
}

std::u16string withDurations(const NSAttributedString& text) {
  std::vector<NSAttributedString::Run> runs = text.runs();
  // From the end, so that earlier ranges stay where they are.
  std::ranges::stable_sort(runs, [](const auto& left, const auto& right) {
    return left.range.location > right.range.location;
  });
  std::u16string spoken(text.string()->text());
  std::size_t end = spoken.size();
  for (const NSAttributedString::Run& run : runs) {
    if (run.range.location + run.range.length > end) {
      continue;
    }
    const std::u16string marked = spoken.substr(run.range.location, run.range.length);
    if (const Ref<NSString> words = wordsFor(run.key, marked)) {
      spoken.replace(run.range.location, run.range.length, words->text());
      end = run.range.location;
    }
  }
  return spoken;
}

}  // namespace

void setReaderResources(const std::string& folder) { resourcesFolder() = folder; }

std::string readerWord(std::string_view key) {
  return NSBundle::bundleWithPath(resourcesFolder())
      ->localizedStringForKey(string(key), nullptr, "Reader")
      ->utf8();
}

std::string spokenText(const id& text) {
  if (const auto attributed = as<NSAttributedString>(text)) {
    return string(withDurations(*attributed))->utf8();
  }
  return utf8(text);
}

std::string utteranceOf(const ElementFacts& facts) {
  std::vector<id> parts{string(spokenText(facts.label)), string(spokenText(facts.value))};
  for (const TraitWord& word : kTraitWords) {
    if ((facts.traits & word.trait) != 0) {
      parts.emplace_back(string(readerWord(word.key)));
    }
  }
  if (facts.expandedStatus != 0) {
    parts.emplace_back(
        string(readerWord(facts.expandedStatus == 1 ? "status.expanded" : "status.collapsed")));
  }
  parts.emplace_back(string(spokenText(facts.hint)));
  return utf8(AXLabelForElements(arrayWithObjects(std::move(parts))));
}

}  // namespace tavro
