#include "platform/foundation/NSString.h"

#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include <algorithm>
#include <limits>

#include "platform/foundation/IcuSupport.h"

namespace tavro {
namespace {

constexpr std::u16string_view kNewlines = u"\n\v\f\r\u0085\u2028\u2029";

}  // namespace

std::string NSString::utf8() const {
  std::string bytes;
  borrowed(text()).toUTF8String(bytes);
  return bytes;
}

void NSString::initWithText(std::u16string_view text) {
  length_ = text.size();
  if (length_ > kShortLength) {
    long_ = std::make_unique_for_overwrite<char16_t[]>(length_);
  }
  text.copy(long_ ? long_.get() : short_.data(), length_);
}

Ref<NSString> string(std::u16string_view text) {
  Ref<NSString> made = make<NSString>();
  made->initWithText(text);
  return made;
}

Ref<NSString> string(std::string_view utf8) {
  // Names and keys, of which hundreds are read when a bundle is opened, need no conversion.
  const bool isAscii =
      std::ranges::all_of(utf8, [](char c) { return static_cast<signed char>(c) >= 0; });
  return isAscii ? string(std::u16string(utf8.begin(), utf8.end())) : stringOf(unicode(utf8));
}

Ref<NSString> stringOf(const icu::UnicodeString& text) { return string(viewOf(text)); }

std::string utf8(const id& string) {
  const Ref<NSString> text = as<NSString>(string);
  return text ? text->utf8() : std::string();
}

Ref<NSArray> componentsSeparatedByNewlines(const NSString& text) {
  std::vector<id> pieces;
  std::u16string_view rest = text.text();
  while (true) {
    const std::size_t end = rest.find_first_of(kNewlines);
    pieces.push_back(string(rest.substr(0, end)));
    if (end == std::u16string_view::npos) {
      return arrayWithObjects(std::move(pieces));
    }
    rest.remove_prefix(end + 1);
  }
}

std::int64_t integerValue(const NSString& text) {
  using Limits = std::numeric_limits<std::int64_t>;
  const icu::UnicodeString whole = borrowed(text.text());
  std::int32_t index = 0;
  while (index < whole.length() && u_isUWhiteSpace(whole.char32At(index)) != 0) {
    index = whole.moveIndex32(index, 1);
  }
  const bool isNegative = index < whole.length() && whole.charAt(index) == u'-';
  if (isNegative || (index < whole.length() && whole.charAt(index) == u'+')) {
    ++index;
  }
  // Summed below zero, where there is one more number.
  std::int64_t sum = 0;
  for (; index < whole.length(); index = whole.moveIndex32(index, 1)) {
    const std::int32_t digit = u_charDigitValue(whole.char32At(index));
    if (digit < 0) {
      break;
    }
    if (sum < (Limits::min() + digit) / 10) {
      return isNegative ? Limits::min() : Limits::max();
    }
    sum = sum * 10 - digit;
  }
  return isNegative ? sum : -std::max(sum, -Limits::max());
}

bool containsString(const NSString& string, std::u16string_view part) {
  return !part.empty() && string.text().find(part) != std::u16string_view::npos;
}

Ref<NSString> stringByReplacing(const NSString& text, std::u16string_view part,
                                std::u16string_view replacement) {
  std::u16string replaced;
  std::u16string_view rest = text.text();
  while (!part.empty()) {
    const std::size_t found = rest.find(part);
    if (found == std::u16string_view::npos) {
      break;
    }
    replaced.append(rest.substr(0, found)).append(replacement);
    rest.remove_prefix(found + part.size());
  }
  return string(replaced.append(rest));
}

namespace {

id description(NSString* self) { return self; }

const Registered kString =
    defineClass<NSString, NSObject>().method<&NSString::length>("length").method<&description>(
        "description");
const Registered kPluralFormat = defineClass<NSPluralFormat, NSString>();

}  // namespace
}  // namespace tavro
