#include "platform/foundation/NSArray.h"

#include <string>

namespace tavro {

id NSArray::objectAtIndex(std::int64_t index) const {
  if (index < 0 || static_cast<std::size_t>(index) >= objects_.size()) {
    raise(kRangeException, "the index " + std::to_string(index) + " lies outside an array of " +
                               std::to_string(objects_.size()));
  }
  return objects_[static_cast<std::size_t>(index)];
}

void NSMutableArray::addObject(const id& object) {
  if (!object) {
    raise(kInvalidArgumentException, "an array cannot hold nil");
  }
  objects_.push_back(object);
}

void NSMutableArray::axSafelyAddObject(const id& object) {
  if (object) {
    objects_.push_back(object);
  }
}

Ref<NSArray> arrayWithObjects(std::vector<id> objects) {
  std::erase(objects, id());
  Ref<NSArray> array = make<NSArray>();
  array->initWithObjects(std::move(objects));
  return array;
}

Ref<NSMutableArray> mutableArray(std::size_t capacity) {
  Ref<NSMutableArray> array = make<NSMutableArray>();
  array->reserve(capacity);
  return array;
}

namespace {

std::int64_t count(NSArray* self) { return static_cast<std::int64_t>(self->count()); }

const Registered kArray = defineClass<NSArray, NSObject>()
                              .method<&count>("count")
                              .method<&NSArray::objectAtIndex>("objectAtIndex:")
                              .method<&NSArray::firstObject>("firstObject");
const Registered kMutableArray = defineClass<NSMutableArray, NSArray>();

}  // namespace
}  // namespace tavro
