#include "reader/SummaryDescription.h"

#include "platform/healthkit/HKActivitySummary.h"

namespace tavro {
namespace {

using DescribePercentages = Ref<NSString> (*)(double, double, double, bool);
DescribePercentages describePercentages = nullptr;

id describe(HKActivitySummary* /*self*/, double move, double exercise, double stand,
            bool isCapped) {
  return describePercentages(move, exercise, stand, isCapped);
}

}  // namespace

void letSummariesDescribeRings(const LoadedBundle& bundle) {
  void* const function = bundle.symbol("accessibilityDescriptionForPercentages");
  if (function == nullptr) {
    return;
  }
  describePercentages = reinterpret_cast<DescribePercentages>(function);
  classOf<HKActivitySummary>()->setMethod(
      methodOf<&describe>("accessibilityDescriptionForPercentages:exercisingPercentage:"
                          "standingPercentage:arePercentagesCapped:"));
}

}  // namespace tavro
