#pragma once

#include <unordered_map>

#include "platform/healthkit/HKActivitySummary.h"

namespace tavro {

/// The application's activity summaries by day. Class message: `sharedInstance`. Message:
/// `activitySummaryForCacheIndex:` ("@,q"; nil for a day without a summary).
class ActivitySummaryCache : public NSObject {
 public:
  static constexpr Name className = "ActivitySummaryCache";

  static Ref<ActivitySummaryCache> sharedInstance();

  id activitySummaryForCacheIndex(std::int64_t index);
  void setSummary(std::int64_t index, const Ref<HKActivitySummary>& summary);
  void removeAllSummaries() { summaries_.clear(); }
  /// How often a summary was asked for.
  [[nodiscard]] std::size_t lookups() const { return lookups_; }

 private:
  std::unordered_map<std::int64_t, Ref<HKActivitySummary>> summaries_;
  std::size_t lookups_ = 0;
};

}  // namespace tavro
