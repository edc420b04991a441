#pragma once

#include <initializer_list>
#include <vector>

#include "platform/foundation/NSObject.h"

namespace tavro {

/// An ordered list of objects, none of them nil. Messages: `count` ("q"), `objectAtIndex:` ("@,q";
/// raises a range exception outside the list), `firstObject` (nil when empty).
class NSArray : public NSObject {
 public:
  static constexpr Name className = "NSArray";

  [[nodiscard]] std::size_t count() const { return objects_.size(); }
  /// Unchecked: the index must lie within the list.
  [[nodiscard]] const id& operator[](std::size_t index) const { return objects_[index]; }
  [[nodiscard]] auto begin() const { return objects_.begin(); }
  [[nodiscard]] auto end() const { return objects_.end(); }
  [[nodiscard]] id firstObject() const { return objects_.empty() ? id() : objects_.front(); }
  /// Raises a range exception outside the list.
  [[nodiscard]] id objectAtIndex(std::int64_t index) const;

  /// Set once, right after allocation.
  void initWithObjects(std::vector<id> objects) { objects_ = std::move(objects); }

 protected:
  std::vector<id> objects_;
};

class NSMutableArray : public NSArray {
 public:
  static constexpr Name className = "NSMutableArray";

  void reserve(std::size_t capacity) { objects_.reserve(capacity); }
  /// Raises for nil.
  void addObject(const id& object);
  /// Adds unless nil.
  void axSafelyAddObject(const id& object);
};

/// An array of those objects that are not nil, in their order.
Ref<NSArray> arrayWithObjects(std::vector<id> objects);
/// The runtime's `axArrayByIgnoringNilElementsWithCount:`; the count is that of the list.
inline Ref<NSArray> axArrayByIgnoringNilElements(std::initializer_list<id> objects) {
  return arrayWithObjects(objects);
}
/// An empty mutable array with room for `capacity` objects.
Ref<NSMutableArray> mutableArray(std::size_t capacity = 0);

}  // namespace tavro
