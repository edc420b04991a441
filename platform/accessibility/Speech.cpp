#include "platform/accessibility/Speech.h"

namespace tavro {

Ref<NSString> AXFormatFloat(std::int64_t option, float value) {
  return decimalString(value, option == 0 ? 1 : 2);
}

Ref<NSString> UIAXFormatFloatWithPercentage(std::int64_t /*option*/, float fraction) {
  return percentString(fraction);
}

Ref<NSString> AXDateStringForFormat(const Ref<NSDate>& date, std::string_view format) {
  return dateStringForFormat(date, format);
}

Ref<NSDate> AXDateFromStringWithFormat(const Ref<NSString>& text, std::string_view format) {
  const auto formatter = make<NSDateFormatter>();
  formatter->setDateFormat(format);
  return formatter->dateFromString(text);
}

}  // namespace tavro
