#pragma once

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <stdexcept>
#include <string>
#include <vector>

#include "tests/support/Files.h"

namespace tavro {

inline std::string narrelPath() { return std::string(TAVRO_BUILD) + "/bin/narrel"; }

/// The arguments as a program is started with them.
inline std::vector<char*> wordsOf(std::vector<std::string>& arguments) {
  std::vector<char*> words;
  words.reserve(arguments.size() + 1);
  for (std::string& argument : arguments) {
    words.push_back(argument.data());
  }
  words.push_back(nullptr);
  return words;
}

/// What a finished program left behind.
struct Finished {
  int code = -1;  ///< the exit code; negative for a program that a signal ended
  std::string output;
  std::string error;
};

/// Runs narrel to its end with that standard input.
inline Finished runNarrel(std::vector<std::string> arguments, const std::string& input = "") {
  const TemporaryFolder folder;
  const std::string in = folder.file("in", input);
  const std::string out = folder.path() + "/out";
  const std::string error = folder.path() + "/error";
  posix_spawn_file_actions_t files;
  posix_spawn_file_actions_init(&files);
  constexpr mode_t mode = 0600;
  posix_spawn_file_actions_addopen(&files, STDIN_FILENO, in.c_str(), O_RDONLY, 0);
  posix_spawn_file_actions_addopen(&files, STDOUT_FILENO, out.c_str(), O_CREAT | O_WRONLY, mode);
  posix_spawn_file_actions_addopen(&files, STDERR_FILENO, error.c_str(), O_CREAT | O_WRONLY, mode);
  arguments.insert(arguments.begin(), narrelPath());
  const std::vector<char*> words = wordsOf(arguments);
  pid_t process = 0;
  const int failure = posix_spawn(&process, words.front(), &files, nullptr, words.data(), environ);
  posix_spawn_file_actions_destroy(&files);
  if (failure != 0) {
    throw std::runtime_error("narrel cannot be started");
  }
  int status = 0;
  waitpid(process, &status, 0);
  return {WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status), contentOf(out),
          contentOf(error)};
}

}  // namespace tavro
