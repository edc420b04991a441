#pragma once

#include <memory>
#include <optional>
#include <string>

#include "host/Application.h"
#include "platform/accessibility/BundleLoader.h"
#include "reader/Model.h"

namespace tavro {

/// How a session is set up. What is not given comes from the diary, or is the sample's.
struct SessionOptions {
  std::string locale = "en_US";
  std::string calendar;  ///< as ICU names it; empty for the locale's
  std::optional<std::string> timeZone;
  std::optional<std::string> now;  ///< "2026-03-02T08:15", local time; with "Z" UTC
  std::optional<HKWheelchairUse> wheelchair;
  bool withPlugin = true;
  std::string diary;                    ///< path
  std::optional<std::string> activity;  ///< path; becomes the diary's latest workout
  std::string bundle;                   ///< path
  std::string reader;                   ///< folder of the reader's own words
};

/// The paths of what lies beside the running program.
SessionOptions optionsBesideProgram();

/// Throws `std::invalid_argument` with one sentence for a locale that is not known.
void requireKnownLocale(const std::string& locale);

/// A screen reader at work on the sample application: settings, application, plug-in. One a
/// process.
class Session {
 public:
  /// Sets the settings, opens the diary, and loads the plug-in before the first screen. Throws a
  /// `FileError` or `std::invalid_argument` with one sentence for people.
  explicit Session(const SessionOptions& options);
  ~Session();
  Session(const Session&) = delete;
  Session& operator=(const Session&) = delete;

  /// Shows a screen. Throws `std::invalid_argument` for a name that no screen has.
  void show(std::string_view screen);
  /// Changes the user's locale while the application runs; what is on screen is loaded anew. Throws
  /// `std::invalid_argument` for a locale that is not known.
  void setLocale(const std::string& locale);
  /// Shows a screen and reads it from top to bottom.
  std::vector<HeardElement> read(std::string_view screen);

  [[nodiscard]] Application& application() { return *application_; }

 private:
  std::unique_ptr<Application> application_;
};

}  // namespace tavro
