#include "reader/Voice.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <sstream>
#include <stdexcept>

#include "platform/foundation/Settings.h"

namespace tavro {
namespace {

constexpr const char* kProgram = "espeak-ng";

bool isInPath(const std::string& program) {
  const char* const path = std::getenv("PATH");
  std::istringstream folders(path == nullptr ? "" : path);
  for (std::string folder; std::getline(folders, folder, ':');) {
    if (access(((folder.empty() ? "." : folder) + "/" + program).c_str(), X_OK) == 0) {
      return true;
    }
  }
  return false;
}

std::string languageOf(const std::string& locale) {
  return locale.substr(0, locale.find_first_of("_-"));
}

/// The program neither reads the reader's keys nor writes between its lines.
class QuietFiles {
 public:
  QuietFiles() {
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
  }
  ~QuietFiles() { posix_spawn_file_actions_destroy(&actions); }
  QuietFiles(const QuietFiles&) = delete;
  QuietFiles& operator=(const QuietFiles&) = delete;

  posix_spawn_file_actions_t actions{};
};

}  // namespace

Voice::Voice() {
  if (!isInPath(kProgram)) {
    throw std::invalid_argument(std::string("to speak aloud, the program ") + kProgram +
                                " is needed, and it is not in the PATH");
  }
}

Voice::~Voice() { stop(); }

void Voice::say(const std::string& text) {
  stop();
  const QuietFiles files;
  std::array<std::string, 5> words{kProgram, "-v", languageOf(Settings::current().locale), "--",
                                   text};
  std::array<char*, words.size() + 1> arguments{};
  for (std::size_t word = 0; word < words.size(); ++word) {
    arguments[word] = words[word].data();
  }
  if (posix_spawnp(&process_, kProgram, &files.actions, nullptr, arguments.data(), environ) != 0) {
    process_ = 0;
  }
}

void Voice::finish() {
  if (process_ != 0) {
    while (waitpid(process_, nullptr, 0) < 0 && errno == EINTR) {
    }
    process_ = 0;
  }
}

void Voice::stop() {
  if (process_ != 0) {
    kill(process_, SIGTERM);
    finish();
  }
}

}  // namespace tavro
