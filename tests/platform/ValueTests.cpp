#include <cmath>
#include <limits>

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSError.h"
#include "platform/foundation/NSValue.h"
#include "tests/platform/FoundationTesting.h"

namespace tavro {
namespace {

using testing::FoundationTest;
using testing::heard;

TEST(ObjectTests, TheRootClassAnswersForObjects) {
  const id plain = make<NSObject>();
  EXPECT_EQ(heard(send<id>(plain, "description")), "NSObject");
  const id text = string("text");
  EXPECT_TRUE(send<bool>(text, "isKindOfClass:", classOf<NSObject>()));
  EXPECT_TRUE(send<bool>(text, "isKindOfClass:", classOf<NSString>()));
  EXPECT_FALSE(send<bool>(plain, "isKindOfClass:", classOf<NSString>()));
  EXPECT_FALSE(send<bool>(plain, "isKindOfClass:", static_cast<Class*>(nullptr)));
  EXPECT_TRUE(send<bool>(plain, "respondsToSelector:", Name("description")));
  EXPECT_FALSE(send<bool>(plain, "respondsToSelector:", Name("length")));
}

TEST(ArrayTests, HoldsNoNilAndRaisesOutside) {
  const id first = string("first");
  const id second = string("second");
  const Ref<NSArray> array = axArrayByIgnoringNilElements({nullptr, first, id(), second});
  EXPECT_EQ(send<std::int64_t>(array, "count"), 2);
  EXPECT_EQ(send<id>(array, "firstObject"), first);
  EXPECT_EQ(send<id>(array, "objectAtIndex:", 1), second);
  for (const std::int64_t outside :
       {std::int64_t{-1}, std::int64_t{2}, std::numeric_limits<std::int64_t>::min()}) {
    EXPECT_THROW(send<id>(array, "objectAtIndex:", outside), NSException) << outside;
  }
  EXPECT_FALSE(send<id>(arrayWithObjects({}), "firstObject"));
}

TEST(ArrayTests, MutableArraysTakeNilOnlySafely) {
  const Ref<NSMutableArray> array = mutableArray(4);
  array->axSafelyAddObject(nullptr);
  EXPECT_EQ(array->count(), 0U);
  array->axSafelyAddObject(string("kept"));
  EXPECT_THROW(array->addObject(nullptr), NSException);
  EXPECT_EQ(array->count(), 1U);
}

TEST(ValueTests, GeometryComesBackOnlyAsWhatItIs) {
  const id point = value(CGPoint{1.5, -2});
  const id size = value(CGSize{3, 4});
  const id rect = value(CGRect{1, 2, 3, 4});
  EXPECT_EQ(send<CGPoint>(point, "CGPointValue"), (CGPoint{1.5, -2}));
  EXPECT_EQ(send<CGSize>(size, "CGSizeValue"), (CGSize{3, 4}));
  EXPECT_EQ(send<CGRect>(rect, "CGRectValue"), (CGRect{1, 2, 3, 4}));
  EXPECT_THROW(send<CGPoint>(rect, "CGPointValue"), NSException);
  EXPECT_THROW(send<CGRect>(point, "CGRectValue"), NSException);
  EXPECT_THROW(send<CGSize>(number(1.0), "CGSizeValue"), NSException);
  EXPECT_THROW(send<CGPoint>(make<NSValue>(), "CGPointValue"), NSException);
}

TEST(NumberTests, ConvertWithoutOverflow) {
  using Int = std::numeric_limits<std::int32_t>;
  using Long = std::numeric_limits<std::int64_t>;
  constexpr auto kHuge = std::numeric_limits<std::uint64_t>::max();
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  const struct {
    Ref<NSNumber> number;
    bool asBool;
    std::int32_t asInt;
    std::int64_t asLong;
    double asDouble;
    std::string_view description;
  } cases[] = {
      {number(true), true, 1, 1, 1, "1"},
      {number(false), false, 0, 0, 0, "0"},
      {number(std::int64_t{-7}), true, -7, -7, -7, "-7"},
      {number(Long::max()), true, Int::max(), Long::max(), 9223372036854775807.0,
       "9223372036854775807"},
      {number(Long::min()), true, Int::min(), Long::min(), -9223372036854775808.0,
       "-9223372036854775808"},
      {number(kHuge), true, Int::max(), Long::max(), 18446744073709551615.0,
       "18446744073709551615"},
      {number(2.9), true, 2, 2, 2.9, "2.9"},
      {number(-2.9), true, -2, -2, -2.9, "-2.9"},
      {number(0.25), true, 0, 0, 0.25, "0.25"},
      {number(1e300), true, Int::max(), Long::max(), 1e300, "1e+300"},
      {number(-kInfinity), true, Int::min(), Long::min(), -kInfinity, "-inf"},
      {number(-0.0), false, 0, 0, 0, "-0"},
  };
  for (const auto& each : cases) {
    SCOPED_TRACE(each.description);
    EXPECT_EQ(send<bool>(each.number, "boolValue"), each.asBool);
    EXPECT_EQ(send<std::int32_t>(each.number, "intValue"), each.asInt);
    EXPECT_EQ(send<std::int64_t>(each.number, "longLongValue"), each.asLong);
    EXPECT_EQ(send<double>(each.number, "doubleValue"), each.asDouble);
    EXPECT_EQ(heard(send<id>(each.number, "description")), each.description);
  }
  EXPECT_EQ(number(std::nan(""))->intValue(), 0);
  EXPECT_FLOAT_EQ(send<float>(number(0.1), "floatValue"), 0.1F);
}

TEST(GeometryTests, UnionAndContainmentFollowTheEdges) {
  const CGRect left{0, 0, 10, 10};
  EXPECT_EQ(CGRectUnion(left, {20, -5, 5, 5}), (CGRect{0, -5, 25, 15}));
  EXPECT_EQ(CGRectUnion({5, 5, 1, 1}, CGRectZero), (CGRect{0, 0, 6, 6}));
  EXPECT_TRUE(left.contains({0, 0}));
  EXPECT_FALSE(left.contains({10, 5}));
  EXPECT_FALSE(left.contains({5, 10}));
}

}  // namespace
}  // namespace tavro
