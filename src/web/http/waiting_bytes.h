#pragma once

#include <cstddef>
#include <unordered_map>

#include "web/http/response.h"

namespace vesk::web {

/// How many bytes are held for all visitors together, where a piece that waits for several counts once.
class WaitingBytes {
 public:
  void add(const SharedText& piece) {
    if (++holders_[piece.get()] == 1) bytes_ += piece->size();
  }
  /// A piece that was added.
  void remove(const SharedText& piece) {
    const auto found = holders_.find(piece.get());
    if (--found->second > 0) return;
    holders_.erase(found);
    bytes_ -= piece->size();
  }

  [[nodiscard]] std::size_t bytes() const { return bytes_; }

 private:
  std::unordered_map<const std::string*, std::size_t> holders_;
  std::size_t bytes_ = 0;
};

}  // namespace vesk::web
