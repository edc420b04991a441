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

constexpr char16_t kRightToLeftMark = 0x200F;

bool isDirectionMark(char16_t unit) {
  return unit == 0x061C || unit == 0x200E || unit == kRightToLeftMark ||
         (unit >= 0x202A && unit <= 0x202E) || (unit >= 0x2066 && unit <= 0x2069);
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

/// Nothing has blanks around it, or a mark of direction where none belongs. In a right-to-left
/// language a text that ends in a placeholder ends with a mark, since the placeholder may be Latin
/// text that would draw the digits of what follows to its own side. Numbers and percentages bring
/// the marks that they need inside.
void checkEdges(const std::string& language, std::u16string_view text) {
  const bool isMarked = text.ends_with(kRightToLeftMark);
  std::u16string_view body = text;
  body.remove_suffix(isMarked ? 1 : 0);
  static const std::regex endsInPlaceholder("%([0-9]+\\$)?(lld|d|@)$");
  const bool needsMark = uloc_isRightToLeft(language.c_str()) != 0 &&
                         std::regex_search(inUtf8(body), endsInPlaceholder);
  EXPECT_EQ(isMarked, needsMark) << "a direction mark at the end";
  EXPECT_FALSE(std::ranges::any_of(body, isDirectionMark)) << "a direction mark inside";
  ASSERT_FALSE(body.empty());
  EXPECT_FALSE(u_isUWhiteSpace(body.front()) || u_isUWhiteSpace(body.back())) << "a blank around";
}

/// One text against the English text of its kind.
void checkText(const std::string& language, const Text& text, std::u16string_view english) {
  checkEdges(language, text.text);
  const Set placeholders = placeholdersOf(text.text);
  const bool saysItsNumber = placeholders.empty() && !text.category.empty() &&
                             standsForOneInteger(language, text.category);
  if (!saysItsNumber) {
    EXPECT_EQ(placeholders, placeholdersOf(english));
  }
  EXPECT_EQ(numbersOf(text.text), numbersOf(english));
  EXPECT_EQ(std::ranges::count(text.text, u'\n'), std::ranges::count(english, u'\n'));
}

void checkEntry(const std::string& language, const Ref<NSString>& entry,
                const Ref<NSString>& english) {
  Set categories;
  for (const Text& text : textsOf(entry)) {
    SCOPED_TRACE(text.category);
    checkText(language, text, english->text());
    categories.insert(text.category);
  }
  const bool isPlural = !textsOf(english).front().category.empty();
  EXPECT_EQ(categories, isPlural ? pluralCategories(language) : Set{""});
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
    const StringTable english = readTable(tables.folder(), "en", tables.name);
    for (const std::string& language : languagesOf(tables.folder())) {
      const StringTable table = readTable(tables.folder(), language, tables.name);
      EXPECT_EQ(table.size(), english.size()) << language << " has other keys";
      for (const auto& [key, entry] : english) {
        SCOPED_TRACE(language + " " + key);
        ASSERT_TRUE(table.contains(key));
        checkEntry(language, table.at(key), entry);
      }
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

}  // namespace
}  // namespace tavro
