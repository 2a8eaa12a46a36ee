#include <new>

#include "app/command_line.h"

int main(int argc, char** argv) {
  try {
    return static_cast<int>(vesk::runCommandLine(argc, argv));
  } catch (const std::bad_alloc&) {
    vesk::tellUser("vesk: out of memory");
    return static_cast<int>(vesk::Outcome::failed);
  }
}
