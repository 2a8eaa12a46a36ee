#include "system/descriptor_writer.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <fcntl.h>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "system/file.h"

namespace vesk {

namespace {

constexpr std::size_t kMuch = 65536;
/// Milliseconds.
constexpr int kUntilAskedAgain = 10;

bool neverBlocks(int descriptor) {
  struct stat status {};
  const bool isFile = fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode);
  return isFile || (fcntl(descriptor, F_GETFL) & O_NONBLOCK) != 0;
}

/// The same terminal, opened anew, where it would block; any other descriptor as it is.
FileDescriptor unblocked(FileDescriptor descriptor) {
  if (neverBlocks(descriptor.get())) return descriptor;
  FileDescriptor opened = openUnblocked(descriptor.get());
  return opened.isOpen() ? std::move(opened) : std::move(descriptor);
}

}  // namespace

// A pipe that has room at all has room for PIPE_BUF bytes.
DescriptorWriter::DescriptorWriter(FileDescriptor descriptor)
    : descriptor_(unblocked(std::move(descriptor))), chunk_(neverBlocks(descriptor_.get()) ? kMuch : PIPE_BUF) {}

DescriptorWriter::Written DescriptorWriter::write(std::string_view bytes, WaitingPolicy policy) const {
  const bool mayBlock = !policy.end && policy.interrupt == nullptr;
  Written written;
  bool wasRefused = false;
  while (written.count < bytes.size()) {
    if (!mayBlock || wasRefused) {
      const Room room = waitForRoom(policy, wasRefused);
      if (room != Room::some) {
        written.outcome = room == Room::interrupted ? Outcome::interrupted : Outcome::timedOut;
        break;
      }
    }
    const std::string_view rest = bytes.substr(written.count);
    const ssize_t count =
        ::write(descriptor_.get(), rest.data(), mayBlock ? rest.size() : std::min(rest.size(), chunk_));
    wasRefused = count < 0 && errno == EAGAIN;
    if (count >= 0) {
      written.count += static_cast<std::size_t>(count);
      if (policy.end && policy.renewal) {
        policy.end = std::max(*policy.end, std::chrono::steady_clock::now() + *policy.renewal);
      }
    } else if (errno != EINTR && errno != EAGAIN) {
      written.error = errno;
      written.outcome = Outcome::failed;
      break;
    }
  }
  return written;
}

DescriptorWriter::Room DescriptorWriter::waitForRoom(const WaitingPolicy& policy, bool wasRefused) const {
  // A negative descriptor is passed over.
  pollfd polled[] = {{wasRefused ? -1 : descriptor_.get(), POLLOUT, 0},
                     {policy.interrupt != nullptr ? policy.interrupt->descriptor() : -1, POLLIN, 0}};
  for (;;) {
    const int untilEnd = policy.end ? pollTimeout(*policy.end - std::chrono::steady_clock::now()) : -1;
    if (wasRefused && untilEnd == 0) return Room::noneInTime;
    const int count = poll(polled, std::size(polled), wasRefused ? kUntilAskedAgain : untilEnd);
    if (polled[0].revents != 0) return Room::some;
    if (polled[1].revents != 0) return Room::interrupted;
    if (untilEnd == 0) return Room::noneInTime;
    // What poll fails for, the write that follows tells better.
    if (wasRefused || (count < 0 && errno != EINTR)) return Room::some;
  }
}

}  // namespace vesk
