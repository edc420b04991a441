#pragma once

#include <cstddef>

namespace tavro {

/// What the process holds that came from `operator new`, in every room: this program replaces it.
struct LiveMemory {
  std::size_t blocks = 0;
  std::size_t bytes = 0;  ///< as the allocator rounded them up

  [[nodiscard]] static LiveMemory now();
};

}  // namespace tavro
