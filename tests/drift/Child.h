#pragma once

#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstring>
#include <functional>
#include <iostream>
#include <stdexcept>
#include <string>
#include <vector>

#include "platform/runtime/Dispatch.h"

#if defined(__SANITIZE_ADDRESS__)
#include <sanitizer/lsan_interface.h>
#endif

namespace tavro::drift {

/// Seconds after which a case counts as hung.
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr unsigned kDeadline = 60;
#else
inline constexpr unsigned kDeadline = 10;
#endif

/// A copy of this process at work; what it has to say comes through a pipe.
struct Child {
  pid_t process = 0;
  int output = -1;

  static Child start(const std::function<std::string()>& work) {
    int ends[2];
    if (pipe(ends) != 0) {
      throw std::runtime_error("no pipe");
    }
    std::cout.flush();
    Child child{fork(), ends[0]};
    if (child.process == 0) {
      alarm(kDeadline);
      std::string text;
      try {
        text = work();
      } catch (const std::exception& error) {
        text = std::string("it raised: ") + error.what() + "\n";
      } catch (...) {
        text = "it raised\n";
      }
      GlobalQueue::shared().drain();
#if defined(__SANITIZE_ADDRESS__)
      text += __lsan_do_recoverable_leak_check() != 0 ? "memory leaks\n" : "";
#endif
      std::size_t written = 0;
      while (written < text.size()) {
        const ssize_t count = write(ends[1], text.data() + written, text.size() - written);
        if (count <= 0) {
          break;
        }
        written += static_cast<std::size_t>(count);
      }
      _exit(0);
    }
    close(ends[1]);
    return child;
  }

  /// Everything that it said, and how it ended when that was not well.
  [[nodiscard]] std::string finish() const {
    constexpr std::size_t size = 65536;
    std::string text;
    std::vector<char> buffer(size);
    for (ssize_t count = 0; (count = read(output, buffer.data(), size)) > 0;) {
      text.append(buffer.data(), static_cast<std::size_t>(count));
    }
    close(output);
    int status = 0;
    waitpid(process, &status, 0);
    if (WIFSIGNALED(status)) {
      text += WTERMSIG(status) == SIGALRM
                  ? "it hung\n"
                  : std::string("it crashed: ") + strsignal(WTERMSIG(status)) + "\n";
    } else if (WEXITSTATUS(status) != 0) {
      text += "it ended with code " + std::to_string(WEXITSTATUS(status)) + "\n";
    }
    return text;
  }
};

}  // namespace tavro::drift
