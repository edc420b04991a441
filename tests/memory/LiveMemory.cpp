#include "tests/memory/LiveMemory.h"

#include <malloc.h>

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

std::atomic<std::size_t> liveBlocks = 0;
std::atomic<std::size_t> liveBytes = 0;

void* counted(void* block) {
  if (block == nullptr) {
    throw std::bad_alloc();
  }
  ++liveBlocks;
  liveBytes += malloc_usable_size(block);
  return block;
}

void release(void* block) noexcept {
  if (block != nullptr) {
    --liveBlocks;
    liveBytes -= malloc_usable_size(block);
    std::free(block);
  }
}

std::size_t rounded(std::size_t size, std::align_val_t alignment) {
  const auto unit = static_cast<std::size_t>(alignment);
  return (size + unit - 1) / unit * unit;
}

}  // namespace

// The array forms call these, unless a sanitizer has its own.
void* operator new(std::size_t size) { return counted(std::malloc(size == 0 ? 1 : size)); }
void* operator new(std::size_t size, const std::nothrow_t& /*tag*/) noexcept {
  void* const block = std::malloc(size == 0 ? 1 : size);
  return block == nullptr ? nullptr : counted(block);
}
void* operator new(std::size_t size, std::align_val_t alignment) {
  return counted(std::aligned_alloc(static_cast<std::size_t>(alignment), rounded(size, alignment)));
}
void operator delete(void* block) noexcept { release(block); }
void operator delete(void* block, std::size_t /*size*/) noexcept { release(block); }
void operator delete(void* block, std::align_val_t /*alignment*/) noexcept { release(block); }
void operator delete(void* block, std::size_t /*size*/, std::align_val_t /*alignment*/) noexcept {
  release(block);
}

namespace tavro {

LiveMemory LiveMemory::now() { return {liveBlocks, liveBytes}; }

}  // namespace tavro
