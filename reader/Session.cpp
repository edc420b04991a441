#include "reader/Session.h"

#include <filesystem>
#include <stdexcept>
#include <utility>

#include "host/ActivityFile.h"
#include "platform/foundation/Language.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Settings.h"
#include "platform/foundation/TextFile.h"
#include "platform/runtime/Dispatch.h"
#include "reader/SummaryDescription.h"

namespace tavro {

void requireKnownLocale(const std::string& locale) {
  if (!isKnownLocale(locale)) {
    throw std::invalid_argument(inQuotes(locale) + " is not a locale that is known here");
  }
}

namespace {

void applySettings(const SessionOptions& options, const Diary& diary) {
  Settings& settings = Settings::current();
  requireKnownLocale(options.locale);
  settings.locale = options.locale;
  if (!options.calendar.empty() && !calendarWithIdentifier(options.calendar)) {
    throw std::invalid_argument(inQuotes(options.calendar) + " is not a calendar");
  }
  settings.calendar = options.calendar;
  settings.timeZone = options.timeZone.value_or(diary.timeZone);
  if (!isKnownTimeZone(settings.timeZone)) {
    throw std::invalid_argument(inQuotes(settings.timeZone) + " is not a time zone");
  }
  const std::string now = options.now.value_or(diary.now.iso);
  const std::optional<double> seconds = secondsFromIso(now);
  if (!seconds) {
    throw std::invalid_argument(inQuotes(now) + " is not a moment such as 2026-03-02T08:15");
  }
  settings.now = *seconds;
  settings.wheelchairUse =
      static_cast<std::int64_t>(options.wheelchair.value_or(diary.person.wheelchair));
  settings.screenReaderRuns = true;
}

}  // namespace

SessionOptions optionsBesideProgram() {
  const std::filesystem::path root =
      std::filesystem::read_symlink("/proc/self/exe").parent_path().parent_path();
  SessionOptions options;
  options.diary = (root / "share/diary.json").string();
  options.bundle = (root / "AXTavro.axbundle").string();
  options.reader = (root / "share/reader").string();
  return options;
}

Session::Session(const SessionOptions& options) {
  setReaderResources(options.reader);
  Diary diary = Diary::read(options.diary);
  if (options.activity) {
    diary.workouts.push_back(readActivityFile(*options.activity));
  }
  applySettings(options, diary);
  application_ = std::make_unique<Application>(std::move(diary));
  if (options.withPlugin) {
    letSummariesDescribeRings(loadAccessibilityBundle(options.bundle));
  }
}

Session::~Session() { GlobalQueue::shared().drain(); }

void Session::show(std::string_view screen) {
  if (!application_->showScreen(screen)) {
    std::string known;
    for (const std::string_view name : Application::screenNames()) {
      known += (known.empty() ? "" : ", ") + std::string(name);
    }
    throw std::invalid_argument("there is no screen \"" + std::string(screen) +
                                "\"; the screens are: " + known);
  }
}

void Session::setLocale(const std::string& locale) {
  requireKnownLocale(locale);
  Settings::current().locale = locale;
  reloadAccessibilityInformation();
}

std::vector<HeardElement> Session::read(std::string_view screen) {
  show(screen);
  return readElements(id(&application_->window()));
}

}  // namespace tavro
