#pragma once

#include <map>
#include <stdexcept>
#include <string>

#include "platform/foundation/NSString.h"

namespace tavro {

/// A text of unknown origin on one line of valid UTF-8: line breaks and other controls are blanks.
std::string oneLine(std::string_view text);

/// A file that people can mend: "FILE:LINE: REASON", without a line where the file is missing. One
/// line, whatever the file holds.
class FileError : public std::runtime_error {
 public:
  explicit FileError(std::string_view sentence) : std::runtime_error(oneLine(sentence)) {}
};

/// The texts of one table in one language, by key. A text may be an `NSPluralFormat`.
using StringTable = std::map<std::string, Ref<NSString>, std::less<>>;

/// Reads `<name>.strings` and, where it exists, `<name>.stringsdict` of a language folder
/// (".../pt-BR.lproj"). Throws a `FileError` when the first is missing or either is malformed.
///
/// `.strings`: UTF-8; entries `"key" = "value";`, each text on one line and no key twice; comments
/// of both kinds; the escapes \n \t \r \" \\ and \U or \u with four hexadecimal digits.
/// `.stringsdict`: an XML property list with a plural format for each key ("%#@name@" and the
/// variable's forms, "other" among them), which takes the place of the plain text.
StringTable readStringTable(const std::string& folder, std::string_view name);

/// A folder with code and resources: `Info.strings`, and one `<language>.lproj` a language.
class NSBundle : public NSObject {
 public:
  static constexpr Name className = "NSBundle";

  /// The bundle that holds the class; nil for a nil class. Classes of the executable and of the
  /// platform are in the main bundle, which has no path and no tables.
  static Ref<NSBundle> bundleForClass(Class* isa);
  /// The one bundle object for a folder.
  static Ref<NSBundle> bundleWithPath(std::string_view path);

  [[nodiscard]] const std::string& path() const { return path_; }
  /// The languages for which the bundle has a table of that name, sorted.
  [[nodiscard]] std::vector<std::string> languagesOfTable(std::string_view table) const;
  /// The language that ICU's locale matcher chooses for the settings' locale; where none fits,
  /// English, or the first one where there is no English; empty when there is no such table at
  /// all. The folders are looked at when the table is first asked for in a locale.
  [[nodiscard]] std::string languageForTable(std::string_view table) const;
  /// Reads the table in the user's language unless it was read before. Throws a `FileError`.
  const StringTable& table(std::string_view name);
  /// The text for the key; nil for a missing key or table. Never raises.
  Ref<NSString> textForKey(std::string_view key, std::string_view table);
  /// The text for the key; for a missing key or table the value, or the key itself when the value
  /// is nil or empty. Never raises.
  Ref<NSString> localizedStringForKey(const Ref<NSString>& key, const Ref<NSString>& value,
                                      std::string_view table);

 private:
  /// The language of a table for the locale that last asked.
  struct Choice {
    std::string locale;
    std::string language;
    mutable const StringTable* texts = nullptr;
  };
  const Choice& choiceForTable(std::string_view table) const;
  [[nodiscard]] bool hasTable(std::string_view language, std::string_view table) const;

  std::string path_;
  mutable std::map<std::string, Choice, std::less<>> choices_;  // by table
  std::map<std::string, StringTable, std::less<>> tables_;      // by "<language>/<table>"
};

}  // namespace tavro
