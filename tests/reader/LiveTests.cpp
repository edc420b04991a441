#include <gtest/gtest.h>
#include <poll.h>
#include <pty.h>
#include <sys/stat.h>
#include <utmp.h>

#include <csignal>
#include <cstring>

#include "tests/support/Process.h"

namespace tavro {
namespace {

namespace fs = std::filesystem;

constexpr const char* kRight = "\033[C";
constexpr const char* kLeft = "\033[D";
constexpr const char* kUp = "\033[A";
constexpr const char* kShiftTab = "\033[Z";

/// A live session on a terminal of its own, where keys are pressed and lines read.
class TerminalSession {
 public:
  explicit TerminalSession(std::vector<std::string> arguments = {}) {
    arguments.insert(arguments.begin(), {narrelPath(), "live", "day", "--now", "2026-03-11T15:20",
                                         "--timezone", "Europe/Lisbon"});
    const std::vector<char*> words = wordsOf(arguments);
    // The terminal's other end stays open here, so that its modes can be read after the session.
    if (openpty(&keyboard_, &terminal_, nullptr, nullptr, nullptr) != 0) {
      throw std::runtime_error("no terminal");
    }
    tcgetattr(terminal_, &before_);
    process_ = fork();
    if (process_ == 0) {
      login_tty(terminal_);
      execv(words.front(), words.data());
      _exit(127);
    }
  }
  ~TerminalSession() {
    if (process_ != 0) {
      kill(process_, SIGKILL);
      waitpid(process_, nullptr, 0);
    }
    close(keyboard_);
    close(terminal_);
  }
  TerminalSession(const TerminalSession&) = delete;
  TerminalSession& operator=(const TerminalSession&) = delete;

  void press(const std::string& keys) const {
    EXPECT_EQ(write(keyboard_, keys.data(), keys.size()), std::ssize(keys));
  }

  /// The next line; "(silence)" when none comes in time.
  std::string line() {
    constexpr int patienceMilliseconds = 20'000;
    std::size_t end = 0;
    while ((end = unread_.find('\n')) == std::string::npos) {
      pollfd input{.fd = keyboard_, .events = POLLIN, .revents = 0};
      char bytes[4096];
      const ssize_t count =
          poll(&input, 1, patienceMilliseconds) > 0 ? read(keyboard_, bytes, sizeof bytes) : 0;
      if (count <= 0) {
        return "(silence)";
      }
      unread_.append(bytes, static_cast<std::size_t>(count));
    }
    std::string text = unread_.substr(0, end);
    unread_.erase(0, end + 1);
    std::erase(text, '\r');
    return text;
  }

  /// Presses keys and yields the next line.
  std::string heardAfter(const std::string& keys) {
    press(keys);
    return line();
  }

  void signal(int number) const { kill(process_, number); }

  /// Waits for the end; the exit code, negative after a signal that was not caught.
  int end() {
    int status = 0;
    waitpid(process_, &status, 0);
    process_ = 0;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
  }

  [[nodiscard]] bool terminalTakesSingleKeys() const { return (modes().c_lflag & ICANON) == 0; }
  [[nodiscard]] bool terminalIsAsBefore() const {
    const termios now = modes();
    return now.c_lflag == before_.c_lflag && now.c_iflag == before_.c_iflag &&
           now.c_oflag == before_.c_oflag && now.c_cc[VSUSP] == before_.c_cc[VSUSP];
  }

 private:
  [[nodiscard]] termios modes() const {
    termios now{};
    tcgetattr(terminal_, &now);
    return now;
  }

  int keyboard_ = -1;
  int terminal_ = -1;
  termios before_{};
  pid_t process_ = 0;
  std::string unread_;
};

TEST(Live, KeysMoveTheCursorAndSayWhereItIs) {
  TerminalSession session({"--locales", "en_US,de_DE"});
  EXPECT_EQ(session.line(), "[day]");
  EXPECT_EQ(session.line(), "Wednesday, March 11, heading");
  EXPECT_TRUE(session.terminalTakesSingleKeys());
  const std::string rings = session.heardAfter(kRight);
  EXPECT_EQ(rings.rfind("Activity rings", 0), 0U) << rings;
  struct Step {
    const char* keys;
    const char* heard;
  };
  constexpr Step steps[] = {
      {"h", "Move, 609/500KCAL, heading"},
      {kRight, "12\u2009–\u20093\u202FAM, 3.6 calories"},
      {"\033OC",
       "3\u2009–\u20096\u202FAM, 3.5 calories"},  // the arrow of a terminal in application mode
      {"w", "3\u2009–\u20096\u202FAM, 3.5 calories, 2 of 8, chart, row, [day]"},
      {kUp, "not adjustable"},
      {"\n", "nothing happens"},
      {"h", "Exercise, 46/30MIN, heading"},
      {"h", "Stand, 8/12HRS, heading"},
      {"h", "no further heading"},
      {"H", "Exercise, 46/30MIN, heading"},
      {"H", "Move, 609/500KCAL, heading"},
      {"HH", "Wednesday, March 11, heading"},
  };
  for (const Step& step : steps) {
    SCOPED_TRACE(step.heard);
    EXPECT_EQ(session.heardAfter(step.keys), step.heard);
  }
  EXPECT_EQ(session.line(), "no earlier heading");
  EXPECT_EQ(session.heardAfter(kLeft), "beginning of screen");
  EXPECT_EQ(session.heardAfter("\033[1;5C"), "no such key, ? for help");
  EXPECT_EQ(session.heardAfter("\033"), "no such key, ? for help");
  EXPECT_EQ(session.heardAfter("l"), "Deutsch (Deutschland)");
  EXPECT_EQ(session.line(), "Mittwoch, 11. März, Überschrift");
  EXPECT_EQ(session.heardAfter("l"), "English (United States)");
  EXPECT_EQ(session.line(), "Wednesday, March 11, heading");
  session.press("q");
  EXPECT_EQ(session.end(), 0);
  EXPECT_TRUE(session.terminalIsAsBefore());
}

TEST(Live, TabGoesRoundTheScreens) {
  TerminalSession session;
  EXPECT_EQ(session.line(), "[day]");
  EXPECT_EQ(session.line(), "Wednesday, March 11, heading");
  session.press(kShiftTab);
  session.line();
  session.line();
  EXPECT_EQ(session.heardAfter("\t"), "[day]");
  EXPECT_EQ(session.line(), "Wednesday, March 11, heading");
}

TEST(Live, EverySignalPutsTheTerminalBack) {
  constexpr int kInterruptKey = 0;
  for (const int signal : {SIGINT, SIGTERM, SIGHUP, kInterruptKey}) {
    SCOPED_TRACE(strsignal(signal));
    TerminalSession session;
    EXPECT_EQ(session.line(), "[day]");
    EXPECT_EQ(session.line(), "Wednesday, March 11, heading");
    if (signal == kInterruptKey) {
      session.press("\003");
    } else {
      session.signal(signal);
    }
    EXPECT_EQ(session.end(), 128 + (signal == kInterruptKey ? SIGINT : signal));
    EXPECT_TRUE(session.terminalIsAsBefore());
  }
}

TEST(Live, ReadsKeysFromAPipeToo) {
  const std::string keys = std::string(kRight) + "h" + kRight;
  const Finished finished =
      runNarrel({"live", "--now", "2026-03-11T15:20", "--verbosity", "containers"}, keys);
  EXPECT_EQ(finished.code, 0);
  EXPECT_EQ(finished.error, "");
  EXPECT_NE(
      finished.output.find("heading\nchart\n12\u2009–\u20093\u202FAM, 3.6 calories, 1 of 8\n"),
      std::string::npos)
      << finished.output;
  EXPECT_EQ(runNarrel({"live"}, "q" + keys).output, runNarrel({"live"}).output);
  const std::string help = runNarrel({"live"}, "?").output;
  for (const char* key : {"arrow", "h and H", "Enter", "Tab", "l:", "w:", "q:"}) {
    EXPECT_NE(help.find(key), std::string::npos) << key;
  }
}

/// Speech through a stand-in for the speaking program, which notes what it is asked to say.
class LiveSpeech : public testing::Test {
 protected:
  void install(const std::string& script) const {
    const fs::path program = folder.file("espeak-ng", "#!/bin/sh\n" + script);
    fs::permissions(program, fs::perms::owner_all);
  }

  static void lookIn(const std::string& path) { setenv("PATH", path.c_str(), 1); }

  TemporaryFolder folder;
};

TEST_F(LiveSpeech, SaysEachUtteranceInItsLanguage) {
  const std::string log = folder.path() + "/log";
  install("printf '%s|' \"$@\" >> " + log + "\n");
  lookIn(folder.path() + ":/usr/bin:/bin");
  const Finished finished =
      runNarrel({"live", "--speak", "--locale", "de_DE", "--now", "2026-03-11T15:20"});
  EXPECT_EQ(finished.code, 0) << finished.error;
  // The end of the input waits until the last utterance has been spoken.
  EXPECT_EQ(contentOf(log), "-v|de|--|[day], Mittwoch, 11. März, Überschrift|");
}

TEST_F(LiveSpeech, ANewUtteranceStopsTheOneBeforeIt) {
  // Each thing that happens is a line in a pipe that stays open, so that two that follow closely
  // are still two lines.
  const std::string pipe = folder.path() + "/happened";
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  std::fstream happened(pipe);
  const auto next = [&] {
    std::string line;
    std::getline(happened, line);
    return line;
  };
  install("pipe=" + pipe + R"(
case "$4" in
*rings*) echo rings > $pipe ;;
*) trap 'echo stopped > $pipe; kill $!; exit' TERM
   sleep 1000000 &
   echo started > $pipe
   wait ;;
esac
)");
  lookIn(folder.path() + ":/usr/bin:/bin");
  TerminalSession session({"--speak"});
  EXPECT_EQ(next(), "started");
  session.press(kRight);
  EXPECT_EQ(next(), "stopped");
  EXPECT_EQ(next(), "rings");
  session.press(kLeft);
  EXPECT_EQ(next(), "started");
  session.press("q");
  EXPECT_EQ(next(), "stopped") << "ending stops what is being said";
  EXPECT_EQ(session.end(), 0);
}

TEST_F(LiveSpeech, IsRefusedWithoutTheProgram) {
  lookIn(folder.path());
  const Finished finished = runNarrel({"live", "--speak"}, kRight);
  EXPECT_EQ(finished.code, 2);
  EXPECT_EQ(finished.output, "");
  EXPECT_EQ(finished.error,
            "narrel: to speak aloud, the program espeak-ng is needed, and it is not in the PATH\n");
}

}  // namespace
}  // namespace tavro
