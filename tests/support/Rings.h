#pragma once

#include "host/libraries/ActivitySummaryCache.h"
#include "platform/healthkit/HKActivitySummary.h"
#include "reader/SummaryDescription.h"
#include "tests/support/Plugin.h"

namespace tavro {

/// A plug-in test whose summaries describe their rings, as they do for the reader.
class RingsTest : public PluginTest {
 protected:
  void SetUp() override {
    PluginTest::SetUp();
    letSummariesDescribeRings(bundle);
  }

  static Ref<NSDate> at(std::string_view iso) {
    return dateWithSeconds(secondsFromIso(iso).value());
  }

  /// Puts a summary of these fractions into the cache; a negative one stands for no data.
  static void record(std::int64_t day, double move, double exercise, double stand) {
    const auto summary = make<HKActivitySummary>();
    summary->activeEnergy = {move, 1};
    summary->exerciseTime = {exercise, 1};
    summary->standHours = {stand, 1};
    ActivitySummaryCache::sharedInstance()->setSummary(day, summary);
  }

  static std::size_t lookups() { return ActivitySummaryCache::sharedInstance()->lookups(); }
};

}  // namespace tavro
