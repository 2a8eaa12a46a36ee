#include "system/file.h"

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>
#include <vector>

namespace vesk {

namespace {

constexpr std::size_t kMost = std::size_t{256} << 20;
constexpr std::size_t kChunk = 65536;

}  // namespace

std::optional<Data> readFile(const std::string& path) {
  const FileDescriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC));
  if (!file.isOpen()) return std::nullopt;
  std::vector<std::uint8_t> content;
  std::array<std::uint8_t, kChunk> chunk;
  for (;;) {
    const ssize_t count = read(file.get(), chunk.data(), chunk.size());
    if (count < 0 && errno == EINTR) continue;
    if (count < 0) return std::nullopt;
    if (count == 0) return Data::copy(content);
    content.insert(content.end(), chunk.data(), chunk.data() + count);
    if (content.size() > kMost) {
      errno = EFBIG;
      return std::nullopt;
    }
  }
}

FileDescriptor openUnblocked(int descriptor) {
  // The path of the other side of a pseudo terminal opens a new one.
  int number = 0;
  const bool isOtherSide = ioctl(descriptor, TIOCGPTN, &number) == 0;
  if (isatty(descriptor) != 1 || isOtherSide) return {};
  const std::string path = "/proc/self/fd/" + std::to_string(descriptor);
  return FileDescriptor(open(path.c_str(), O_WRONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
}

}  // namespace vesk
