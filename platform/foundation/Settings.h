#pragma once

#include <atomic>
#include <cstdint>
#include <string>

namespace tavro {

/// What a device would tell its applications. Everything of the platform that depends on the
/// moment, the place or the user reads it here, at each use; nothing reads the machine's own clock
/// or locale. Main thread only, except the atomic members.
struct Settings {
  /// The process's one set of settings.
  static Settings& current();

  /// The user's locale as an ICU locale name ("de_DE"); also chooses the language of texts.
  std::string locale = "en_US";
  /// An IANA time zone name.
  std::string timeZone = "UTC";
  /// The user's calendar as ICU names it ("gregorian", "hebrew", "islamic", ...); empty for the
  /// locale's own.
  std::string calendar;
  /// The moment that counts as now, in seconds since 1970-01-01 00:00 UTC.
  double now = 0;
  /// The first day of weekly goals: 1 is Sunday ... 7 is Saturday.
  std::int64_t firstWeekday = 2;

  /// The health store's wheelchair setting: 0 not set, 1 no, 2 yes.
  std::atomic<std::int64_t> wheelchairUse = 0;
  /// While true, the health store answers the wheelchair query with an error.
  std::atomic<bool> wheelchairUseFails = false;
  /// How often the health store was asked for the wheelchair setting.
  std::atomic<std::int64_t> wheelchairQueries = 0;
  std::atomic<bool> screenReaderRuns = false;

  /// Whether the accessibility runtime runs the checks of a host contract.
  bool performsValidationChecks = true;
};

}  // namespace tavro
