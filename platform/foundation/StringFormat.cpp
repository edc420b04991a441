#include <algorithm>
#include <span>

#include "platform/foundation/IcuSupport.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/TextBuffer.h"

namespace tavro {
namespace {

enum class PlaceholderKind { percent, object, integer };

struct Placeholder {
  PlaceholderKind kind = PlaceholderKind::percent;
  std::size_t length = 0;    ///< units after the per cent sign
  std::size_t position = 0;  ///< counted from 1; 0 takes the next argument
  bool isPositional = false;
};

struct Conversion {
  std::u16string_view text;
  PlaceholderKind kind;
};

constexpr Conversion kConversions[] = {
    {u"@", PlaceholderKind::object},
    {u"d", PlaceholderKind::integer},
    {u"lld", PlaceholderKind::integer},
};

// No format has so many arguments; a longer number would only overflow.
constexpr std::size_t kLastPosition = 1000;

/// Reads "2$" where it stands.
std::size_t readPosition(std::u16string_view text, Placeholder& into) {
  std::size_t position = 0;
  std::size_t length = 0;
  while (length < text.size() && text[length] >= u'0' && text[length] <= u'9') {
    position = std::min(position * 10 + (text[length] - u'0'), kLastPosition);
    ++length;
  }
  if (length == 0 || length == text.size() || text[length] != u'$') {
    return 0;
  }
  into.isPositional = true;
  into.position = position;
  return length + 1;
}

/// What stands after a per cent sign, when it is a placeholder.
bool readPlaceholder(std::u16string_view text, Placeholder& into) {
  if (text.starts_with(u'%')) {
    into = {.length = 1};
    return true;
  }
  into = {};
  const std::size_t start = readPosition(text, into);
  for (const Conversion& conversion : kConversions) {
    if (text.substr(start).starts_with(conversion.text)) {
      into.kind = conversion.kind;
      into.length = start + conversion.text.size();
      return true;
    }
  }
  return false;
}

class Filler {
 public:
  Filler(std::span<const FormatArgument> arguments, bool isLocalized)
      : arguments_(arguments), isLocalized_(isLocalized) {}

  Ref<NSString> fill(std::u16string_view format) {
    while (true) {
      const std::size_t percent = format.find(u'%');
      filled_ += format.substr(0, percent);
      if (percent == std::u16string_view::npos) {
        return string(filled_.text());
      }
      format.remove_prefix(percent + 1);
      Placeholder placeholder;
      if (!readPlaceholder(format, placeholder)) {
        filled_ += u"%";
        continue;
      }
      format.remove_prefix(placeholder.length);
      append(placeholder);
    }
  }

 private:
  void append(const Placeholder& placeholder) {
    if (placeholder.kind == PlaceholderKind::percent) {
      filled_ += u"%";
      return;
    }
    const std::size_t position = placeholder.isPositional ? placeholder.position : ++used_;
    if (position == 0 || position > arguments_.size()) {
      return;
    }
    const FormatArgument& argument = arguments_[position - 1];
    if (const auto* const integer = std::get_if<std::int64_t>(&argument)) {
      if (placeholder.kind == PlaceholderKind::integer) {
        appendInteger(*integer);
      }
    } else if (placeholder.kind == PlaceholderKind::object) {
      appendObject(std::get<id>(argument));
    }
  }

  void appendInteger(std::int64_t integer) {
    if (isLocalized_) {
      filled_ += viewOf(groupedInteger(integer));
      return;
    }
    const std::string digits = std::to_string(integer);
    filled_ += std::u16string(digits.begin(), digits.end());
  }

  void appendObject(const id& object) {
    Ref<NSString> text = as<NSString>(object);
    if (!text) {
      text = as<NSString>(trySend<id>(object, "description"));
    }
    if (text) {
      filled_ += text->text();
    }
  }

  std::span<const FormatArgument> arguments_;
  bool isLocalized_;
  std::size_t used_ = 0;
  TextBuffer filled_;
};

/// The text of a plural format that fits the arguments; of another string its text.
std::u16string_view formatText(const Ref<NSString>& format,
                               std::span<const FormatArgument> arguments) {
  const Ref<NSPluralFormat> plural = as<NSPluralFormat>(format);
  if (!plural) {
    return format->text();
  }
  const auto argument = std::ranges::find_if(arguments, [](const FormatArgument& each) {
    return std::holds_alternative<std::int64_t>(each);
  });
  if (argument == arguments.end()) {
    return format->text();
  }
  const std::string category = pluralCategory(plural->language, std::get<std::int64_t>(*argument));
  const auto form =
      std::ranges::find(plural->forms, category, &std::pair<std::string, std::u16string>::first);
  if (form == plural->forms.end()) {
    return format->text();
  }
  return form->second;
}

Ref<NSString> filled(const Ref<NSString>& format, std::span<const FormatArgument> arguments,
                     bool isLocalized) {
  const bool lacksOne = std::ranges::any_of(arguments, [](const FormatArgument& argument) {
    const id* const object = std::get_if<id>(&argument);
    return object != nullptr && !*object;
  });
  if (!format || lacksOne) {
    return nullptr;
  }
  return Filler(arguments, isLocalized).fill(formatText(format, arguments));
}

}  // namespace

Ref<NSString> stringWithFormat(const Ref<NSString>& format,
                               std::initializer_list<FormatArgument> arguments) {
  return filled(format, {arguments.begin(), arguments.size()}, false);
}

Ref<NSString> localizedStringWithFormat(const Ref<NSString>& format,
                                        std::initializer_list<FormatArgument> arguments) {
  return filled(format, {arguments.begin(), arguments.size()}, true);
}

}  // namespace tavro
