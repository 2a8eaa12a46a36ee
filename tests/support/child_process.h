#pragma once

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <gtest/gtest.h>
#include <initializer_list>
#include <string>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

#include "support/input.h"
#include "system/file_descriptor.h"

namespace vesk {

/// A program that was started with its own standard input, output and error.
class ChildProcess {
 public:
  /// Reads `input`, writes to `output` and `error`; they may be closed here once it runs.
  ChildProcess(const std::string& program, std::vector<std::string> arguments, const FileDescriptor& input,
               const FileDescriptor& output, const FileDescriptor& error)
      : process_(fork()) {
    if (process_ == 0) become(program, std::move(arguments), input, output, error);
  }
  /// Runs on that terminal, in a session of its own.
  ChildProcess(const std::string& program, std::vector<std::string> arguments, const FileDescriptor& terminal)
      : process_(fork()) {
    if (process_ != 0) return;
    setsid();
    ioctl(terminal.get(), TIOCSCTTY, 0);
    become(program, std::move(arguments), terminal, terminal, terminal);
  }
  ChildProcess(const ChildProcess&) = delete;
  ChildProcess& operator=(const ChildProcess&) = delete;
  ~ChildProcess() {
    if (process_ > 0) waitForExit();
  }

  [[nodiscard]] pid_t id() const { return process_; }
  int endBy(int signal) {
    kill(process_, signal);
    return waitForExit();
  }
  /// Its exit status, or the negative number of the signal that ended it.
  int waitForExit() {
    int status = 0;
    waitpid(process_, &status, 0);
    process_ = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
  }

 private:
  [[noreturn]] static void become(const std::string& program, std::vector<std::string> arguments,
                                  const FileDescriptor& input, const FileDescriptor& output,
                                  const FileDescriptor& error) {
    arguments.insert(arguments.begin(), program);
    std::vector<char*> argv;
    argv.reserve(arguments.size() + 1);
    for (std::string& argument : arguments)
      argv.push_back(argument.data());
    argv.push_back(nullptr);
    dup2(input.get(), STDIN_FILENO);
    dup2(output.get(), STDOUT_FILENO);
    dup2(error.get(), STDERR_FILENO);
    execv(program.c_str(), argv.data());
    _exit(127);
  }

  pid_t process_ = -1;
};

/// What has been written to a file of fileWith() so far.
inline std::string contentOf(const FileDescriptor& file) {
  std::string content(static_cast<std::size_t>(lseek(file.get(), 0, SEEK_END)), '\0');
  EXPECT_EQ(pread(file.get(), content.data(), content.size(), 0), static_cast<ssize_t>(content.size()));
  return content;
}

/// Blocks until the line feed; what came before it, or all there was at the end.
inline std::string readLine(const FileDescriptor& descriptor) {
  std::string line;
  char c = 0;
  while (read(descriptor.get(), &c, 1) == 1 && c != '\n')
    line += c;
  return line;
}

struct Finished {
  int status;
  std::string output;
  std::string error;
};

/// Runs a program over `input` to its end.
inline Finished run(const std::string& program, std::vector<std::string> arguments, std::string_view input = "") {
  const FileDescriptor output = fileWith("");
  const FileDescriptor error = fileWith("");
  const int status = ChildProcess(program, std::move(arguments), fileWith(input), output, error).waitForExit();
  return {status, contentOf(output), contentOf(error)};
}

}  // namespace vesk
