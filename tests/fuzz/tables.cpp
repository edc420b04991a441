// String tables and plural dictionaries: what can be read can be written and read again, and says
// one of its own texts; what cannot is one sentence.

#include <algorithm>

#include "tests/fuzz/Fuzz.h"
#include "tests/support/Process.h"

namespace tavro::fuzz {
namespace {

constexpr std::string_view kSeparator = "\n%%%\n";  // after it, the plural dictionary

std::string escaped(std::string_view text) {
  std::string written;
  for (const char letter : text) {
    constexpr std::string_view kLetters = "\n\t\r\"\\";
    const std::size_t place = kLetters.find(letter);
    written += place == std::string_view::npos ? std::string(1, letter)
                                               : std::string("\\") + "ntr\"\\"[place];
  }
  return written;
}

std::string writtenOut(const StringTable& table) {
  std::string file;
  for (const auto& [key, text] : table) {
    file += "\"" + escaped(key) + "\" = \"" + escaped(text->utf8()) + "\";\n";
  }
  return file;
}

void requirePlural(const NSPluralFormat& plural, const Ref<NSString>& text) {
  const auto fill = [](std::u16string_view format, std::int64_t count) {
    return utf8(stringWithFormat(string(format), {count}));
  };
  for (const std::int64_t count : {0, 1, 2, 5, 21, 1000000}) {
    const std::string filled = utf8(stringWithFormat(text, {count}));
    const bool isForm = std::ranges::any_of(
        plural.forms, [&](const auto& form) { return fill(form.second, count) == filled; });
    require(isForm, "a plural format says one of its forms", filled);
  }
}

void requireConsistent(const StringTable& table, const std::string& folder) {
  for (const auto& [key, text] : table) {
    require(text && utf8(table.find(key)->second) == text->utf8(), "a key has its text", key);
    if (const auto plural = as<NSPluralFormat>(text)) {
      requirePlural(*plural, text);
    }
  }
  write(folder + "/Written.strings", writtenOut(table));
  const StringTable again = readStringTable(folder, "Written");
  require(std::ranges::equal(table, again,
                             [](const auto& left, const auto& right) {
                               return left.first == right.first &&
                                      left.second->text() == right.second->text();
                             }),
          "a table that is written out reads the same", writtenOut(table));
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  static const TemporaryFolder temporary;
  static const std::string folder = temporary.path() + "/pl.lproj";  // a language of many plurals
  std::filesystem::create_directory(folder);
  const std::string_view input = fuzz::textOf(data, size);
  const std::size_t end = input.find(fuzz::kSeparator);
  fuzz::write(folder + "/Table.strings", input.substr(0, end));
  if (end == std::string_view::npos) {
    std::filesystem::remove(folder + "/Table.stringsdict");
  } else {
    fuzz::write(folder + "/Table.stringsdict", input.substr(end + fuzz::kSeparator.size()));
  }
  try {
    fuzz::requireConsistent(readStringTable(folder, "Table"), folder);
  } catch (const FileError& error) {
    fuzz::requireOneSentence(error.what(), folder + "/Table.strings");
  }
  return 0;
}
