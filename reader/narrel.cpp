// narrel, the screen reader: reads the sample application aloud, as text.

#include <CLI/CLI.hpp>
#include <iostream>
#include <map>

#include "platform/runtime/Exception.h"
#include "reader/Output.h"
#include "reader/Session.h"

namespace tavro {
namespace {

constexpr int kFailed = 1;
constexpr int kBadInput = 2;

struct Command {
  SessionOptions session = optionsBesideProgram();
  std::string screen;
  bool json = false;
};

void addSessionOptions(CLI::App& app, SessionOptions& options) {
  static const std::map<std::string, HKWheelchairUse> wheelchairWords{
      {"notset", HKWheelchairUse::notSet},
      {"no", HKWheelchairUse::no},
      {"yes", HKWheelchairUse::yes}};
  app.add_option("--locale", options.locale, "The user's locale, such as de_DE");
  app.add_option("--calendar", options.calendar, "The user's calendar, such as hebrew");
  app.add_option("--timezone", options.timeZone, "The user's time zone, such as Europe/Lisbon");
  app.add_option("--now", options.now, "The moment, such as 2026-03-02T08:15 (local)");
  app.add_option("--wheelchair", options.wheelchair, "The wheelchair setting: notset, no or yes")
      ->transform(CLI::CheckedTransformer(wheelchairWords, CLI::ignore_case));
  app.add_flag_function(
      "--without-plugin", [&](std::int64_t) { options.withPlugin = false; },
      "Read the application as it is on its own");
  app.add_option("--diary", options.diary, "Another diary to show");
  app.add_option("--activity", options.activity,
                 "A recorded activity (GPX or TCX) to show as the latest workout");
  app.add_option("--bundle", options.bundle, "Another plug-in bundle to load");
}

int readAll(const Command& command) {
  Session session(command.session);
  std::cout << tour(session);
  return 0;
}

int read(const Command& command) {
  Session session(command.session);
  std::cout << transcript(session.read(command.screen));
  return 0;
}

int tree(const Command& command) {
  Session session(command.session);
  const auto elements = session.read(command.screen);
  std::cout << (command.json ? treeJson(command.screen, elements) : treeText(elements));
  return 0;
}

int validate(const Command& command) {
  Session session(command.session);
  const ValidationReport& report = AXValidationManager::sharedInstance()->report();
  std::cout << (command.json ? reportJson(report) : reportTable(report));
  return isClean(report) ? 0 : kFailed;
}

int run(int argumentCount, char** arguments) {
  Command command;
  int (*action)(const Command&) = nullptr;
  CLI::App app("Reads the sample activity application as a screen reader would.", "narrel");
  const auto add = [&](const char* name, const char* help, int (*run)(const Command&)) {
    CLI::App* const subcommand = app.add_subcommand(name, help);
    addSessionOptions(*subcommand, command.session);
    subcommand->callback([&action, run] { action = run; });
    return subcommand;
  };
  add("tour", "Read every screen in order", &readAll);
  add("read", "Read one screen", &read)->add_option("SCREEN", command.screen)->required();
  CLI::App* const treeCommand = add("tree", "Show every fact of a screen's elements", &tree);
  treeCommand->add_option("SCREEN", command.screen)->required();
  treeCommand->add_flag("--json", command.json, "As JSON");
  add("validate", "Check what the plug-in needs of the application", &validate)
      ->add_flag("--json", command.json, "As JSON");
  try {
    app.parse(argumentCount, arguments);
  } catch (const CLI::Success& help) {
    return app.exit(help);
  } catch (const CLI::ParseError& error) {
    std::cerr << "narrel: " << error.what() << "\n";
    return kBadInput;
  }
  if (action == nullptr) {
    std::cout << app.help();
    return 0;
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
