#pragma once

#include <termios.h>

#include <optional>

namespace tavro {

/// The keys that the reader knows; every other character stands for itself.
enum Key : int { keyUp = 256, keyDown, keyRight, keyLeft, keyShiftTab, keyUnknown };

/// Single key presses from standard input. Where that is a terminal, keys arrive at once and
/// without an echo until this is destroyed, which puts the terminal back as it was; otherwise they
/// are read as bytes. SIGINT, SIGTERM and SIGHUP end the input instead of the process meanwhile,
/// and a closed standard output is an error instead of the end of the process.
class Terminal {
 public:
  Terminal();
  ~Terminal();
  Terminal(const Terminal&) = delete;
  Terminal& operator=(const Terminal&) = delete;

  /// Waits for the next key: a character or a `Key`. Nothing at the end of the input or after a
  /// signal.
  std::optional<int> nextKey();
  /// The signal that ended the input, or 0.
  [[nodiscard]] int endingSignal() const;

 private:
  /// Nothing when the input ends, a signal came, or nothing came in time; less than 0 waits on.
  std::optional<unsigned char> nextByte(int patienceMilliseconds);
  int keyAfterEscape();

  bool isTerminal_ = false;
  termios saved_{};
};

}  // namespace tavro
