// narrel, the screen reader: reads the sample application aloud, as text.

#include <CLI/CLI.hpp>
#include <iostream>

#include "reader/Commands.h"
#include "reader/Live.h"

namespace tavro {
namespace {

/// An option whose text is turned into a value; `convert` throws a sentence for a wrong one.
template <class Value, class Converted>
CLI::Option* addConverted(CLI::App& app, const char* name, const char* help, Value& value,
                          Converted (*convert)(const std::string&)) {
  return app.add_option_function<std::string>(
      name, [&value, convert](const std::string& text) { value = convert(text); }, help);
}

void addSessionOptions(CLI::App& app, SessionOptions& options) {
  app.option_defaults()->take_last();
  app.add_option("--locale", options.locale, "The user's locale, such as de_DE");
  app.add_option("--calendar", options.calendar, "The user's calendar, such as hebrew");
  app.add_option("--timezone", options.timeZone, "The user's time zone, such as Europe/Lisbon");
  app.add_option("--now", options.now, "The moment, such as 2026-03-02T08:15 (local)");
  addConverted(app, "--wheelchair", "The wheelchair setting: notset, no or yes", options.wheelchair,
               &wheelchairFromText);
  app.add_flag_callback(
      "--without-plugin", [&] { options.withPlugin = false; },
      "Read the application as it is on its own");
  app.add_option("--diary", options.diary, "Another diary to show");
  app.add_option("--activity", options.activity,
                 "A recorded activity (GPX or TCX) to show as the latest workout");
  app.add_option("--bundle", options.bundle, "Another plug-in bundle to load");
}

void addVerbosity(CLI::App& app, Command& command) {
  addConverted(app, "--verbosity", "What is said: elements, or containers as well",
               command.verbosity, &verbosityFromText);
}

void addScreen(CLI::App& app, Command& command) {
  app.add_option("SCREEN", command.screen, "The screen's name")->required();
}

void addLabel(CLI::App& app, Command& command) {
  addScreen(app, command);
  app.add_option("LABEL", command.label, "How the element's label or utterance begins")->required();
}

using Action = int (*)(const Command&);

/// Declares every command; the one that is given is put into `action`.
void declareCommands(CLI::App& app, Command& command, Action& action) {
  const auto add = [&](const char* name, const char* help, Action run) -> CLI::App& {
    CLI::App& subcommand = *app.add_subcommand(name, help);
    addSessionOptions(subcommand, command.session);
    subcommand.callback([&action, run] { action = run; });
    return subcommand;
  };
  addVerbosity(add("tour", "Read every screen in order", &tourScreens), command);

  CLI::App& read = add("read", "Read one screen", &readScreen);
  addScreen(read, command);
  read.add_flag("--headings", command.headings, "Read the headings only");
  addVerbosity(read, command);

  CLI::App& tree = add("tree", "Show every fact of a screen's elements", &showTree);
  addScreen(tree, command);
  tree.add_flag("--json", command.json, "As JSON");

  CLI::App& touch = add("touch", "Say what a finger at a point hears", &touchScreen);
  addScreen(touch, command);
  addConverted(touch, "--at", "The point X,Y on the screen", command.point, &pointFromText)
      ->required();

  addLabel(add("activate", "Activate an element and say what is heard after", &activateElement),
           command);

  CLI::App& adjust = add("adjust", "Change an element's value and say it", &adjustElement);
  addLabel(adjust, command);
  adjust.add_flag("--up", command.up, "To the next larger value");
  adjust.add_flag("--down", command.down, "To the next smaller value");
  addConverted(adjust, "--times", "How often", command.times, &timesFromText);

  CLI::App& live = add("live", "Read by key presses; ? lists the keys", &readLive);
  live.add_option("SCREEN", command.screen, "The screen to begin with");
  addConverted(live, "--locales", "The locales to change between, such as en_US,de_DE",
               command.locales, &localesFromText);
  live.add_flag("--speak", command.speak, "Speak aloud through espeak-ng");
  addVerbosity(live, command);

  add("validate", "Check what the plug-in needs of the application", &validateContract)
      .add_flag("--json", command.json, "As JSON");
}

/// What is wrong with the arguments, as one sentence.
std::string sentenceOf(const CLI::ParseError& error, const CLI::App& app) {
  const auto chosen = app.get_subcommands();
  const std::string help =
      "narrel " + (chosen.empty() ? "" : chosen.front()->get_name() + " ") + "--help tells more";
  const std::string text = error.what();
  if (dynamic_cast<const CLI::ExtrasError*>(&error) != nullptr) {
    const std::string extra = app.remaining(true).front();
    if (!chosen.empty() && !app.remaining().empty()) {
      return "\"" + extra + "\" must come after the command; " + help;
    }
    if (!chosen.empty() && !extra.starts_with('-')) {
      return "\"" + extra + "\" is one argument too many; " + help;
    }
    const std::string kind = extra.starts_with('-') ? "option" : "command";
    return "there is no " + kind + " \"" + extra + "\"; " + help;
  }
  if (dynamic_cast<const CLI::RequiredError*>(&error) != nullptr) {
    return text.substr(0, text.find(' ')) + " is missing; " + help;
  }
  if (dynamic_cast<const CLI::ArgumentMismatch*>(&error) != nullptr) {
    return text.substr(0, text.find(':')) + " needs a value; " + help;
  }
  if (dynamic_cast<const CLI::ConversionError*>(&error) != nullptr) {
    const std::size_t name = text.find("--");
    return text.substr(name, text.find(' ', name) - name) + " takes no value; " + help;
  }
  return text + "; " + help;
}

int run(int argumentCount, char** arguments) {
  Command command;
  Action action = nullptr;
  CLI::App app("Reads the sample activity application as a screen reader would.", "narrel");
  declareCommands(app, command, action);
  try {
    app.parse(argumentCount, arguments);
  } catch (const CLI::Success& help) {
    return app.exit(help);
  } catch (const CLI::ParseError& error) {
    std::cerr << "narrel: " << sentenceOf(error, app) << "\n";
    return kBadInput;
  }
  if (action == nullptr) {
    std::cout << app.help();
    return kSucceeded;
  }
  return action(command);
}

}  // namespace
}  // namespace tavro

int main(int argumentCount, char** arguments) {
  try {
    return tavro::run(argumentCount, arguments);
  } catch (const std::exception& error) {
    std::cerr << "narrel: " << error.what() << "\n";
    return tavro::kBadInput;
  }
}
