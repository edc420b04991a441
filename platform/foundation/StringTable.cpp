#include <unicode/locid.h>
#include <unicode/uchar.h>
#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "platform/foundation/TextFile.h"

namespace tavro {

std::string oneLine(std::string_view text) {
  std::u16string line(string(text)->text());
  std::ranges::replace_if(
      line,
      [](char16_t unit) { return u_isISOControl(unit) != 0 || unit == 0x2028 || unit == 0x2029; },
      u' ');
  return string(line)->utf8();
}

TextFile::TextFile(std::string path) : path_(std::move(path)) {
  std::ifstream stream(path_, std::ios::binary);
  stream.peek();  // a folder can be opened; reading it is what fails
  if (!stream.is_open() || stream.bad()) {
    throw FileError(path_ + ": the file cannot be read");
  }
  text_.assign(std::istreambuf_iterator<char>(stream), {});
  const auto length = static_cast<std::int32_t>(text_.size());
  for (std::int32_t offset = 0; offset < length;) {
    const auto start = static_cast<std::size_t>(offset);
    UChar32 character = 0;
    U8_NEXT(text_.data(), offset, length, character);
    if (character < 0) {
      fail(start, "the text is not valid UTF-8");
    }
  }
}

void TextFile::fail(std::size_t offset, std::string_view reason) const {
  const auto end = text_.begin() + static_cast<std::ptrdiff_t>(std::min(offset, text_.size()));
  const auto line = std::count(text_.begin(), end, '\n') + 1;
  throw FileError(path_ + ":" + std::to_string(line) + ": " + std::string(reason));
}

namespace {

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kBlanks = " \t\r\n\f\v";

struct Escape {
  char letter;
  char16_t unit;
};
constexpr Escape kEscapes[] = {
    {'n', u'\n'}, {'t', u'\t'}, {'r', u'\r'}, {'"', u'"'}, {'\\', u'\\'},
};

/// Reads `"key" = "value";` entries.
class StringsReader {
 public:
  explicit StringsReader(const TextFile& file) : file_(file), text_(file.text()) {
    if (text_.starts_with(kByteOrderMark)) {
      position_ = kByteOrderMark.size();
    }
  }

  StringTable read() {
    StringTable table;
    for (skipBlanks(); position_ < text_.size(); skipBlanks()) {
      const std::size_t start = position_;
      if (text_[position_] != '"') {
        file_.fail(start, "a key in quotation marks is missing");
      }
      const std::string key = readText()->utf8();
      expect("=", "after the key");
      skipBlanks();
      if (!text_.substr(position_).starts_with('"')) {
        file_.fail(lastEnd_, "a value in quotation marks is missing after the \"=\"");
      }
      const Ref<NSString> value = readText();
      expect(";", "after the value");
      if (!table.emplace(key, value).second) {
        file_.fail(start, "the key " + inQuotes(key) + " stands in the file twice");
      }
    }
    return table;
  }

 private:
  void skipBlanks() {
    while (true) {
      position_ = std::min(text_.find_first_not_of(kBlanks, position_), text_.size());
      const std::string_view rest = text_.substr(position_);
      if (rest.starts_with("//")) {
        position_ = std::min(text_.find('\n', position_), text_.size());
      } else if (rest.starts_with("/*")) {
        const std::size_t end = text_.find("*/", position_ + 2);
        if (end == std::string_view::npos) {
          file_.fail(position_, "the comment is not closed");
        }
        position_ = end + 2;
      } else {
        return;
      }
    }
  }

  /// Passes a sign. What is missing is missing where the text before it ends.
  void expect(std::string_view sign, std::string_view where) {
    skipBlanks();
    if (!text_.substr(position_).starts_with(sign)) {
      file_.fail(lastEnd_, "a " + inQuotes(sign) + " is missing " + std::string(where));
    }
    position_ += sign.size();
    lastEnd_ = position_ - 1;
  }

  /// Passes a text in quotation marks, which ends on its line.
  Ref<NSString> readText() {
    const std::size_t start = position_++;
    std::u16string units;
    while (true) {
      const std::size_t end = std::min(text_.find_first_of("\"\\\n", position_), text_.size());
      units.append(string(text_.substr(position_, end - position_))->text());
      position_ = end;
      if (end == text_.size() || text_[end] == '\n') {
        file_.fail(start, "the text is not closed on its line");
      }
      ++position_;
      if (text_[end] == '"') {
        break;
      }
      units.push_back(readEscape());
    }
    requireWholeCharacters(units, start);
    lastEnd_ = position_ - 1;
    return string(units);
  }

  char16_t readEscape() {
    const char letter = position_ < text_.size() ? text_[position_] : '\n';
    if (letter == 'U' || letter == 'u') {
      ++position_;
      return readHexadecimal();
    }
    for (const Escape& escape : kEscapes) {
      if (escape.letter == letter) {
        ++position_;
        return escape.unit;
      }
    }
    file_.fail(position_ - 1, "no such escape follows the \"\\\"");
  }

  char16_t readHexadecimal() {
    constexpr std::size_t kDigits = 4;
    constexpr std::string_view kHexadecimal = "0123456789abcdef0123456789ABCDEF";
    const std::string_view digits = text_.substr(position_, kDigits);
    if (digits.size() < kDigits || digits.find_first_not_of(kHexadecimal) != digits.npos) {
      file_.fail(position_, "a \"\\U\" needs four hexadecimal digits");
    }
    std::uint32_t unit = 0;
    for (const char digit : digits) {
      unit = unit * 16 + static_cast<std::uint32_t>(kHexadecimal.find(digit) % 16);
    }
    position_ += kDigits;
    return static_cast<char16_t>(unit);
  }

  void requireWholeCharacters(std::u16string_view units, std::size_t start) {
    const auto length = static_cast<std::int32_t>(units.size());
    for (std::int32_t offset = 0; offset < length;) {
      UChar32 character = 0;
      U16_NEXT(units.data(), offset, length, character);
      if (U_IS_SURROGATE(character)) {
        file_.fail(start, "the text holds half of a surrogate pair");
      }
    }
  }

  const TextFile& file_;
  std::string_view text_;
  std::size_t position_ = 0;
  std::size_t lastEnd_ = 0;
};

}  // namespace

StringTable readStringTable(const std::string& folder, std::string_view name) {
  const std::filesystem::path base(folder);
  const std::string file(name);
  const TextFile strings((base / (file + ".strings")).string());
  StringTable table = StringsReader(strings).read();
  const std::filesystem::path plurals = base / (file + ".stringsdict");
  if (std::filesystem::exists(plurals)) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale language = icu::Locale::forLanguageTag(base.stem().string().c_str(), status);
    readPluralFormats(plurals.string(), language.getName(), table);
  }
  return table;
}

}  // namespace tavro
