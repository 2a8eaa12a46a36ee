#include "recording/byte_input.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>
#include <zlib.h>

namespace vesk {

namespace {

constexpr std::size_t kAtOnce = std::size_t{64} << 10;
/// The first look is a short one, which mostly suffices.
constexpr std::size_t kFirst = std::size_t{4} << 10;
/// What every member that gzip writes begins with.
constexpr std::array<std::uint8_t, 3> kCompressed = {0x1F, 0x8B, 0x08};

FileDescriptor openForReading(const std::string& path) {
  if (path == "-") return FileDescriptor::borrowed(STDIN_FILENO);
  return FileDescriptor(open(path.c_str(), O_RDONLY | O_CLOEXEC));
}

/// A directory can be opened, and fails only when it is read.
const char* whyUnreadable(const FileDescriptor& descriptor) {
  struct stat status {};
  if (!descriptor.isOpen() || fstat(descriptor.get(), &status) != 0) return std::strerror(errno);
  return S_ISDIR(status.st_mode) ? std::strerror(EISDIR) : nullptr;
}

/// read(2), carried on after a signal and, on a descriptor that does not block, once there is something.
ssize_t readSome(int descriptor, std::span<std::uint8_t> place) {
  for (;;) {
    const ssize_t count = ::read(descriptor, place.data(), place.size());
    if (count >= 0 || (errno != EINTR && errno != EAGAIN)) return count;
    if (errno == EAGAIN) {
      pollfd waited{descriptor, POLLIN, 0};
      poll(&waited, 1, -1);
    }
  }
}

}  // namespace

/// What zlib knows between two reads.
class ByteInput::Unpacking {
 public:
  /// `start` is at most as long as room().
  explicit Unpacking(std::span<const std::uint8_t> start) {
    constexpr int kGzip = 16;
    if (inflateInit2(&stream_, MAX_WBITS + kGzip) != Z_OK) throw std::bad_alloc();
    std::copy(start.begin(), start.end(), packed_.begin());
    setInput(start.size());
  }
  ~Unpacking() { inflateEnd(&stream_); }
  Unpacking(const Unpacking&) = delete;
  Unpacking& operator=(const Unpacking&) = delete;

  /// Where packed bytes are to be put, when all before were used up.
  [[nodiscard]] std::span<std::uint8_t> room() { return packed_; }
  void setInput(std::size_t size) {
    stream_.next_in = packed_.data();
    stream_.avail_in = static_cast<uInt>(size);
  }

  /// Puts into `place` what it can: nothing when more packed bytes are needed. Absent when they are damaged.
  [[nodiscard]] std::optional<std::size_t> unpack(std::span<std::uint8_t> place) {
    stream_.next_out = place.data();
    stream_.avail_out = static_cast<uInt>(place.size());
    while (stream_.avail_out > 0) {
      if (isBetweenMembers_ && !beginMember()) break;
      const int status = inflate(&stream_, Z_NO_FLUSH);
      if (status == Z_BUF_ERROR) break;
      if (status == Z_MEM_ERROR) throw std::bad_alloc();
      if (status != Z_OK && status != Z_STREAM_END) {
        // It fails again at the next call: what stands before the damage goes first.
        if (stream_.avail_out < place.size()) break;
        return std::nullopt;
      }
      isBetweenMembers_ = status == Z_STREAM_END;
    }
    return place.size() - stream_.avail_out;
  }

  /// Whether the input may end here.
  [[nodiscard]] bool isWhole() const { return isBetweenMembers_; }

 private:
  /// False where none begins: what stands behind the last one is no part of what was packed.
  bool beginMember() {
    if (stream_.avail_in == 0) return false;
    hasEnded_ = hasEnded_ || *stream_.next_in != kCompressed.front();
    if (hasEnded_) {
      stream_.avail_in = 0;
      return false;
    }
    isBetweenMembers_ = false;
    inflateReset(&stream_);
    return true;
  }

  z_stream stream_{};
  std::array<std::uint8_t, kAtOnce> packed_;
  bool isBetweenMembers_ = false;
  bool hasEnded_ = false;
};

ByteInput::ByteInput(const std::string& path)
    : ByteInput(openForReading(path), path == "-" ? "standard input" : path) {}

ByteInput::ByteInput(FileDescriptor descriptor, std::string name)
    : descriptor_(std::move(descriptor)), name_(std::move(name)) {
  if (const char* reason = whyUnreadable(descriptor_)) fail(reason);
}

ByteInput::ByteInput(ByteInput&& other) noexcept = default;
ByteInput& ByteInput::operator=(ByteInput&& other) noexcept = default;
ByteInput::~ByteInput() = default;

std::size_t ByteInput::read(std::span<std::uint8_t> place) {
  begin();
  if (ahead_.empty()) return readOn(place);
  const std::size_t count = std::min(place.size(), ahead_.size() - taken_);
  std::copy_n(ahead_.data() + taken_, count, place.data());
  taken_ += count;
  if (taken_ == ahead_.size()) {
    ahead_ = {};
    taken_ = 0;
  }
  return count;
}

std::span<const std::uint8_t> ByteInput::lookFurther() {
  const std::size_t before = ahead_.size();
  begin();
  if (ahead_.size() == before) {
    ahead_.resize(before + kAtOnce);
    ahead_.resize(before + readOn(std::span(ahead_).subspan(before)));
  }
  return ahead_;
}

void ByteInput::begin() {
  while (!hasBegun_) {
    const std::size_t before = ahead_.size();
    ahead_.resize(before + kFirst);
    const std::size_t count = readRaw(std::span(ahead_).subspan(before)).value_or(0);
    ahead_.resize(before + count);
    if (ahead_.empty()) return;
    const std::size_t known = std::min(ahead_.size(), kCompressed.size());
    const bool mayBeCompressed =
        std::equal(ahead_.begin(), ahead_.begin() + static_cast<std::ptrdiff_t>(known), kCompressed.begin());
    if (mayBeCompressed && known < kCompressed.size() && count > 0) continue;
    hasBegun_ = true;
    if (mayBeCompressed && known == kCompressed.size()) {
      unpacking_ = std::make_unique<Unpacking>(ahead_);
      ahead_ = {};
    }
  }
}

std::size_t ByteInput::readOn(std::span<std::uint8_t> place) {
  return unpacking_ == nullptr ? readRaw(place).value_or(0) : readUnpacked(place);
}

std::size_t ByteInput::readUnpacked(std::span<std::uint8_t> place) {
  for (;;) {
    const std::optional<std::size_t> count = unpacking_->unpack(place);
    if (!count) {
      fail("its compressed data are damaged");
      return 0;
    }
    if (*count > 0) return *count;
    const std::optional<std::size_t> packed = readRaw(unpacking_->room());
    if (!packed) return 0;
    if (*packed == 0) {
      if (!failure_ && !unpacking_->isWhole()) fail("its compressed data are cut off");
      return 0;
    }
    unpacking_->setInput(*packed);
  }
}

std::optional<std::size_t> ByteInput::readRaw(std::span<std::uint8_t> place) {
  if (failure_) return 0;
  if (beforeRead_ && !beforeRead_(descriptor_.get())) return std::nullopt;
  const ssize_t count = readSome(descriptor_.get(), place);
  if (count >= 0) return static_cast<std::size_t>(count);
  fail(std::strerror(errno));
  return 0;
}

void ByteInput::fail(const std::string& reason) {
  failure_ = name_ + ": " + reason;
}

bool ByteInput::rewind() {
  if (lseek(descriptor_.get(), 0, SEEK_SET) != 0) return false;
  ahead_ = {};
  taken_ = 0;
  hasBegun_ = false;
  unpacking_.reset();
  failure_.reset();
  return true;
}

}  // namespace vesk
