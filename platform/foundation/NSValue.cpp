#include "platform/foundation/NSValue.h"

#include <charconv>
#include <limits>
#include <string>

#include "platform/foundation/NSString.h"

namespace tavro {
namespace {

template <class T>
T geometryOf(const NSValue& box, std::string_view kind) {
  const T* const held = std::get_if<T>(&box.value);
  if (held == nullptr) {
    raise(kInvalidArgumentException, "the value does not hold a " + std::string(kind));
  }
  return *held;
}

template <class T>
Ref<NSValue> boxed(const T& geometry) {
  Ref<NSValue> box = make<NSValue>();
  box->value = geometry;
  return box;
}

template <class T>
Ref<NSNumber> numberOf(T held) {
  Ref<NSNumber> box = make<NSNumber>();
  box->number = held;
  return box;
}

/// The number as I; what lies outside I becomes its nearest end.
template <class I>
I integerOf(const NSNumber& box) {
  return std::visit(
      [](auto held) -> I {
        using Held = decltype(held);
        if constexpr (std::is_same_v<Held, double>) {
          return saturatingCast<I>(held);
        } else if constexpr (std::is_same_v<Held, bool>) {
          return held ? 1 : 0;
        } else {
          if (std::cmp_less(held, std::numeric_limits<I>::min())) {
            return std::numeric_limits<I>::min();
          }
          return std::cmp_greater(held, std::numeric_limits<I>::max())
                     ? std::numeric_limits<I>::max()
                     : static_cast<I>(held);
        }
      },
      box.number);
}

}  // namespace

CGPoint NSValue::CGPointValue() const { return geometryOf<CGPoint>(*this, "point"); }
CGSize NSValue::CGSizeValue() const { return geometryOf<CGSize>(*this, "size"); }
CGRect NSValue::CGRectValue() const { return geometryOf<CGRect>(*this, "rectangle"); }

bool NSNumber::boolValue() const {
  return std::visit([](auto held) { return held != decltype(held){}; }, number);
}
std::int32_t NSNumber::intValue() const { return integerOf<std::int32_t>(*this); }
std::int64_t NSNumber::longLongValue() const { return integerOf<std::int64_t>(*this); }
double NSNumber::doubleValue() const {
  return std::visit([](auto held) { return static_cast<double>(held); }, number);
}

Ref<NSValue> value(CGPoint point) { return boxed(point); }
Ref<NSValue> value(CGSize size) { return boxed(size); }
Ref<NSValue> value(CGRect rect) { return boxed(rect); }
Ref<NSNumber> number(bool boolean) { return numberOf(boolean); }
Ref<NSNumber> number(std::int64_t integer) { return numberOf(integer); }
Ref<NSNumber> number(std::uint64_t integer) { return numberOf(integer); }
Ref<NSNumber> number(double real) { return numberOf(real); }

id kCFBooleanTrue() {
  static auto* const instance = new Ref<NSNumber>(number(true));
  return *instance;
}

namespace {

Ref<NSString> description(NSNumber* self) {
  return std::visit(
      [](auto held) {
        if constexpr (std::is_same_v<decltype(held), bool>) {
          return string(held ? "1" : "0");
        } else {
          char digits[32];
          const auto [end, error] = std::to_chars(std::begin(digits), std::end(digits), held);
          return string(std::string_view(digits, static_cast<std::size_t>(end - digits)));
        }
      },
      self->number);
}

const Registered kValue = defineClass<NSValue, NSObject>()
                              .method<&NSValue::CGPointValue>("CGPointValue")
                              .method<&NSValue::CGSizeValue>("CGSizeValue")
                              .method<&NSValue::CGRectValue>("CGRectValue");
const Registered kNumber = defineClass<NSNumber, NSValue>()
                               .method<&NSNumber::boolValue>("boolValue")
                               .method<&NSNumber::intValue>("intValue")
                               .method<&NSNumber::longLongValue>("longLongValue")
                               .method<&NSNumber::floatValue>("floatValue")
                               .method<&NSNumber::doubleValue>("doubleValue")
                               .method<&description>("description");

}  // namespace
}  // namespace tavro
