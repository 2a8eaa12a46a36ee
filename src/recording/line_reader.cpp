#include "recording/line_reader.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace vesk {

namespace {

constexpr std::size_t kUsualCapacity = std::size_t{256} << 10;

}  // namespace

LineReader::LineReader(ByteInput input, std::size_t padding, std::size_t longestLine)
    : input_(std::move(input)),
      padding_(padding),
      longestLine_(longestLine),
      buffer_(std::make_unique_for_overwrite<char[]>(std::min(kUsualCapacity, longestLine + 1) + padding)),
      capacity_(std::min(kUsualCapacity, longestLine + 1)) {}

LineReader::Found LineReader::next() {
  for (;;) {
    const char* unscanned = buffer_.get() + scanned_;
    if (const void* lineFeed = std::memchr(unscanned, '\n', end_ - scanned_)) {
      const auto end = static_cast<std::size_t>(static_cast<const char*>(lineFeed) - buffer_.get());
      return take(end, end + 1);
    }
    scanned_ = end_;
    switch (refill()) {
      case Input::more:
        break;
      case Input::end:
        if (begin_ < end_ || isPassingOver_) return take(end_, end_);
        return Found::end;
      case Input::failure:
        return Found::failure;
    }
  }
}

LineReader::Found LineReader::take(std::size_t end, std::size_t next) {
  line_ = {buffer_.get() + begin_, end - begin_};
  begin_ = scanned_ = next;
  ++lineNumber_;
  if (isPassingOver_ || line_.size() > longestLine_) {
    isPassingOver_ = false;
    line_ = {};
    return Found::tooLongLine;
  }
  return Found::line;
}

LineReader::Input LineReader::refill() {
  makeRoom();
  const std::size_t count = input_.read({reinterpret_cast<std::uint8_t*>(buffer_.get()) + end_, capacity_ - end_});
  if (count == 0) return input_.failure() ? Input::failure : Input::end;
  end_ += count;
  return Input::more;
}

void LineReader::makeRoom() {
  if (begin_ > 0) {
    std::memmove(buffer_.get(), buffer_.get() + begin_, end_ - begin_);
    end_ -= begin_;
    begin_ = 0;
  }
  if (isPassingOver_ || end_ > longestLine_) {
    isPassingOver_ = true;
    end_ = 0;
  } else if (end_ == capacity_) {
    const std::size_t capacity = std::min(2 * capacity_, longestLine_ + 1);
    auto grown = std::make_unique_for_overwrite<char[]>(capacity + padding_);
    std::memcpy(grown.get(), buffer_.get(), end_);
    buffer_ = std::move(grown);
    capacity_ = capacity;
  }
  scanned_ = end_;
}

bool LineReader::rewind() {
  if (!input_.rewind()) return false;
  begin_ = scanned_ = end_ = 0;
  isPassingOver_ = false;
  line_ = {};
  lineNumber_ = 0;
  return true;
}

}  // namespace vesk
