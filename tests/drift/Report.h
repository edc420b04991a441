#pragma once

#include "platform/accessibility/Validation.h"
#include "tests/drift/Members.h"

namespace tavro::drift {

struct Mutation {
  int member = kNoMember;
  Drift drift = Drift::none;

  [[nodiscard]] const Member& which() const { return members()[static_cast<std::size_t>(member)]; }
};
/// One mutation, or two at once.
using Case = std::vector<Mutation>;

std::string nameOf(const Case& each);

/// Whether a check is on that member, or on that class.
bool concerns(const CheckOutcome& row, const Member& member);

/// What checking and installing must say of a case; worked out before the case is made true.
class ExpectedReport {
 public:
  ExpectedReport(const ValidationReport& baseline, const Case& each);

  /// Empty when a report says that and no more; otherwise the first difference.
  [[nodiscard]] std::string difference(const ValidationReport& report) const;

 private:
  void addCategory(const InstallationOutcome& category, const Case& each);

  std::vector<std::string> lines_;
};

}  // namespace tavro::drift
