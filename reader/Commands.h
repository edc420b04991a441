#pragma once

#include <string>
#include <vector>

#include "reader/Containers.h"
#include "reader/Session.h"

namespace tavro {

inline constexpr int kSucceeded = 0;
inline constexpr int kFailed = 1;    ///< what was to be checked is not right
inline constexpr int kBadInput = 2;  ///< what was given cannot be used

/// What was asked of narrel; each command uses its part.
struct Command {
  SessionOptions session = optionsBesideProgram();
  std::string screen;
  std::string label;
  Verbosity verbosity = Verbosity::elements;
  bool json = false;
  bool headings = false;
  CGPoint point;  ///< screen coordinates
  bool up = false;
  bool down = false;
  int times = 1;
  std::vector<std::string> locales{"en_US", "de_DE", "ar_EG", "ja_JP"};
  bool speak = false;
};

// Each command prints to standard output, and nothing before it has succeeded, except the live
// session. It yields the program's exit code, or throws an exception with one sentence for people.

int tourScreens(const Command& command);
int readScreen(const Command& command);
int showTree(const Command& command);
int touchScreen(const Command& command);
int activateElement(const Command& command);
int adjustElement(const Command& command);
int validateContract(const Command& command);

// Options as they are typed. Each throws `std::invalid_argument` with one sentence.

/// "120,300.5"
CGPoint pointFromText(const std::string& text);
/// "1" to "1000"
int timesFromText(const std::string& text);
Verbosity verbosityFromText(const std::string& text);
HKWheelchairUse wheelchairFromText(const std::string& text);
/// "en_US,de_DE"
std::vector<std::string> localesFromText(const std::string& text);

}  // namespace tavro
