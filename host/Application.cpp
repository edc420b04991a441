#include "host/Application.h"

#include <algorithm>
#include <utility>

#include "host/Dates.h"
#include "host/libraries/Achievements.h"
#include "host/libraries/ActivitySummaryCache.h"
#include "host/screens/achievements/AchievementDetailViewController.h"
#include "host/screens/achievements/AchievementsViewController.h"
#include "host/screens/calendar/CalendarScreens.h"
#include "host/screens/day/DayViewController.h"
#include "host/screens/goals/GoalSetupViewController.h"
#include "host/screens/sharing/FriendDetailViewController.h"
#include "host/screens/sharing/FriendInboxViewController.h"
#include "host/screens/sharing/FriendListViewController.h"
#include "host/screens/trends/TrendControllers.h"
#include "host/screens/workouts/NoHeartRateData.h"
#include "host/screens/workouts/WorkoutDetailController.h"
#include "host/screens/workouts/WorkoutRecords.h"
#include "host/screens/workouts/WorkoutsListController.h"
#include "platform/foundation/NSDate.h"

namespace tavro {
namespace {

constexpr CGRect kScreen{0, 0, 390, 844};

Ref<UIViewController> makeDay(const Application& application) {
  const auto controller = makeController<DayViewController>();
  controller->setDay(application.today());
  return controller;
}

Ref<UIViewController> makeTrends(const Application& application) {
  const auto controller = makeController<TrendsViewController>();
  controller->setTrends(&application.diary().trends);
  return controller;
}

Ref<UIViewController> makeTrend(const Application& application) {
  const auto controller = makeController<TrendDetailViewController>();
  const std::vector<Trend>& trends = application.diary().trends;
  controller->setTrend(trends.empty() ? nullptr : &trends.front());
  return controller;
}

Ref<UIViewController> makeWorkouts(const Application& application) {
  constexpr std::size_t listed = 12;
  const auto controller = makeController<WorkoutsListController>();
  controller->setWorkouts(latestWorkouts(application.diary(), listed));
  return controller;
}

Ref<UIViewController> makeWorkout(const Application& application) {
  const auto controller = makeController<WorkoutDetailController>();
  const std::vector<const Workout*> latest = latestWorkouts(application.diary(), 1);
  controller->setWorkout(latest.empty() ? nullptr : latest.front());
  return controller;
}

struct Screen {
  std::string_view name;
  Ref<UIViewController> (*make)(const Application&);
};

constexpr Screen kScreens[] = {
    {"day", &makeDay},
    {"week", &makeWeek},
    {"calendar", &makeCalendar},
    {"loading", &makeLoadingCalendar},
    {"workouts", &makeWorkouts},
    {"workout", &makeWorkout},
    {"no-heart-rate", &makeNoHeartRateData},
    {"trends", &makeTrends},
    {"trend", &makeTrend},
    {"friends", &makeFriendList},
    {"friend", &makeFriendDetail},
    {"inbox", &makeFriendInbox},
    {"achievements", &makeAchievements},
    {"achievement", &makeAchievementDetail},
    {"goals", &makeGoalSetup},
};

}  // namespace

Application::Application(Diary diary)
    : diary_(std::move(diary)), window_(makeView<UIWindow>(kScreen)) {
  window_->makeKey();
  setAddressBookFirstName(diary_.person.firstName);
  const auto cache = ActivitySummaryCache::sharedInstance();
  cache->removeAllSummaries();
  for (const Day& day : diary_.days) {
    cache->setSummary(day.date.number, summaryOf(day));
  }
}

const Day* Application::today() const {
  const auto found = std::ranges::find(diary_.days, dayOf(dateNow()), &Day::date);
  return found == diary_.days.end() ? nullptr : &*found;
}

std::vector<std::string_view> Application::screenNames() {
  std::vector<std::string_view> names;
  std::ranges::transform(kScreens, std::back_inserter(names), &Screen::name);
  return names;
}

Ref<UIViewController> Application::makeScreen(std::string_view name) const {
  const auto* const screen = std::ranges::find(kScreens, name, &Screen::name);
  return screen == std::end(kScreens) ? nullptr : screen->make(*this);
}

bool Application::showScreen(std::string_view name) {
  const Ref<UIViewController> controller = makeScreen(name);
  if (!controller) {
    return false;
  }
  window_->setRootViewController(controller);
  return true;
}

}  // namespace tavro
