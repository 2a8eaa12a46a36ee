#include "diag/framing/frame_reader.h"

#include <algorithm>
#include <cstring>

#include "diag/framing/checksum.h"

namespace vesk::diag {

namespace {

using Bytes = std::span<const std::uint8_t>;

/// The place of the first `byte`; the size where there is none.
std::size_t find(Bytes bytes, std::uint8_t byte) {
  if (bytes.empty()) return 0;
  const void* found = std::memchr(bytes.data(), byte, bytes.size());
  if (found == nullptr) return bytes.size();
  return static_cast<std::size_t>(static_cast<const std::uint8_t*>(found) - bytes.data());
}

}  // namespace

std::optional<Frame> FrameReader::next() {
  if (isBegunDone_) {
    begun_.clear();
    isBegunDone_ = false;
  }
  while (!rest_.empty()) {
    const std::size_t end = find(rest_, kFrameEnd);
    Bytes piece = rest_.first(end);
    const bool isClosed = end < rest_.size();
    rest_ = rest_.subspan(isClosed ? end + 1 : end);
    if (!isClosed || !begun_.empty()) keep(piece);
    if (!isClosed) break;
    if (!begun_.empty()) {
      piece = begun_;
      isBegunDone_ = true;
    }
    if (!piece.empty()) return read(piece);
  }
  return std::nullopt;
}

bool FrameReader::endsWithinFrame() {
  const bool isCutOff = !isBegunDone_ && !begun_.empty();
  begun_.clear();
  isBegunDone_ = false;
  return isCutOff;
}

void FrameReader::keep(Bytes bytes) {
  bytes = bytes.first(std::min(bytes.size(), kLongestFrame + 1 - begun_.size()));
  begun_.insert(begun_.end(), bytes.begin(), bytes.end());
}

Frame FrameReader::read(Bytes piece) {
  constexpr Frame kDamaged{false, {}};
  if (piece.size() > kLongestFrame) return kDamaged;
  const std::optional<Bytes> bytes = unescape(piece);
  if (!bytes || bytes->size() <= kChecksumSize) return kDamaged;
  const Bytes content = bytes->first(bytes->size() - kChecksumSize);
  const Bytes sum = bytes->last(kChecksumSize);
  if (checksum(content) != (sum[0] | sum[1] << 8)) return kDamaged;
  return {true, content};
}

std::optional<Bytes> FrameReader::unescape(Bytes piece) {
  std::size_t escape = find(piece, kEscape);
  if (escape == piece.size()) return piece;
  unescaped_.resize(piece.size());
  std::uint8_t* out = unescaped_.data();
  while (escape < piece.size()) {
    if (escape + 1 == piece.size() || piece[escape + 1] == kEscape) return std::nullopt;
    std::copy_n(piece.data(), escape, out);
    out += escape;
    *out++ = piece[escape + 1] ^ kEscapedBit;
    piece = piece.subspan(escape + 2);
    escape = find(piece, kEscape);
  }
  out = std::copy_n(piece.data(), piece.size(), out);
  return Bytes(unescaped_.data(), out);
}

}  // namespace vesk::diag
