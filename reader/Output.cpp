#include "reader/Output.h"

#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>
#include <sstream>

namespace tavro {
namespace {

using Json = nlohmann::ordered_json;

Json jsonOf(const CGRect& rect) {
  return {rect.origin.x, rect.origin.y, rect.size.width, rect.size.height};
}

Json traitsJson(UIAccessibilityTraits traits) {
  constexpr std::array<std::pair<UIAccessibilityTraits, const char*>, 6> names{{
      {UIAccessibilityTraitButton, "button"},
      {UIAccessibilityTraitHeader, "header"},
      {UIAccessibilityTraitAdjustable, "adjustable"},
      {UIAccessibilityTraitSelected, "selected"},
      {UIAccessibilityTraitStaticText, "staticText"},
      {UIAccessibilityTraitImage, "image"},
  }};
  Json list = Json::array();
  for (const auto& [trait, name] : names) {
    if ((traits & trait) != 0) {
      list.push_back(name);
    }
  }
  return list;
}

Json textJson(const id& text) { return text ? Json(spokenText(text)) : Json(nullptr); }

std::string className(const id& object) { return std::string(object.get()->isa()->name().text()); }

Json jsonOf(const HeardElement& element) {
  Json containers = Json::array();
  for (const id& container : element.containers) {
    containers.push_back(className(container));
  }
  return {{"utterance", element.utterance},
          {"label", textJson(element.facts.label)},
          {"value", textJson(element.facts.value)},
          {"hint", textJson(element.facts.hint)},
          {"traits", traitsJson(element.facts.traits)},
          {"frame", jsonOf(element.frame)},
          {"activationPoint", {element.activationPoint.x, element.activationPoint.y}},
          {"class", className(element.element)},
          {"containers", containers}};
}

/// Rows of cells in aligned columns; the last column is not padded.
std::string aligned(const std::vector<std::vector<std::string>>& rows) {
  std::vector<std::size_t> widths;
  for (const auto& row : rows) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t column = 0; column < row.size(); ++column) {
      widths[column] = std::max(widths[column], row[column].size());
    }
  }
  std::string text;
  for (const auto& row : rows) {
    std::string line;
    for (std::size_t column = 0; column < row.size(); ++column) {
      line += row[column] + std::string(widths[column] - row[column].size() + 2, ' ');
    }
    line.erase(line.find_last_not_of(' ') + 1);
    text += line + "\n";
  }
  return text;
}

std::string outcomeText(bool good, std::string_view word, const std::string& reason) {
  return good ? std::string(word) : "FAILED: " + reason;
}

std::string linesOf(const std::vector<std::string>& texts) {
  std::string lines;
  for (const std::string& text : texts) {
    lines += text + "\n";
  }
  return lines;
}

}  // namespace

std::string transcript(const std::vector<HeardElement>& elements, Verbosity verbosity) {
  const std::vector<AccessibleElement> found(elements.begin(), elements.end());
  const ContainerSpeech containers(verbosity, found);
  std::string text;
  std::vector<id> open;
  for (std::size_t index = 0; index < elements.size(); ++index) {
    const HeardElement& element = elements[index];
    if (!element.utterance.empty()) {
      text += linesOf(containers.passage(open, element.containers));
      text += containers.withPosition(element.utterance, index) + "\n";
      open = element.containers;
    }
  }
  return text + linesOf(containers.passage(open, {}));
}

std::string headings(const std::vector<HeardElement>& elements) {
  std::string text;
  for (const HeardElement& element : elements) {
    text += isHeading(element) ? element.utterance + "\n" : "";
  }
  return text;
}

std::string tour(Session& session, Verbosity verbosity) {
  std::string text;
  for (const std::string_view screen : Application::screenNames()) {
    text += (text.empty() ? "[" : "\n[") + std::string(screen) + "]\n" +
            transcript(session.read(screen), verbosity);
  }
  return text;
}

std::string treeText(const std::vector<HeardElement>& elements) {
  std::ostringstream text;
  std::vector<id> open;
  for (const HeardElement& element : elements) {
    if (element.containers != open) {
      open = element.containers;
      for (std::size_t depth = 0; depth < open.size(); ++depth) {
        text << std::string(depth * 2, ' ') << className(open[depth]) << "\n";
      }
    }
    const CGRect& frame = element.frame;
    text << std::string(open.size() * 2, ' ') << "\"" << element.utterance << "\" "
         << className(element.element) << " (" << frame.origin.x << ", " << frame.origin.y << ", "
         << frame.size.width << ", " << frame.size.height << ")\n";
  }
  return text.str();
}

std::string treeJson(std::string_view screen, const std::vector<HeardElement>& elements) {
  Json list = Json::array();
  for (const HeardElement& element : elements) {
    list.push_back(jsonOf(element));
  }
  return Json{{"screen", screen}, {"elements", list}}.dump(2) + "\n";
}

std::string reportTable(const ValidationReport& report) {
  std::vector<std::vector<std::string>> checks{
      {"CATEGORY", "CLASS", "MEMBER", "KIND", "TYPE", "OUTCOME"}};
  std::size_t failed = 0;
  for (const CheckOutcome& check : report.checks) {
    failed += check.passed ? 0 : 1;
    checks.push_back({check.category.empty() ? "(process)" : check.category, check.className,
                      check.member, std::string(textOfKind(check.kind)), check.type,
                      outcomeText(check.passed, "passed", check.reason)});
  }
  std::vector<std::vector<std::string>> methods{{"CATEGORY", "TARGET", "METHOD", "OUTCOME"}};
  std::size_t installed = 0;
  std::size_t intercepting = 0;
  std::size_t grafted = 0;
  for (const InstallationOutcome& category : report.installations) {
    installed += category.installed ? 1 : 0;
    if (!category.installed || category.methods.empty()) {
      methods.push_back({category.category, category.target, "",
                         category.installed ? "installed" : "not installed: " + category.reason});
    }
    for (const GraftOutcome& method : category.methods) {
      ++grafted;
      intercepting += method.intercepts ? 1 : 0;
      methods.push_back({category.category, category.target,
                         (method.isClassMethod ? "+" : "-") + method.selector,
                         outcomeText(method.intercepts, "intercepts", method.reason)});
    }
  }
  std::ostringstream text;
  text << report.targetName << "\n\n"
       << aligned(checks) << "\n"
       << aligned(methods) << "\n"
       << report.checks.size() << " checks, " << failed << " failed; " << installed << " of "
       << report.installations.size() << " categories installed; " << intercepting << " of "
       << grafted << " methods intercept\n";
  return text.str();
}

std::string reportJson(const ValidationReport& report) {
  Json checks = Json::array();
  for (const CheckOutcome& check : report.checks) {
    checks.push_back({{"category", check.category},
                      {"class", check.className},
                      {"member", check.member},
                      {"kind", textOfKind(check.kind)},
                      {"type", check.type},
                      {"passed", check.passed},
                      {"reason", check.reason}});
  }
  Json categories = Json::array();
  for (const InstallationOutcome& category : report.installations) {
    Json methods = Json::array();
    for (const GraftOutcome& method : category.methods) {
      methods.push_back({{"selector", method.selector},
                         {"isClassMethod", method.isClassMethod},
                         {"intercepts", method.intercepts},
                         {"reason", method.reason}});
    }
    categories.push_back({{"category", category.category},
                          {"target", category.target},
                          {"installed", category.installed},
                          {"reason", category.reason},
                          {"methods", methods}});
  }
  return Json{{"target", report.targetName}, {"checks", checks}, {"categories", categories}}.dump(
             2) +
         "\n";
}

bool isClean(const ValidationReport& report) {
  return std::ranges::all_of(report.checks, &CheckOutcome::passed) &&
         std::ranges::all_of(report.installations, [](const InstallationOutcome& category) {
           return category.installed &&
                  std::ranges::all_of(category.methods, &GraftOutcome::intercepts);
         });
}

}  // namespace tavro
