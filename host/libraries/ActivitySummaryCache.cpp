#include "host/libraries/ActivitySummaryCache.h"

namespace tavro {
namespace {

id sharedCache(Class* /*self*/) { return ActivitySummaryCache::sharedInstance(); }

const Registered cacheClass = defineClass<ActivitySummaryCache, NSObject>()
                                  .classMethod<&sharedCache>("sharedInstance")
                                  .method<&ActivitySummaryCache::activitySummaryForCacheIndex>(
                                      "activitySummaryForCacheIndex:");

}  // namespace

Ref<ActivitySummaryCache> ActivitySummaryCache::sharedInstance() {
  static const auto* const shared = new auto(make<ActivitySummaryCache>());
  return *shared;
}

id ActivitySummaryCache::activitySummaryForCacheIndex(std::int64_t index) {
  ++lookups_;
  const auto found = summaries_.find(index);
  return found == summaries_.end() ? id() : id(found->second);
}

void ActivitySummaryCache::setSummary(std::int64_t index, const Ref<HKActivitySummary>& summary) {
  summaries_[index] = summary;
}

}  // namespace tavro
