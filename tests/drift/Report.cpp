#include "tests/drift/Report.h"

#include <algorithm>

namespace tavro::drift {
namespace {

std::string withoutBlanks(std::string text) {
  std::erase(text, ' ');
  return text;
}

Class* methodsOf(const Member& member) {
  return member.sort == Member::Sort::classMethod ? member.owner->isa() : member.owner;
}

/// Whether a message or a read of that name to the class ends at the member.
bool reaches(Class* isa, Name name, const Member& member) {
  if (isa == nullptr || name != member.name) {
    return false;
  }
  if (member.sort == Member::Sort::variable) {
    const InstanceVariable* const variable = isa->variable(name);
    return variable != nullptr && variable == member.owner->variable(name);
  }
  Class* const receiver = member.sort == Member::Sort::classMethod ? isa->isa() : isa;
  const Method* const method = receiver->methodWithoutTable(name);
  return method != nullptr && method->owner == methodsOf(member);
}

/// Whether a check can see the mutation: what is looked at is whether a member is there, and its
/// type, not what it answers.
bool sees(const CheckOutcome& row, const Mutation& mutation) {
  const Member& member = mutation.which();
  if (!concerns(row, member) ||
      (mutation.drift != Drift::missing && mutation.drift != Drift::otherType)) {
    return false;
  }
  const bool isMethod =
      member.sort == Member::Sort::method || member.sort == Member::Sort::classMethod;
  if (!isMethod || mutation.drift == Drift::otherType) {
    return true;
  }
  // One that is taken away may leave an inherited one to be found.
  const Class* const above = methodsOf(member)->superclass();
  const Method* const inherited =
      above == nullptr ? nullptr : above->methodWithoutTable(member.name);
  return inherited == nullptr || inherited->signature.encodings != member.type;
}

std::string lineOf(const CheckOutcome& row, bool passed) {
  return row.category + ": " + row.className + " " + row.member + (passed ? " passed" : " failed");
}
std::string lineOf(const InstallationOutcome& category, const GraftOutcome& method,
                   bool intercepts) {
  return category.category + " " + method.selector + (intercepts ? " intercepts" : " refused");
}

}  // namespace

bool concerns(const CheckOutcome& row, const Member& member) {
  using Kind = HostCheck::Kind;
  if (member.sort == Member::Sort::wholeClass) {
    return row.className == member.name.text() ||
           (row.kind == Kind::kindOfClass && row.member == member.name.text());
  }
  const Kind kind = member.sort == Member::Sort::variable      ? Kind::instanceVariable
                    : member.sort == Member::Sort::classMethod ? Kind::classMethod
                                                               : Kind::instanceMethod;
  return row.kind == kind && reaches(Class::named(Name::make(row.className)),
                                     Name::make(withoutBlanks(row.member)), member);
}

std::string nameOf(const Case& each) {
  std::string text;
  for (const Mutation& mutation : each) {
    text += (text.empty() ? "" : " + ") + mutation.which().text() + " " +
            std::string(textOf(mutation.drift));
  }
  return text;
}

ExpectedReport::ExpectedReport(const ValidationReport& baseline, const Case& each) {
  for (const CheckOutcome& row : baseline.checks) {
    const bool fails =
        std::ranges::any_of(each, [&](const Mutation& mutation) { return sees(row, mutation); });
    lines_.push_back(lineOf(row, !fails));
  }
  for (const InstallationOutcome& category : baseline.installations) {
    addCategory(category, each);
  }
}

void ExpectedReport::addCategory(const InstallationOutcome& category, const Case& each) {
  Class* const target = Class::named(Name::make(category.target));
  const auto isHit = [&](Member::Sort sort, Drift drift, const auto& test) {
    return std::ranges::any_of(each, [&](const Mutation& mutation) {
      const Member& member = mutation.which();
      return member.sort == sort && mutation.drift == drift && test(member);
    });
  };
  const bool isMissing = isHit(Member::Sort::wholeClass, Drift::missing, [&](const Member& member) {
    return member.name.text() == category.target;
  });
  lines_.push_back(category.category + (isMissing ? " left out" : " installed"));
  if (isMissing) {
    return;
  }
  for (const GraftOutcome& method : category.methods) {
    const bool isRefused = isHit(
        method.isClassMethod ? Member::Sort::classMethod : Member::Sort::method, Drift::otherType,
        [&](const Member& member) { return reaches(target, Name::make(method.selector), member); });
    lines_.push_back(lineOf(category, method, !isRefused));
  }
}

std::string ExpectedReport::difference(const ValidationReport& report) const {
  std::vector<std::string> lines;
  for (const CheckOutcome& row : report.checks) {
    lines.push_back(lineOf(row, row.passed));
  }
  for (const InstallationOutcome& category : report.installations) {
    lines.push_back(category.category + (category.installed ? " installed" : " left out"));
    for (const GraftOutcome& method : category.methods) {
      lines.push_back(lineOf(category, method, method.intercepts));
    }
  }
  const auto [mine, theirs] = std::ranges::mismatch(lines_, lines);
  if (mine == lines_.end() && theirs == lines.end()) {
    return {};
  }
  return "validation says \"" + (theirs == lines.end() ? std::string() : *theirs) + "\" where \"" +
         (mine == lines_.end() ? std::string() : *mine) + "\" is right";
}

}  // namespace tavro::drift
