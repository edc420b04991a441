#include "platform/healthkit/HKUnit.h"

#include <algorithm>

namespace tavro {
namespace {

struct NamedUnit {
  std::string_view symbol;
  HKDimension dimension;  // powers of metre, kilogram, second
  double scale;
};

constexpr NamedUnit kKilocalorie{"kcal", {2, 1, -2}, 4184};
constexpr NamedUnit kMinute{"min", {0, 0, 1}, 60};
constexpr NamedUnit kHour{"hr", {0, 0, 1}, 3600};
constexpr NamedUnit kSecond{"s", {0, 0, 1}, 1};
constexpr NamedUnit kCount{"count", {0, 0, 0}, 1};
constexpr NamedUnit kMeter{"m", {1, 0, 0}, 1};
constexpr NamedUnit kLiter{"L", {3, 0, 0}, 1e-3};
constexpr NamedUnit kGram{"g", {0, 1, 0}, 1e-3};

struct Prefix {
  std::string_view symbol;
  double scale;
};

/// By the number of the prefix.
constexpr Prefix kPrefixes[] = {{"", 1},     {"p", 1e-12}, {"n", 1e-9}, {"µ", 1e-6}, {"m", 1e-3},
                                {"c", 1e-2}, {"d", 1e-1},  {"da", 1e1}, {"h", 1e2},  {"k", 1e3},
                                {"M", 1e6},  {"G", 1e9},   {"T", 1e12}};

Ref<HKUnit> makeUnit(const NamedUnit& named, const Prefix& prefix) {
  Ref<HKUnit> unit = make<HKUnit>();
  unit->initWithFactors({{std::string(prefix.symbol) + std::string(named.symbol), 1}},
                        named.dimension, prefix.scale * named.scale);
  return unit;
}

Ref<HKUnit> makeUnit(const NamedUnit& named, HKMetricPrefix prefix = HKMetricPrefix::none) {
  const auto index = static_cast<std::int64_t>(prefix);
  if (index < 0 || index >= std::ssize(kPrefixes)) {
    raise(kInvalidArgumentException, std::to_string(index) + " is no metric prefix");
  }
  return makeUnit(named, kPrefixes[index]);
}

/// The class message of a function that needs no class.
template <auto Function>
Ref<HKUnit> ofClass(Class* /*isa*/) {
  return Function();
}
template <auto Function>
Ref<HKUnit> ofClassWithPrefix(Class* /*isa*/, HKMetricPrefix prefix) {
  return Function(prefix);
}

void appendFactor(std::string& text, const std::string& symbol, int power) {
  if (!text.empty()) {
    text += "·";
  }
  text += symbol;
  if (power != 1) {
    text += "^" + std::to_string(power);
  }
}

const Registered kUnit = defineClass<HKUnit, NSObject>()
                             .classMethod<&ofClass<&HKUnit::kilocalorieUnit>>("kilocalorieUnit")
                             .classMethod<&ofClass<&HKUnit::minuteUnit>>("minuteUnit")
                             .classMethod<&ofClass<&HKUnit::hourUnit>>("hourUnit")
                             .classMethod<&ofClass<&HKUnit::secondUnit>>("secondUnit")
                             .classMethod<&ofClass<&HKUnit::countUnit>>("countUnit")
                             .classMethod<&ofClass<&HKUnit::meterUnit>>("meterUnit")
                             .classMethod<&ofClass<&HKUnit::literUnit>>("literUnit")
                             .classMethod<&ofClass<&HKUnit::gramUnit>>("gramUnit")
                             .classMethod<&ofClassWithPrefix<&HKUnit::meterUnitWithMetricPrefix>>(
                                 "meterUnitWithMetricPrefix:")
                             .classMethod<&ofClassWithPrefix<&HKUnit::literUnitWithMetricPrefix>>(
                                 "literUnitWithMetricPrefix:")
                             .classMethod<&ofClassWithPrefix<&HKUnit::gramUnitWithMetricPrefix>>(
                                 "gramUnitWithMetricPrefix:")
                             .method<&HKUnit::unitDividedByUnit>("unitDividedByUnit:")
                             .method<&HKUnit::unitString>("unitString")
                             .method<&HKUnit::unitString>("description");

}  // namespace

Ref<HKUnit> HKUnit::kilocalorieUnit() { return makeUnit(kKilocalorie); }
Ref<HKUnit> HKUnit::minuteUnit() { return makeUnit(kMinute); }
Ref<HKUnit> HKUnit::hourUnit() { return makeUnit(kHour); }
Ref<HKUnit> HKUnit::secondUnit() { return makeUnit(kSecond); }
Ref<HKUnit> HKUnit::countUnit() { return makeUnit(kCount); }
Ref<HKUnit> HKUnit::meterUnit() { return makeUnit(kMeter); }
Ref<HKUnit> HKUnit::literUnit() { return makeUnit(kLiter); }
Ref<HKUnit> HKUnit::gramUnit() { return makeUnit(kGram); }

Ref<HKUnit> HKUnit::meterUnitWithMetricPrefix(HKMetricPrefix prefix) {
  return makeUnit(kMeter, prefix);
}
Ref<HKUnit> HKUnit::literUnitWithMetricPrefix(HKMetricPrefix prefix) {
  return makeUnit(kLiter, prefix);
}
Ref<HKUnit> HKUnit::gramUnitWithMetricPrefix(HKMetricPrefix prefix) {
  return makeUnit(kGram, prefix);
}

void HKUnit::initWithFactors(std::vector<Factor> factors, const HKDimension& dimension,
                             double scale) {
  factors_ = std::move(factors);
  dimension_ = dimension;
  scale_ = scale;
}

Ref<HKUnit> HKUnit::unitDividedByUnit(const Ref<HKUnit>& divisor) const {
  if (!divisor) {
    raise(kInvalidArgumentException, "a unit cannot be divided by nil");
  }
  std::vector<Factor> factors = factors_;
  for (const auto& [symbol, power] : divisor->factors_) {
    const auto same = [&symbol = symbol](const Factor& factor) { return factor.first == symbol; };
    const auto found = std::find_if(factors.begin(), factors.end(), same);
    if (found == factors.end()) {
      factors.emplace_back(symbol, -power);
    } else {
      found->second -= power;
    }
  }
  std::erase_if(factors, [](const Factor& factor) { return factor.second == 0; });
  HKDimension dimension = dimension_;
  for (std::size_t i = 0; i < dimension.size(); ++i) {
    dimension[i] -= divisor->dimension_[i];
  }
  Ref<HKUnit> quotient = make<HKUnit>();
  quotient->initWithFactors(std::move(factors), dimension, scale_ / divisor->scale_);
  return quotient;
}

Ref<NSString> HKUnit::unitString() const {
  if (unitString_) {
    return unitString_;
  }
  std::string numerator;
  std::string denominator;
  for (const auto& [symbol, power] : factors_) {
    appendFactor(power > 0 ? numerator : denominator, symbol, std::abs(power));
  }
  if (numerator.empty()) {
    numerator = "1";
  }
  unitString_ = string(denominator.empty() ? numerator : numerator + "/" + denominator);
  return unitString_;
}

}  // namespace tavro
