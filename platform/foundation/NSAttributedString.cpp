#include "platform/foundation/NSAttributedString.h"

#include <algorithm>

namespace tavro {

void AXAttributedString::setAttribute(const id& value, Name key) {
  setAttribute(value, key, {0, lengthOfText(string_)});
}

void AXAttributedString::setAttribute(const id& value, Name key, NSRange range) {
  const std::size_t length = lengthOfText(string_);
  if (!value || range.location >= length) {
    return;
  }
  range.length = std::min(range.length, length - range.location);
  if (range.length > 0) {
    runs_.push_back({key, range, value});
  }
}

Ref<NSAttributedString> attributedString(const Ref<NSString>& string) {
  if (!string) {
    return nullptr;
  }
  Ref<NSAttributedString> attributed = make<NSAttributedString>();
  attributed->initWithString(string);
  return attributed;
}

Ref<AXAttributedString> axAttributedString(const Ref<NSString>& string) {
  if (!string) {
    return nullptr;
  }
  Ref<AXAttributedString> attributed = make<AXAttributedString>();
  attributed->initWithString(string);
  return attributed;
}

Ref<NSString> plainText(const id& text) {
  if (const Ref<NSAttributedString> attributed = as<NSAttributedString>(text)) {
    return attributed->string();
  }
  return as<NSString>(text);
}

std::size_t lengthOfText(const id& text) {
  const Ref<NSString> plain = plainText(text);
  return plain ? plain->length() : 0;
}

namespace {

const Registered kAttributedString = defineClass<NSAttributedString, NSObject>()
                                         .method<&NSAttributedString::string>("string")
                                         .method<&NSAttributedString::string>("description");
const Registered kAXAttributedString = defineClass<AXAttributedString, NSAttributedString>();

}  // namespace
}  // namespace tavro
