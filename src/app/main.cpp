#include <fcntl.h>
#include <new>
#include <unistd.h>

#include "app/command_line.h"

namespace {

/// Whatever the program opens must not come to stand where standard input or output is expected: a descriptor that the
/// program was started without is opened on nothing.
void openMissingStandardDescriptors() {
  for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
    if (fcntl(descriptor, F_GETFD) < 0) open("/dev/null", O_RDWR);
  }
}

}  // namespace

int main(int argc, char** argv) {
  openMissingStandardDescriptors();
  try {
    return static_cast<int>(vesk::runCommandLine(argc, argv));
  } catch (const std::bad_alloc&) {
    vesk::tellUser("vesk: out of memory");
    return static_cast<int>(vesk::Outcome::failed);
  }
}
