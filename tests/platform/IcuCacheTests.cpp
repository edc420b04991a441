#include "platform/foundation/Formatters.h"
#include "platform/foundation/IcuCache.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::at;
using testing::FoundationTest;

class IcuCacheTest : public FoundationTest {
 protected:
  /// How many of ICU's objects a piece of work creates.
  template <class Work>
  static std::size_t created(const Work& work) {
    const std::size_t before = icuFormattersCreated();
    work();
    return icuFormattersCreated() - before;
  }
};

TEST_F(IcuCacheTest, TheLeastRecentlyUsedLeaves) {
  IcuCache<int> cache;
  std::vector<int> made;
  const auto use = [&](int option) {
    const int& kept = cache.get({.option = option}, [&] {
      made.push_back(option);
      return std::make_unique<int>(option);
    });
    EXPECT_EQ(kept, option);
  };
  const int capacity = static_cast<int>(kIcuCacheCapacity);
  for (int option = 0; option < capacity; ++option) {
    use(option);
  }
  made.clear();
  use(0);         // now the most recently used
  use(capacity);  // takes the place of 1
  use(0);
  EXPECT_EQ(made, std::vector<int>{capacity});
  use(1);  // takes the place of 2
  for (int option = 3; option < capacity; ++option) {
    use(option);
  }
  EXPECT_EQ(made, (std::vector<int>{capacity, 1}));
}

TEST_F(IcuCacheTest, EveryPartOfAKeyCounts) {
  const IcuKey keys[] = {
      {}, {.detail = "x"}, {.option = 1}, {.locale = "x"}, {.timeZone = "x"}, {.calendar = "x"},
  };
  IcuCache<int> cache;
  for (int round = 0; round < 2; ++round) {
    for (int index = 0; index < 6; ++index) {
      EXPECT_EQ(cache.get(keys[index], [&] { return std::make_unique<int>(index); }), index);
    }
  }
}

TEST_F(IcuCacheTest, AFailedCreationLeavesNothingBehind) {
  IcuCache<int> cache;
  const auto fail = []() -> std::unique_ptr<int> { throw std::runtime_error("no"); };
  EXPECT_EQ(created([&] { EXPECT_THROW(cache.get({}, fail), std::runtime_error); }), 0U);
  EXPECT_EQ(cache.get({}, [] { return std::make_unique<int>(7); }), 7);
}

TEST_F(IcuCacheTest, FormattersShareWhatIcuMade) {
  const Ref<NSDate> start = at("2026-03-02T09:00");
  const Ref<NSDate> end = at("2026-03-02T10:00");
  settings_.locale = "is_IS";  // no other test speaks it
  const auto formatDay = [&] {
    const Ref<NSDateIntervalFormatter> formatter = make<NSDateIntervalFormatter>();
    for (int hour = 0; hour < 24; ++hour) {
      formatter->setDateTemplate(hour == 23 ? "h:mma" : "ha");
      EXPECT_TRUE(formatter->stringFromDate(start, end));
    }
  };
  EXPECT_EQ(created(formatDay), 2U);
  EXPECT_EQ(created(formatDay), 0U);
  settings_.timeZone = "Asia/Tokyo";
  EXPECT_EQ(created(formatDay), 2U);
}

}  // namespace
}  // namespace tavro
