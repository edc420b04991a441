#include <algorithm>
#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "platform/accessibility/KeyAccess.h"
#include "platform/foundation/NSValue.h"
#include "platform/runtime/Dispatch.h"
#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

using testing::madeClass;
using testing::newOf;

TEST(GlobalQueueTests, WorkRunsInOrderOnAnotherThread) {
  GlobalQueue& queue = GlobalQueue::shared();
  queue.drain();  // nothing was queued: returns at once
  std::vector<int> order;
  std::thread::id worker;
  for (int index = 0; index < 100; ++index) {
    queue.async([&, index] {
      order.push_back(index);
      worker = std::this_thread::get_id();
    });
  }
  queue.drain();
  ASSERT_EQ(order.size(), 100U);
  EXPECT_TRUE(std::ranges::is_sorted(order));
  EXPECT_NE(worker, std::this_thread::get_id());
}

TEST(GlobalQueueTests, HeldWorkWaitsForTheRelease) {
  GlobalQueue& queue = GlobalQueue::shared();
  const std::size_t before = queue.queuedCount();
  std::atomic<int> done = 0;
  queue.async([&] { ++done; });
  queue.drain();
  queue.hold();
  queue.async([&] { ++done; });
  queue.async([&] { ++done; });
  EXPECT_EQ(queue.queuedCount(), before + 3) << "what waits is counted";
  EXPECT_EQ(done, 1);
  queue.release();
  queue.drain();
  EXPECT_EQ(done, 3);
}

TEST(GlobalQueueTests, WorkMayQueueMoreEvenAsItGoes) {
  GlobalQueue& queue = GlobalQueue::shared();
  std::atomic<int> done = 0;
  /// Queues work when the work that holds it is destroyed.
  struct Farewell {
    explicit Farewell(std::atomic<int>* counter) : done(counter) {}
    std::atomic<int>* done;
    ~Farewell() {
      GlobalQueue::shared().async([done = done] { ++*done; });
    }
  };
  queue.async([&done, farewell = std::make_shared<Farewell>(&done)] {
    GlobalQueue::shared().async([&done] { ++done; });
  });
  queue.drain();
  EXPECT_EQ(done, 2);
}

TEST(GlobalQueueDeathTest, TheProcessEndsOnlyWhenWaitingWorkIsDone) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  for (const bool held : {false, true}) {
    EXPECT_EXIT(
        {
          if (held) {
            GlobalQueue::shared().hold();
          }
          GlobalQueue::shared().async([] { std::fputs("first ", stderr); });
          GlobalQueue::shared().async([] { std::fputs("second", stderr); });
          std::exit(3);
        },
        ::testing::ExitedWithCode(3), "first second");
  }
}

TEST(OnceQueueTests, AOnceTokenRunsItsWorkOnceForAllThreads) {
  OnceToken token;
  std::atomic<int> runs = 0;
  std::vector<std::thread> threads;
  for (int index = 0; index < 4; ++index) {
    threads.emplace_back([&] { dispatchOnce(token, [&] { ++runs; }); });
  }
  for (std::thread& each : threads) {
    each.join();
  }
  EXPECT_EQ(runs, 1);
}

std::int64_t one(Object* /*self*/) { return 1; }
std::int64_t two(Object* /*self*/) { return 2; }

TEST(ThreadTests, ClassesAreLookedUpWhileAnotherThreadChangesThem) {
  constexpr int rounds = 300;
  Class* const base = madeClass("ThreadBase", {methodOf<&one>("answer")});
  Class* const sub = madeClass("ThreadSub", {}, "ThreadBase");
  std::atomic<bool> failed = false;
  std::atomic<int> started = 0;
  const auto ask = [&] {
    ++started;
    for (int round = 0; round < rounds; ++round) {
      const id object = newOf(sub);  // an object lives on the thread that made it
      const auto answer = send<std::int64_t>(object, "answer");
      const Name key = Name::make("key" + std::to_string(round % 20));
      failed = failed || (answer != 1 && answer != 2) || Class::named("ThreadSub") != sub ||
               safeIntForKey(object.get(), "answer") == 0 || safeValueForKey(object, key);
    }
  };
  std::vector<std::thread> threads;
  threads.emplace_back(ask);
  threads.emplace_back(ask);
  for (int round = 0; round < rounds || started < 2; ++round) {
    base->setMethod(round % 2 == 0 ? methodOf<&two>("answer") : methodOf<&one>("answer"));
    if (round < rounds) {
      madeClass("Thread" + std::to_string(round), {}, "ThreadBase");
    }
  }
  for (std::thread& each : threads) {
    each.join();
  }
  EXPECT_FALSE(failed);
}

}  // namespace
}  // namespace tavro
