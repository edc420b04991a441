#pragma once

#include <array>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <variant>
#include <vector>

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"

namespace tavro {

/// A range of UTF-16 units.
struct NSRange {
  std::size_t location = 0;
  std::size_t length = 0;
  friend bool operator==(const NSRange&, const NSRange&) = default;
};

/// An immutable text of UTF-16 units. Messages: `length` ("Q", in units), `description` (itself).
class NSString : public NSObject {
 public:
  static constexpr Name className = "NSString";

  [[nodiscard]] std::size_t length() const { return length_; }
  [[nodiscard]] std::u16string_view text() const {
    return {long_ ? long_.get() : short_.data(), length_};
  }
  /// A surrogate without its partner becomes U+FFFD.
  [[nodiscard]] std::string utf8() const;

  /// Set once, right after allocation. The text is copied.
  void initWithText(std::u16string_view text);

 private:
  // Most of what is said is no longer than this, and takes one allocation so.
  static constexpr std::size_t kShortLength = 32;

  std::size_t length_ = 0;
  std::unique_ptr<char16_t[]> long_;
  std::array<char16_t, kShortLength> short_;
};

/// A localized format that has one text for each plural category; as a plain string it is the text
/// for "other". Made by string tables only.
class NSPluralFormat : public NSString {
 public:
  static constexpr Name className = "__NSPluralFormat";

  /// Category ("one", "few", ...) and its text.
  std::vector<std::pair<std::string, std::u16string>> forms;
  /// The language whose plural rules choose among them, as ICU names it.
  std::string language;
};

/// A string with that text; invalid UTF-8 becomes U+FFFD.
Ref<NSString> string(std::string_view utf8);
Ref<NSString> string(std::u16string_view text);
/// The text of a string as UTF-8; empty for nil and for objects of other classes.
std::string utf8(const id& string);
/// The number of UTF-16 units of a string or attributed string; 0 for anything else.
std::size_t lengthOfText(const id& text);

/// What fills a placeholder: an object for "%@", an integer for "%d" and "%lld".
using FormatArgument = std::variant<id, std::int64_t>;

/// Fills "%@", "%d", "%lld", their positional forms ("%2$@") and "%%". Objects print by their
/// `description`, strings as they are. A plural format chooses its text by its first integer
/// argument; without one it is the text for "other". A nil format or a nil argument gives nil. A
/// placeholder without a fitting argument prints nothing, and a lone "%" prints itself: a faulty
/// translation stays readable.
/// Integers are written in ASCII digits.
Ref<NSString> stringWithFormat(const Ref<NSString>& format,
                               std::initializer_list<FormatArgument> arguments);
/// The same, with integers in the user's digits and grouping.
Ref<NSString> localizedStringWithFormat(const Ref<NSString>& format,
                                        std::initializer_list<FormatArgument> arguments);

/// The pieces between line breaks (every newline character of Unicode); empty pieces included.
Ref<NSArray> componentsSeparatedByNewlines(const NSString& text);
/// The whole number that the text begins with, after white space and a sign, in digits of any
/// script; 0 when there is none. Numbers beyond 64 bits become the nearest one that fits.
std::int64_t integerValue(const NSString& text);
/// Whether the text occurs in the string, unit by unit; the empty text occurs nowhere.
bool containsString(const NSString& string, std::u16string_view part);
/// The string with every occurrence of `part` replaced.
Ref<NSString> stringByReplacing(const NSString& string, std::u16string_view part,
                                std::u16string_view replacement);

}  // namespace tavro
