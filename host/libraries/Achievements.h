#pragma once

#include <string>

#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"

namespace tavro {

/// An achievement as the achievements library knows it.
class ACHAchievement : public NSObject {
 public:
  static constexpr Name className = "ACHAchievement";

  /// "{name}" in a title stands for the person's first name.
  std::string title;
  /// The title for a person who uses a wheelchair; empty where it is the same.
  std::string wheelchairTitle;
  /// How far the user is; may have several lines.
  std::string progress;
  /// A moment of the day on which it was earned; nil before.
  Ref<NSDate> earnedDate;
};

/// Names achievements for one person. Messages: `setName:`, `setWheelchairUser:`,
/// `titleForAchievement:` (nil for an object of another class).
class AAUIAchievementLocalizationProvider : public NSObject {
 public:
  static constexpr Name className = "AAUIAchievementLocalizationProvider";

  void setName(const Ref<NSString>& name) { name_ = name; }
  void setWheelchairUser(bool isWheelchairUser) { isWheelchairUser_ = isWheelchairUser; }
  id titleForAchievement(const id& achievement);

 private:
  Ref<NSString> name_;
  bool isWheelchairUser_ = false;
};

/// The first name that `TVUICopyUserFirstNameFromAddressBook` yields; empty for none.
void setAddressBookFirstName(std::string_view name);

}  // namespace tavro
