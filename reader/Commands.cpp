#include "reader/Commands.h"

#include <charconv>
#include <cmath>
#include <iostream>
#include <map>
#include <sstream>
#include <stdexcept>

#include "platform/foundation/TextFile.h"
#include "reader/Cursor.h"
#include "reader/Output.h"

namespace tavro {
namespace {

[[noreturn]] void refuse(const std::string& sentence) { throw std::invalid_argument(sentence); }

/// The number that the whole text is.
template <class Number>
std::optional<Number> numberFrom(std::string_view text) {
  Number number{};
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  return error == std::errc() && end == text.data() + text.size() ? std::optional(number)
                                                                  : std::nullopt;
}

template <class Value>
Value choiceFrom(const std::string& text, const std::map<std::string, Value>& choices,
                 const std::string& what) {
  if (const auto found = choices.find(text); found != choices.end()) {
    return found->second;
  }
  std::string known;
  for (const auto& [word, value] : choices) {
    known += (known.empty() ? "" : ", ") + word;
  }
  refuse(inQuotes(text) + " is not " + what + "; there are: " + known);
}

/// A shown screen, and the cursor on the element that the command names.
struct Place {
  explicit Place(const Command& command) : session(command.session) {
    session.show(command.screen);
    cursor.emplace(Ref<UIView>(&session.application().window()));
  }

  void find(const Command& command) {
    if (command.label.empty() || !cursor->find(command.label)) {
      refuse("no element of " + inQuotes(command.screen) + " begins with " +
             inQuotes(command.label));
    }
  }
  [[nodiscard]] HeardElement here() const {
    auto element = cursor->current();
    return element ? std::move(*element) : HeardElement();
  }

  Session session;
  std::optional<Cursor> cursor;
};

}  // namespace

int tourScreens(const Command& command) {
  Session session(command.session);
  std::cout << tour(session, command.verbosity);
  return kSucceeded;
}

int readScreen(const Command& command) {
  Session session(command.session);
  const auto elements = session.read(command.screen);
  std::cout << (command.headings ? headings(elements) : transcript(elements, command.verbosity));
  return kSucceeded;
}

int showTree(const Command& command) {
  Session session(command.session);
  const auto elements = session.read(command.screen);
  std::cout << (command.json ? treeJson(command.screen, elements) : treeText(elements));
  return kSucceeded;
}

int touchScreen(const Command& command) {
  Place place(command);
  if (!place.cursor->touch(command.point)) {
    std::ostringstream sentence;
    sentence << "nothing can be heard at " << command.point.x << "," << command.point.y << " on "
             << inQuotes(command.screen);
    refuse(sentence.str());
  }
  std::cout << place.here().utterance << "\n";
  return kSucceeded;
}

int activateElement(const Command& command) {
  Place place(command);
  place.find(command);
  const std::string before = place.here().utterance;
  if (!place.cursor->activate()) {
    refuse(inQuotes(before) + " does nothing when it is activated");
  }
  std::cout << place.here().utterance << "\n";
  return kSucceeded;
}

int adjustElement(const Command& command) {
  if (command.up == command.down) {
    refuse("to adjust needs either --up or --down");
  }
  Place place(command);
  place.find(command);
  std::string text;
  for (int time = 0; time < command.times; ++time) {
    const std::string before = place.here().utterance;
    if (!(command.up ? place.cursor->increment() : place.cursor->decrement())) {
      refuse(inQuotes(before) + " cannot be adjusted");
    }
    text += utteranceAfterAdjusting(place.here()) + "\n";
  }
  std::cout << text;
  return kSucceeded;
}

int validateContract(const Command& command) {
  Session session(command.session);
  const ValidationReport& report = AXValidationManager::sharedInstance()->report();
  std::cout << (command.json ? reportJson(report) : reportTable(report));
  return isClean(report) ? kSucceeded : kFailed;
}

CGPoint pointFromText(const std::string& text) {
  const std::string_view point = text;
  const std::size_t comma = point.find(',');
  const auto x = numberFrom<double>(point.substr(0, comma));
  const auto y =
      comma == std::string_view::npos ? std::nullopt : numberFrom<double>(point.substr(comma + 1));
  if (!x || !y || !std::isfinite(*x) || !std::isfinite(*y)) {
    refuse(inQuotes(text) + " is not a point such as 120,300");
  }
  return {*x, *y};
}

int timesFromText(const std::string& text) {
  constexpr int most = 1000;
  const auto times = numberFrom<int>(text);
  if (!times || *times < 1 || *times > most) {
    refuse(inQuotes(text) + " is not a number of times from 1 to " + std::to_string(most));
  }
  return *times;
}

Verbosity verbosityFromText(const std::string& text) {
  return choiceFrom<Verbosity>(
      text, {{"elements", Verbosity::elements}, {"containers", Verbosity::containers}},
      "a verbosity");
}

HKWheelchairUse wheelchairFromText(const std::string& text) {
  return choiceFrom<HKWheelchairUse>(text,
                                     {{"notset", HKWheelchairUse::notSet},
                                      {"no", HKWheelchairUse::no},
                                      {"yes", HKWheelchairUse::yes}},
                                     "a wheelchair setting");
}

std::vector<std::string> localesFromText(const std::string& text) {
  std::vector<std::string> locales;
  std::istringstream names(text);
  for (std::string name; std::getline(names, name, ',');) {
    requireKnownLocale(name);
    locales.push_back(name);
  }
  return locales;
}

}  // namespace tavro
