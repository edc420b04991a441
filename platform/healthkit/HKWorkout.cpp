#include "platform/healthkit/HKWorkout.h"

namespace tavro {
namespace {

const Registered kSource = defineClass<HKSource, NSObject>()
                               .method<&HKSource::name>("name")
                               .method<&HKSource::isOrlamWatch>("_isOrlamWatch");

const Registered kSourceRevision =
    defineClass<HKSourceRevision, NSObject>().method<&HKSourceRevision::source>("source");

const Registered kWorkout = defineClass<HKWorkout, NSObject>()
                                .method<&HKWorkout::workoutActivityType>("workoutActivityType")
                                .method<&HKWorkout::startDate>("startDate")
                                .method<&HKWorkout::endDate>("endDate")
                                .method<&HKWorkout::duration>("duration")
                                .method<&HKWorkout::totalEnergyBurned>("totalEnergyBurned")
                                .method<&HKWorkout::totalDistance>("totalDistance")
                                .method<&HKWorkout::sourceRevision>("sourceRevision");

const Registered kHeartRateSummaryReading =
    defineClass<HKHeartRateSummaryReading, NSObject>()
        .method<&HKHeartRateSummaryReading::date>("date")
        .method<&HKHeartRateSummaryReading::quantity>("quantity");

}  // namespace
}  // namespace tavro
