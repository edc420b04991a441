// Counts what the program and the libraries that it loads allocate. ICU has an allocator of its
// own, so what its formatting takes is left out.

#include <cstdlib>
#include <new>

#include "bench/Bench.h"

namespace {

// Of one thread: the benchmarks use one.
thread_local std::size_t allocations = 0;

}  // namespace

std::size_t tavro::bench::allocationCount() { return allocations; }

void* operator new(std::size_t size) {
  ++allocations;
  if (void* const memory = std::malloc(size)) {
    return memory;
  }
  throw std::bad_alloc();
}
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t /*size*/) noexcept { std::free(memory); }
