#include <functional>
#include <vector>

#include "tests/platform/RuntimeTesting.h"

namespace tavro {
namespace {

int alive = 0;

/// Counts itself and runs something as it goes.
class Mortal : public NSObject {
 public:
  static constexpr Name className = "ReferenceTestMortal";

  std::function<void()> last;
  Ref<Mortal> next;

  Mortal() { ++alive; }
  ~Mortal() override {
    --alive;
    if (last) {
      last();
    }
  }
};
const Registered mortalClass = defineClass<Mortal, NSObject>();

constexpr std::uint64_t kKey = Name("key").hash();
constexpr std::uint64_t kOtherKey = Name("otherKey").hash();

class ReferenceTests : public ::testing::Test {
 protected:
  void TearDown() override { EXPECT_EQ(alive, 0) << "every object is gone at the end"; }
};
using WeakTests = ReferenceTests;
using AttachedValueTests = ReferenceTests;

TEST_F(ReferenceTests, AssignmentsKeepWhatIsStillNeeded) {
  Ref<Mortal> head = make<Mortal>();
  head->next = make<Mortal>();
  head->next->next = make<Mortal>();
  const Ref<Mortal>& same = head;
  head = same;
  EXPECT_EQ(alive, 3);
  head = head->next;  // the list's head goes, what it leads to stays
  EXPECT_EQ(alive, 2);
  head = std::move(head->next);
  EXPECT_EQ(alive, 1);
  Ref<Mortal>& itself = head;
  head = std::move(itself);
  EXPECT_TRUE(head);
  Ref<Mortal> moved = std::move(head);
  EXPECT_FALSE(head);  // NOLINT(bugprone-use-after-move): a moved reference is nil
  EXPECT_EQ(moved->referenceCount(), 1U);
  const id plain = std::move(moved);
  EXPECT_EQ(plain.get()->referenceCount(), 1U);
}

TEST_F(WeakTests, AWeakReferenceReadsAsNilOnceItsObjectIsGone) {
  Weak<Mortal> early;
  std::vector<Weak<Mortal>> many;
  {
    const Ref<Mortal> object = make<Mortal>();
    early = object;
    many.assign(100, object);
    EXPECT_EQ(object->referenceCount(), 1U) << "a weak reference keeps nothing alive";
    EXPECT_EQ(early.get(), object.get());
    many.erase(many.begin(), many.begin() + 50);
    EXPECT_EQ(many.front().strong(), object);
  }
  EXPECT_EQ(alive, 0);
  EXPECT_EQ(early.get(), nullptr);
  for (const Weak<Mortal>& each : many) {
    EXPECT_FALSE(each.strong());
  }
  early = make<Mortal>();  // nobody keeps it
  EXPECT_EQ(early.get(), nullptr);
}

TEST_F(WeakTests, CopiesMovesAndAssignmentsToItself) {
  const Ref<Mortal> object = make<Mortal>();
  const Ref<Mortal> other = make<Mortal>();
  Weak<Mortal> weak(object);
  Weak<Mortal>& itself = weak;
  weak = itself;
  EXPECT_EQ(weak.get(), object.get());
  weak = std::move(itself);
  EXPECT_EQ(weak.get(), object.get());
  Weak<Mortal> moved(std::move(weak));
  EXPECT_EQ(weak.get(), nullptr);  // NOLINT(bugprone-use-after-move): it reads as nil
  EXPECT_EQ(moved.get(), object.get());
  weak = moved;
  moved = Weak<Mortal>(other.get());
  EXPECT_EQ(weak.get(), object.get());
  EXPECT_EQ(moved.get(), other.get());
  EXPECT_EQ(Weak<Mortal>(nullptr).get(), nullptr);
}

TEST_F(WeakTests, WhatADestructorSeesOfItsObjectIsNil) {
  Ref<Mortal> object = make<Mortal>();
  Weak<Mortal> weak(object);
  bool wasNil = false;
  object->last = [&] { wasNil = weak.get() == nullptr; };
  object = nullptr;
  EXPECT_TRUE(wasNil) << "a strong reference to a dying object would kill it twice";
}

TEST_F(AttachedValueTests, AValueStaysUnderItsKeyUntilItIsReplacedOrRemoved) {
  const Ref<Mortal> owner = make<Mortal>();
  EXPECT_EQ(owner->attachedValue(kKey), nullptr);
  owner->attachValue(kKey, nullptr);
  const Ref<Mortal> first = make<Mortal>();
  owner->attachValue(kKey, first);
  owner->attachValue(kOtherKey, make<Mortal>());
  EXPECT_EQ(owner->attachedValue(kKey), first.get());
  EXPECT_EQ(first->referenceCount(), 2U);
  owner->attachValue(kKey, first);  // itself
  EXPECT_EQ(first->referenceCount(), 2U);
  owner->attachValue(kKey, make<Mortal>());
  EXPECT_EQ(first->referenceCount(), 1U);
  EXPECT_EQ(alive, 4);
  owner->attachValue(kKey, nullptr);
  EXPECT_EQ(owner->attachedValue(kKey), nullptr);
  EXPECT_NE(owner->attachedValue(kOtherKey), nullptr);
  EXPECT_EQ(alive, 3);
}

TEST_F(AttachedValueTests, TheDestructorOfAReplacedValueMayUseTheOwner) {
  for (const bool removes : {false, true}) {
    const Ref<Mortal> owner = make<Mortal>();
    const Ref<Mortal> replacement = removes ? nullptr : make<Mortal>();
    const Object* seen = owner.get();
    {
      const Ref<Mortal> value = make<Mortal>();
      value->last = [&] {
        seen = owner->attachedValue(kKey);
        for (std::uint64_t key = 1; key < 100; ++key) {  // moves what is attached elsewhere
          owner->attachValue(key, make<Mortal>());
        }
      };
      owner->attachValue(kOtherKey, make<Mortal>());
      owner->attachValue(kKey, value);
    }
    owner->attachValue(kKey, replacement);
    EXPECT_EQ(seen, replacement.get()) << "the new value is in place when the old one leaves";
    EXPECT_EQ(owner->attachedValue(kKey), replacement.get());
    EXPECT_NE(owner->attachedValue(kOtherKey), nullptr);
    EXPECT_NE(owner->attachedValue(99), nullptr);
  }
}

TEST_F(AttachedValueTests, WhatIsAttachedToADyingOwnerGoesWithIt) {
  Ref<Mortal> owner = make<Mortal>();
  Mortal* const dying = owner.get();
  const Ref<Mortal> value = make<Mortal>();
  {
    const Ref<Mortal> first = make<Mortal>();
    first->last = [&] { dying->attachValue(kOtherKey, make<Mortal>()); };
    owner->attachValue(kKey, first);
  }
  owner = nullptr;
  EXPECT_EQ(alive, 1);
}

}  // namespace
}  // namespace tavro
