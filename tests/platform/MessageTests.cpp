#include <limits>
#include <tuple>

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

template <class T>
T echo(Object* /*self*/, T value) {
  return value;
}
template <class T>
T yield(Object* /*self*/) {
  return T();
}
template <class T>
void take(Object* /*self*/, T /*value*/) {}
std::int32_t narrow(Object* /*self*/) { return -8; }
bool isView(Object* /*self*/, UIView* view) { return view != nullptr; }
bool asks(Object* self, const Filter& filter) { return filter(self); }
id firstIf(Object* /*self*/, const id& first, std::int64_t second) {
  return second > 0 ? first : id();
}
bool fill(Object* /*self*/, id* out) {
  if (out != nullptr) {
    *out = string("filled");
  }
  return out != nullptr;
}

/// Has a method of every kind that can be called.
class Traveller : public NSObject {
 public:
  static constexpr Name className = "MessageTestTraveller";
};
const Registered travellerClass = defineClass<Traveller, NSObject>()
                                      .method<&yield<std::int64_t>>("integer")
                                      .method<&narrow>("narrow")
                                      .method<&yield<float>>("single")
                                      .method<&yield<id>>("object")
                                      .method<&yield<CGSize>>("size")
                                      .method<&yield<Class*>>("kind")
                                      .method<&take<std::int64_t>>("takeInteger:")
                                      .method<&take<std::uint64_t>>("takeUnsigned:")
                                      .method<&take<bool>>("takeFlag:")
                                      .method<&take<double>>("takeReal:")
                                      .method<&take<float>>("takeSingle:")
                                      .method<&take<Class*>>("takeClass:")
                                      .method<&take<Name>>("takeSelector:")
                                      .method<&take<CGRect>>("takeRect:")
                                      .method<&take<Ref<NSString>>>("takeString:")
                                      .method<&isView>("takeView:")
                                      .method<&asks>("takeBlock:")
                                      .method<&firstIf>("take:two:")
                                      .method<&fill>("fill:");

class MessageTests : public ::testing::Test {
 protected:
  /// A value of that type arrives as an argument and comes back as a result; nil yields zero.
  template <class T, class Sent = T>
  void expectTravels(const Sent& sent) {
    Class* const isa = testing::madeClass("MessageTestEcho" + std::to_string(++count_),
                                          {methodOf<&echo<T>>("echo:")});
    const id echoing = newOf(isa);
    EXPECT_EQ(send<T>(echoing, "echo:", sent), T(sent)) << count_;
    EXPECT_EQ(send<T>(id(), "echo:", sent), T()) << count_;
    EXPECT_EQ(send<T>(static_cast<Object*>(nullptr), "echo:", sent), T()) << count_;
    EXPECT_EQ(trySend<T>(echoing, "noSuchSelector"), T()) << count_;
  }

  Ref<Traveller> traveller = make<Traveller>();

 private:
  int count_ = 0;
};

TEST_F(MessageTests, EveryKindOfValueTravels) {
  expectTravels<std::int64_t>(3);
  expectTravels<std::int64_t>(short{-3});
  expectTravels<std::int64_t>(std::numeric_limits<long long>::min());
  expectTravels<std::int64_t>(Color::red);
  expectTravels<Color>(Color::green);
  expectTravels<Color>(2);
  expectTravels<std::uint64_t>(3U);
  expectTravels<std::uint64_t>(std::numeric_limits<std::size_t>::max());
  EXPECT_EQ(send<std::int32_t>(traveller, "narrow"), -8);
  expectTravels<bool>(true);
  expectTravels<double>(0.1);
  expectTravels<float>(0.25F);
  expectTravels<id>(string("a"));
  expectTravels<id>(nullptr);
  expectTravels<Class*>(classOf<UIView>());
  expectTravels<Name>(Name("frame"));
  expectTravels<CGPoint>(CGPoint{1, 2});
  expectTravels<CGSize>(CGSize{3, 4});
  expectTravels<CGRect>(CGRect(1, 2, 3, 4));
  EXPECT_NO_THROW(send<void>(traveller, "takeString:", id(string("typed"))));
  EXPECT_NO_THROW(send<void>(traveller, "takeString:", nullptr));
  EXPECT_NO_THROW(send<void>(id(), "takeString:", string("nobody")));
  EXPECT_FALSE(send<bool>(traveller, "takeView:", id()));
  EXPECT_TRUE(send<bool>(traveller, "takeView:", makeView<UIWindow>())) << "a subclass";
  EXPECT_TRUE(send<bool>(
      traveller, "takeBlock:", Filter([this](const id& object) { return object == traveller; })));
}

TEST_F(MessageTests, WrongCallsRaise) {
  const id text = string("text");
  const std::tuple<const char*, std::function<void()>, const char*> cases[] = {
      {"unknown selector", [&] { send<id>(traveller, "walk"); },
       "-[MessageTestTraveller walk]: unrecognized selector"},
      {"unknown class method", [&] { send<id>(classOf<Traveller>(), "integer"); },
       "+[MessageTestTraveller integer]: unrecognized selector"},
      {"no selector", [&] { send<id>(traveller, Name()); }, "unrecognized selector"},
      {"result: object for integer", [&] { send<id>(traveller, "integer"); },
       "-[MessageTestTraveller integer]: has the signature q and was called as @"},
      {"result: double for float", [&] { send<double>(traveller, "single"); }, "f"},
      {"result: 32 bits for 64", [&] { send<std::int32_t>(traveller, "integer"); }, "q"},
      {"result: nothing for object", [&] { send<void>(traveller, "object"); }, "@"},
      {"result: point for size", [&] { send<CGPoint>(traveller, "size"); }, "CGSize"},
      {"unsigned literal", [&] { send<void>(traveller, "takeInteger:", 3U); }, "v,Q"},
      {"boolean for integer", [&] { send<void>(traveller, "takeInteger:", true); }, "v,B"},
      {"float for double", [&] { send<void>(traveller, "takeReal:", 1.0F); }, "v,f"},
      {"integer for double", [&] { send<void>(traveller, "takeReal:", 1); }, "v,q"},
      {"object for class", [&] { send<void>(traveller, "takeClass:", text); }, "v,@"},
      {"point for rectangle", [&] { send<void>(traveller, "takeRect:", CGPoint()); }, "CGPoint"},
      {"another block", [&] { send<void>(traveller, "takeBlock:", std::function<void(id)>()); },
       "@?<v,@>"},
      {"missing argument", [&] { send<id>(traveller, "take:two:", text); }, "@,@"},
      {"extra argument", [&] { send<id>(traveller, "take:two:", text, 1, 1); }, "@,@,q,q"},
      {"swapped arguments", [&] { send<id>(traveller, "take:two:", 1, text); }, "@,q,@"},
      {"object for out-parameter", [&] { send<bool>(traveller, "fill:", text); }, "B,@"},
      {"another class", [&] { send<void>(traveller, "takeString:", number(1.0)); },
       "an object of class NSNumber stands where NSString is needed"},
      {"another class by pointer", [&] { send<bool>(traveller, "takeView:", text); }, "UIView"},
      {"a class object", [&] { send<void>(traveller, "takeString:", id(classOf<NSString>())); },
       "NSString"},
  };
  for (const auto& [what, call, reason] : cases) {
    const std::string raised = raisedBy(call);
    EXPECT_TRUE(holds(raised, "NSInvalidArgumentException: ")) << what;
    EXPECT_TRUE(holds(raised, reason)) << what;
  }
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
  EXPECT_EQ(send<std::int64_t>(traveller, Name::make(half + "ger")), 0);
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
  EXPECT_EQ(classOf<Needy>()->isa()->allocate(), nullptr) << "a metaclass";
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
