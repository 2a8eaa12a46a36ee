#include "recording/record_file.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace vesk {

std::unique_ptr<RecordFile> RecordFile::create(const std::string& path, std::string& reason) {
  FileDescriptor descriptor(open(path.c_str(), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600));
  struct stat status {};
  if (!descriptor.isOpen() || fstat(descriptor.get(), &status) != 0) {
    reason = path + ": " + std::strerror(errno);
    return nullptr;
  }
  if (S_ISREG(status.st_mode) && status.st_size > 0) {
    reason = path + ": holds something already, which would be lost; choose another name";
    return nullptr;
  }
  return std::unique_ptr<RecordFile>(new RecordFile(std::move(descriptor), path));
}

RecordFile::RecordFile(FileDescriptor descriptor, std::string path)
    : descriptor_(std::move(descriptor)), path_(std::move(path)) {}

bool RecordFile::append(std::string_view piece) {
  if (failure_) return false;
  for (std::string_view left = piece; !left.empty();) {
    const ssize_t count = write(descriptor_.get(), left.data(), left.size());
    if (count < 0 && errno == EINTR) continue;
    if (count < 0) {
      failure_ = path_ + ": " + std::strerror(errno);
      // What was written of the piece goes; a pipe, which has no way back, is no file to be left whole.
      if (ftruncate(descriptor_.get(), size_) != 0 && errno != EINVAL) *failure_ += "; its end is not whole";
      return false;
    }
    left.remove_prefix(static_cast<std::size_t>(count));
  }
  size_ += static_cast<off_t>(piece.size());
  return true;
}

}  // namespace vesk
