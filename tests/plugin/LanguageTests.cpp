#include <unicode/plurrule.h>
#include <unicode/uchar.h>
#include <unicode/uloc.h>

#include <algorithm>
#include <iterator>
#include <memory>
#include <regex>
#include <set>

#include "platform/foundation/NSBundle.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using ::tavro::testing::TemporaryFolder;
using Lines = std::vector<std::string>;
using Set = std::set<std::string>;

const Set kLanguages = {"ar", "ca", "cs", "da",    "de", "el", "en",      "en-GB",  "es", "es-419",
                        "fa", "fi", "fr", "fr-CA", "he", "hi", "hr",      "hu",     "id", "it",
                        "ja", "ko", "ms", "nb",    "nl", "pl", "pt-BR",   "pt-PT",  "ro", "ru",
                        "sk", "sv", "th", "tr",    "uk", "vi", "zh-Hans", "zh-Hant"};

/// Where a table's language folders stand in the project.
struct Tables {
  const char* room;
  const char* name;

  [[nodiscard]] std::string folder() const {
    return std::string(TAVRO_SOURCE) + "/" + room + "/resources";
  }
};
constexpr Tables kTables[] = {{"plugin", "Accessibility"}, {"reader", "Reader"}};

// What can be wrong with a translation. Each fault is a line that begins with language and key.

constexpr char16_t kRightToLeftMark = 0x200F;

bool isDirectionMark(char16_t unit) {
  return unit == 0x061C || unit == 0x200E || unit == kRightToLeftMark ||
         (unit >= 0x202A && unit <= 0x202E) || (unit >= 0x2066 && unit <= 0x2069);
}

bool readsRightToLeft(const std::string& language) {
  return uloc_isRightToLeft(language.c_str()) != 0;
}

/// One text of a table; a plural format has one for each category.
struct Text {
  std::string category;  ///< empty for a plain text
  std::u16string text;
};

std::vector<Text> textsOf(const Ref<NSString>& entry) {
  const auto plural = as<NSPluralFormat>(entry);
  if (!plural) {
    return {{"", std::u16string(entry->text())}};
  }
  std::vector<Text> texts;
  for (const auto& [category, text] : plural->forms) {
    texts.push_back({category, text});
  }
  return texts;
}

std::string inUtf8(std::u16string_view text) { return string(text)->utf8(); }

const std::regex kPlaceholder("%([0-9]+\\$)?(lld|d|@|%)");

Set placeholdersOf(std::u16string_view text) {
  const std::string all = inUtf8(text);
  Set found;
  for (std::sregex_iterator each(all.begin(), all.end(), kPlaceholder), end; each != end; ++each) {
    found.insert(each->str());
  }
  const std::string rest = std::regex_replace(all, kPlaceholder, "");
  if (rest.find('%') != std::string::npos) {
    found.insert("a lone %");
  }
  return found;
}

/// The text without its placeholders.
Ref<NSString> wordsOf(std::u16string_view text) {
  return string(std::regex_replace(inUtf8(text), kPlaceholder, " "));
}

/// The numbers that stand in a text itself, whatever their digits.
std::vector<int> numbersOf(std::u16string_view text) {
  std::vector<int> numbers;
  bool isInside = false;
  const Ref<NSString> words = wordsOf(text);
  for (const char16_t unit : words->text()) {
    const int digit = u_charDigitValue(unit);
    if (digit >= 0) {
      if (!isInside) {
        numbers.push_back(0);
      }
      numbers.back() = numbers.back() * 10 + digit;
    }
    isInside = digit >= 0;
  }
  return numbers;
}

std::unique_ptr<icu::PluralRules> pluralRules(const std::string& language) {
  UErrorCode status = U_ZERO_ERROR;
  return std::unique_ptr<icu::PluralRules>(
      icu::PluralRules::forLocale(icu::Locale::forLanguageTag(language, status), status));
}

Set pluralCategories(const std::string& language) {
  UErrorCode status = U_ZERO_ERROR;
  const std::unique_ptr<icu::StringEnumeration> keywords(
      pluralRules(language)->getKeywords(status));
  Set categories;
  while (const char* const keyword = keywords->next(nullptr, status)) {
    categories.insert(keyword);
  }
  return categories;
}

/// Whether one integer only is counted with a category, so that its text can say it in a word.
bool standsForOneInteger(const std::string& language, const std::string& category) {
  constexpr int kBeyondTheRulesPeriod = 1000;
  const auto rules = pluralRules(language);
  int count = 0;
  for (int integer = 0; integer <= kBeyondTheRulesPeriod; ++integer) {
    count +=
        inUtf8(std::u16string(rules->select(integer).getTerminatedBuffer())) == category ? 1 : 0;
  }
  return count == 1;
}

std::string joined(const auto& parts) {
  std::string text;
  for (const auto& part : parts) {
    text += (text.empty() ? "" : " ") + part;
  }
  return text.empty() ? "nothing" : text;
}

/// Whether the text has blanks around it, or a mark of direction where none belongs. In a
/// right-to-left language a text that ends in a placeholder ends with a mark, since the placeholder
/// may be Latin text that would draw the digits of what follows to its own side. Numbers and
/// percentages bring the marks that they need inside.
Lines edgeFaults(const std::string& language, std::u16string_view text) {
  Lines faults;
  const bool isMarked = text.ends_with(kRightToLeftMark);
  std::u16string_view body = text;
  body.remove_suffix(isMarked ? 1 : 0);
  static const std::regex endsInPlaceholder("%([0-9]+\\$)?(lld|d|@)$");
  const bool needsMark =
      readsRightToLeft(language) && std::regex_search(inUtf8(body), endsInPlaceholder);
  if (isMarked != needsMark || std::ranges::any_of(body, isDirectionMark)) {
    faults.emplace_back(needsMark && !isMarked ? "lacks its direction mark"
                                               : "has a direction mark that does nothing");
  }
  if (body.empty() || u_isUWhiteSpace(body.front()) || u_isUWhiteSpace(body.back())) {
    faults.emplace_back("is empty or has a blank at an edge");
  }
  return faults;
}

/// What is wrong with one text, compared with the English text of its kind.
Lines textFaults(const std::string& language, const Text& text, std::u16string_view english) {
  Lines faults = edgeFaults(language, text.text);
  Set expected = placeholdersOf(english);
  const Set placeholders = placeholdersOf(text.text);
  const bool saysItsNumber = placeholders.empty() && !text.category.empty() &&
                             standsForOneInteger(language, text.category);
  if (placeholders != expected && !saysItsNumber) {
    faults.push_back("has " + joined(placeholders) + ", not " + joined(expected));
  }
  if (numbersOf(text.text) != numbersOf(english)) {
    faults.emplace_back("has other numbers in it");
  }
  if (std::ranges::count(text.text, u'\n') != std::ranges::count(english, u'\n')) {
    faults.emplace_back("has another number of lines");
  }
  return faults;
}

/// What is wrong with the translation of one key.
Lines entryFaults(const std::string& language, const Ref<NSString>& entry,
                  const Ref<NSString>& english) {
  Lines faults;
  const std::vector<Text> texts = textsOf(entry);
  const bool isPlural = !textsOf(english).front().category.empty();
  Set categories;
  for (const Text& text : texts) {
    for (const std::string& fault : textFaults(language, text, english->text())) {
      faults.push_back((text.category.empty() ? "" : text.category + " ") + fault);
    }
    categories.insert(text.category);
  }
  const Set expected = isPlural ? pluralCategories(language) : Set{""};
  if (categories != expected) {
    faults.push_back("is for " + joined(categories) + ", not " + joined(expected));
  }
  return faults;
}

Lines tableFaults(const std::string& language, const StringTable& table,
                  const StringTable& english) {
  Lines faults;
  for (const auto& [key, entry] : english) {
    const auto found = table.find(key);
    if (found == table.end()) {
      faults.push_back(language + " " + key + " is missing");
      continue;
    }
    for (const std::string& fault : entryFaults(language, found->second, entry)) {
      faults.push_back(language + " " + key + " " + fault);
    }
  }
  for (const auto& [key, entry] : table) {
    if (!english.contains(key)) {
      faults.push_back(language + " " + key + " is no key of the English table");
    }
  }
  return faults;
}

StringTable readTable(const std::string& folder, const std::string& language,
                      const std::string& name) {
  return readStringTable(folder + "/" + language + ".lproj", name);
}

Set languagesOf(const std::string& folder) {
  Set languages;
  for (const auto& each : std::filesystem::directory_iterator(folder)) {
    if (each.path().extension() == ".lproj") {
      languages.insert(each.path().stem().string());
    }
  }
  return languages;
}

Lines faultsOf(const std::string& folder, const std::string& name) {
  const StringTable english = readTable(folder, "en", name);
  Lines faults;
  for (const std::string& language : languagesOf(folder)) {
    try {
      std::ranges::move(tableFaults(language, readTable(folder, language, name), english),
                        std::back_inserter(faults));
    } catch (const FileError& error) {
      faults.emplace_back(error.what());
    }
  }
  return faults;
}

bool hasWords(std::u16string_view text) {
  const Ref<NSString> words = wordsOf(text);
  return std::ranges::any_of(words->text(), [](char16_t unit) { return u_isalpha(unit) != 0; });
}

/// The keys whose text is the English one, as "LANGUAGE KEY". The other Englishes are no
/// translations, and a text of placeholders alone has nothing to translate.
Lines untranslated(const std::string& folder, const std::string& name) {
  const StringTable english = readTable(folder, "en", name);
  Lines found;
  for (const std::string& language : languagesOf(folder)) {
    if (language.starts_with("en")) {
      continue;
    }
    for (const auto& [key, entry] : readTable(folder, language, name)) {
      const auto original = english.find(key);
      if (original != english.end() && original->second->text() == entry->text() &&
          hasWords(entry->text())) {
        found.push_back(language + " " + key);
      }
    }
  }
  return found;
}

TEST(Languages, AreTheSameInEachRoom) {
  for (const Tables& tables : kTables) {
    EXPECT_EQ(languagesOf(tables.folder()), kLanguages) << tables.room;
  }
}

TEST(Languages, HaveTablesWithoutFaults) {
  for (const Tables& tables : kTables) {
    for (const std::string& fault : faultsOf(tables.folder(), tables.name)) {
      ADD_FAILURE() << tables.room << " " << fault;
    }
  }
}

TEST(Languages, AreTranslatedButForWhatTheListAllows) {
  const std::string path = std::string(TAVRO_SOURCE) + "/tests/data/untranslated.txt";
  std::ifstream file(path);
  ASSERT_TRUE(file) << path << " is missing";
  Set allowed;
  for (std::string line; std::getline(file, line);) {
    if (!line.empty() && line.front() != '#') {
      allowed.insert(line);
    }
  }
  Set found;
  for (const Tables& tables : kTables) {
    for (const std::string& each : untranslated(tables.folder(), tables.name)) {
      found.insert(std::string(tables.room) + " " + each);
    }
  }
  for (const std::string& each : found) {
    EXPECT_TRUE(allowed.contains(each)) << each << " is still English";
  }
  for (const std::string& each : allowed) {
    EXPECT_TRUE(found.contains(each)) << each << " is translated or gone: take it out of " << path;
  }
}

std::string pluralFile(std::string_view forms) {
  return "<plist><dict><key>count</key><dict><key>NSStringLocalizedFormatKey</key>"
         "<string>%#@n@</string><key>n</key><dict><key>NSStringFormatSpecTypeKey</key>"
         "<string>NSStringPluralRuleType</string><key>NSStringFormatValueTypeKey</key>"
         "<string>lld</string>" +
         std::string(forms) + "</dict></dict></dict></plist>";
}

std::string form(const std::string& category, const std::string& text) {
  return "<key>" + category + "</key><string>" + text + "</string>";
}

/// A translation of the English table below, and what there is to say about it.
struct Fault {
  const char* language;
  std::string entries;
  std::string forms;
  Lines faults;
};

const std::string kPolishForms = form("one", "%lld a") + form("few", "%lld b") +
                                 form("many", "%lld c") + form("other", "%lld d");
const std::string kGermanForms = form("one", "%lld a") + form("other", "%lld b");
const std::string kHebrewForms = form("one", "א") + form("two", "ב") + form("other", "%lld ג");

const Fault kFaults[] = {
    {"de", R"("range" = "%2$@ nach %1$@"; "year" = "365 Tage";)", kGermanForms, {}},
    {"fa", R"("range" = "%1$@ a %2$@\U200F"; "year" = "۳۶۵";)", kGermanForms, {}},
    {"he", R"("range" = "%1$@ %2$@\U200F"; "year" = "365 a";)", kHebrewForms, {}},
    {"de",
     R"("range" = "%1$@ %2$@"; "more" = "a";)",
     kGermanForms,
     {"de year is missing", "de more is no key of the English table"}},
    {"de",
     R"("range" = "%1$@ bis %2$lld"; "year" = "356 Tage";)",
     kGermanForms,
     {"de range has %1$@ %2$lld, not %1$@ %2$@", "de year has other numbers in it"}},
    {"de",
     R"("range" = "%@ %2$@"; "year" = "365 % Tage";)",
     kGermanForms,
     {"de range has %2$@ %@, not %1$@ %2$@", "de year has a lone %, not nothing"}},
    {"de",
     R"("range" = " %1$@ %2$@"; "year" = "365 Tage\n";)",
     kGermanForms,
     {"de range is empty or has a blank at an edge", "de year is empty or has a blank at an edge",
      "de year has another number of lines"}},
    {"de",
     R"("range" = "%1$@ %2$@\U200F"; "year" = "\U200E365";)",
     kGermanForms,
     {"de range has a direction mark that does nothing",
      "de year has a direction mark that does nothing"}},
    {"he",
     R"("range" = "%1$@ %2$@"; "year" = "365\U200F";)",
     kHebrewForms,
     {"he range lacks its direction mark", "he year has a direction mark that does nothing"}},
    {"de",
     R"("range" = "%1$@ %2$@"; "year" = "365";)",
     form("one", "a") + form("other", "b"),
     {"de count other has nothing, not %lld"}},
    {"pl", R"("range" = "%1$@ %2$@"; "year" = "365";)", kPolishForms, {}},
    {"ru",
     R"("range" = "%1$@ %2$@"; "year" = "365";)",
     form("one", "a") + form("many", "%lld b") + form("other", "%lld c"),
     {"ru count one has nothing, not %lld",
      "ru count is for many one other, not few many one other"}},
    {"fr",
     R"("range" = "%1$@ %2$@"; "year" = "365";)",
     kPolishForms,
     {"fr count is for few many one other, not many one other"}},
};

TEST(Languages, FaultsAreNamed) {
  for (const Fault& fault : kFaults) {
    const TemporaryFolder folder;
    folder.write("en.lproj/Table.strings",
                 R"("range" = "%1$@ to %2$@"; "year" = "365 days"; "count" = "";)");
    folder.write("en.lproj/Table.stringsdict", pluralFile(kGermanForms));
    const std::string language = std::string(fault.language) + ".lproj/Table";
    folder.write(language + ".strings", fault.entries);
    folder.write(language + ".stringsdict", pluralFile(fault.forms));
    EXPECT_EQ(faultsOf(folder.path(), "Table"), fault.faults) << fault.language << fault.entries;
  }
}

}  // namespace
}  // namespace tavro
