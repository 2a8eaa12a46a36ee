#pragma once

#include <cstdlib>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <optional>
#include <poll.h>
#include <string>
#include <termios.h>
#include <unistd.h>
#include <vector>

#include "diag/framing/frame_reader.h"
#include "support/bytes.h"
#include "system/file_descriptor.h"

namespace vesk::diag {

/// A modem behind a pseudo-terminal, whose every answer the test gives. Its port stays under one name while it is
/// unplugged and plugged in again.
class Modem {
 public:
  Modem() { plugIn(); }
  ~Modem() { unlink(path().c_str()); }
  Modem(const Modem&) = delete;
  Modem& operator=(const Modem&) = delete;

  [[nodiscard]] std::string path() const { return "/tmp/vesk-modem-" + std::to_string(getpid()); }

  void plugIn() {
    end_ = FileDescriptor(posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC));
    grantpt(end_.get());
    unlockpt(end_.get());
    unlink(path().c_str());
    ASSERT_EQ(symlink(ptsname(end_.get()), path().c_str()), 0);
    frames_ = {};
  }
  void unplug() {
    unlink(path().c_str());
    end_ = FileDescriptor();
  }

  /// The content of the next frame that the program sends; "nothing" when none comes within ten seconds, which is
  /// never.
  [[nodiscard]] std::string next() {
    for (;;) {
      if (const auto frame = frames_.next()) return frame->isSound ? hexOf(frame->content) : "damaged";
      pollfd waited{end_.get(), POLLIN, 0};
      if (poll(&waited, 1, 10000) != 1) return "nothing";
      const ssize_t count = read(end_.get(), received_.data(), received_.size());
      if (count <= 0) return "nothing";
      frames_.take(std::span(received_).first(static_cast<std::size_t>(count)));
    }
  }
  void send(std::string_view content) const {
    Bytes frame;
    appendFrame(frame, bytesOf(content));
    sendBytes(frame);
  }
  void sendBytes(const Bytes& bytes) const {
    ASSERT_EQ(write(end_.get(), bytes.data(), bytes.size()), static_cast<ssize_t>(bytes.size()));
  }

  /// Answers everything until the logs of LTE were asked for.
  void answerUntilItWatches() {
    for (;;) {
      const std::string command = next();
      if (command == "00")
        send("00 31 32");
      else if (command == "7C")
        send("7C 01");
      else if (command == "60 00")
        send("60 00 00");
      else if (command.starts_with("7D 05"))
        send("7D 05 01 00 00 00 00 00");
      else if (command.starts_with("73 00 00 00 00"))
        send(command + " 00 00 00 00");
      else if (command.starts_with("73 00 00 00 01"))
        send(command + repeated(12, " 00 00 00 00") + " FF 01 00 00" + repeated(4, " 00 00 00 00"));
      else {
        ASSERT_TRUE(command.starts_with("73 00 00 00 03 00 00 00 0B")) << command;
        send("73 00 00 00 03 00 00 00 00 00 00 00 0B 00 00 00");
        return;
      }
    }
  }

 private:
  FileDescriptor end_;
  FrameReader frames_;
  Bytes received_ = Bytes(4096);
};

}  // namespace vesk::diag
