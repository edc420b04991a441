// Format strings with up to three arguments, a line each after the format: a number ("5"), a text
// ("=text") or nil (""). What is filled in agrees with a search for the placeholders.

#include <charconv>
#include <optional>
#include <regex>
#include <vector>

#include "platform/foundation/NSString.h"
#include "tests/fuzz/Fuzz.h"

namespace tavro::fuzz {
namespace {

FormatArgument argumentOf(std::string_view line) {
  if (line.starts_with('=')) {
    return id(string(line.substr(1)));
  }
  std::int64_t number = 0;
  const auto [end, error] = std::from_chars(line.data(), line.data() + line.size(), number);
  return error == std::errc() ? FormatArgument(number) : FormatArgument(id());
}

/// Unit by unit, so that halves of characters stay what they are.
std::wstring wide(std::u16string_view text) { return {text.begin(), text.end()}; }

std::wstring textFor(const std::wsmatch& match, const std::vector<FormatArgument>& arguments,
                     std::size_t& used) {
  if (match.str(1) == L"%") {
    return L"%";
  }
  std::size_t position = used;
  if (match[2].matched) {
    const std::wstring digits = match.str(2);
    const std::size_t first = digits.find_first_not_of(L'0');
    if (first == std::wstring::npos || digits.size() - first > 1) {
      return {};  // no format has ten arguments here
    }
    position = static_cast<std::size_t>(digits.back() - L'1');
  } else {
    ++used;
  }
  const FormatArgument* const argument =
      position < arguments.size() ? &arguments[position] : nullptr;
  const bool wantsObject = match.str(3) == L"@";
  if (argument == nullptr || wantsObject != std::holds_alternative<id>(*argument)) {
    return {};
  }
  return wantsObject ? wide(as<NSString>(std::get<id>(*argument))->text())
                     : std::to_wstring(std::get<std::int64_t>(*argument));
}

std::optional<std::wstring> expected(std::u16string_view format,
                                     const std::vector<FormatArgument>& arguments) {
  for (const FormatArgument& argument : arguments) {
    if (const id* const object = std::get_if<id>(&argument); object != nullptr && !*object) {
      return std::nullopt;
    }
  }
  static const std::wregex placeholder(L"%(%|(?:([0-9]+)\\$)?(@|d|lld))");
  const std::wstring text = wide(format);
  std::wstring filled;
  std::size_t used = 0;
  auto rest = text.cbegin();
  for (std::wsregex_iterator each(text.begin(), text.end(), placeholder), end; each != end;
       ++each) {
    filled.append(rest, (*each)[0].first).append(textFor(*each, arguments, used));
    rest = (*each)[0].second;
  }
  return filled.append(rest, text.cend());
}

using Formatter = Ref<NSString> (*)(const Ref<NSString>&, std::initializer_list<FormatArgument>);

Ref<NSString> fill(Formatter formatter, const Ref<NSString>& format,
                   const std::vector<FormatArgument>& all) {
  switch (all.size()) {
    case 0:
      return formatter(format, {});
    case 1:
      return formatter(format, {all[0]});
    case 2:
      return formatter(format, {all[0], all[1]});
    default:
      return formatter(format, {all[0], all[1], all[2]});
  }
}

std::wstring withoutCommas(std::wstring text) {
  std::erase(text, L',');
  return text;
}

}  // namespace
}  // namespace tavro::fuzz

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using namespace tavro;
  constexpr std::size_t kMostArguments = 3;
  std::vector<std::string_view> lines;
  std::string_view rest = fuzz::textOf(data, size);
  while (lines.size() <= kMostArguments) {
    const std::size_t end = rest.find('\n');
    lines.push_back(rest.substr(0, end));
    if (end == std::string_view::npos) {
      break;
    }
    rest.remove_prefix(end + 1);
  }
  const Ref<NSString> format = string(lines.front());
  std::vector<FormatArgument> arguments;
  for (std::size_t line = 1; line < lines.size(); ++line) {
    arguments.push_back(fuzz::argumentOf(lines[line]));
  }
  const std::optional<std::wstring> expected = fuzz::expected(format->text(), arguments);
  const Ref<NSString> filled = fuzz::fill(&stringWithFormat, format, arguments);
  const Ref<NSString> grouped = fuzz::fill(&localizedStringWithFormat, format, arguments);
  fuzz::require(static_cast<bool>(filled) == expected.has_value() &&
                    static_cast<bool>(grouped) == expected.has_value(),
                "nil is filled in with nothing");
  if (expected) {
    fuzz::require(fuzz::wide(filled->text()) == *expected, "placeholders are filled in order",
                  filled->utf8());
    fuzz::require(
        fuzz::withoutCommas(fuzz::wide(grouped->text())) == fuzz::withoutCommas(*expected),
        "in English, the user's digits differ in their grouping alone", grouped->utf8());
  }
  return 0;
}
