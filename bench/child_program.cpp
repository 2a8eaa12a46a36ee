#include "bench/child_program.h"

#include <chrono>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include "bench/stop.h"

namespace vesk::bench {

namespace {

double seconds(const timeval& time) {
  return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) / 1e6;
}

/// Standard input and output on nothing.
class SilentActions {
 public:
  SilentActions() {
    posix_spawn_file_actions_init(&actions_);
    posix_spawn_file_actions_addopen(&actions_, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_addopen(&actions_, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
  }
  SilentActions(const SilentActions&) = delete;
  SilentActions& operator=(const SilentActions&) = delete;
  ~SilentActions() { posix_spawn_file_actions_destroy(&actions_); }

  [[nodiscard]] const posix_spawn_file_actions_t* get() const { return &actions_; }

 private:
  posix_spawn_file_actions_t actions_{};
};

}  // namespace

Usage runToEnd(const std::vector<std::string>& command) {
  using Clock = std::chrono::steady_clock;
  std::vector<char*> arguments;
  arguments.reserve(command.size() + 1);
  for (const std::string& argument : command)
    arguments.push_back(const_cast<char*>(argument.c_str()));
  arguments.push_back(nullptr);
  const SilentActions actions;

  const Clock::time_point began = Clock::now();
  pid_t process = 0;
  const int error = posix_spawn(&process, arguments[0], actions.get(), nullptr, arguments.data(), environ);
  if (error != 0) stop(command[0] + ": " + std::strerror(error));
  int status = 0;
  rusage used{};
  while (wait4(process, &status, 0, &used) < 0 && errno == EINTR) {
  }
  const std::chrono::duration<double> wall = Clock::now() - began;
  if (!WIFEXITED(status) || WEXITSTATUS(status) != 0) stop(command[0] + ": failed");
  return {seconds(used.ru_utime) + seconds(used.ru_stime), wall.count(), used.ru_maxrss};
}

}  // namespace vesk::bench
