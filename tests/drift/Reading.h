#pragma once

#include <array>
#include <map>
#include <string>
#include <vector>

#include "reader/Session.h"
#include "tests/drift/Recording.h"

namespace tavro::drift {

/// What one element says, part by part.
using Words = std::array<std::string, kParts>;

struct Heard {
  std::vector<Words> elements;
  std::vector<std::string> paths;  ///< where each is: a path of view indices from the window
  std::vector<std::string> raised;
};

/// Shows a screen; yields what the host raised, or an empty text.
std::string show(Session& session, std::string_view screen);
/// Takes the screen away again, so that its objects go.
void release(Session& session);
/// Hears what is on screen from top to bottom.
Heard hear(Session& session);
/// Moves, activates, adjusts and touches everywhere.
void gestureEverywhere(Session& session);

/// What the host itself shows: each view by its path.
using Drawing = std::map<std::string, std::string>;
Drawing drawingOf(Session& session);
/// The paths at which two drawings differ.
std::vector<std::string> changedPaths(const Drawing& before, const Drawing& after);
/// Whether something at a path, above it or below it is among the changed ones.
bool isTouched(const std::string& path, const std::vector<std::string>& changed);

/// What must be heard: an element with some parts left open, or any number of any elements.
struct Expected {
  bool isAnything = false;
  PartMask open = 0;
  Words words;
  /// Of an open part: the pieces that must be said all the same, in order.
  std::array<std::vector<std::string>, kParts> rest = {};
};
/// What separates the pieces of a part.
std::vector<std::string> piecesOf(const std::string& words);
/// Empty when the elements are as expected, in order; otherwise what differs.
std::string difference(const std::vector<Expected>& expected, const std::vector<Words>& heard);

}  // namespace tavro::drift
