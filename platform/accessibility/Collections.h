#pragma once

#include <algorithm>
#include <iterator>
#include <utility>
#include <vector>

#include "platform/foundation/NSArray.h"

namespace tavro {

/// The objects for which the test answers YES, in their order; nil for nil.
template <class Test>
Ref<NSArray> ax_filteredArrayUsingBlock(const Ref<NSArray>& array, const Test& test) {
  if (!array) {
    return nullptr;
  }
  std::vector<id> kept;
  std::ranges::copy_if(*array, std::back_inserter(kept), test);
  return arrayWithObjects(std::move(kept));
}

}  // namespace tavro
