#include "platform/healthkit/HKQuantity.h"

#include <sstream>

namespace tavro {
namespace {

Ref<HKQuantity> quantityOfClass(Class* /*isa*/, const Ref<HKUnit>& unit, double value) {
  return HKQuantity::quantityWithUnit(unit, value);
}

const Registered kQuantity = defineClass<HKQuantity, NSObject>()
                                 .classMethod<&quantityOfClass>("quantityWithUnit:doubleValue:")
                                 .method<&HKQuantity::isCompatibleWithUnit>("isCompatibleWithUnit:")
                                 .method<&HKQuantity::doubleValueForUnit>("doubleValueForUnit:")
                                 .method<&HKQuantity::description>("description");

}  // namespace

Ref<HKQuantity> HKQuantity::quantityWithUnit(const Ref<HKUnit>& unit, double value) {
  if (!unit) {
    raise(kInvalidArgumentException, "a quantity needs a unit");
  }
  Ref<HKQuantity> quantity = make<HKQuantity>();
  quantity->unit_ = unit;
  quantity->value_ = value;
  return quantity;
}

bool HKQuantity::isCompatibleWithUnit(const Ref<HKUnit>& unit) const {
  return unit && unit_ && unit->dimension() == unit_->dimension();
}

double HKQuantity::doubleValueForUnit(const Ref<HKUnit>& unit) const {
  if (!isCompatibleWithUnit(unit)) {
    raise(kInvalidArgumentException,
          "cannot convert " + utf8(description()) + " to " +
              (unit ? utf8(unit->unitString()) : std::string("a nil unit")));
  }
  // Equal scales leave the value exactly as it was given.
  return unit->scale() == unit_->scale() ? value_ : value_ * (unit_->scale() / unit->scale());
}

Ref<NSString> HKQuantity::description() const {
  std::ostringstream text;
  text.imbue(std::locale::classic());
  text << value_;
  if (unit_) {
    text << ' ' << utf8(unit_->unitString());
  }
  return string(text.str());
}

}  // namespace tavro
