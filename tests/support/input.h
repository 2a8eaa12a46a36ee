#pragma once

#include <fcntl.h>
#include <gtest/gtest.h>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

#include "system/file_descriptor.h"

namespace vesk {

inline void writeAll(const FileDescriptor& descriptor, std::string_view bytes) {
  ASSERT_EQ(write(descriptor.get(), bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
}

/// A file without a name, holding `content`, read from its start.
inline FileDescriptor fileWith(std::string_view content) {
  FileDescriptor file(memfd_create("vesk-test", MFD_CLOEXEC));
  writeAll(file, content);
  lseek(file.get(), 0, SEEK_SET);
  return file;
}

struct Pipe {
  Pipe() {
    int ends[2];
    EXPECT_EQ(pipe2(ends, O_CLOEXEC), 0);
    reading = FileDescriptor(ends[0]);
    writing = FileDescriptor(ends[1]);
  }

  FileDescriptor reading;
  FileDescriptor writing;
};

}  // namespace vesk
