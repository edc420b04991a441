#include <limits>
#include <stdexcept>

#include "platform/accessibility/KeyAccess.h"
#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIControls.h"
#include "tests/platform/RuntimeTesting.h"
#include "tests/support/Elements.h"

namespace tavro {
namespace {

using testing::newOf;

/// What a key gives, in words: each source of an answer names itself.
std::string source(const id& object, Name key) {
  const id found = safeValueForKey(object, key);
  return found ? utf8(send<id>(found, "description")) : "(nil)";
}

template <int Source>
Ref<NSString> from(Object* /*self*/) {
  constexpr std::string_view names[] = {"key", "isKey", "_key"};
  return string(names[Source]);
}
void nothing(Object* /*self*/) {}
Ref<NSString> echo(Object* /*self*/, const Ref<NSString>& text) { return text; }

/// Has variables; accessors are added by the tests.
class Holder : public NSObject {
 public:
  static constexpr Name className = "KeyTestHolder";

  Ref<NSString> underscored = string("variable _key");
  id bare = string("variable key");
  bool flag = true;
  std::int64_t count = -5;
  std::uint64_t size = std::numeric_limits<std::uint64_t>::max();
  std::int32_t narrow = -6;
  double ratio = 0.25;
  float share = 0.5F;
  CGPoint point{1, 2};
  CGSize extent{3, 4};
  CGRect frame{1, 2, 3, 4};
  Class* kind = classOf<NSString>();
  Name selector = "frame";
  std::function<void()> block = [] {};

  id raise() { tavro::raise("TestException", "on purpose"); }
  id throwStandard() { throw std::out_of_range("on purpose"); }
  id throwInteger() { throw 42; }
};

const Registered holderClass = defineClass<Holder, NSObject>()
                                   .variable<&Holder::underscored>("_key")
                                   .variable<&Holder::bare>("key")
                                   .variable<&Holder::flag>("_flag")
                                   .variable<&Holder::count>("_count")
                                   .variable<&Holder::size>("_size")
                                   .variable<&Holder::narrow>("_narrow")
                                   .variable<&Holder::ratio>("_ratio")
                                   .variable<&Holder::share>("_share")
                                   .variable<&Holder::point>("_point")
                                   .variable<&Holder::extent>("_extent")
                                   .variable<&Holder::frame>("_frame")
                                   .variable<&Holder::kind>("_kind")
                                   .variable<&Holder::selector>("_selector")
                                   .variable<&Holder::block>("_block")
                                   .variable<&Holder::bare>("_raising")
                                   .variable<&Holder::bare>("_standard")
                                   .variable<&Holder::bare>("_integer")
                                   .method<&Holder::raise>("raising")
                                   .method<&Holder::throwStandard>("standard")
                                   .method<&Holder::throwInteger>("integer");

class KeyAccessTests : public ::testing::Test {
 protected:
  /// A class below Holder with these accessors of its own.
  static id holderWith(std::string_view name, std::vector<Method> accessors) {
    return newOf(testing::madeClass(name, std::move(accessors), Holder::className));
  }

  /// Lets an accessor answer with the variable's value, and empties the variable.
  template <class T>
  void moveToAccessor(Name key, T Holder::*member) {
    answers<T>(holder, key, [value = std::exchange((*holder).*member, T())] { return value; });
  }

  Ref<Holder> holder = make<Holder>();
};

TEST_F(KeyAccessTests, AccessorsComeBeforeVariablesInTheirOrder) {
  const Method key = methodOf<&from<0>>("key");
  const Method isKey = methodOf<&from<1>>("isKey");
  const Method underscored = methodOf<&from<2>>("_key");
  EXPECT_EQ(source(holderWith("KeyAll", {underscored, isKey, key}), "key"), "key");
  EXPECT_EQ(source(holderWith("KeyTwo", {underscored, isKey}), "key"), "isKey");
  EXPECT_EQ(source(holderWith("KeyOne", {underscored}), "key"), "_key");
  EXPECT_EQ(source(holderWith("KeyNone", {}), "key"), "variable _key") << "inherited";
  EXPECT_EQ(source(holder, "key"), "variable _key");
  EXPECT_EQ(source(holder, "_key"), "variable _key") << "the variable by its own name";
  const Method withArgument = methodOf<&echo>("key");
  const Method withoutResult = methodOf<&nothing>("isKey");
  EXPECT_EQ(source(holderWith("KeySkips", {withArgument, withoutResult, underscored}), "key"),
            "_key");
  EXPECT_EQ(source(holderWith("KeySkipsAll", {withArgument, withoutResult}), "key"),
            "variable _key");
}

TEST_F(KeyAccessTests, WhatIsKnownOfAClassFollowsItsChanges) {
  Class* const base = testing::madeClass("KeyChanges", {}, Holder::className);
  const id object = newOf(testing::madeClass("KeyChangesSub", {}, "KeyChanges"));
  EXPECT_EQ(source(object, "key"), "variable _key");
  EXPECT_EQ(source(object, "later"), "(nil)");
  base->setMethod(methodOf<&from<0>>("later"));
  base->setMethod(methodOf<&from<1>>("isKey"));
  EXPECT_EQ(source(object, "later") + source(object, "key"), "keyisKey");
  base->removeMethod("isKey");
  const InstanceVariable* const bare = classOf<Holder>()->variable("key");
  base->setVariable({.name = "_key", .type = "@", .isObject = true, .address = bare->address});
  EXPECT_EQ(source(object, "key"), "variable key") << "the nearer variable";
  base->removeVariable("_key");
  EXPECT_EQ(source(object, "key"), "variable _key");
}

TEST_F(KeyAccessTests, PrimitivesArriveBoxedFromVariablesAndAccessors) {
  const auto expectBoxes = [&] {
    const auto boxed = [&](Name key) { return safeValueForKey(holder, key); };
    EXPECT_EQ(as<NSNumber>(boxed("flag"))->number.index(), 0U) << "a boolean stays one";
    EXPECT_TRUE(send<bool>(boxed("flag"), "boolValue"));
    EXPECT_EQ(send<std::int64_t>(boxed("count"), "longLongValue"), -5);
    EXPECT_EQ(utf8(send<id>(boxed("size"), "description")), "18446744073709551615");
    EXPECT_EQ(send<std::int32_t>(boxed("narrow"), "intValue"), -6);
    EXPECT_EQ(send<double>(boxed("ratio"), "doubleValue"), 0.25);
    EXPECT_EQ(send<float>(boxed("share"), "floatValue"), 0.5F);
    EXPECT_EQ(send<CGPoint>(boxed("point"), "CGPointValue"), (CGPoint{1, 2}));
    EXPECT_EQ(send<CGSize>(boxed("extent"), "CGSizeValue"), (CGSize{3, 4}));
    EXPECT_EQ(send<CGRect>(boxed("frame"), "CGRectValue"), CGRect(1, 2, 3, 4));
    EXPECT_EQ(boxed("kind"), id(classOf<NSString>()));
    EXPECT_FALSE(boxed("selector")) << "a selector has no box";
  };
  expectBoxes();
  EXPECT_FALSE(safeValueForKey(holder, "block")) << "a block is no object";
  moveToAccessor("flag", &Holder::flag);
  moveToAccessor("count", &Holder::count);
  moveToAccessor("size", &Holder::size);
  moveToAccessor("narrow", &Holder::narrow);
  moveToAccessor("ratio", &Holder::ratio);
  moveToAccessor("share", &Holder::share);
  moveToAccessor("point", &Holder::point);
  moveToAccessor("extent", &Holder::extent);
  moveToAccessor("frame", &Holder::frame);
  moveToAccessor("kind", &Holder::kind);
  moveToAccessor("selector", &Holder::selector);
  expectBoxes();
}

TEST_F(KeyAccessTests, TypedCallsGiveTheEmptyResultForAnythingElse) {
  const id label = makeLabel("text");
  struct Case {
    id object;
    Name key;
    bool flag;
    std::int32_t integer;
    double real;
    const char* text;
    bool isView;
  };
  const Case cases[] = {
      {holder, "flag", true, 1, 1, "", false},
      {holder, "count", true, -5, -5, "", false},
      {holder, "size", true, std::numeric_limits<std::int32_t>::max(), 18446744073709551616.0, "",
       false},
      {holder, "ratio", true, 0, 0.25, "", false},
      {holder, "key", false, 0, 0, "variable _key", false},
      {holder, "point", false, 0, 0, "", false},
      {holder, "kind", false, 0, 0, "", false},
      {holder, "noSuchKey", false, 0, 0, "", false},
      {label, "text", false, 0, 0, "text", false},
      {label, "hidden", false, 0, 0, "", false},
      {nullptr, "text", false, 0, 0, "", false},
  };
  for (const Case& each : cases) {
    EXPECT_EQ(safeBoolForKey(each.object, each.key), each.flag) << each.key.text();
    EXPECT_EQ(safeIntForKey(each.object.get(), each.key), each.integer) << each.key.text();
    EXPECT_EQ(safeDoubleForKey(each.object, each.key), each.real) << each.key.text();
    EXPECT_EQ(utf8(safeStringForKey(each.object, each.key)), each.text) << each.key.text();
    EXPECT_EQ(safeArrayForKey(each.object, each.key), nullptr) << each.key.text();
    EXPECT_EQ(bool(safeUIViewForKey(each.object, each.key)), each.isView) << each.key.text();
  }
  const id parent = makeView<UIView>();
  send<void>(parent, "addSubview:", label);
  EXPECT_EQ(safeUIViewForKey(label, "superview"), parent);
  EXPECT_EQ(safeArrayForKey(parent, "subviews")->count(), 1U);
  EXPECT_TRUE(typedRead<NSNumber>(label, "hidden")) << "isHidden, boxed";
  EXPECT_FALSE(typedRead<UIView>(label, "text"));
}

TEST_F(KeyAccessTests, AnAccessorThatRaisesEndsTheSearchWithNothing) {
  for (const Name key : {Name("raising"), Name("standard"), Name("integer")}) {
    EXPECT_TRUE(safeValueForKey(holder, Name::make("_" + std::string(key.text()))));
    EXPECT_FALSE(safeValueForKey(holder, key)) << key.text();
    EXPECT_EQ(safeIntForKey(holder.get(), key), 0) << key.text();
  }
}

id sharedHolder(Class* /*isa*/) {
  static const auto* const shared = new Ref<Holder>(make<Holder>());
  return *shared;
}
const Registered sharing = extendClass("KeyTestHolder").classMethod<&sharedHolder>("sharedHolder");

TEST_F(KeyAccessTests, ClassObjectsAnswerThroughClassMethodsAlone) {
  Class* const isa = AXSafeClassFromString("KeyTestHolder");
  const id shared = safeValueForKey(isa, "sharedHolder");
  EXPECT_TRUE(as<Holder>(shared));
  EXPECT_EQ(safeValueForKey(testing::madeClass("KeySharing", {}, "KeyTestHolder"), "sharedHolder"),
            shared);
  for (const Name key : {Name("key"), Name("count"), Name("description"),
                         Name("accessibilityLabel"), Name("noSuchKey")}) {
    EXPECT_FALSE(safeValueForKey(isa, key)) << key.text();
    EXPECT_FALSE(safeValueForKey(AXSafeClassFromString("NoSuchClass"), key)) << key.text();
  }
}

TEST_F(KeyAccessTests, OddKeysAreKeysThatAreNotThere) {
  for (const std::string& key :
       {std::string(), std::string("."), std::string("key."), std::string("take:"),
        std::string("é"), std::string("Key"), std::string("a b"), std::string(10000, 'k')}) {
    EXPECT_FALSE(safeValueForKey(holder, Name::make(key))) << key.substr(0, 20);
  }
  EXPECT_FALSE(safeValueForKey(holder, Name()));
  for (int index = 0; index < 300; ++index) {  // far more keys than fit one small table
    EXPECT_FALSE(safeValueForKey(holder, Name::make("absent" + std::to_string(index))));
  }
  EXPECT_EQ(source(holder, "key"), "variable _key");
}

TEST_F(KeyAccessTests, KeyPathsFollowTheirKeys) {
  const auto outer = makeView<UIView>();
  const auto inner = makeView<UIView>();
  const auto label = makeLabel("deep");
  outer->addSubview(inner);
  inner->addSubview(label);
  const std::pair<const char*, const char*> cases[] = {
      {"text", "deep"},
      {"superview.subviews.firstObject.text", "deep"},
      {"superview.superview", "UIView"},
      {"superview.superview.superview", "(nil)"},
      {"superview.superview.superview.text", "(nil)"},
      {"hidden", "0"},
      {"superview..text", "(nil)"},
      {".text", "(nil)"},
      {"noSuchKey.text", "(nil)"}};
  for (const auto& [path, expected] : cases) {
    const id found = safeValueForKeyPath(label.get(), path);
    EXPECT_EQ(found ? utf8(send<id>(found, "description")) : "(nil)", expected) << path;
  }
  EXPECT_FALSE(safeValueForKeyPath(nullptr, "text"));
}

TEST_F(KeyAccessTests, TypedReadsFlagWhatIsOfAnotherClass) {
  const id label = makeLabel("text");
  const struct {
    Name className;
    id value;
    bool passes;
  } cases[] = {
      {"UILabel", label, true},   {"UIView", label, true},
      {"UIButton", label, false}, {"NoSuch", label, false},
      {"UILabel", nullptr, true}, {"NoSuch", nullptr, true},
      {"NSObject", label, true},  {"NSObject", id(classOf<UIView>()), false},
      {"NSString", label, false},
  };
  for (const auto& each : cases) {
    bool failed = false;
    const id value = __UIAccessibilitySafeClass(each.className, each.value, true, &failed);
    EXPECT_EQ(failed, !each.passes) << each.className.text();
    EXPECT_EQ(value, each.passes ? each.value : id()) << each.className.text();
    EXPECT_EQ(__UIAccessibilitySafeClass(each.className, each.value, true, nullptr), value);
  }
}

TEST_F(KeyAccessTests, SafeBlocksContainWhateverIsRaised) {
  const char* reached = "none";
  AXPerformSafeBlock([&] {
    reached = "first";
    throw "a text";  // NOLINT: any type may cross
    reached = "second";
  });
  EXPECT_STREQ(reached, "first");
}

TEST_F(KeyAccessTests, RetainedValuesAndAssociatedObjectsStayApart) {
  static const char first = 0;
  static const char second = 0;
  const id a = string("a");
  const id b = string("b");
  const Ref<NSString> copied = string("a");
  _accessibilitySetRetainedValue(holder.get(), a, "kAXTestKey");
  __UIAccessibilitySetAssociatedObject(holder.get(), &first, b);
  __UIAccessibilitySetAssociatedCopiedObject(holder.get(), &second, copied);
  EXPECT_EQ(_accessibilityValueForKey(holder.get(), "kAXTestKey"), a);
  EXPECT_EQ(_accessibilityValueForKey(holder.get(), "kAXOtherKey"), nullptr);
  EXPECT_EQ(__UIAccessibilityGetAssociatedObject(holder.get(), &first), b);
  EXPECT_EQ(utf8(__UIAccessibilityGetAssociatedObject(holder.get(), &second)), "a");
  _accessibilitySetRetainedValue(holder.get(), nullptr, "kAXTestKey");
  __UIAccessibilitySetAssociatedObject(holder.get(), &first, nullptr);
  EXPECT_EQ(_accessibilityValueForKey(holder.get(), "kAXTestKey"), nullptr);
  EXPECT_EQ(__UIAccessibilityGetAssociatedObject(holder.get(), &first), nullptr);
  EXPECT_TRUE(__UIAccessibilityGetAssociatedObject(holder.get(), &second));
  _accessibilitySetRetainedValue(nullptr, a, "kAXTestKey");
  EXPECT_EQ(_accessibilityValueForKey(nullptr, "kAXTestKey"), nullptr);
  EXPECT_FALSE(safeValueForKey(holder, "kAXTestKey")) << "a retained value is no key of the host";
}

}  // namespace
}  // namespace tavro
