#include "app/output/whole_file.h"

#include <array>
#include <cerrno>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

#include "app/output/outcome.h"

namespace vesk {

namespace {

using Status = struct stat;

bool isSameRegularFile(const Status& one, const Status& other) {
  return S_ISREG(one.st_mode) && one.st_dev == other.st_dev && one.st_ino == other.st_ino;
}

/// With its slash; empty for a file of the current directory.
std::string folderOf(const std::string& path) {
  return path.substr(0, path.rfind('/') + 1);
}

/// Where the links lead from `path`, also when nothing is there.
std::string behindLinks(std::string path) {
  constexpr int kMostLinks = 40;
  std::array<char, PATH_MAX> link;
  for (int count = 0; count < kMostLinks; ++count) {
    const ssize_t size = readlink(path.c_str(), link.data(), link.size());
    if (size <= 0) return path;
    const std::string next(link.data(), static_cast<std::size_t>(size));
    path = (next.starts_with('/') ? std::string() : folderOf(path)).append(next);
  }
  return path;
}

}  // namespace

WholeFile::WholeFile(const std::optional<std::string>& path)
    : name_(path.value_or("standard output")), file_(FileDescriptor::borrowed(STDOUT_FILENO)) {
  if (path) findPlace(*path);
}

void WholeFile::findPlace(const std::string& path) {
  Status status{};
  const bool isThere = stat(path.c_str(), &status) == 0;
  if (!isThere && (errno != ENOENT || path.empty())) return fail();
  // As /dev/stdout is, whatever that leads to.
  Status output{};
  if (isThere && fstat(STDOUT_FILENO, &output) == 0 && isSameRegularFile(status, output)) return;
  if (isThere && !S_ISREG(status.st_mode)) {
    file_ = FileDescriptor(open(path.c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY));
    if (!file_.isOpen()) fail();
    return;
  }
  target_ = behindLinks(path);
  // Told before a long recording is read, not behind it.
  const std::string folder = folderOf(target_);
  const bool isForbidden = isThere && access(target_.c_str(), W_OK) != 0;
  if (isForbidden || access(folder.empty() ? "." : folder.c_str(), W_OK | X_OK) != 0) fail();
}

WholeFile::~WholeFile() {
  if (!temporary_.empty()) unlink(temporary_.c_str());
}

bool WholeFile::isInput(const std::string& input) const {
  Status read{};
  Status written{};
  if ((input == "-" ? fstat(STDIN_FILENO, &read) : stat(input.c_str(), &read)) != 0) return false;
  const int result = target_.empty() ? fstat(file_.get(), &written) : stat(target_.c_str(), &written);
  return result == 0 && isSameRegularFile(read, written);
}

void WholeFile::begin() {
  if (target_.empty()) return;
  std::string temporary = folderOf(target_) + ".vesk-XXXXXX";
  file_ = FileDescriptor(mkostemp(temporary.data(), O_CLOEXEC));
  if (!file_.isOpen()) return fail();
  temporary_ = std::move(temporary);
}

void WholeFile::write(std::string_view piece) {
  while (!piece.empty() && !hasFailed_) {
    const ssize_t written = ::write(file_.get(), piece.data(), piece.size());
    if (written >= 0) {
      piece.remove_prefix(static_cast<std::size_t>(written));
    } else if (errno != EINTR) {
      fail();
    }
  }
}

void WholeFile::commit() {
  if (temporary_.empty() || hasFailed_) return;
  // Without the first, a loss of power could leave an empty file in its place.
  if (fsync(file_.get()) != 0 || rename(temporary_.c_str(), target_.c_str()) != 0) return fail();
  temporary_.clear();
}

void WholeFile::fail() {
  hasFailed_ = true;
  tellUser("vesk: " + name_ + ": " + std::generic_category().message(errno));
}

}  // namespace vesk
