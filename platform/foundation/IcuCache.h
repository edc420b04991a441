#pragma once

#include <algorithm>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

// Internal to platform/foundation and its tests.

namespace tavro {

/// How many objects of one kind are kept. An interval formatter holds 85 kB.
inline constexpr std::size_t kIcuCacheCapacity = 16;

/// How many objects of ICU's the caches ever had to create. For tests.
std::size_t icuFormattersCreated();
namespace detail {
void countCreatedIcuFormatter();
}

/// What tells one ICU object from another of its kind; an empty part plays no role for that kind.
struct IcuKey {
  std::string_view detail = {};  ///< a template, pattern or language
  std::int64_t option = 0;       ///< a style, a number of decimals ...
  std::string_view locale = {};
  std::string_view timeZone = {};
  std::string_view calendar = {};
};

/// ICU's objects of one kind, the most recently used ones. Main thread only.
template <class T>
class IcuCache {
 public:
  /// The object for the key; `create` makes it (a `std::unique_ptr<T>`, never null) when it is not
  /// kept. What it yields stays valid until the next call.
  template <class Create>
  T& get(const IcuKey& key, const Create& create) {
    const auto found =
        std::ranges::find_if(entries_, [&](const auto& entry) { return entry->matches(key); });
    if (found != entries_.end()) {
      std::rotate(entries_.begin(), found, found + 1);
      return *entries_.front()->object;
    }
    auto entry = std::make_unique<Entry>(key, create());
    detail::countCreatedIcuFormatter();
    if (entries_.size() == kIcuCacheCapacity) {
      entries_.pop_back();
    }
    entries_.insert(entries_.begin(), std::move(entry));
    return *entries_.front()->object;
  }

 private:
  struct Entry {
    Entry(const IcuKey& key, std::unique_ptr<T> made)
        : detail(key.detail),
          option(key.option),
          locale(key.locale),
          timeZone(key.timeZone),
          calendar(key.calendar),
          object(std::move(made)) {}

    [[nodiscard]] bool matches(const IcuKey& key) const {
      return option == key.option && detail == key.detail && locale == key.locale &&
             timeZone == key.timeZone && calendar == key.calendar;
    }

    std::string detail;
    std::int64_t option;
    std::string locale;
    std::string timeZone;
    std::string calendar;
    std::unique_ptr<T> object;
  };

  std::vector<std::unique_ptr<Entry>> entries_;  // the most recently used first
};

/// The process's cache of the kind that `Kind` names. Never destroyed: objects that outlive `main`
/// may still format.
template <class Kind, class T>
IcuCache<T>& icuCache() {
  static auto* const cache = new IcuCache<T>;
  return *cache;
}

}  // namespace tavro
