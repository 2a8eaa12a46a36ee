#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace vesk::diag {

/// The commands that are ever given to a modem: it is asked what it is and told which logs to send. Nothing else can be
/// made into a Command, and a port sends nothing but Commands.
enum class Request {
  version,
  firmware,
  eventsOff,
  debugMessagesOff,
  logsOff,
  /// How many items each equipment has.
  logSizes,
  /// Which items of one equipment are to be logged.
  logMask,
};

class Command {
 public:
  /// Any but a log mask.
  [[nodiscard]] static Command make(Request request);
  /// Asks for the items of `codes` that belong to `equipment` and are below `itemCount`, and for no others of it.
  [[nodiscard]] static Command makeLogMask(std::uint32_t equipment, std::uint32_t itemCount,
                                           std::span<const std::uint16_t> codes);

  [[nodiscard]] Request request() const { return request_; }
  /// The equipment of a log mask.
  [[nodiscard]] std::uint32_t equipment() const { return equipment_; }
  /// As it goes over the wire.
  [[nodiscard]] std::span<const std::uint8_t> frame() const { return frame_; }

  /// Whether a frame's content answers this command, with what it asked for or with a refusal.
  [[nodiscard]] bool isAnsweredBy(std::span<const std::uint8_t> content) const;

 private:
  Command(Request request, std::uint32_t equipment, std::vector<std::uint8_t> content);

  Request request_;
  std::uint32_t equipment_;
  std::vector<std::uint8_t> content_;
  std::vector<std::uint8_t> frame_;
};

/// What an answer says.
struct Answer {
  enum class Kind {
    done,
    /// The modem does not know the command, or is locked against it.
    locked,
    refused,
  };

  Kind kind;
  /// For a refused log command: its status, other than 0; else the byte that refuses.
  std::uint32_t status = 0;
  /// For Request::logSizes: the number of items by equipment.
  std::vector<std::uint32_t> sizes{};
  /// For Request::firmware: what the firmware calls itself, without what a terminal would heed.
  std::string text{};
};

[[nodiscard]] Answer readAnswer(const Command& command, std::span<const std::uint8_t> content);

}  // namespace vesk::diag
