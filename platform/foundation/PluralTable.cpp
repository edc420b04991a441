#include <algorithm>
#include <pugixml.hpp>
#include <span>

#include "platform/foundation/TextFile.h"

namespace tavro {
namespace {

constexpr std::string_view kFormatKey = "NSStringLocalizedFormatKey";
constexpr std::string_view kRuleKey = "NSStringFormatSpecTypeKey";
constexpr std::string_view kRule = "NSStringPluralRuleType";
constexpr std::string_view kTypeKey = "NSStringFormatValueTypeKey";
constexpr std::string_view kTypes[] = {"d", "lld"};
constexpr std::string_view kCategories[] = {"zero", "one", "two", "few", "many", "other"};

bool isOneOf(std::span<const std::string_view> texts, std::string_view text) {
  return std::ranges::find(texts, text) != texts.end();
}

/// Reads a property list whose dictionaries hold one plural format each.
class PluralReader {
 public:
  PluralReader(const TextFile& file, const std::string& language)
      : file_(file), language_(language) {}

  void readInto(StringTable& table) {
    pugi::xml_document document;
    const pugi::xml_parse_result result = document.load_buffer(
        file_.text().data(), file_.text().size(), pugi::parse_default, pugi::encoding_utf8);
    if (!result) {
      file_.fail(static_cast<std::size_t>(result.offset),
                 "the XML is malformed: " + std::string(result.description()));
    }
    const pugi::xml_node list = document.child("plist");
    if (!list || !list.child("dict")) {
      fail(list, "the file is not a property list of a dictionary");
    }
    for (const Entry& entry : entriesOf(list.child("dict"))) {
      table[std::string(entry.key)] = readFormat(entry);
    }
  }

 private:
  struct Entry {
    std::string_view key;
    pugi::xml_node value;
  };

  [[noreturn]] void fail(const pugi::xml_node& node, std::string_view reason) const {
    file_.fail(static_cast<std::size_t>(std::max<std::ptrdiff_t>(node.offset_debug(), 0)), reason);
  }

  std::vector<Entry> entriesOf(const pugi::xml_node& dictionary) const {
    std::vector<Entry> entries;
    for (pugi::xml_node key = dictionary.first_child(); key;) {
      const pugi::xml_node value = key.next_sibling();
      if (std::string_view(key.name()) != "key" || !value) {
        fail(key, "a dictionary needs a value for each key");
      }
      const std::string_view name = key.text().get();
      if (std::ranges::find(entries, name, &Entry::key) != entries.end()) {
        fail(key, "the key " + inQuotes(name) + " stands in its dictionary twice");
      }
      entries.push_back({name, value});
      key = value.next_sibling();
    }
    return entries;
  }

  std::vector<Entry> dictionaryOf(const Entry& entry) const {
    if (std::string_view(entry.value.name()) != "dict") {
      fail(entry.value, "the value of " + inQuotes(entry.key) + " is not a dictionary");
    }
    return entriesOf(entry.value);
  }

  std::string_view textOf(const Entry& entry) const {
    if (std::string_view(entry.value.name()) != "string") {
      fail(entry.value, "the value of " + inQuotes(entry.key) + " is not a string");
    }
    return entry.value.text().get();
  }

  const Entry& require(const std::vector<Entry>& entries, std::string_view key,
                       const Entry& owner) const {
    const auto found = std::ranges::find(entries, key, &Entry::key);
    if (found == entries.end()) {
      fail(owner.value, inQuotes(owner.key) + " has no " + inQuotes(key));
    }
    return *found;
  }

  Ref<NSString> readFormat(const Entry& entry) const {
    const std::vector<Entry> parts = dictionaryOf(entry);
    const Entry& format = require(parts, kFormatKey, entry);
    std::string_view variable = textOf(format);
    if (!variable.starts_with("%#@") || !variable.ends_with('@') || variable.size() < 5) {
      fail(format.value,
           "the format of " + inQuotes(entry.key) + " is not of the form \"%#@name@\"");
    }
    variable = variable.substr(3, variable.size() - 4);
    return readForms(require(parts, variable, entry));
  }

  Ref<NSString> readForms(const Entry& variable) const {
    const std::vector<Entry> parts = dictionaryOf(variable);
    const Entry& rule = require(parts, kRuleKey, variable);
    if (textOf(rule) != kRule) {
      fail(rule.value, "the only rule is " + inQuotes(kRule));
    }
    const Entry& type = require(parts, kTypeKey, variable);
    if (!isOneOf(kTypes, textOf(type))) {
      fail(type.value, "the value type is neither \"d\" nor \"lld\"");
    }
    const Entry& other = require(parts, "other", variable);
    Ref<NSPluralFormat> format = make<NSPluralFormat>();
    format->language = language_;
    format->initWithText(string(textOf(other))->text());
    for (const Entry& part : parts) {
      if (part.key == kRuleKey || part.key == kTypeKey) {
        continue;
      }
      if (!isOneOf(kCategories, part.key)) {
        fail(part.value, inQuotes(part.key) + " is not a plural category");
      }
      format->forms.emplace_back(part.key, string(textOf(part))->text());
    }
    return format;
  }

  const TextFile& file_;
  const std::string& language_;
};

}  // namespace

void readPluralFormats(const std::string& path, const std::string& language, StringTable& into) {
  const TextFile file(path);
  PluralReader(file, language).readInto(into);
}

}  // namespace tavro
