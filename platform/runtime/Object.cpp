#include "platform/runtime/Object.h"

#include <vector>

namespace tavro {

/// What few objects need: attached values, and the slot that weak references share.
struct ObjectExtras {
  struct Attached {
    std::uint64_t key;
    id value;
  };
  std::vector<Attached> attached;
  WeakSlot* weak = nullptr;
};

Object::~Object() = default;

void Object::destroy() {
  // More than once when the destructor of an attached value attaches another.
  while (ObjectExtras* const extras = std::exchange(extras_, nullptr)) {
    if (WeakSlot* const weak = extras->weak) {
      weak->object = nullptr;
      if (--weak->references == 0) {
        delete weak;
      }
    }
    delete extras;
  }
  delete this;
}

ObjectExtras& Object::extras() {
  if (extras_ == nullptr) {
    extras_ = new ObjectExtras;
  }
  return *extras_;
}

Object* Object::attachedValue(std::uint64_t key) const {
  if (extras_ != nullptr) {
    for (const ObjectExtras::Attached& entry : extras_->attached) {
      if (entry.key == key) {
        return entry.value.get();
      }
    }
  }
  return nullptr;
}

void Object::attachValue(std::uint64_t key, const id& value) {
  if (!value && extras_ == nullptr) {
    return;
  }
  auto& attached = extras().attached;
  for (auto entry = attached.begin(); entry != attached.end(); ++entry) {
    if (entry->key == key) {
      // The old value leaves last: its destructor may run code that reads this object.
      const id old = std::exchange(entry->value, value);
      if (!value) {
        attached.erase(entry);
      }
      return;
    }
  }
  if (value) {
    attached.push_back({key, value});
  }
}

WeakSlot* Object::weakSlot() {
  ObjectExtras& own = extras();
  if (own.weak == nullptr) {
    own.weak = new WeakSlot{this, 1};
  }
  return own.weak;
}

}  // namespace tavro
