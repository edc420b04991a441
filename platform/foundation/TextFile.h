#pragma once

#include <string>
#include <string_view>

#include "platform/foundation/NSBundle.h"

// Text files that people write or export: string tables, and what an application reads.

namespace tavro {

inline std::string inQuotes(std::string_view text) { return "\"" + oneLine(text) + "\""; }

/// A whole file of valid UTF-8.
class TextFile {
 public:
  /// Throws a `FileError` when the file cannot be read or is not UTF-8.
  explicit TextFile(std::string path);

  [[nodiscard]] std::string_view text() const { return text_; }
  /// Throws a `FileError` for the line that holds the byte at `offset`.
  [[noreturn]] void fail(std::size_t offset, std::string_view reason) const;

 private:
  std::string path_;
  std::string text_;
};

/// Adds the plural formats of a `.stringsdict` file to a table; they take the place of plain texts.
/// Throws a `FileError`.
void readPluralFormats(const std::string& path, const std::string& language, StringTable& into);

}  // namespace tavro
