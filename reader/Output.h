#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "platform/accessibility/Validation.h"
#include "reader/Containers.h"
#include "reader/Session.h"

namespace tavro {

/// The utterances, a line each; an element with nothing to say is left out.
std::string transcript(const std::vector<HeardElement>& elements,
                       Verbosity verbosity = Verbosity::elements);
/// The utterances of the headings alone, a line each.
std::string headings(const std::vector<HeardElement>& elements);
/// The transcripts of all screens in order, each under its name.
std::string tour(Session& session, Verbosity verbosity = Verbosity::elements);
/// Each element's utterance with its class and frame, below the containers that lead to it.
std::string treeText(const std::vector<HeardElement>& elements);
/// Every fact of every element as JSON.
std::string treeJson(std::string_view screen, const std::vector<HeardElement>& elements);

/// A validation report as tables for people: each check, each method of each category, and how many
/// there are.
std::string reportTable(const ValidationReport& report);
std::string reportJson(const ValidationReport& report);
/// Whether every check passed, every category is installed and every one of its methods intercepts.
bool isClean(const ValidationReport& report);

}  // namespace tavro
