#pragma once

#include <variant>

#include "platform/foundation/Geometry.h"
#include "platform/foundation/NSObject.h"

namespace tavro {

/// A boxed geometry value. Messages: `CGPointValue`, `CGSizeValue`, `CGRectValue`; each raises when
/// the value holds something else.
class NSValue : public NSObject {
 public:
  static constexpr Name className = "NSValue";

  std::variant<std::monostate, CGPoint, CGSize, CGRect> value;

  [[nodiscard]] CGPoint CGPointValue() const;
  [[nodiscard]] CGSize CGSizeValue() const;
  [[nodiscard]] CGRect CGRectValue() const;
};

/// A boxed number or boolean. Messages: `boolValue` ("B"), `intValue` ("i", saturating),
/// `longLongValue` ("q", saturating), `floatValue` ("f"), `doubleValue` ("d").
class NSNumber : public NSValue {
 public:
  static constexpr Name className = "NSNumber";

  std::variant<bool, std::int64_t, std::uint64_t, double> number;

  [[nodiscard]] bool boolValue() const;
  [[nodiscard]] std::int32_t intValue() const;
  [[nodiscard]] std::int64_t longLongValue() const;
  [[nodiscard]] float floatValue() const { return static_cast<float>(doubleValue()); }
  [[nodiscard]] double doubleValue() const;
};

Ref<NSValue> value(CGPoint point);
Ref<NSValue> value(CGSize size);
Ref<NSValue> value(CGRect rect);
Ref<NSNumber> number(bool boolean);
Ref<NSNumber> number(std::int64_t integer);
Ref<NSNumber> number(std::uint64_t integer);
Ref<NSNumber> number(double real);

/// The one true object, as speech attributes carry it.
id kCFBooleanTrue();

}  // namespace tavro
