#pragma once

#include <functional>
#include <span>
#include <string_view>
#include <vector>

#include "host/Diary.h"
#include "platform/uikit/UIViewController.h"

namespace tavro {

/// The sample application: screens that show a diary.
class Application {
 public:
  /// Takes over the diary and fills what the application's libraries share. The settings' moment
  /// and time zone are to be set before.
  explicit Application(Diary diary);
  Application(const Application&) = delete;
  Application& operator=(const Application&) = delete;

  [[nodiscard]] const Diary& diary() const { return diary_; }
  /// The diary's entry for the settings' present day, or nullptr.
  [[nodiscard]] const Day* today() const;

  /// The screens by their names, in the order in which a person would go through them.
  [[nodiscard]] static std::vector<std::string_view> screenNames();
  /// A new controller of that screen; nil when there is no such screen.
  [[nodiscard]] Ref<UIViewController> makeScreen(std::string_view name) const;
  /// Shows a screen; NO when there is none of that name.
  bool showScreen(std::string_view name);

  [[nodiscard]] UIWindow& window() const { return *window_; }

 private:
  Diary diary_;
  Ref<UIWindow> window_;
};

}  // namespace tavro
