#pragma once

#include <vector>

#include "platform/foundation/NSString.h"

namespace tavro {

/// A text with attributes over ranges of it. Messages: `string`, `description` (the string).
class NSAttributedString : public NSObject {
 public:
  static constexpr Name className = "NSAttributedString";

  struct Run {
    Name key;
    NSRange range;
    id value;
  };

  /// Never nil once initialised.
  [[nodiscard]] Ref<NSString> string() const { return string_; }
  /// In the order in which they were set.
  [[nodiscard]] const std::vector<Run>& runs() const { return runs_; }

  void initWithString(const Ref<NSString>& string) { string_ = string; }

 protected:
  Ref<NSString> string_;
  std::vector<Run> runs_;
};

/// The accessibility runtime's attributed string, which carries speech attributes.
class AXAttributedString : public NSAttributedString {
 public:
  static constexpr Name className = "AXAttributedString";

  /// Sets an attribute over the whole string. A nil value or an empty string sets nothing.
  void setAttribute(const id& value, Name key);
  /// Sets an attribute over a range; the part of the range outside the text is left out. A nil
  /// value, or nothing left of the range, sets nothing.
  void setAttribute(const id& value, Name key, NSRange range);
};

/// nil for a nil string.
Ref<NSAttributedString> attributedString(const Ref<NSString>& string);
/// nil for a nil string.
Ref<AXAttributedString> axAttributedString(const Ref<NSString>& string);

/// The text of a string or an attributed string; nil for anything else.
Ref<NSString> plainText(const id& text);

}  // namespace tavro
