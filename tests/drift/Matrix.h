#pragma once

#include <memory>
#include <set>

#include "tests/drift/Reading.h"
#include "tests/drift/Report.h"
#include "tests/support/Process.h"

namespace tavro::drift {

struct Outcome {
  std::vector<std::string> failures;
  std::string summary;
};

/// The host, prepared once and not yet met by the plug-in; each case is tried in a copy of this
/// process. TAVRO_DRIFT, when set, chooses the cases whose names contain it.
class Matrix {
 public:
  Matrix();

  /// What keeps the matrix from being of use; empty when nothing does.
  [[nodiscard]] const std::string& problem() const { return problem_; }
  [[nodiscard]] std::vector<Case> singles() const;
  /// Missing, raising and nil, two members at a time of those that one category checks or reads.
  [[nodiscard]] std::vector<Case> pairs() const;
  [[nodiscard]] Outcome run(const std::vector<Case>& cases) const;

 private:
  /// What is known of a screen before anything drifts.
  struct Screen {
    Heard heard;
    std::vector<std::map<int, Recording::Dependency>> dependencies;
    std::map<int, Recording::Reads> reads;
    Drawing drawing;
  };
  /// A screen on which a case is tried, and what the host alone makes of the case there.
  struct Trial {
    std::string screen;
    std::string hostRaised;
    std::vector<std::string> changed;
    bool isHeardAlone = false;
  };

  void prepare();
  void record();
  [[nodiscard]] std::vector<Drift> driftsOf(int member) const;
  [[nodiscard]] std::vector<std::string> screensFor(const Case& each) const;
  [[nodiscard]] std::vector<Expected> expectation(const Screen& screen, const Case& each,
                                                  const std::vector<std::string>& changed) const;
  [[nodiscard]] std::vector<std::string> tryCase(const Case& each) const;
  [[nodiscard]] std::vector<std::string> tryScreen(const Trial& trial, const Case& each) const;
  void initializePlugin() const;

  std::string problem_;
  TemporaryFolder folder_;
  std::unique_ptr<Session> session_;
  std::unique_ptr<LoadedBundle> bundle_;
  std::map<std::string, Screen> screens_;
  ValidationReport report_;
  std::map<int, Recording::Reads> concerned_;
};

}  // namespace tavro::drift
