#pragma once

#include "host/Diary.h"
#include "host/libraries/Achievements.h"
#include "platform/uikit/UITables.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// All achievements: a strip of those that were earned last, then one section after the other.
class CHAchievementsViewController : public UIViewController {
 public:
  static constexpr Name className = "CHAchievementsViewController";

  /// Set before the view is asked for. The diary must outlive the controller.
  void setDiary(const Diary* diary) { diary_ = diary; }
  void viewDidLoad();

 private:
  void appendRecent(UITableView& list);
  void appendSection(UITableView& list, std::string_view section);
  [[nodiscard]] Ref<NSString> titleOf(const Ref<ACHAchievement>& achievement) const;

  const Diary* diary_ = nullptr;
  Ref<AAUIAchievementLocalizationProvider> provider_;
};

Ref<ACHAchievement> achievementOf(const Achievement& entry);
/// Names achievements for the user.
Ref<AAUIAchievementLocalizationProvider> providerFor(const Person& person);

Ref<UIViewController> makeAchievements(const Application& application);

}  // namespace tavro
