#pragma once

#include <sys/types.h>

#include <string>

namespace tavro {

/// Speaks aloud through the program espeak-ng. A new utterance stops the one being spoken.
class Voice {
 public:
  /// Throws `std::invalid_argument` with one sentence when the program is not in the PATH.
  Voice();
  /// Stops speaking.
  ~Voice();
  Voice(const Voice&) = delete;
  Voice& operator=(const Voice&) = delete;

  /// Starts to speak in the settings' language, and returns at once.
  void say(const std::string& text);
  /// Waits until the last utterance has been spoken.
  void finish();

 private:
  void stop();

  pid_t process_ = 0;
};

}  // namespace tavro
