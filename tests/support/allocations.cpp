#include "support/allocations.h"

#include <atomic>
#include <cstdlib>
#include <new>

namespace {

std::atomic<std::uint64_t> allocated = 0;

void* countedBlock(std::size_t size) {
  allocated.fetch_add(size, std::memory_order_relaxed);
  return std::malloc(size == 0 ? 1 : size);
}

void* countedBlockOrFailure(std::size_t size) {
  if (void* block = countedBlock(size)) return block;
  throw std::bad_alloc();
}

}  // namespace

std::uint64_t vesk::allocatedBytes() {
  return allocated.load(std::memory_order_relaxed);
}

void* operator new(std::size_t size) {
  return countedBlockOrFailure(size);
}
void* operator new[](std::size_t size) {
  return countedBlockOrFailure(size);
}
void* operator new(std::size_t size, const std::nothrow_t& /*tag*/) noexcept {
  return countedBlock(size);
}
void* operator new[](std::size_t size, const std::nothrow_t& /*tag*/) noexcept {
  return countedBlock(size);
}
void operator delete(void* block) noexcept {
  std::free(block);
}
void operator delete[](void* block) noexcept {
  std::free(block);
}
void operator delete(void* block, std::size_t /*size*/) noexcept {
  std::free(block);
}
void operator delete[](void* block, std::size_t /*size*/) noexcept {
  std::free(block);
}
