#include <algorithm>
#include <tuple>

#include "platform/accessibility/SafeCategory.h"
#include "platform/accessibility/Validation.h"
#include "platform/foundation/NSValue.h"
#include "platform/foundation/Settings.h"
#include "platform/uikit/UIControls.h"
#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

using testing::holds;
using testing::newOf;
using testing::raisedBy;

/// A host class with a member of every kind.
class Gauge : public UIView {
 public:
  static constexpr Name className = "ValidationTestGauge";
  Ref<UILabel> label;
  id anything;
  bool flag = false;
  int answers = 0;

  id text() { return string("host"); }
  double ratio() { return 0.5; }
  void configure(const id& /*title*/, std::int64_t /*index*/) {}
  void four(const id& /*a*/, const id& /*b*/, const id& /*c*/, bool /*d*/, double /*e*/,
            std::int64_t /*f*/, const id& /*g*/) {}
  static id shared(Class* /*isa*/) { return string("host class"); }
};
const Registered gaugeClass = defineClass<Gauge, UIView>()
                                  .variable<&Gauge::label>("_label")
                                  .variable<&Gauge::anything>("_anything")
                                  .variable<&Gauge::flag>("_flag")
                                  .method<&Gauge::text>("text")
                                  .method<&Gauge::ratio>("ratio")
                                  .method<&Gauge::configure>("configureWithTitle:index:")
                                  .method<&Gauge::four>("a:b:c:d:e:f:g:")
                                  .classMethod<&Gauge::shared>("sharedGauge")
                                  .protocol("ValidationTestMeasuring");
class RoundGauge : public Gauge {
 public:
  static constexpr Name className = "ValidationTestRoundGauge";
};
const Registered roundGaugeClass = defineClass<RoundGauge, Gauge>();

constexpr Name kGauge = "ValidationTestGauge";
constexpr Name kRound = "ValidationTestRoundGauge";

TEST(CheckTests, EveryKindOfCheckPassesAndFailsWithItsReason) {
  const std::pair<HostCheck, const char*> cases[] = {
      {classExists(kGauge), ""},
      {classExists("NoSuchClass"), "not loaded"},
      {kindOfClass(kRound, kGauge), ""},
      {kindOfClass(kGauge, kGauge), ""},
      {kindOfClass(kGauge, kRound), "not a kind"},
      {kindOfClass(kGauge, "NoSuchClass"), "not a kind"},
      {kindOfClass("NoSuchClass", kGauge), "not loaded"},
      {conformsToProtocol(kRound, "ValidationTestMeasuring"), ""},
      {conformsToProtocol(kGauge, "Singing"), "does not adopt"},
      {instanceVariable(kRound, "_label", "UILabel"), ""},
      {instanceVariable(kGauge, "_flag", "B"), ""},
      {instanceVariable(kGauge, "_anything", "@"), ""},
      {instanceVariable(kGauge, "_label", "UIView"), "UILabel"},
      {instanceVariable(kGauge, "_flag", "q"), "its type is B"},
      {instanceVariable(kGauge, "label", "UILabel"), "no such instance variable"},
      {instanceMethod(kGauge, "text", "@"), ""},
      {instanceMethod(kRound, "ratio", "d"), ""},
      {instanceMethod(kGauge, "configureWithTitle:index:", "v", "@", "q"), ""},
      {instanceMethod(kGauge, "configureWithTitle: index:", "v", "@", "q"), ""},
      {instanceMethod(kGauge, "a: b: c: d: e: f: g:", "v", "@", "@", "@", "B", "d", "q", "@"), ""},
      {instanceMethod(kGauge, "text", "v"), "its signature is @"},
      {instanceMethod(kGauge, "configureWithTitle:index:", "v", "@"), "v,@,q"},
      {instanceMethod(kGauge, "configureWithTitle:index:", "v", "q", "@"), "v,@,q"},
      {instanceMethod(kGauge, "sharedGauge", "@"), "no such method"},
      {classMethod(kRound, "sharedGauge", "@"), ""},
      {classMethod(kGauge, "text", "@"), "no such method"},
      {classMethod(kGauge, "sharedGauge", "@", "@"), "its signature is @"},
  };
  const auto manager = make<AXValidationManager>();
  for (const auto& [check, reason] : cases) {
    const bool passes = std::string_view(reason).empty();
    const std::string_view member = check.member.text();
    EXPECT_EQ(manager->validate(check), passes) << member << " " << reason;
    const CheckOutcome& outcome = manager->report().checks.back();
    EXPECT_EQ(outcome.passed, passes) << member;
    EXPECT_TRUE(passes ? outcome.reason.empty() : bool(holds(outcome.reason, reason)))
        << member << ": " << outcome.reason;
    EXPECT_EQ(outcome.className, check.className.text());
    EXPECT_EQ(outcome.member, member) << "as it is written, blanks included";
  }
  EXPECT_EQ(manager->report().checks.size(), std::size(cases));
}

// Categories.

class GaugeTestAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "GaugeTestAccessibility";
  static constexpr Name target = kGauge;
  id text() { return string(utf8(super.send<id>()) + " first"); }
  id added() { return string("added"); }
  id shared() { return string(utf8(super.send<id>()) + " category"); }
  id lonely() { return super.send<id>(); }
};
constexpr HostCheck kGaugeContract[] = {
    instanceMethod(kGauge, "added", "@"),  // what the category itself adds
    instanceMethod(kGauge, "text", "@"),
};
const Registered gaugeCategory = safeCategory<GaugeTestAccessibility, kGaugeContract>()
                                     .method<&GaugeTestAccessibility::text>("text")
                                     .method<&GaugeTestAccessibility::added>("added")
                                     .method<&GaugeTestAccessibility::lonely>("lonely")
                                     .classMethod<&GaugeTestAccessibility::shared>("sharedGauge");

class WrongSignatureAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "WrongSignatureAccessibility";
  static constexpr Name target = kRound;
  std::int64_t text() { return 1; }
  float ratio() { return 1; }
  id right() { return string("right"); }
};
const Registered wrongCategory = safeCategory<WrongSignatureAccessibility, kNoHostContract>()
                                     .method<&WrongSignatureAccessibility::text>("text")
                                     .method<&WrongSignatureAccessibility::ratio>("ratio")
                                     .method<&WrongSignatureAccessibility::right>("right");

class StrayAccessibility : public SafeCategory {
 public:
  static constexpr Name className = "StrayAccessibility";
  static constexpr Name target = "NoSuchHostClass";
};
const Registered strayCategory = safeCategory<StrayAccessibility, kNoHostContract>();

id raisingTarget(Class* /*isa*/) { throw 1; }
void raisingValidations(Class* /*isa*/, const id& /*manager*/) { throw 1; }
const Registered raisingCategory =
    ClassBuilder({.name = "RaisingAccessibility", .superclass = "UIAccessibilitySafeCategory"})
        .classMethod<&raisingTarget>("safeCategoryTargetClassName")
        .classMethod<&raisingValidations>("_accessibilityPerformValidations:");

class ValidationTests : public ::testing::Test {
 protected:
  /// Runs with an installation handler that names these categories.
  const ValidationReport& run(std::vector<std::string> categories, bool checks = true) {
    manager->performValidations(
        [](const id& given) {
          as<AXValidationManager>(given)->validate(classExists("ProcessWide"));
          return true;
        },
        [checks](const id&) { return checks; }, {},
        [categories](const id& installer) {
          for (const std::string& category : categories) {
            send<void>(installer,
                       "installSafeCategory:canInteractWithTargetClass:", string(category), true);
          }
        });
    return manager->report();
  }

  static const GraftOutcome& methodOf(const InstallationOutcome& outcome,
                                      std::string_view selector) {
    const auto found = std::ranges::find(outcome.methods, selector, &GraftOutcome::selector);
    EXPECT_NE(found, outcome.methods.end()) << selector;
    return *found;
  }

  Ref<AXValidationManager> manager = make<AXValidationManager>();
};

TEST_F(ValidationTests, ChecksSeeTheBareHostAndAreReportedWithTheirCategory) {
  const ValidationReport& report = run({"GaugeTestAccessibility"});
  ASSERT_EQ(report.checks.size(), 3U);
  EXPECT_EQ(report.checks[0].className, "ProcessWide");
  EXPECT_EQ(report.checks[0].category, "");
  EXPECT_FALSE(report.checks[1].passed) << "a category does not satisfy its own check";
  EXPECT_EQ(report.checks[1].category, "GaugeTestAccessibility");
  EXPECT_TRUE(report.checks[2].passed);
  EXPECT_TRUE(report.installations.at(0).installed) << "outcomes of checks keep nothing back";
}

TEST_F(ValidationTests, WithoutChecksTheCategoriesAreInstalledAllTheSame) {
  const ValidationReport& report = run({"GaugeTestAccessibility"}, false);
  EXPECT_TRUE(report.checks.empty());
  EXPECT_EQ(utf8(send<id>(newOf(classOf<Gauge>()), "text")), "host first");
  Settings::current().performsValidationChecks = false;
  EXPECT_FALSE(AXPerformValidationChecks());
  Settings::current().performsValidationChecks = true;
  EXPECT_TRUE(AXPerformValidationChecks());
}

TEST_F(ValidationTests, TheHandlersRunInOrderAndMayBeMissing) {
  std::string order;
  const auto textNow = [] { return utf8(send<id>(newOf(classOf<Gauge>()), "text")); };
  const id given = manager;
  send<void>(given,
             "performValidations:withPreValidationHandler:postValidationHandler:"
             "safeCategoryInstallationHandler:",
             ChecksHandler([&](const id&) {
               order += "checks:" + textNow() + " ";
               return false;
             }),
             PreValidationHandler([&](const id& passed) {
               EXPECT_EQ(passed, given);
               order += "before ";
               return true;
             }),
             PostValidationHandler([&](const id&) { order += "after:" + textNow(); }),
             InstallationHandler([&](const id& installer) {
               send<void>(installer, "installSafeCategory:canInteractWithTargetClass:",
                          string("GaugeTestAccessibility"), true);
               order += "naming:" + textNow() + " ";
             }));
  EXPECT_EQ(order, "before checks:host naming:host after:host first");
  EXPECT_NO_THROW(manager->performValidations({}, {}, {}, {}));
  EXPECT_EQ(manager->report().installations.size(), 1U);
}

TEST_F(ValidationTests, WhatRaisesIsAFailedCheckAndTheRestIsDone) {
  const auto raising = [](auto&&...) { throw std::runtime_error("a handler"); };
  manager->performValidations(
      [&](const id&) { return raising(), true; }, [](const id&) { return true; }, raising,
      [&](const id& installer) {
        for (const char* const category : {"RaisingAccessibility", "GaugeTestAccessibility"}) {
          send<void>(installer, "installSafeCategory:canInteractWithTargetClass:", string(category),
                     true);
        }
        raising();
      });
  const ValidationReport& report = manager->report();
  std::vector<std::string> failed;
  for (const CheckOutcome& check : report.checks) {
    if (check.reason == "it raises") {
      failed.push_back(check.className + " " + check.member);
    }
  }
  EXPECT_EQ(failed,
            (std::vector<std::string>{"AXValidationManager performValidations:",
                                      "AXValidationManager safeCategoryInstallationHandler:",
                                      "RaisingAccessibility _accessibilityPerformValidations:",
                                      "AXValidationManager postValidationHandler:"}));
  ASSERT_EQ(report.installations.size(), 2U);
  EXPECT_TRUE(report.installations[1].installed) << "what was named before is installed";
  const auto other = make<AXValidationManager>();
  EXPECT_NO_THROW(other->performValidations({}, [](const id&) -> bool { throw 1; }, {}, {}));
  EXPECT_EQ(other->report().checks.at(0).member, "withPreValidationHandler:");
}

TEST_F(ValidationTests, ACategoryThatCannotBeRegisteredSaysWhy) {
  declareClass({.name = "HomelessAccessibility", .superclass = "NoSuchSuperclass"});
  const ValidationReport& report = run({"HomelessAccessibility", "GaugeTestAccessibility"});
  EXPECT_EQ(report.installations.at(0).reason,
            "the category's class is not loaded: the class \"NoSuchSuperclass\" is not loaded");
  EXPECT_TRUE(report.installations.at(1).installed);
}

TEST_F(ValidationTests, GraftsInterceptAndReachTheHostsOwnThroughSuper) {
  const InstallationOutcome outcome = run({"GaugeTestAccessibility"}).installations.at(0);
  EXPECT_EQ(outcome.target, "ValidationTestGauge");
  EXPECT_EQ(outcome.methods.size(), 4U) << "the three methods of a category are not grafted";
  for (const GraftOutcome& method : outcome.methods) {
    EXPECT_TRUE(method.intercepts) << method.selector << " " << method.reason;
    EXPECT_EQ(method.isClassMethod, method.selector == "sharedGauge");
  }
  const id round = newOf(classOf<RoundGauge>());
  EXPECT_EQ(utf8(send<id>(round, "text")), "host first") << "subclasses of the target too";
  EXPECT_EQ(utf8(send<id>(round, "added")), "added");
  EXPECT_EQ(utf8(send<id>(classOf<Gauge>(), "sharedGauge")), "host class category");
  EXPECT_FALSE(respondsTo(classOf<Gauge>(), "safeCategoryTargetClassName"));
  EXPECT_FALSE(respondsTo(classOf<Gauge>(), "_accessibilityPerformValidations:"));
  EXPECT_TRUE(holds(raisedBy([&] { send<id>(round, "lonely"); }), "unrecognized selector"));
  Class* const category = Class::named("GaugeTestAccessibility");
  Class* const middle = category->superclass();
  EXPECT_EQ(middle->name(), Name("__GaugeTestAccessibility_super"));
  EXPECT_EQ(send<Class*>(category, "safeCategoryBaseClass"), middle->superclass());
  EXPECT_EQ(interceptingCategory(classOf<Gauge>(), "text"), category);
  EXPECT_EQ(interceptingCategory(classOf<Gauge>(), "ratio"), nullptr);
  EXPECT_EQ(interceptingCategory(nullptr, "text"), nullptr);
}

TEST_F(ValidationTests, AMethodOfAnotherSignatureIsRefusedAndReported) {
  const InstallationOutcome outcome = run({"WrongSignatureAccessibility"}).installations.at(0);
  EXPECT_TRUE(outcome.installed);
  const std::tuple<const char*, bool, const char*> cases[] = {
      {"text", false, "the host's method has the signature @, the category's q"},
      {"ratio", false, "the host's method has the signature d, the category's f"},
      {"right", true, ""},
  };
  for (const auto& [selector, intercepts, reason] : cases) {
    const GraftOutcome& method = methodOf(outcome, selector);
    EXPECT_EQ(method.intercepts, intercepts) << selector;
    EXPECT_EQ(method.reason, reason) << selector;
  }
  const id round = newOf(classOf<RoundGauge>());
  EXPECT_EQ(utf8(send<id>(round, "text")), "host") << "the host's own is left as it was";
  EXPECT_EQ(utf8(send<id>(round, "right")), "right");
}

TEST_F(ValidationTests, WhatCannotBeInstalledIsReportedAndTheNextIsInstalled) {
  const ValidationReport& report = run({"NoSuchCategory", "StrayAccessibility",
                                        "RaisingAccessibility", "", "GaugeTestAccessibility"});
  const struct {
    const char* category;
    const char* target;
    const char* reason;
  } cases[] = {
      {"NoSuchCategory", "", "the category's class is not loaded"},
      {"StrayAccessibility", "NoSuchHostClass", "the target class is not loaded"},
      {"RaisingAccessibility", "", "asking for its target class raises"},
      {"", "", "the category's class is not loaded"},
      {"GaugeTestAccessibility", "ValidationTestGauge", ""},
  };
  ASSERT_EQ(report.installations.size(), std::size(cases));
  for (std::size_t index = 0; index < std::size(cases); ++index) {
    const InstallationOutcome& outcome = report.installations[index];
    EXPECT_EQ(outcome.category, cases[index].category);
    EXPECT_EQ(outcome.target, cases[index].target);
    EXPECT_EQ(outcome.reason, cases[index].reason);
    EXPECT_EQ(outcome.installed, outcome.reason.empty());
  }
}

}  // namespace
}  // namespace tavro
