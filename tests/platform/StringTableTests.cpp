#include "platform/foundation/NSBundle.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::FoundationTest;
using testing::heard;

class StringTableTest : public FoundationTest {
 protected:
  TemporaryFolder folder_;
};

TEST_F(StringTableTest, ReadsEntriesCommentsAndEscapes) {
  folder_.write("en.lproj/Table.strings",
                "\xEF\xBB\xBF/* a comment\n with \"quotes\"; */\n"
                "\"plain\" = \"text\"; // more \"words\"\n"
                "\"a\"=\"1\";\"b\"\n=\n\"2\"\n;\n"
                "\"escapes\" = \"\\\"x\\\" \\\\ \\n\\t\\r\";\n"
                "\"unicode\" = \"\\U00e9\\u2013\\UD83D\\UDE00 ü – 😀\";\n"
                "\"key \\\"quoted\\\"\" = \"/* kept */ // too\";\n"
                "\"empty\" = \"\";");
  const StringTable table = readStringTable(folder_.path() + "/en.lproj", "Table");
  std::map<std::string, std::string> texts;
  for (const auto& [key, text] : table) {
    texts[key] = heard(text);
  }
  EXPECT_EQ(texts, (std::map<std::string, std::string>{
                       {"plain", "text"},
                       {"a", "1"},
                       {"b", "2"},
                       {"escapes", "\"x\" \\ \n\t\r"},
                       {"unicode", "é–😀 ü – 😀"},
                       {"key \"quoted\"", "/* kept */ // too"},
                       {"empty", ""},
                   }));
}

TEST_F(StringTableTest, AFileMayBeEmpty) {
  folder_.write("en.lproj/Table.strings", "// nothing yet");
  EXPECT_TRUE(readStringTable(folder_.path() + "/en.lproj", "Table").empty());
}

/// The message of the `FileError` that reading a table throws.
std::string errorOf(const std::string& folder) {
  try {
    readStringTable(folder, "Table");
    return "no error";
  } catch (const FileError& error) {
    return error.what();
  }
}

TEST_F(StringTableTest, ABrokenTableIsNamedWithLineAndReason) {
  const std::pair<std::string_view, std::string> cases[] = {
      {"\"a\" = \"1\";\n\"b\" = \"2\"\n\n\"c\" = \"3\";", ":2: a \";\" is missing after the value"},
      {"\"a\" = \"1\"", ":1: a \";\" is missing after the value"},
      {"\n\"a\"\n\"1\";", ":2: a \"=\" is missing after the key"},
      {"\"a\" = one;", ":1: a value in quotation marks is missing after the \"=\""},
      {"\"a\"\n=\n\n", ":2: a value in quotation marks is missing after the \"=\""},
      {"\n\na = \"1\";", ":3: a key in quotation marks is missing"},
      {"\"a\" = \"1\";;", ":1: a key in quotation marks is missing"},
      {"\"a\" = \"1\";\n\"b\" = \"1;\n", ":2: the text is not closed on its line"},
      {"\"a\" = \"1\\", ":1: no such escape follows the \"\\\""},
      {"\"a\" = \"\\q\";", ":1: no such escape follows the \"\\\""},
      {"\n\"a\" = \"\\U12\";", ":2: a \"\\U\" needs four hexadecimal digits"},
      {"\"a\" = \"\\U12", ":1: a \"\\U\" needs four hexadecimal digits"},
      {"\"a\" = \"\\UD83D\";", ":1: the text holds half of a surrogate pair"},
      {"\"a\" = \"1\";\n/* open\n\n", ":2: the comment is not closed"},
      {"\"a\" = \"1\";\n\"b\" = \"2\";\n\"a\" = \"3\";",
       ":3: the key \"a\" stands in the file twice"},
      {"\"a\" = \"1\";\n\"b\" = \"\xFF\";", ":2: the text is not valid UTF-8"}};
  for (const auto& [text, error] : cases) {
    const std::string file = folder_.file("en.lproj/Table.strings", text);
    EXPECT_EQ(errorOf(folder_.path() + "/en.lproj"), file + error);
  }
}

TEST_F(StringTableTest, AMissingFileIsNamed) {
  EXPECT_EQ(errorOf(folder_.path() + "/en.lproj"),
            folder_.path() + "/en.lproj/Table.strings: the file cannot be read");
}

constexpr std::string_view kPluralHead =
    "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
    "<!DOCTYPE plist PUBLIC \"-//EXAMPLE//DTD PLIST 1.0//EN\" \"plist.dtd\">\n"
    "<plist version=\"1.0\"><dict>\n";  // the body begins in line 4
constexpr std::string_view kPluralTail = "</dict></plist>\n";

std::string pluralFile(std::string_view body) {
  return std::string(kPluralHead) + std::string(body) + std::string(kPluralTail);
}

/// A format "minutes" whose variable "n" has the given entries.
std::string pluralEntry(std::string_view forms) {
  return "<key>minutes</key>\n<dict>\n"
         "<key>NSStringLocalizedFormatKey</key><string>%#@n@</string>\n"
         "<key>n</key>\n<dict>\n" +
         std::string(forms) + "</dict>\n</dict>\n";
}

constexpr std::string_view kRule =
    "<key>NSStringFormatSpecTypeKey</key><string>NSStringPluralRuleType</string>\n"
    "<key>NSStringFormatValueTypeKey</key><string>lld</string>\n";

TEST_F(StringTableTest, PluralFormatsTakeThePlaceOfPlainTexts) {
  folder_.write("pl.lproj/Table.strings", "\"minutes\" = \"plain\"; \"left\" = \"%d alone\";");
  folder_.write("pl.lproj/Table.stringsdict",
                pluralFile(pluralEntry(std::string(kRule) +
                                       "<key>one</key><string>%d minuta</string>\n"
                                       "<!-- a word to translators -->\n"
                                       "<key>few</key><string>%d minuty</string>\n"
                                       "<key>many</key><string>%d minut &amp; 1</string>\n"
                                       "<key>other</key><string>%d minuty (o)</string>\n")));
  const StringTable table = readStringTable(folder_.path() + "/pl.lproj", "Table");
  const Ref<NSString> minutes = table.at("minutes");
  EXPECT_EQ(heard(minutes), "%d minuty (o)");
  const std::pair<std::int64_t, std::string_view> cases[] = {
      {1, "1 minuta"}, {2, "2 minuty"}, {5, "5 minut & 1"}, {22, "22 minuty"}};
  for (const auto& [integer, expected] : cases) {
    EXPECT_EQ(heard(stringWithFormat(minutes, {integer})), expected);
    EXPECT_EQ(heard(stringWithFormat(table.at("left"), {integer})),
              std::to_string(integer) + " alone");
  }
}

TEST_F(StringTableTest, PluralRulesAreThoseOfTheFoldersLanguage) {
  const std::string file = pluralFile(
      pluralEntry(std::string(kRule) +
                  "<key>one</key><string>one</string><key>other</key><string>other</string>"));
  const std::pair<std::string, std::string_view> cases[] = {
      {"pt-BR", "one"}, {"pt-PT", "other"}, {"fr", "one"}, {"zh-Hans", "other"}};
  for (const auto& [language, zero] : cases) {
    const std::string folder = language + ".lproj";
    folder_.write(folder + "/Table.strings", "");
    folder_.write(folder + "/Table.stringsdict", file);
    const StringTable table = readStringTable(folder_.path() + "/" + folder, "Table");
    EXPECT_EQ(heard(stringWithFormat(table.at("minutes"), {std::int64_t{0}})), zero) << language;
  }
}

TEST_F(StringTableTest, ABrokenPluralFileIsNamedWithLineAndReason) {
  folder_.write("en.lproj/Table.strings", "");
  const std::pair<std::string, std::string> cases[] = {
      {"<plist>\n<dict>\n</plist>", ":3: the XML is malformed: "},
      {"", ":1: the XML is malformed: "},
      {"<strings/>", ":1: the file is not a property list of a dictionary"},
      {"<plist>\n\xFF</plist>", ":2: the text is not valid UTF-8"},
      {pluralFile("<key>minutes</key>\n"), ":4: a dictionary needs a value for each key"},
      {pluralFile("\n<string>a</string><key>b</key>\n"),
       ":5: a dictionary needs a value for each key"},
      {pluralFile("<key>minutes</key>\n<string>x</string>\n"),
       ":5: the value of \"minutes\" is not a dictionary"},
      {pluralFile("<key>minutes</key>\n<dict></dict>\n"),
       ":5: \"minutes\" has no \"NSStringLocalizedFormatKey\""},
      {pluralFile("<key>minutes</key><dict>\n"
                  "<key>NSStringLocalizedFormatKey</key>\n"
                  "<string>%d minutes</string></dict>\n"),
       ":6: the format of \"minutes\" is not of the form \"%#@name@\""},
      {pluralFile("<key>minutes</key><dict>\n"
                  "<key>NSStringLocalizedFormatKey</key>\n"
                  "<string>%#@other@</string></dict>\n"),
       ":4: \"minutes\" has no \"other\""},
      {pluralFile(pluralEntry(kRule)), ":8: \"n\" has no \"other\""},
      {pluralFile(pluralEntry("<key>other</key><string>x</string>")),
       ":8: \"n\" has no \"NSStringFormatSpecTypeKey\""},
      {pluralFile(pluralEntry("<key>NSStringFormatSpecTypeKey</key>\n<string>Gender</string>")),
       ":10: the only rule is \"NSStringPluralRuleType\""},
      {pluralFile(pluralEntry(
           "<key>NSStringFormatSpecTypeKey</key><string>NSStringPluralRuleType</string>\n"
           "<key>NSStringFormatValueTypeKey</key><string>@</string>")),
       ":10: the value type is neither \"d\" nor \"lld\""},
      {pluralFile(pluralEntry(std::string(kRule) + "<key>other</key><string>x</string>\n"
                                                   "<key>several</key><string>y</string>")),
       ":12: \"several\" is not a plural category"},
      {pluralFile(pluralEntry(std::string(kRule) + "<key>other</key><string>x</string>\n"
                                                   "<key>other</key><string>y</string>")),
       ":12: the key \"other\" stands in its dictionary twice"},
      {pluralFile(pluralEntry(std::string(kRule) + "<key>other</key><true/>")),
       ":11: the value of \"other\" is not a string"}};
  for (const auto& [text, expected] : cases) {
    const std::string file = folder_.file("en.lproj/Table.stringsdict", text);
    const std::string error = errorOf(folder_.path() + "/en.lproj");
    EXPECT_TRUE(error.starts_with(file + expected)) << error;
  }
}

class BundleTest : public StringTableTest {
 protected:
  Ref<NSBundle> bundle() { return NSBundle::bundleWithPath(folder_.path()); }
  std::string text(std::string_view key, const Ref<NSString>& value = string("")) {
    return heard(bundle()->localizedStringForKey(string(key), value, "Table"));
  }
};

TEST_F(BundleTest, TheLanguageIsTheOneThatFitsBest) {
  for (const char* const language : {"en", "de", "pt-BR", "zh-Hans", "zh-Hant", "ar", "nb"}) {
    folder_.write(std::string(language) + ".lproj/Table.strings", "");
  }
  folder_.write("ja.lproj/Other.strings", "");
  folder_.write("fr.folder/Table.strings", "");
  EXPECT_EQ(bundle()->languagesOfTable("Table"),
            (std::vector<std::string>{"ar", "de", "en", "nb", "pt-BR", "zh-Hans", "zh-Hant"}));
  const std::pair<std::string, std::string_view> cases[] = {
      {"en_GB", "en"}, {"pt_PT", "pt-BR"}, {"zh_CN", "zh-Hans"}, {"zh_TW", "zh-Hant"},
      {"no_NO", "nb"}, {"ja_JP", "en"},    {"xx", "en"},         {"de_DE@calendar=hebrew", "de"},
  };
  for (const auto& [locale, expected] : cases) {
    settings_.locale = locale;
    EXPECT_EQ(bundle()->languageForTable("Table"), expected) << locale;
  }
  EXPECT_EQ(bundle()->languageForTable("Other"), "ja");
  EXPECT_EQ(bundle()->languageForTable("Missing"), "");
}

TEST_F(BundleTest, TextsFollowTheLocaleAndMissingOnesFallBack) {
  folder_.write("en.lproj/Table.strings", "\"today\" = \"Today\"; \"empty\" = \"\";");
  folder_.write("de.lproj/Table.strings", "\"today\" = \"Heute\";");
  EXPECT_EQ(text("today"), "Today");
  settings_.locale = "de_CH";
  EXPECT_EQ(text("today"), "Heute");
  settings_.locale = "en_US";
  EXPECT_EQ(text("today"), "Today");
  EXPECT_EQ(text("empty"), "");
  EXPECT_EQ(text("no.such.key"), "no.such.key");
  EXPECT_EQ(text("no.such.key", nullptr), "no.such.key");
  EXPECT_EQ(text("no.such.key", string("value")), "value");
  EXPECT_EQ(heard(bundle()->localizedStringForKey(string("today"), nullptr, "Missing")), "today");
  EXPECT_FALSE(bundle()->localizedStringForKey(nullptr, nullptr, "Table"));
}

TEST_F(BundleTest, ATableIsReadOnce) {
  folder_.write("en.lproj/Table.strings", "\"today\" = \"Today\";");
  EXPECT_EQ(text("today"), "Today");
  folder_.write("en.lproj/Table.strings", "\"today\" = \"changed\";");
  EXPECT_EQ(text("today"), "Today");
  EXPECT_EQ(&bundle()->table("Table"), &bundle()->table("Table"));
}

TEST_F(BundleTest, ABrokenTableIsReportedToWhoAsksAndSilentInTexts) {
  const std::string file = folder_.file("en.lproj/Table.strings", "\"today\" = \"Today\"");
  EXPECT_EQ(text("today"), "today");
  EXPECT_THROW(bundle()->table("Table"), FileError);
  EXPECT_THROW(bundle()->table("Missing"), FileError);
}

class BundledThing : public NSObject {
 public:
  static constexpr Name className = "FoundationTestBundledThing";
};

TEST_F(BundleTest, AClassBelongsToTheBundleThatDeclaredIt) {
  {
    const ImageScope scope(folder_.path());
    declareClass(defineClass<BundledThing, NSObject>().take());
  }
  folder_.write("en.lproj/Table.strings", "\"today\" = \"Today\";");
  const Ref<NSBundle> owner = NSBundle::bundleForClass(classOf<BundledThing>());
  EXPECT_EQ(owner->path(), folder_.path());
  EXPECT_EQ(owner, bundle());
  const Ref<NSBundle> main = NSBundle::bundleForClass(classOf<NSString>());
  EXPECT_EQ(main->path(), "");
  EXPECT_EQ(main, NSBundle::bundleForClass(classOf<NSObject>()));
  EXPECT_TRUE(main->languagesOfTable("Table").empty());
  EXPECT_FALSE(NSBundle::bundleForClass(nullptr));
}

}  // namespace
}  // namespace tavro
