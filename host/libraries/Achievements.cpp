#include "host/libraries/Achievements.h"

#include "platform/runtime/Function.h"

namespace tavro {
namespace {

const Registered achievementClass = defineClass<ACHAchievement, NSObject>();

const Registered providerClass =
    defineClass<AAUIAchievementLocalizationProvider, NSObject>()
        .method<&AAUIAchievementLocalizationProvider::setName>("setName:")
        .method<&AAUIAchievementLocalizationProvider::setWheelchairUser>("setWheelchairUser:")
        .method<&AAUIAchievementLocalizationProvider::titleForAchievement>("titleForAchievement:");

std::string& firstName() {
  static std::string name;
  return name;
}

id copyFirstName(Class* /*functions*/) {
  return firstName().empty() ? id() : id(string(firstName()));
}

const Registered addressBook =
    extendClass(kFunctions).classMethod<&copyFirstName>("TVUICopyUserFirstNameFromAddressBook");

}  // namespace

id AAUIAchievementLocalizationProvider::titleForAchievement(const id& achievement) {
  const auto known = as<ACHAchievement>(achievement);
  if (!known) {
    return nullptr;
  }
  const bool usesOther = isWheelchairUser_ && !known->wheelchairTitle.empty();
  const Ref<NSString> title = string(usesOther ? known->wheelchairTitle : known->title);
  return stringByReplacing(*title, u"{name}", name_ ? name_->text() : u"");
}

void setAddressBookFirstName(std::string_view name) { firstName() = name; }

}  // namespace tavro
