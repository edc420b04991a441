#include <limits>

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSValue.h"
#include "platform/uikit/UIViewController.h"
#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

using testing::holds;
using testing::newOf;
using testing::raisedBy;

enum class Color : std::int64_t { red = 1, green = 2 };
using Filter = std::function<bool(id)>;

/// Takes and yields one of everything that can travel.
class Traveller : public NSObject {
 public:
  static constexpr Name className = "MessageTestTraveller";

  std::string seen;

  std::int64_t integer() { return -7; }
  std::uint64_t unsignedInteger() { return std::numeric_limits<std::uint64_t>::max(); }
  std::int32_t narrow() { return -8; }
  bool flag() { return true; }
  double real() { return 0.1; }
  float single() { return 0.25F; }
  id object() { return this; }
  Class* kind() { return isa(); }
  Name selector() { return "real"; }
  CGPoint point() { return {1, 2}; }
  CGSize size() { return {3, 4}; }
  CGRect rect() { return {1, 2, 3, 4}; }
  Color color() { return Color::green; }
  void nothing() { seen = "nothing"; }

  void takeInteger(std::int64_t value) { seen = std::to_string(value); }
  void takeUnsigned(std::uint64_t value) { seen = std::to_string(value); }
  void takeReal(double value) { seen = std::to_string(value); }
  void takeSingle(float value) { seen = std::to_string(value); }
  void takeFlag(bool value) { seen = value ? "YES" : "NO"; }
  void takeColor(Color value) { seen = std::to_string(static_cast<int>(value)); }
  void takeString(const Ref<NSString>& value) { seen = value ? utf8(value) : "nil"; }
  void takeView(UIView* value) { seen = value == nullptr ? "nil" : "view"; }
  void takeClass(Class* value) { seen = value == nullptr ? "nil" : value->name().text(); }
  void takeSelector(Name value) { seen = value.text(); }
  void takeRect(CGRect value) { seen = std::to_string(value.size.height); }
  void takeBlock(const Filter& value) { seen = value(this) ? "passed" : "failed"; }
  id takeTwo(const id& first, std::int64_t second) { return second > 0 ? first : id(); }
  bool fill(id* out) {
    if (out != nullptr) {
      *out = string("filled");
    }
    return out != nullptr;
  }
};

const Registered travellerClass = defineClass<Traveller, NSObject>()
                                      .method<&Traveller::integer>("integer")
                                      .method<&Traveller::unsignedInteger>("unsignedInteger")
                                      .method<&Traveller::narrow>("narrow")
                                      .method<&Traveller::flag>("flag")
                                      .method<&Traveller::real>("real")
                                      .method<&Traveller::single>("single")
                                      .method<&Traveller::object>("object")
                                      .method<&Traveller::kind>("kind")
                                      .method<&Traveller::selector>("selector")
                                      .method<&Traveller::point>("point")
                                      .method<&Traveller::size>("size")
                                      .method<&Traveller::rect>("rect")
                                      .method<&Traveller::color>("color")
                                      .method<&Traveller::nothing>("nothing")
                                      .method<&Traveller::takeInteger>("takeInteger:")
                                      .method<&Traveller::takeUnsigned>("takeUnsigned:")
                                      .method<&Traveller::takeReal>("takeReal:")
                                      .method<&Traveller::takeSingle>("takeSingle:")
                                      .method<&Traveller::takeFlag>("takeFlag:")
                                      .method<&Traveller::takeColor>("takeColor:")
                                      .method<&Traveller::takeString>("takeString:")
                                      .method<&Traveller::takeView>("takeView:")
                                      .method<&Traveller::takeClass>("takeClass:")
                                      .method<&Traveller::takeSelector>("takeSelector:")
                                      .method<&Traveller::takeRect>("takeRect:")
                                      .method<&Traveller::takeBlock>("takeBlock:")
                                      .method<&Traveller::takeTwo>("take:two:")
                                      .method<&Traveller::fill>("fill:");

class MessageTests : public ::testing::Test {
 protected:
  template <class R>
  void expectResult(Name selector, const R& expected) {
    EXPECT_EQ(send<R>(traveller, selector), expected) << selector.text();
    EXPECT_EQ(send<R>(id(), selector), R()) << selector.text();
    EXPECT_EQ(send<R>(static_cast<Object*>(nullptr), selector), R()) << selector.text();
    EXPECT_EQ(trySend<R>(traveller, "noSuchSelector"), R()) << selector.text();
  }

  /// What the traveller saw of one argument.
  template <class A>
  std::string seen(Name selector, const A& argument) {
    traveller->seen = "(not reached)";
    send<void>(traveller, selector, argument);
    return traveller->seen;
  }

  Ref<Traveller> traveller = make<Traveller>();
};

TEST_F(MessageTests, EveryResultArrivesAndNilYieldsZero) {
  expectResult<std::int64_t>("integer", -7);
  expectResult<std::uint64_t>("unsignedInteger", std::numeric_limits<std::uint64_t>::max());
  expectResult<std::int32_t>("narrow", -8);
  expectResult<bool>("flag", true);
  expectResult<double>("real", 0.1);
  expectResult<float>("single", 0.25F);
  expectResult<id>("object", traveller);
  expectResult<CGPoint>("point", {1, 2});
  expectResult<CGSize>("size", {3, 4});
  expectResult<CGRect>("rect", {1, 2, 3, 4});
  expectResult<Name>("selector", "real");
  expectResult<Color>("color", Color::green);
  EXPECT_EQ(send<Class*>(traveller, "kind"), classOf<Traveller>());
  EXPECT_EQ(send<Class*>(id(), "kind"), nullptr);
  send<void>(traveller, "nothing");
  EXPECT_EQ(traveller->seen, "nothing");
  EXPECT_NO_THROW(send<void>(id(), "nothing"));
}

TEST_F(MessageTests, EveryArgumentArrives) {
  EXPECT_EQ(seen("takeInteger:", 3), "3");
  EXPECT_EQ(seen("takeInteger:", short{-3}), "-3");
  EXPECT_EQ(seen("takeInteger:", std::numeric_limits<long long>::min()), "-9223372036854775808");
  EXPECT_EQ(seen("takeInteger:", Color::red), "1");
  EXPECT_EQ(seen("takeUnsigned:", 3U), "3");
  EXPECT_EQ(seen("takeUnsigned:", std::size_t{4}), "4");
  EXPECT_EQ(seen("takeReal:", 0.5), "0.500000");
  EXPECT_EQ(seen("takeSingle:", 0.5F), "0.500000");
  EXPECT_EQ(seen("takeFlag:", true), "YES");
  EXPECT_EQ(seen("takeColor:", 2), "2");
  EXPECT_EQ(seen("takeString:", string("a")), "a");
  EXPECT_EQ(seen("takeString:", id(string("b"))), "b");
  EXPECT_EQ(seen("takeString:", nullptr), "nil");
  EXPECT_EQ(seen("takeView:", makeView<UIView>()), "view");
  EXPECT_EQ(seen("takeView:", id()), "nil");
  EXPECT_EQ(seen("takeClass:", classOf<UIView>()), "UIView");
  EXPECT_EQ(seen("takeSelector:", Name("frame")), "frame");
  EXPECT_EQ(seen("takeRect:", CGRect(1, 2, 3, 4)), "4.000000");
  EXPECT_EQ(seen("takeBlock:", Filter([this](const id& object) { return object == traveller; })),
            "passed");
}

TEST_F(MessageTests, WrongCallsRaise) {
  const id text = string("text");
  const struct {
    const char* what;
    std::function<void()> call;
    const char* reason;
  } cases[] = {
      {"unknown selector", [&] { send<id>(traveller, "walk"); },
       "-[MessageTestTraveller walk]: unrecognized selector"},
      {"unknown class method", [&] { send<id>(classOf<Traveller>(), "integer"); },
       "+[MessageTestTraveller integer]: unrecognized selector"},
      {"no selector", [&] { send<id>(traveller, Name()); }, "unrecognized selector"},
      {"result: object for integer", [&] { send<id>(traveller, "integer"); },
       "-[MessageTestTraveller integer]: has the signature q and was called as @"},
      {"result: double for float", [&] { send<double>(traveller, "single"); }, "f"},
      {"result: 32 bits for 64", [&] { send<std::int32_t>(traveller, "integer"); }, "q"},
      {"result: 64 bits for 32", [&] { send<std::int64_t>(traveller, "narrow"); }, "i"},
      {"result: nothing for object", [&] { send<void>(traveller, "object"); }, "@"},
      {"result: point for size", [&] { send<CGPoint>(traveller, "size"); }, "CGSize"},
      {"result: object for class", [&] { send<id>(traveller, "kind"); }, "#"},
      {"unsigned literal", [&] { send<void>(traveller, "takeInteger:", 3U); }, "v,Q"},
      {"signed literal", [&] { send<void>(traveller, "takeUnsigned:", 3); }, "v,q"},
      {"boolean for integer", [&] { send<void>(traveller, "takeInteger:", true); }, "v,B"},
      {"integer for boolean", [&] { send<void>(traveller, "takeFlag:", 1); }, "v,q"},
      {"float for double", [&] { send<void>(traveller, "takeReal:", 1.0F); }, "v,f"},
      {"double for float", [&] { send<void>(traveller, "takeSingle:", 1.0); }, "v,d"},
      {"integer for double", [&] { send<void>(traveller, "takeReal:", 1); }, "v,q"},
      {"object for class", [&] { send<void>(traveller, "takeClass:", text); }, "v,@"},
      {"object for selector", [&] { send<void>(traveller, "takeSelector:", text); }, "v,@"},
      {"point for rectangle", [&] { send<void>(traveller, "takeRect:", CGPoint()); }, "CGPoint"},
      {"another block", [&] { send<void>(traveller, "takeBlock:", std::function<void(id)>()); },
       "@?<v,@>"},
      {"missing argument", [&] { send<id>(traveller, "take:two:", text); }, "@,@"},
      {"extra argument", [&] { send<id>(traveller, "take:two:", text, 1, 1); }, "@,@,q,q"},
      {"swapped arguments", [&] { send<id>(traveller, "take:two:", 1, text); }, "@,q,@"},
      {"object for out-parameter", [&] { send<bool>(traveller, "fill:", text); }, "B,@"},
      {"another class", [&] { send<void>(traveller, "takeString:", number(1.0)); },
       "an object of class NSNumber stands where NSString is needed"},
      {"another class by pointer", [&] { send<void>(traveller, "takeView:", text); }, "UIView"},
      {"a class object", [&] { send<void>(traveller, "takeString:", id(classOf<NSString>())); },
       "NSString"},
  };
  for (const auto& each : cases) {
    const std::string raised = raisedBy(each.call);
    EXPECT_TRUE(holds(raised, "NSInvalidArgumentException: ")) << each.what;
    EXPECT_TRUE(holds(raised, each.reason)) << each.what;
  }
}

TEST_F(MessageTests, SubclassesPassWhereTheirSuperclassIsTaken) {
  EXPECT_EQ(seen("takeView:", makeView<UIWindow>()), "view");
}

TEST_F(MessageTests, OutParametersAreFilledUnlessNull) {
  id out;
  EXPECT_TRUE(send<bool>(traveller, "fill:", &out));
  EXPECT_EQ(utf8(out), "filled");
  EXPECT_FALSE(send<bool>(traveller, "fill:", static_cast<id*>(nullptr)));
  EXPECT_FALSE(send<bool>(id(), "fill:", &out));
}

TEST_F(MessageTests, SelectorsMayBeMadeAtRunTime) {
  const std::string half = "inte";
  EXPECT_EQ(send<std::int64_t>(traveller, Name::make(half + "ger")), -7);
  EXPECT_EQ(Name::make(half + "ger"), Name("integer"));
  EXPECT_EQ(Name::make(""), Name());
  EXPECT_EQ(Name::make(half).text(), half);
  EXPECT_TRUE(respondsTo(traveller.get(), Name::make(half + "ger")));
  EXPECT_FALSE(respondsTo(traveller.get(), Name()));
  EXPECT_FALSE(respondsTo(nullptr, "integer"));
}

TEST_F(MessageTests, ClassObjectsAnswerNoInstanceMethods) {
  // Code of the root class needs an instance of it, which a class object is not.
  Class* const isa = classOf<Traveller>();
  for (const Name selector :
       {Name("description"), Name("accessibilityLabel"), Name("accessibilityElements")}) {
    EXPECT_TRUE(holds(raisedBy([&] { send<id>(isa, selector); }), "unrecognized selector"));
    EXPECT_TRUE(holds(raisedBy([&] { send<id>(classOf<NSObject>(), selector); }), "unrecognized"));
    EXPECT_FALSE(respondsTo(isa, selector));
  }
  EXPECT_TRUE(respondsTo(isa, "new"));
  EXPECT_FALSE(as<NSObject>(id(isa)));
  EXPECT_TRUE(as<NSObject>(traveller));
}

/// Cannot be made without saying what it needs.
class Needy : public NSObject {
 public:
  static constexpr Name className = "MessageTestNeedy";
  explicit Needy(std::int64_t need) : need_(need) {}
  std::int64_t need() { return need_; }

 private:
  std::int64_t need_;
};
const Registered needyClass = defineClass<Needy, NSObject>().method<&Needy::need>("need");

TEST_F(MessageTests, WhatCannotBeMadeIsNil) {
  EXPECT_FALSE(send<id>(classOf<Needy>(), "alloc"));
  EXPECT_FALSE(make<Needy>());
  EXPECT_EQ(send<std::int64_t>(newOf(classOf<Needy>()), "need"), 0);
}

TEST(SaturatingCastTests, ValuesOutsideEndAtTheEdge) {
  constexpr double infinity = std::numeric_limits<double>::infinity();
  constexpr auto least = std::numeric_limits<std::int64_t>::min();
  constexpr auto most = std::numeric_limits<std::int64_t>::max();
  const struct {
    double value;
    std::int64_t wide;
    std::int32_t narrow;
    std::uint64_t natural;
    std::uint8_t byte;
  } cases[] = {
      {0, 0, 0, 0, 0},
      {-0.9, 0, 0, 0, 0},
      {2.9, 2, 2, 2, 2},
      {-2.9, -2, -2, 0, 0},
      {255.9, 255, 255, 255, 255},
      {256, 256, 256, 256, 255},
      {2147483647.5, 2147483647, 2147483647, 2147483647, 255},
      {-2147483648.5, -2147483648, -2147483648, 0, 0},
      {9223372036854775808.0, most, 2147483647, 9223372036854775808U, 255},
      {-9223372036854775808.0, least, std::numeric_limits<std::int32_t>::min(), 0, 0},
      {18446744073709551616.0, most, 2147483647, std::numeric_limits<std::uint64_t>::max(), 255},
      {infinity, most, 2147483647, std::numeric_limits<std::uint64_t>::max(), 255},
      {-infinity, least, std::numeric_limits<std::int32_t>::min(), 0, 0},
      {std::numeric_limits<double>::quiet_NaN(), 0, 0, 0, 0},
      {std::numeric_limits<double>::denorm_min(), 0, 0, 0, 0},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(saturatingCast<std::int64_t>(each.value), each.wide) << each.value;
    EXPECT_EQ(saturatingCast<std::int32_t>(each.value), each.narrow) << each.value;
    EXPECT_EQ(saturatingCast<std::uint64_t>(each.value), each.natural) << each.value;
    EXPECT_EQ(saturatingCast<std::uint8_t>(each.value), each.byte) << each.value;
  }
}

TEST(ExceptionTests, AnExceptionTellsItsNameAndItsReason) {
  try {
    send<id>(arrayWithObjects({}), "objectAtIndex:", 1);
    FAIL() << "an index outside the array passed";
  } catch (const std::exception& caught) {
    const auto* const exception = dynamic_cast<const NSException*>(&caught);
    ASSERT_NE(exception, nullptr);
    EXPECT_EQ(exception->name(), kRangeException);
    EXPECT_EQ(caught.what(), exception->name() + ": " + exception->reason());
  }
  EXPECT_EQ(trySend<id>(arrayWithObjects({}), "objectAtIndex:", -1), id());
}

}  // namespace
}  // namespace tavro
