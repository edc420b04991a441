#include <atomic>
#include <thread>

#include "platform/healthkit/HKHealthStore.h"
#include "platform/runtime/Dispatch.h"
#include "tests/support/Plugin.h"

namespace tavro {
namespace {

constexpr std::int64_t kNo = 1;
constexpr std::int64_t kYes = 2;

class WheelchairTest : public PluginTest {
 protected:
  void SetUp() override {
    PluginTest::SetUp();
    // The query is the plug-in's own and no exported function: C++ names it.
    ask = reinterpret_cast<bool (*)()>(
        bundle.symbol("_ZN5tavro33_userIsWheelchairUserWithNarrelOnEv"));
    ASSERT_NE(ask, nullptr);
  }
  void TearDown() override { GlobalQueue::shared().drain(); }

  /// What the plug-in knows once every refresh that is under way has ended.
  bool answerAfterRefresh() {
    ask();
    GlobalQueue::shared().drain();
    settings.screenReaderRuns = false;
    const bool answer = ask();
    settings.screenReaderRuns = true;
    return answer;
  }

  Settings& settings = Settings::current();
  bool (*ask)() = nullptr;
};

TEST_F(WheelchairTest, WithTheScreenReaderOffNobodyIsAsked) {
  settings.screenReaderRuns = false;
  settings.wheelchairUse = kYes;
  const std::size_t queued = GlobalQueue::shared().queuedCount();
  EXPECT_FALSE(ask());
  EXPECT_FALSE(ask());
  GlobalQueue::shared().drain();
  EXPECT_EQ(settings.wheelchairQueries, 0);
  EXPECT_EQ(GlobalQueue::shared().queuedCount(), queued);
  settings.screenReaderRuns = true;
  EXPECT_TRUE(ask()) << "the first call with the screen reader on asks at once";
}

TEST_F(WheelchairTest, TheFirstAnswerIsFreshAndEachLaterOneIsThatOfTheQueryBefore) {
  GlobalQueue& queue = GlobalQueue::shared();
  const std::size_t queued = queue.queuedCount();
  queue.hold();
  settings.wheelchairUse = kYes;
  EXPECT_TRUE(ask());
  EXPECT_EQ(settings.wheelchairQueries, 1) << "asked on the caller's thread";
  EXPECT_EQ(queue.queuedCount(), queued);
  settings.wheelchairUse = kNo;
  EXPECT_TRUE(ask());
  EXPECT_EQ(queue.queuedCount(), queued + 1);
  EXPECT_EQ(settings.wheelchairQueries, 1) << "the refresh waits";
  queue.release();
  queue.drain();
  EXPECT_EQ(settings.wheelchairQueries, 2);
  queue.hold();
  EXPECT_FALSE(ask());
  EXPECT_EQ(queue.queuedCount(), queued + 2);
  queue.release();
}

TEST_F(WheelchairTest, OnlyYesMeansYes) {
  const std::pair<std::int64_t, bool> cases[] = {{2, true}, {0, false}, {2, true},  {1, false},
                                                 {2, true}, {3, false}, {-2, false}};
  for (const auto& [use, answer] : cases) {
    settings.wheelchairUse = use;
    EXPECT_EQ(answerAfterRefresh(), answer) << use;
  }
}

TEST_F(WheelchairTest, AnErrorLeavesTheAnswerAsItWas) {
  settings.wheelchairUse = kYes;
  settings.wheelchairUseFails = true;
  EXPECT_FALSE(ask()) << "nothing was ever learnt";
  EXPECT_EQ(settings.wheelchairQueries, 1);
  settings.wheelchairUseFails = false;
  EXPECT_TRUE(answerAfterRefresh());
  settings.wheelchairUse = kNo;
  settings.wheelchairUseFails = true;
  EXPECT_TRUE(answerAfterRefresh());
  settings.wheelchairUseFails = false;
  EXPECT_FALSE(answerAfterRefresh());
}

id raisingStore(Object* /*self*/, id* /*error*/) { throw 1; }
id emptyStore(Object* /*self*/, id* /*error*/) { return nullptr; }

TEST_F(WheelchairTest, AStoreThatRaisesTellsNothingAndOneWithoutAnAnswerSaysNo) {
  settings.wheelchairUse = kYes;
  EXPECT_TRUE(ask());
  Class* const store = classOf<HKHealthStore>();
  store->setMethod(methodOf<&raisingStore>("wheelchairUseWithError:"));
  EXPECT_TRUE(answerAfterRefresh());
  store->setMethod(methodOf<&emptyStore>("wheelchairUseWithError:"));
  EXPECT_FALSE(answerAfterRefresh());
}

TEST_F(WheelchairTest, CallsFromTwoThreadsAtOnceAskOnceEach) {
  constexpr int calls = 200;
  settings.wheelchairUse = kYes;
  const auto askOften = [this] {
    for (int call = 0; call < calls; ++call) {
      ask();
    }
  };
  std::thread other(askOften);
  askOften();
  other.join();
  GlobalQueue::shared().drain();
  EXPECT_EQ(settings.wheelchairQueries, 2 * calls);
  settings.screenReaderRuns = false;
  EXPECT_TRUE(ask());
}

TEST_F(WheelchairTest, TheScreenReaderGoesOnAndOffWhileThreadsAsk) {
  // Two threads ask, this one switches, and the queue's own refreshes.
  settings.wheelchairUse = kYes;
  EXPECT_TRUE(ask());
  constexpr int enough = 2000;
  std::atomic<int> asked = 0;
  std::atomic<int> wrong = 0;
  std::vector<std::thread> threads;
  for (int thread = 0; thread < 2; ++thread) {
    threads.emplace_back([&] {
      while (asked++ < enough) {
        wrong += ask() ? 0 : 1;
      }
    });
  }
  for (int round = 0; asked < enough; ++round) {
    settings.screenReaderRuns = round % 2 != 0;
    settings.wheelchairUseFails = round % 7 == 0;
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  GlobalQueue::shared().drain();
  EXPECT_EQ(wrong, 0) << "what was learnt once is not unlearnt, on or off, refreshed or failing";
}

TEST_F(WheelchairTest, SettingsChangeWhileRefreshesRun) {
  std::int64_t asked = 0;
  for (int round = 0; round < 300; ++round) {
    settings.wheelchairUse = round % 3;
    settings.wheelchairUseFails = round % 5 == 0;
    settings.screenReaderRuns = round % 4 != 0;
    asked += settings.screenReaderRuns ? 1 : 0;
    ask();
  }
  GlobalQueue::shared().drain();
  EXPECT_EQ(settings.wheelchairQueries, asked);
  settings.screenReaderRuns = true;
  settings.wheelchairUseFails = false;
  settings.wheelchairUse = kYes;
  EXPECT_TRUE(answerAfterRefresh());
}

}  // namespace
}  // namespace tavro
