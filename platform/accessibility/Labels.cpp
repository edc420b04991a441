#include "platform/accessibility/Labels.h"

#include <optional>
#include <string>

#include "platform/accessibility/KeyAccess.h"
#include "platform/accessibility/Traversal.h"
#include "platform/foundation/TextBuffer.h"

namespace tavro {
namespace {

constexpr std::u16string_view kSeparator = u", ";

/// Puts texts together and remembers where each attributed one went.
class Joiner {
 public:
  void add(const id& part) {
    const Ref<NSString> text = plainText(part);
    if (!text || text->length() == 0) {
      return;
    }
    if (!joined_.text().empty()) {
      joined_ += kSeparator;
    }
    if (const auto attributed = as<NSAttributedString>(part)) {
      parts_.push_back({joined_.text().size(), attributed});
    }
    joined_ += text->text();
  }

  [[nodiscard]] id result() const {
    if (joined_.text().empty()) {
      return nullptr;
    }
    const Ref<NSString> text = string(joined_.text());
    if (parts_.empty()) {
      return text;
    }
    const Ref<AXAttributedString> attributed = axAttributedString(text);
    for (const Part& part : parts_) {
      for (const NSAttributedString::Run& run : part.text->runs()) {
        attributed->setAttribute(run.value, run.key,
                                 {part.start + run.range.location, run.range.length});
      }
    }
    return attributed;
  }

 private:
  struct Part {
    std::size_t start;
    Ref<NSAttributedString> text;
  };
  TextBuffer joined_;
  std::vector<Part> parts_;
};

bool isText(const id& object) {
  return isA<NSString>(object.get()) || isA<NSAttributedString>(object.get());
}

bool isInvisibleView(const id& object) {
  return isA<UIView>(object.get()) && !trySend<bool>(object, "_accessibilityViewIsVisible");
}

}  // namespace

id __UIAXStringForVariables(std::initializer_list<id> parts) {
  Joiner joiner;
  for (const id& part : parts) {
    if (const auto text = as<NSString>(part); text && text->text() == kVariablesSentinel) {
      break;
    }
    joiner.add(part);
  }
  return joiner.result();
}

id __AXStringForVariables(std::initializer_list<id> parts) {
  return __UIAXStringForVariables(parts);
}

id AXLabelForElements(const Ref<NSArray>& elements) {
  Joiner joiner;
  if (elements) {
    for (const id& element : *elements) {
      if (isText(element)) {
        joiner.add(element);
      } else if (!isInvisibleView(element)) {
        joiner.add(accessibilityLabelOf(element));
      }
    }
  }
  return joiner.result();
}

id UIAXLabelForElements(const Ref<NSArray>& elements) { return AXLabelForElements(elements); }

CGRect UIAXFrameForElements(const Ref<NSArray>& elements) {
  std::optional<CGRect> frame;
  if (elements) {
    for (const id& element : *elements) {
      AXPerformSafeBlock([&] {
        const auto each = send<CGRect>(element, "accessibilityFrame");
        frame = frame ? CGRectUnion(*frame, each) : each;
      });
    }
  }
  return frame.value_or(CGRect());
}

id UIAXStringForAllChildren(const Ref<UIView>& view) {
  return view ? AXLabelForElements(arrayWithObjects(accessibleDescendants(view))) : id();
}

id stringForLabelKeyValues(const id& object, std::string_view keys) {
  constexpr std::string_view separator = ", ";
  Joiner joiner;
  while (!keys.empty()) {
    const std::size_t end = keys.find(separator);
    const id found = safeValueForKey(object, Name::make(keys.substr(0, end)));
    if (isText(found)) {
      joiner.add(found);
    } else if (!isInvisibleView(found)) {
      joiner.add(accessibilityLabelOf(found));
    }
    keys = end == std::string_view::npos ? std::string_view() : keys.substr(end + separator.size());
  }
  return joiner.result();
}

id accessibilityLabelOf(const id& object) { return trySend<id>(object, "accessibilityLabel"); }

id accessibilityTextForSubhierarchy(const id& view, bool includesHeaders, bool focusableItems) {
  return trySend<id>(view,
                     "_accessibilityTextForSubhierarchyIncludingHeaders:focusableItems:exclusions:",
                     includesHeaders, focusableItems, nullptr);
}

}  // namespace tavro
