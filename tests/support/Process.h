#pragma once

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace tavro {

/// A folder of its own for one test, removed with everything in it.
class TemporaryFolder {
 public:
  TemporaryFolder() {
    std::string name = (std::filesystem::temp_directory_path() / "tavro-XXXXXX").string();
    if (mkdtemp(name.data()) == nullptr) {
      throw std::runtime_error("no temporary folder");
    }
    path = name;
  }
  ~TemporaryFolder() { std::filesystem::remove_all(path); }
  TemporaryFolder(const TemporaryFolder&) = delete;
  TemporaryFolder& operator=(const TemporaryFolder&) = delete;

  std::filesystem::path path;
};

inline std::string contentOf(const std::filesystem::path& file) {
  std::stringstream content;
  content << std::ifstream(file).rdbuf();
  return content.str();
}

inline std::string narrelPath() { return std::string(TAVRO_BUILD) + "/bin/narrel"; }

/// What a finished program left behind.
struct Finished {
  int code = -1;  ///< the exit code; negative for a program that a signal ended
  std::string output;
  std::string error;
};

/// Runs narrel to its end with that standard input.
inline Finished runNarrel(std::vector<std::string> arguments, const std::string& input = "") {
  const TemporaryFolder folder;
  const std::string in = folder.path / "in";
  const std::string out = folder.path / "out";
  const std::string error = folder.path / "error";
  std::ofstream(in) << input;
  posix_spawn_file_actions_t files;
  posix_spawn_file_actions_init(&files);
  constexpr mode_t mode = 0600;
  posix_spawn_file_actions_addopen(&files, STDIN_FILENO, in.c_str(), O_RDONLY, 0);
  posix_spawn_file_actions_addopen(&files, STDOUT_FILENO, out.c_str(), O_CREAT | O_WRONLY, mode);
  posix_spawn_file_actions_addopen(&files, STDERR_FILENO, error.c_str(), O_CREAT | O_WRONLY, mode);
  arguments.insert(arguments.begin(), narrelPath());
  std::vector<char*> words;
  words.reserve(arguments.size() + 1);
  for (std::string& argument : arguments) {
    words.push_back(argument.data());
  }
  words.push_back(nullptr);
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
