#include <algorithm>

#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

using testing::holds;
using testing::madeClass;
using testing::newOf;
using testing::raisedBy;

// Methods that tell which of them ran.
template <char Letter>
Ref<NSString> letter(Object* /*self*/) {
  return string(std::string(1, Letter));
}
template <char Letter>
Method answer() {
  return methodOf<&letter<Letter>>("answer");
}
std::string ask(const id& object) { return utf8(send<id>(object, "answer")); }

TEST(ClassTests, AReplacedMethodIsReachedWhoeverWasMessagedBefore) {
  enum Messaged { base = 1, inheriting = 2, overriding = 4, unrelated = 8, all = 16 };
  for (int messaged = 0; messaged < all; ++messaged) {
    const std::string prefix = "Order" + std::to_string(messaged);
    const Name baseName = Name::make(prefix + "Base");
    Class* const classes[] = {
        madeClass(prefix + "Base", {answer<'b'>()}),
        madeClass(prefix + "Inheriting", {}, baseName),
        madeClass(prefix + "Overriding", {answer<'o'>()}, baseName),
        madeClass(prefix + "Unrelated", {answer<'u'>()}),
    };
    const auto askAll = [&] {
      std::string answers;
      for (Class* const each : classes) {
        answers += ask(newOf(each));
      }
      return answers;
    };
    for (std::size_t index = 0; index < std::size(classes); ++index) {
      if ((messaged & (1 << index)) != 0) {
        ask(newOf(classes[index]));
      }
    }
    classes[0]->setMethod(answer<'R'>());
    EXPECT_EQ(askAll(), "RRou") << messaged;
    classes[1]->setMethod(answer<'I'>());
    EXPECT_EQ(askAll(), "RIou") << messaged;
    classes[0]->setMethod(answer<'S'>());
    EXPECT_EQ(askAll(), "SIou") << messaged;
    classes[1]->removeMethod("answer");
    EXPECT_EQ(askAll(), "SSou") << messaged;
  }
}

TEST(ClassTests, ARemovedMethodIsGoneUntilItIsSetAgain) {
  Class* const isa = madeClass("RemovalTarget", {answer<'a'>()});
  isa->setMethod(answer<'b'>());
  isa->removeMethod("answer");
  EXPECT_TRUE(holds(raisedBy([&] { ask(newOf(isa)); }), "unrecognized selector"));
  isa->removeMethod("answer");  // once more changes nothing
  const Method* const set = isa->setMethod(answer<'c'>());
  EXPECT_EQ(set->replaced, nullptr) << "what was taken away is not what was replaced";
  EXPECT_EQ(ask(newOf(isa)), "c");
  EXPECT_EQ(isa->ownMethods(), std::vector<const Method*>{set});
}

TEST(ClassTests, OwnMethodsAreThoseInForceInTheOrderOfTheirDeclaration) {
  Class* const isa =
      madeClass("OwnMethods", {methodOf<&letter<'x'>>("x"), methodOf<&letter<'y'>>("y")});
  isa->setMethod(methodOf<&letter<'z'>>("x"));
  std::string names;
  for (const Method* method : isa->ownMethods()) {
    names += method->selector.text();
  }
  EXPECT_EQ(names, "yx");
}

// Classes that make and set up their instances in their own way.

id sharedInstance;
id allocShared(Class* isa) {
  if (!sharedInstance) {
    sharedInstance = isa->allocate();
  }
  return sharedInstance;
}
Ref<NSString> classAnswer(Class* isa) { return string(isa->name().text()); }
id initAsNil(Object* /*self*/) { return nullptr; }

TEST(ClassTests, AllocInitAndClassMethodsCanBeOverridden) {
  const Name baseName = "SingletonBase";
  declareClass({.name = baseName,
                .superclass = "NSObject",
                .classMethods = {methodOf<&allocShared>("alloc"), methodOf<&classAnswer>("who")}});
  Class* const base = Class::named(baseName);
  EXPECT_EQ(newOf(base), newOf(base));
  Class* const sub = madeClass("SingletonSub", {}, baseName);
  EXPECT_EQ(utf8(send<id>(sub, "who")), "SingletonSub") << "self is the class that was asked";
  sub->isa()->setMethod(methodOf<&letter<'s'>>("who"));
  EXPECT_EQ(utf8(send<id>(sub, "who")) + utf8(send<id>(base, "who")), "sSingletonBase");
  EXPECT_FALSE(newOf(madeClass("InitIsNil", {methodOf<&initAsNil>("init")})));
}

// Ordinary categories, declared before the class that they extend exists.
const Registered early = extendClass("LateClass")
                             .method<&letter<'c'>>("answer")
                             .classMethod<&classAnswer>("who")
                             .protocol("Answering");
const Registered ofStrings = extendClass("NSString").method<&letter<'n'>>("runtimeTestAnswer");

TEST(ClassTests, OrdinaryCategoriesExtendClassesOfAnyRoom) {
  EXPECT_EQ(utf8(send<id>(string("any"), "runtimeTestAnswer")), "n");
  EXPECT_TRUE(std::ranges::any_of(registrationProblems(), [](const RegistrationProblem& problem) {
    return problem.className == "LateClass" && !problem.reason.empty();
  }));
  Class* const late = madeClass("LateClass", {answer<'o'>()});
  EXPECT_EQ(ask(newOf(late)), "c");
  EXPECT_EQ(utf8(send<id>(late, "who")), "LateClass");
  EXPECT_TRUE(late->conformsTo("Answering"));
  for (const RegistrationProblem& problem : registrationProblems()) {
    EXPECT_NE(problem.className, "LateClass") << problem.reason;
  }
}

TEST(ClassTests, ASuperclassMayBeRegisteredLater) {
  declareClass({.name = "OrderLast", .superclass = "OrderMiddle"});
  declareClass({.name = "OrderMiddle", .superclass = "OrderFirst"});
  EXPECT_EQ(Class::named("OrderLast"), nullptr);
  for (const char* const waiting : {"OrderLast", "OrderMiddle"}) {
    EXPECT_TRUE(
        std::ranges::count(registrationProblems(), waiting, &RegistrationProblem::className) == 1)
        << waiting;
  }
  Class* const first = madeClass("OrderFirst", {answer<'f'>()});
  Class* const last = Class::named("OrderLast");
  ASSERT_NE(last, nullptr);
  EXPECT_EQ(last->superclass()->superclass(), first);
  EXPECT_TRUE(last->isSubclassOf(first));
  EXPECT_FALSE(first->isSubclassOf(last));
  EXPECT_EQ(ask(newOf(last)), "f");
}

TEST(ClassTests, ASecondClassOfTheSameNameIsRefusedAndReported) {
  Class* const first = madeClass("Twice", {answer<'1'>()});
  EXPECT_EQ(madeClass("Twice", {answer<'2'>()}), first);
  EXPECT_EQ(ask(newOf(first)), "1");
  EXPECT_TRUE(std::ranges::any_of(registrationProblems(), [](const RegistrationProblem& problem) {
    return problem.className == "Twice" && holds(problem.reason, "already registered");
  }));
  forgetClass("Twice");
  EXPECT_EQ(Class::named("Twice"), nullptr);
  EXPECT_EQ(ask(newOf(first)), "1") << "a forgotten class stays usable";
}

TEST(ClassTests, TwoTextsWithOneHashAreRefused) {
  NameTable& table = NameTable::shared();
  const std::uint64_t hash = Name("takenSelector").hash();
  EXPECT_NE(table.add(hash, "the first text"), nullptr);
  EXPECT_NE(table.add(hash, "the first text"), nullptr) << "the same text again is no clash";
  EXPECT_EQ(table.add(hash, "takenSelector"), nullptr);
  EXPECT_TRUE(holds(raisedBy([] { Name::make(std::string("taken") + "Selector"); }), "hash"));

  const auto isRefused = [](const ClassDeclaration& declaration) {
    declareClass(declaration);
    const std::string name(declaration.name.text());
    return Class::named(declaration.name) == nullptr &&
           std::ranges::any_of(registrationProblems(), [&](const RegistrationProblem& problem) {
             return problem.className == name && holds(problem.reason, "takenSelector");
           });
  };
  const Method method = methodOf<&letter<'t'>>("takenSelector");
  EXPECT_TRUE(isRefused({.name = "ClashA", .superclass = "NSObject", .methods = {method}}));
  EXPECT_TRUE(isRefused({.name = "ClashB", .superclass = "NSObject", .classMethods = {method}}));
  EXPECT_TRUE(isRefused(
      {.name = "ClashC", .superclass = "NSObject", .variables = {{.name = "takenSelector"}}}));
  EXPECT_TRUE(
      isRefused({.name = "ClashD", .superclass = "NSObject", .protocols = {"takenSelector"}}));
}

TEST(ClassTests, ProtocolsAndVariablesAreInherited) {
  declareClass(
      {.name = "VariablesBase",
       .superclass = "NSObject",
       .variables = {{.name = "_count", .type = "q"}, {.name = "_title", .type = "UILabel"}},
       .protocols = {"Countable"}});
  Class* const base = Class::named("VariablesBase");
  Class* const sub = madeClass("VariablesSub", {}, "VariablesBase");
  EXPECT_TRUE(sub->conformsTo("Countable"));
  EXPECT_FALSE(sub->conformsTo("Titled"));
  EXPECT_FALSE(sub->superclass()->superclass()->conformsTo("Countable"));
  EXPECT_EQ(sub->variable("_count"), base->variable("_count"));
  sub->setVariable({.name = "_title", .type = "NSString"});
  EXPECT_EQ(sub->variable("_title")->type, "NSString");
  EXPECT_EQ(base->variable("_title")->type, "UILabel");
  sub->removeVariable("_title");
  EXPECT_EQ(sub->variable("_title")->type, "UILabel");
  base->removeVariable("_title");
  EXPECT_EQ(sub->variable("_title"), nullptr);
}

/// A facade as a category is one; each adds its letter to what lies above.
template <char Letter>
class Adding {
 public:
  void enter(Object* receiver, const Method& running) { super_ = Super(receiver, running); }
  Ref<NSString> answer() {
    return string(utf8(super_.template send<id>()) + std::string(1, Letter));
  }

 private:
  Super super_;
};
template <char Letter>
Method adding() {
  return methodOf<&Adding<Letter>::answer>("answer");
}

TEST(SuperTests, GraftedMethodsContinueInWhatTheyTookThePlaceOf) {
  Class* const base = madeClass("SuperBase", {answer<'b'>()});
  Class* const target = madeClass("SuperTarget", {answer<'t'>()}, "SuperBase");
  Class* const inheriting = madeClass("SuperInheriting", {}, "SuperBase");
  for (Class* const each : {target, inheriting}) {
    each->setMethod(adding<'1'>());
    each->setMethod(adding<'2'>());
    each->setMethod(adding<'3'>());
  }
  EXPECT_EQ(ask(newOf(target)), "t123");
  EXPECT_EQ(ask(newOf(inheriting)), "b123");
  base->setMethod(adding<'+'>());
  EXPECT_EQ(ask(newOf(inheriting)), "b+123") << "what lies above is looked up at each call";
  EXPECT_EQ(ask(newOf(target)), "t123");
  base->removeMethod("answer");
  EXPECT_TRUE(holds(raisedBy([&] { ask(newOf(inheriting)); }),
                    "-[SuperInheriting answer]: unrecognized selector"));
  EXPECT_EQ(ask(newOf(target)), "t123");
}

/// Takes itself away, and then continues above.
class Leaving {
 public:
  void enter(Object* receiver, const Method& running) {
    receiver_ = receiver;
    super_ = Super(receiver, running);
  }
  Ref<NSString> answer() {
    receiver_->isa()->removeMethod("answer");
    return string(utf8(super_.send<id>()) + "!");
  }

 private:
  Object* receiver_ = nullptr;
  Super super_;
};

TEST(SuperTests, AMethodThatWasTakenAwayIsNotContinued) {
  madeClass("LeavingBase", {answer<'b'>()});
  Class* const target = madeClass("LeavingTarget", {answer<'t'>()}, "LeavingBase");
  target->setMethod(methodOf<&Leaving::answer>("answer"));
  const id object = newOf(target);
  EXPECT_EQ(ask(object), "b!");
  EXPECT_EQ(ask(object), "b");
}

double realAnswer(Object* /*self*/) { return 1; }

TEST(SuperTests, AnotherSignatureAboveRaises) {
  Class* const base = madeClass("SignatureBase", {methodOf<&realAnswer>("answer")});
  Class* const sub = madeClass("SignatureSub", {}, "SignatureBase");
  sub->setMethod(adding<'s'>());
  EXPECT_TRUE(holds(raisedBy([&] { ask(newOf(sub)); }), "has the signature d"));
  base->setMethod(answer<'b'>());
  EXPECT_EQ(ask(newOf(sub)), "bs");
}

}  // namespace
}  // namespace tavro
