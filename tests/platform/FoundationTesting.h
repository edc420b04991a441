#pragma once

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/Settings.h"
#include "tests/support/Files.h"

namespace tavro::testing {

/// Gives each test the settings of an English-speaking person in New York and puts back what was.
class FoundationTest : public ::testing::Test {
 protected:
  FoundationTest() {
    settings_.locale = "en_US";
    settings_.timeZone = "America/New_York";
    settings_.calendar = "";
    settings_.now = 0;
  }
  ~FoundationTest() override {
    settings_.locale = locale_;
    settings_.timeZone = timeZone_;
    settings_.calendar = calendar_;
    settings_.now = now_;
  }

  Settings& settings_ = Settings::current();

 private:
  std::string locale_ = settings_.locale;
  std::string timeZone_ = settings_.timeZone;
  std::string calendar_ = settings_.calendar;
  double now_ = settings_.now;
};

/// The text for comparison; nil is told from the empty text.
inline std::string heard(const id& text) { return text ? utf8(text) : "(nil)"; }

/// A moment as local time of the settings' time zone.
inline Ref<NSDate> at(std::string_view iso) {
  const std::optional<double> seconds = secondsFromIso(iso);
  EXPECT_TRUE(seconds.has_value()) << iso;
  return dateWithSeconds(seconds.value_or(0));
}

/// A moment as UTC.
inline std::string utc(const Ref<NSDate>& date) {
  return date ? utf8(send<id>(date, "description")) : "(nil)";
}

}  // namespace tavro::testing
