#include "host/libraries/CHWorkoutFormattingManager.h"

#include <array>
#include <cmath>
#include <cstdio>

#include "platform/foundation/Formatters.h"
#include "platform/uikit/UIAccessibility.h"

namespace tavro {
namespace {

/// `+[NSString attrStringWithValue:unit:]`
id attrStringWithValue(Class* /*self*/, const id& value, const id& unit) {
  const Ref<NSString> amount = plainText(value);
  const Ref<NSString> name = plainText(unit);
  return attributedString(
      name ? stringWithFormat(string("%1$@ %2$@"), {FormatArgument(amount), FormatArgument(name)})
           : amount);
}

const Registered stringCategory =
    extendClass("NSString").classMethod<&attrStringWithValue>("attrStringWithValue:unit:");

using Calculator = CHWorkoutDataCalculator;
const Registered calculatorClass =
    defineClass<Calculator, NSObject>().method<&Calculator::averagePaceForWorkout>(
        "averagePaceForWorkout:");

using Manager = CHWorkoutFormattingManager;
const Registered managerClass =
    defineClass<Manager, NSObject>()
        .method<&Manager::formattedDuration>("formattedDurationForWorkout:workoutActivity:context:")
        .method<&Manager::formattedDistance>("formattedDistanceForWorkout:workoutActivity:context:")
        .method<&Manager::formattedEnergy>("formattedEnergyForWorkout:workoutActivity:context:");

constexpr std::int64_t kMinute = 60;
constexpr std::int64_t kHour = 3600;
constexpr double kMetersPerKilometer = 1000;

template <class... Numbers>
std::string printed(const char* format, Numbers... numbers) {
  std::array<char, 64> text{};
  // NOLINTNEXTLINE(cppcoreguidelines-pro-type-vararg,hicpp-vararg): the format is a literal.
  std::snprintf(text.data(), text.size(), format, numbers...);
  return text.data();
}

std::string clockText(std::int64_t seconds) {
  const auto hours = static_cast<long long>(seconds / kHour);
  const auto minutes = static_cast<long long>(seconds % kHour / kMinute);
  const auto rest = static_cast<long long>(seconds % kMinute);
  return hours > 0 ? printed("%lld:%02lld:%02lld", hours, minutes, rest)
                   : printed("%lld:%02lld", minutes, rest);
}

std::optional<double> amountOf(const Ref<HKQuantity>& quantity, const Ref<HKUnit>& unit) {
  return quantity ? std::optional(quantity->doubleValueForUnit(unit)) : std::nullopt;
}

}  // namespace

id valueWithUnit(std::optional<double> amount, const DisplayUnit& unit, int decimals) {
  if (!amount) {
    return attributedString(string("--"));
  }
  const Ref<NSString> symbol = string(unit.symbol);
  send<void>(symbol, "setAccessibilityLabel:", string(unit.name));
  return send<id>(Class::named("NSString"),
                  "attrStringWithValue:unit:", decimalString(*amount, decimals), symbol);
}

std::string paceText(double seconds) {
  const auto whole = saturatingCast<std::int64_t>(std::round(seconds));
  return printed("%lld'%02lld''", static_cast<long long>(whole / kMinute),
                 static_cast<long long>(whole % kMinute));
}

double CHWorkoutDataCalculator::averagePaceForWorkout(const Ref<HKWorkout>& workout) {
  const auto distance =
      workout ? amountOf(workout->totalDistance(), HKUnit::meterUnit()) : std::nullopt;
  return distance && *distance > 0 ? workout->duration() / *distance : 0;
}

id CHWorkoutFormattingManager::formattedDuration(const Ref<HKWorkout>& workout,
                                                 const id& /*activity*/, const id& /*context*/) {
  return workout ? attributedString(
                       string(clockText(saturatingCast<std::int64_t>(workout->duration()))))
                 : nullptr;
}

id CHWorkoutFormattingManager::formattedDistance(const Ref<HKWorkout>& workout,
                                                 const id& /*activity*/, const id& /*context*/) {
  const auto meters =
      workout ? amountOf(workout->totalDistance(), HKUnit::meterUnit()) : std::nullopt;
  return valueWithUnit(meters ? std::optional(*meters / kMetersPerKilometer) : std::nullopt,
                       kKilometers, 2);
}

id CHWorkoutFormattingManager::formattedEnergy(const Ref<HKWorkout>& workout,
                                               const id& /*activity*/, const id& /*context*/) {
  return valueWithUnit(
      workout ? amountOf(workout->totalEnergyBurned(), HKUnit::kilocalorieUnit()) : std::nullopt,
      kKilocalories);
}

}  // namespace tavro
