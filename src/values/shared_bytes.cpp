#include "values/shared_bytes.h"

#include <cstring>
#include <new>
#include <stdexcept>

#include "values/recycled_memory.h"

namespace vesk {

SharedBytes SharedBytes::copy(std::string_view bytes) {
  if (bytes.empty()) return {};
  if (bytes.size() > UINT32_MAX) throw std::length_error("text or data beyond 4 GiB");
  void* storage = RecycledMemory::allocate(sizeof(Block) + bytes.size());
  char* content = static_cast<char*>(storage) + sizeof(Block);
  std::memcpy(content, bytes.data(), bytes.size());
  return SharedBytes(new (storage) Block{content, static_cast<std::uint32_t>(bytes.size()), 1});
}

void SharedBytes::release() noexcept {
  Block* const released = block();
  if (released->owners.fetch_sub(1, std::memory_order_acq_rel) == 1) {
    const std::size_t size = sizeof(Block) + released->size;
    released->~Block();
    RecycledMemory::release(released, size);
  }
}

}  // namespace vesk
