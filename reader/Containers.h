#pragma once

#include <optional>
#include <span>
#include <string>
#include <vector>

#include "platform/accessibility/Traversal.h"

namespace tavro {

/// What is said besides the elements themselves.
enum class Verbosity {
  elements,    ///< nothing
  containers,  ///< what one enters and leaves, and where one is in a chart
};

/// How the things that hold elements are spoken of. A container is an object with an element list
/// of its own; one whose elements are all drawn, and more than one, is a chart.
class ContainerSpeech {
 public:
  /// The elements are all that can be heard, in reading order; they are not copied.
  ContainerSpeech(Verbosity verbosity, std::span<const AccessibleElement> elements)
      : verbosity_(verbosity), elements_(elements) {}

  /// What is said on the way from one element to another, given the containers of both, outermost
  /// first: those that are left, innermost first, then those that are entered.
  [[nodiscard]] std::vector<std::string> passage(const std::vector<id>& from,
                                                 const std::vector<id>& to) const;
  /// The utterance of the element at that index, with its place in its chart ("3 of 7").
  [[nodiscard]] std::string withPosition(const std::string& utterance, std::size_t index) const;
  /// Where the element at that index is, whatever the verbosity: its place in its chart, then its
  /// containers, innermost first. Empty where there is nothing around it.
  [[nodiscard]] std::string whereabouts(std::size_t index) const;

 private:
  struct Position {
    std::int64_t place;  ///< from 1
    std::int64_t count;
  };
  [[nodiscard]] std::optional<Position> positionInChart(std::size_t index) const;
  [[nodiscard]] std::string kindOf(const id& container) const;
  [[nodiscard]] std::string nameOf(const id& container) const;

  Verbosity verbosity_;
  std::span<const AccessibleElement> elements_;
};

}  // namespace tavro
