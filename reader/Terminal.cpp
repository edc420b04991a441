#include "reader/Terminal.h"

#include <fcntl.h>
#include <poll.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <system_error>

namespace tavro {
namespace {

constexpr int kEndingSignals[] = {SIGINT, SIGTERM, SIGHUP};
constexpr unsigned char kEscape = 0x1B;
constexpr int kForever = -1;
/// In milliseconds; what follows so closely belongs to the same key.
constexpr int kPatienceWithinKey = 50;

volatile std::sig_atomic_t caughtSignal = 0;
int wakingPipe[2] = {-1, -1};

/// May run on any thread; the pipe wakes the one that waits for keys.
void noteSignal(int signal) {
  const int error = errno;
  caughtSignal = signal;
  const unsigned char byte = 0;
  [[maybe_unused]] const ssize_t written = write(wakingPipe[1], &byte, 1);
  errno = error;
}

void handle(int signal, void (*handler)(int)) {
  struct sigaction action {};
  action.sa_handler = handler;
  action.sa_flags = SA_RESTART;
  sigaction(signal, &action, nullptr);
}

int keyOfFinalByte(unsigned char byte) {
  switch (byte) {
    case 'A':
      return keyUp;
    case 'B':
      return keyDown;
    case 'C':
      return keyRight;
    case 'D':
      return keyLeft;
    case 'Z':
      return keyShiftTab;
    default:
      return keyUnknown;
  }
}

}  // namespace

Terminal::Terminal() {
  caughtSignal = 0;
  if (fcntl(STDIN_FILENO, F_GETFD) == -1) {
    // Without a standard input there are no keys, and nothing else may take its number.
    [[maybe_unused]] const int nothing = open("/dev/null", O_RDONLY);
  }
  if (pipe2(wakingPipe, O_CLOEXEC | O_NONBLOCK) != 0) {
    throw std::system_error(errno, std::generic_category(), "the keyboard cannot be waited for");
  }
  for (const int signal : kEndingSignals) {
    handle(signal, &noteSignal);
  }
  handle(SIGPIPE, SIG_IGN);
  isTerminal_ = tcgetattr(STDIN_FILENO, &saved_) == 0;
  if (isTerminal_) {
    termios keys = saved_;
    keys.c_lflag &= ~static_cast<tcflag_t>(ICANON | ECHO);
    // Suspended, the terminal would be left without an echo.
    keys.c_cc[VSUSP] = _POSIX_VDISABLE;
    keys.c_cc[VMIN] = 1;
    keys.c_cc[VTIME] = 0;
    tcsetattr(STDIN_FILENO, TCSADRAIN, &keys);
  }
}

Terminal::~Terminal() {
  if (isTerminal_) {
    tcsetattr(STDIN_FILENO, TCSADRAIN, &saved_);
  }
  for (const int signal : kEndingSignals) {
    handle(signal, SIG_DFL);
  }
  handle(SIGPIPE, SIG_DFL);
  close(wakingPipe[0]);
  close(wakingPipe[1]);
}

int Terminal::endingSignal() const { return caughtSignal; }

std::optional<unsigned char> Terminal::nextByte(int patienceMilliseconds) {
  std::array<pollfd, 2> inputs{{{.fd = STDIN_FILENO, .events = POLLIN, .revents = 0},
                                {.fd = wakingPipe[0], .events = POLLIN, .revents = 0}}};
  int ready = -1;
  do {
    ready = poll(inputs.data(), inputs.size(), patienceMilliseconds);
  } while (ready < 0 && errno == EINTR);
  unsigned char byte = 0;
  return ready > 0 && caughtSignal == 0 && read(STDIN_FILENO, &byte, 1) == 1 ? std::optional(byte)
                                                                             : std::nullopt;
}

/// Reads what a terminal sends for the arrows: escape, "[" or "O", parameters, a final byte.
int Terminal::keyAfterEscape() {
  const auto introducer = nextByte(kPatienceWithinKey);
  if (!introducer || (*introducer != '[' && *introducer != 'O')) {
    return keyUnknown;
  }
  bool isPlain = true;
  for (auto byte = nextByte(kPatienceWithinKey); byte; byte = nextByte(kPatienceWithinKey)) {
    constexpr unsigned char firstFinalByte = 0x40;
    if (*byte >= firstFinalByte) {
      return isPlain ? keyOfFinalByte(*byte) : keyUnknown;
    }
    isPlain = false;
  }
  return keyUnknown;
}

std::optional<int> Terminal::nextKey() {
  const auto byte = nextByte(kForever);
  if (!byte) {
    return std::nullopt;
  }
  return *byte == kEscape ? keyAfterEscape() : static_cast<int>(*byte);
}

}  // namespace tavro
