#include "tests/drift/Matrix.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <nlohmann/json.hpp>
#include <thread>

#include "platform/accessibility/Validation.h"
#include "reader/SummaryDescription.h"
#include "tests/drift/Child.h"

namespace tavro::drift {
namespace {

using Json = nlohmann::json;

constexpr std::size_t kDays = 14;

/// The sample diary's last two weeks, as a file.
std::string shortDiary(const TemporaryFolder& folder) {
  Json diary = Json::parse(contentOf(TAVRO_SAMPLE_DIARY));
  Json& days = diary["days"];
  while (days.size() > kDays) {
    days.erase(0);
  }
  const std::string first = days.front()["date"];
  std::erase_if(diary["workouts"].get_ref<Json::array_t&>(),
                [&](const Json& workout) { return workout["start"].get<std::string>() < first; });
  return folder.file("diary.json", diary.dump());
}

/// What two weeks of objects became after a screen was shown again.
std::string growth(const std::map<std::string, int>& before,
                   const std::map<std::string, int>& after) {
  std::string text;
  for (const auto& [name, count] : after) {
    const auto found = before.find(name);
    const int earlier = found == before.end() ? 0 : found->second;
    if (count > earlier) {
      text += " " + std::to_string(count - earlier) + " " + name;
    }
  }
  return text;
}

Json jsonOf(const ValidationReport& report) {
  Json json{{"checks", Json::array()}, {"categories", Json::array()}};
  for (const CheckOutcome& row : report.checks) {
    json["checks"].push_back({row.category, row.className, row.member, row.kind, row.passed});
  }
  for (const InstallationOutcome& category : report.installations) {
    Json methods = Json::array();
    for (const GraftOutcome& method : category.methods) {
      methods.push_back({method.selector, method.isClassMethod});
    }
    json["categories"].push_back({category.category, category.target, methods});
  }
  return json;
}

ValidationReport reportFrom(const Json& json) {
  ValidationReport report;
  for (const Json& row : json["checks"]) {
    report.checks.push_back(
        {row[0], row[1], row[2], row[3].get<HostCheck::Kind>(), {}, row[4], {}});
  }
  for (const Json& category : json["categories"]) {
    InstallationOutcome& outcome = report.installations.emplace_back(
        InstallationOutcome{category[0], category[1], true, {}, {}});
    for (const Json& method : category[2]) {
      outcome.methods.push_back({method[0], method[1], true, {}});
    }
  }
  return report;
}

const ValidationReport& currentReport() { return AXValidationManager::sharedInstance()->report(); }

std::set<std::string> checkedMembers(const ValidationReport& report) {
  std::set<std::string> checked;
  for (const CheckOutcome& row : report.checks) {
    std::string member = row.member;
    std::erase(member, ' ');
    checked.insert(row.className + " " + member);
  }
  return checked;
}

/// What is heard, shown or raised when the undisturbed plug-in answers one screen.
Json recordScreen(Session& session, const std::string& screen) {
  Recording recording;
  Recording::current = &recording;
  show(session, screen);
  const Heard heard = hear(session);
  Json dependencies = Json::array();
  for (const auto& element : recording.dependencies()) {
    Json& members = dependencies.emplace_back(Json::array());
    for (const auto& [member, dependency] : element) {
      members.push_back({member, dependency.parts, dependency.place, dependency.texts});
    }
  }
  gestureEverywhere(session);
  Json reads = Json::array();
  for (const auto& [member, read] : recording.membersRead()) {
    reads.push_back({member, read.answers, read.categories});
  }
  Recording::current = nullptr;
  release(session);
  return {{"elements", heard.elements},
          {"paths", heard.paths},
          {"raised", heard.raised},
          {"dependencies", dependencies},
          {"reads", reads}};
}

/// The pieces of a part that a member has no share in; none when its share is not known.
std::vector<std::string> restOf(const std::string& words,
                                const std::map<int, std::set<std::string>>& texts, int part) {
  const auto found = texts.find(part);
  std::vector<std::string> rest = piecesOf(words);
  if (found == texts.end()) {
    return {};
  }
  for (const std::string& text : found->second) {
    if (text.empty() || words.find(text) == std::string::npos) {
      return {};
    }
    for (const std::string& piece : piecesOf(text)) {
      const auto own = std::ranges::find(rest, piece);
      if (own == rest.end()) {
        return {};
      }
      rest.erase(own);
    }
  }
  return rest;
}

std::size_t processors() { return std::max(1U, std::thread::hardware_concurrency()); }

}  // namespace

Matrix::Matrix() { prepare(); }

void Matrix::prepare() {
  SessionOptions options;
  options.withPlugin = false;
  options.diary = shortDiary(folder_);
  options.reader = std::string(TAVRO_SOURCE) + "/reader/resources";
  session_ = std::make_unique<Session>(options);
  bundle_ = std::make_unique<LoadedBundle>(
      openAccessibilityBundle(std::string(TAVRO_BUILD) + "/AXTavro.axbundle"));
  const auto report = Child::start([this] {
    initializePlugin();
    return jsonOf(currentReport()).dump();
  });
  report_ = reportFrom(Json::parse(report.finish()));
  watchHost(*bundle_, checkedMembers(report_));
  for (const std::string& signature : unwatchedSignatures()) {
    problem_ += "no watching method is made for " + signature + "\n";
  }
  for (const std::string_view screen : Application::screenNames()) {
    problem_ += show(*session_, screen);
    screens_[std::string(screen)].drawing = drawingOf(*session_);
    release(*session_);
  }
  if (problem_.empty()) {
    record();
  }
}

void Matrix::initializePlugin() const {
  setInstalling(true);
  bundle_->initialize();
  setInstalling(false);
  letSummariesDescribeRings(*bundle_);
}

void Matrix::record() {
  const auto child = Child::start([this] {
    initializePlugin();
    Json screens;
    for (const auto& [name, screen] : screens_) {
      screens[name] = recordScreen(*session_, name);
    }
    return Json{{"screens", screens}, {"escaped", escapedExceptions()}}.dump();
  });
  const std::string text = child.finish();
  if (!Json::accept(text)) {
    problem_ = "the recording failed: " + text;
    return;
  }
  const Json json = Json::parse(text);
  for (auto& [name, screen] : screens_) {
    const Json& recorded = json["screens"][name];
    recorded["elements"].get_to(screen.heard.elements);
    recorded["paths"].get_to(screen.heard.paths);
    recorded["raised"].get_to(screen.heard.raised);
    for (const Json& element : recorded["dependencies"]) {
      auto& members = screen.dependencies.emplace_back();
      for (const Json& each : element) {
        members[each[0]] = {each[1], each[2], each[3]};
      }
    }
    for (const Json& read : recorded["reads"]) {
      const Recording::Reads reads{read[1], read[2]};
      screen.reads[read[0]] = reads;
      concerned_[read[0]].answers.insert(reads.answers.begin(), reads.answers.end());
      concerned_[read[0]].categories.insert(reads.categories.begin(), reads.categories.end());
    }
  }
  for (const CheckOutcome& row : report_.checks) {
    for (std::size_t index = 0; index < members().size(); ++index) {
      if (concerns(row, members()[index])) {
        concerned_[static_cast<int>(index)].categories.insert(row.category);
      }
    }
  }
}

std::vector<Drift> Matrix::driftsOf(int index) const {
  const Member& member = members()[static_cast<std::size_t>(index)];
  const std::set<std::string>& answers = concerned_.at(index).answers;
  if (member.sort == Member::Sort::wholeClass) {
    // Only the host's own: the platform's are there.
    const bool isHosts = std::ranges::any_of(members(), [&](const Member& each) {
      return each.owner == member.owner && each.sort != Member::Sort::wholeClass;
    });
    return isHosts && !member.name.text().starts_with("NS") ? std::vector{Drift::missing}
                                                            : std::vector<Drift>();
  }
  std::vector<Drift> drifts{Drift::missing, Drift::otherType};
  if (member.sort != Member::Sort::variable) {
    drifts.push_back(Drift::raises);
  }
  if (member.isObject) {
    drifts.insert(drifts.end(), {Drift::nil, Drift::aView});
    if (!answers.contains("string")) {
      drifts.push_back(Drift::aString);
    }
    if (!answers.contains("number")) {
      drifts.push_back(Drift::aNumber);
    }
    if (answers.contains("array")) {
      drifts.insert(drifts.end(), {Drift::wrongFirst, Drift::wrongLater});
    }
  }
  return drifts;
}

std::vector<Case> Matrix::singles() const {
  std::vector<Case> cases;
  for (const auto& [member, reads] : concerned_) {
    for (const Drift drift : driftsOf(member)) {
      cases.push_back({{member, drift}});
    }
  }
  return cases;
}

std::vector<Case> Matrix::pairs() const {
  std::map<std::string, std::vector<Mutation>> byCategory;
  for (const auto& [member, reads] : concerned_) {
    for (const Drift drift : driftsOf(member)) {
      if (drift == Drift::missing || drift == Drift::raises || drift == Drift::nil) {
        for (const std::string& category : reads.categories) {
          byCategory[category].push_back({member, drift});
        }
      }
    }
  }
  std::map<std::string, Case> cases;
  for (const auto& [category, mutations] : byCategory) {
    for (const Mutation& first : mutations) {
      for (const Mutation& second : mutations) {
        if (first.member < second.member) {
          const Case pair{first, second};
          cases.emplace(nameOf(pair), pair);
        }
      }
    }
  }
  std::vector<Case> all(cases.size());
  std::ranges::transform(cases, all.begin(), [](const auto& named) { return named.second; });
  return all;
}

std::vector<std::string> Matrix::screensFor(const Case& each) const {
  std::vector<std::string> affected;
  std::vector<std::string> others;
  for (const auto& [name, screen] : screens_) {
    const auto isReadOn = [this, &reads = screen.reads](const Mutation& mutation) {
      // One that is never read can still be missed by the host, where there are such objects.
      const bool isNeverRead = concerned_.at(mutation.member).answers.empty();
      return reads.contains(isNeverRead ? indexOfClass(mutation.which().owner->name())
                                        : mutation.member);
    };
    const bool isAffected = std::ranges::any_of(each, isReadOn);
    (isAffected ? affected : others).push_back(name);
  }
  if (!others.empty()) {
    affected.push_back(others[static_cast<std::size_t>(each.front().member) % others.size()]);
  }
  return affected;
}

std::vector<Expected> Matrix::expectation(const Screen& screen, const Case& each,
                                          const std::vector<std::string>& changed) const {
  std::vector<Expected> expected;
  for (std::size_t index = 0; index < screen.heard.elements.size(); ++index) {
    PartMask open = isTouched(screen.heard.paths[index], changed) ? kPresence : 0;
    for (const Mutation& mutation : each) {
      const auto& members = screen.dependencies[index];
      const auto found = members.find(mutation.member);
      if (found == members.end()) {
        continue;
      }
      const int place = mutation.drift == Drift::wrongFirst   ? 0
                        : mutation.drift == Drift::wrongLater ? 1
                                                              : found->second.place;
      const bool isElsewhere = found->second.place >= 0 && place != found->second.place;
      open |= isElsewhere ? found->second.parts & ~kPresence : found->second.parts;
    }
    const Words& words = screen.heard.elements[index];
    Expected& element = expected.emplace_back(Expected{(open & kPresence) != 0, open, words, {}});
    for (int part = 0; part < kParts && each.size() == 1; ++part) {
      const auto found = screen.dependencies[index].find(each.front().member);
      if (found != screen.dependencies[index].end()) {
        const auto at = static_cast<std::size_t>(part);
        element.rest[at] = restOf(words[at], found->second.texts, part);
      }
    }
  }
  return expected;
}

std::vector<std::string> Matrix::tryCase(const Case& each) const {
  std::vector<std::string> failures;
  const ExpectedReport report(report_, each);
  std::vector<Trial> trials;
  for (const std::string& name : screensFor(each)) {
    trials.push_back({name, {}, {}, false});
  }
  for (const Mutation& mutation : each) {
    makeDrift(mutation.member, mutation.drift);
  }
  for (Trial& trial : trials) {
    trial.hostRaised = show(*session_, trial.screen);
    trial.changed = changedPaths(screens_.at(trial.screen).drawing, drawingOf(*session_));
    trial.isHeardAlone = !hear(*session_).elements.empty();
    release(*session_);
  }
  initializePlugin();
  if (const std::string differs = report.difference(currentReport()); !differs.empty()) {
    failures.push_back(differs);
  }
  std::map<std::string, int> live;
  for (int round = 0; round < 2; ++round) {
    for (const Trial& trial : trials) {
      for (const std::string& failure : tryScreen(trial, each)) {
        failures.push_back("[" + trial.screen + "] " + failure);
      }
    }
    GlobalQueue::shared().drain();
    const std::string grown = growth(live, liveObjects());
    if (round > 0 && !grown.empty()) {
      failures.push_back("these were left over:" + grown);
    }
    live = liveObjects();
  }
  failures.insert(failures.end(), escapedExceptions().begin(), escapedExceptions().end());
  return failures;
}

std::vector<std::string> Matrix::tryScreen(const Trial& trial, const Case& each) const {
  std::vector<std::string> failures;
  // The plug-in may take the place of what raises, and then nothing does.
  if (const std::string raised = show(*session_, trial.screen);
      !raised.empty() && raised != trial.hostRaised) {
    failures.push_back("raised: " + raised + "; the host alone: " + trial.hostRaised);
  }
  const Heard heard = hear(*session_);
  if (trial.hostRaised.empty()) {
    const std::string differs =
        difference(expectation(screens_.at(trial.screen), each, trial.changed), heard.elements);
    if (!differs.empty()) {
      failures.push_back(differs);
    }
  } else if (trial.isHeardAlone && heard.elements.empty()) {
    failures.emplace_back("nothing is heard; the host alone is");
  }
  for (const std::string& raised : heard.raised) {
    failures.push_back("an attribute raised " + raised);
  }
  gestureEverywhere(*session_);
  release(*session_);
  return failures;
}

Outcome Matrix::run(const std::vector<Case>& cases) const {
  const char* const chosen = std::getenv("TAVRO_DRIFT");
  const auto start = std::chrono::steady_clock::now();
  Outcome outcome;
  std::map<std::string, int> counts;
  std::deque<std::pair<std::string, Child>> running;
  int tried = 0;
  const auto finishOne = [&] {
    const auto [name, child] = running.front();
    running.pop_front();
    if (const std::string text = child.finish(); !text.empty()) {
      outcome.failures.push_back(name + "\n" + text);
    }
  };
  for (const Case& each : cases) {
    const std::string name = nameOf(each);
    if (chosen != nullptr && name.find(chosen) == std::string::npos) {
      continue;
    }
    ++tried;
    for (const Mutation& mutation : each) {
      const bool isClass = mutation.which().sort == Member::Sort::wholeClass;
      ++counts[(isClass ? "class-" : "") + std::string(textOf(mutation.drift))];
    }
    if (running.size() == processors()) {
      finishOne();
    }
    running.emplace_back(name, Child::start([&] {
                           std::string text;
                           for (const std::string& failure : tryCase(each)) {
                             text += "  " + failure + "\n";
                           }
                           return text;
                         }));
  }
  while (!running.empty()) {
    finishOne();
  }
  const std::chrono::duration<double> elapsed = std::chrono::steady_clock::now() - start;
  std::ostringstream summary;
  summary << tried << " cases in " << elapsed.count() << " s (";
  for (const auto& [kind, count] : counts) {
    summary << (kind == counts.begin()->first ? "" : ", ") << kind << " " << count;
  }
  outcome.summary = summary.str() + ")";
  if (tried == 0) {
    outcome.failures.push_back("no case is named so");
  }
  return outcome;
}

}  // namespace tavro::drift
