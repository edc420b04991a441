#include "host/screens/achievements/AchievementDetailViewController.h"

#include "host/Application.h"
#include "host/screens/achievements/AchievementViews.h"
#include "host/screens/achievements/AchievementsViewController.h"
#include "platform/foundation/Formatters.h"

namespace tavro {
namespace {

using Controller = CHAchievementDetailViewController;
const Registered controllerClass = defineClass<Controller, UIViewController>()
                                       .method<&Controller::label>("label")
                                       .method<&Controller::badgeContainer>("badgeContainer")
                                       .method<&Controller::viewDidLoad>("viewDidLoad")
                                       .variable<&Controller::_achievement>("_achievement")
                                       .variable<&Controller::_locProvider>("_locProvider");

std::string textOf(const ACHAchievement& achievement) {
  const auto day = dateStringForFormat(achievement.earnedDate, "MMMMdyyyy");
  return achievement.progress + (day ? "\nEarned on " + day->utf8() : "");
}

}  // namespace

void CHAchievementDetailViewController::setAchievement(
    const Ref<ACHAchievement>& achievement,
    const Ref<AAUIAchievementLocalizationProvider>& provider) {
  _achievement = achievement;
  _locProvider = provider;
}

void CHAchievementDetailViewController::viewDidLoad() {
  const auto screen = makeView<UIView>({0, 0, 390, 800});
  setView(screen);
  badgeContainer_ = makeView<UIView>({75, 40, 240, 240});
  label_ = makeLabel("No awards yet", {16, 310, 358, 88});
  screen->addSubview(badgeContainer_);
  screen->addSubview(label_);
  navigationItem()->title = string("Award");
  if (_achievement) {
    const auto badge = makeView<UIImageView>({0, 0, 240, 240});
    badge->setImage(badgeImageOf(*_achievement));
    badgeContainer_->addSubview(badge);
    label_->setText(string(textOf(*_achievement)));
  }
}

Ref<UIViewController> makeAchievementDetail(const Application& application) {
  const auto controller = makeController<CHAchievementDetailViewController>();
  const Diary& diary = application.diary();
  if (!diary.achievements.empty()) {
    controller->setAchievement(achievementOf(diary.achievements.front()),
                               providerFor(diary.person));
  }
  return controller;
}

}  // namespace tavro
