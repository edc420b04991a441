#pragma once

#include "host/libraries/Achievements.h"
#include "platform/uikit/UIControls.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

class Application;

/// One achievement: its badge, and how it was earned or how far it is, in several lines. Messages:
/// `label`, `badgeContainer`.
class CHAchievementDetailViewController : public UIViewController {
 public:
  static constexpr Name className = "CHAchievementDetailViewController";

  Ref<ACHAchievement> _achievement;
  Ref<AAUIAchievementLocalizationProvider> _locProvider;

  /// Set before the view is asked for.
  void setAchievement(const Ref<ACHAchievement>& achievement,
                      const Ref<AAUIAchievementLocalizationProvider>& provider);
  id label() { return label_; }
  id badgeContainer() { return badgeContainer_; }
  void viewDidLoad();

 private:
  Ref<UILabel> label_;
  Ref<UIView> badgeContainer_;
};

/// The first achievement of the diary.
Ref<UIViewController> makeAchievementDetail(const Application& application);

}  // namespace tavro
