#include "reader/Live.h"

#include <algorithm>
#include <iostream>

#include "platform/foundation/Language.h"
#include "platform/foundation/Settings.h"
#include "reader/Cursor.h"
#include "reader/Terminal.h"
#include "reader/Voice.h"

namespace tavro {
namespace {

constexpr int kControlD = 4;
constexpr int kAfterSignal = 128;

class Live {
 public:
  explicit Live(const Command& command)
      : session_(command.session),
        verbosity_(command.verbosity),
        screens_(Application::screenNames()),
        locales_(command.locales) {
    if (command.speak) {
      voice_.emplace();
    }
    // The language that one starts in comes around again.
    locale_ = static_cast<std::size_t>(std::ranges::find(locales_, command.session.locale) -
                                       locales_.begin());
    if (locale_ == locales_.size()) {
      locales_.push_back(command.session.locale);
    }
    const std::string first =
        command.screen.empty() ? std::string(screens_.front()) : command.screen;
    session_.show(first);
    screen_ = static_cast<std::size_t>(std::ranges::find(screens_, first) - screens_.begin());
    cursor_.emplace(Ref<UIView>(&session_.application().window()));
  }

  int run() {
    Terminal terminal;
    sayPlace(screenTitle());
    bool quit = false;
    while (!quit && std::cout) {
      const auto key = terminal.nextKey();
      if (!key) {
        break;
      }
      quit = *key == 'q' || *key == kControlD;
      if (!quit) {
        press(*key);
      }
    }
    if (const int signal = terminal.endingSignal()) {
      return kAfterSignal + signal;
    }
    if (voice_ && !quit) {
      voice_->finish();
    }
    return std::cout ? kSucceeded : kFailed;
  }

 private:
  struct KeyPress {
    int key;
    void (Live::*action)();
  };
  static const KeyPress kKeys[];

  void press(int key);

  void next() { move(Move::next, "live.end"); }
  void previous() { move(Move::previous, "live.beginning"); }
  void nextHeading() { move(Move::nextHeading, "live.no.next.heading"); }
  void previousHeading() { move(Move::previousHeading, "live.no.previous.heading"); }

  void move(Move move, std::string_view otherwise) {
    if (cursor_->move(move)) {
      sayPlace();
    } else {
      say({readerWord(otherwise)});
    }
  }

  void activate() {
    if (cursor_->activate()) {
      sayPlace();
    } else {
      say({readerWord("live.no.action")});
    }
  }

  void increment() { sayAdjusted(cursor_->increment()); }
  void decrement() { sayAdjusted(cursor_->decrement()); }

  void sayAdjusted(bool adjusted) {
    const auto element = cursor_->current();
    say({adjusted && element ? utteranceAfterAdjusting(*element)
                             : readerWord("live.not.adjustable")});
  }

  void nextScreen() { showScreen(screen_ + 1); }
  void previousScreen() { showScreen(screen_ + screens_.size() - 1); }

  void showScreen(std::size_t number) {
    screen_ = number % screens_.size();
    showAgain(screenTitle());
  }

  void nextLanguage() {
    locale_ = (locale_ + 1) % locales_.size();
    session_.setLocale(locales_[locale_]);
    showAgain(nameOfLocale(locales_[locale_]));
  }

  void showAgain(const std::string& title) {
    session_.show(screens_[screen_]);
    cursor_->update();
    open_.clear();
    sayPlace(title);
  }

  void sayWhereabouts() {
    const auto element = cursor_->current();
    if (!element) {
      sayPlace(screenTitle());
      return;
    }
    const ContainerSpeech speech(verbosity_, cursor_->elements());
    const std::string around = speech.whereabouts(cursor_->index());
    say({element->utterance + (around.empty() ? "" : ", " + around) + ", " + screenTitle()});
  }

  void sayHelp() { say({readerWord("live.help")}); }

  /// Says where the cursor is now, after a title if there is one.
  void sayPlace(const std::string& title = "") {
    std::vector<std::string> lines;
    if (!title.empty()) {
      lines.push_back(title);
    }
    if (const auto element = cursor_->current()) {
      const ContainerSpeech speech(verbosity_, cursor_->elements());
      std::ranges::copy(speech.passage(open_, element->containers), std::back_inserter(lines));
      lines.push_back(speech.withPosition(element->utterance, cursor_->index()));
      open_ = element->containers;
    } else {
      lines.push_back(readerWord("live.nothing"));
    }
    say(lines);
  }

  void say(const std::vector<std::string>& lines) {
    std::string spoken;
    for (const std::string& line : lines) {
      std::cout << line << "\n";
      spoken += (spoken.empty() ? "" : ", ") + line;
    }
    std::cout.flush();
    if (voice_) {
      voice_->say(spoken);
    }
  }

  [[nodiscard]] std::string screenTitle() const {
    return "[" + std::string(screens_[screen_]) + "]";
  }

  std::optional<Voice> voice_;
  Session session_;
  Verbosity verbosity_;
  std::vector<std::string_view> screens_;
  std::vector<std::string> locales_;
  std::size_t screen_ = 0;
  std::size_t locale_ = 0;
  std::optional<Cursor> cursor_;
  std::vector<id> open_;  ///< the containers around what was said last
};

const Live::KeyPress Live::kKeys[] = {
    {keyRight, &Live::next},    {keyLeft, &Live::previous},
    {keyUp, &Live::increment},  {keyDown, &Live::decrement},
    {'\n', &Live::activate},    {'\r', &Live::activate},
    {'\t', &Live::nextScreen},  {keyShiftTab, &Live::previousScreen},
    {'h', &Live::nextHeading},  {'H', &Live::previousHeading},
    {'l', &Live::nextLanguage}, {'w', &Live::sayWhereabouts},
    {'?', &Live::sayHelp},
};

void Live::press(int key) {
  const auto* const known = std::ranges::find(kKeys, key, &KeyPress::key);
  if (known == std::end(kKeys)) {
    say({readerWord("live.unknown.key")});
  } else {
    (this->*known->action)();
  }
}

}  // namespace

int readLive(const Command& command) {
  Live live(command);
  return live.run();
}

}  // namespace tavro
