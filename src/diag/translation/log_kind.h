#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "diag/layout/version.h"
#include "diag/packet.h"

namespace vesk::diag {

class EventBatch;
struct SimState;

/// Reads a packet, adds its events, and changes what is known of its SIM. A damaged packet changes nothing; what it has
/// added is not used. A packet that says a version is never empty.
using ReadLog = Reading (*)(const LogPacket& packet, SimState& sim, EventBatch& events);

/// Where a packet says which version of its layout it has.
enum class VersionPlace { none, firstByte, twoBitsOfFirstByte };

/// One log code that is read, in the order of the table's columns.
// NOLINTNEXTLINE(clang-analyzer-optin.performance.Padding)
struct LogKind {
  std::uint16_t code;
  std::string_view name;
  ReadLog read;
  /// What is read of it.
  Versions (*versions)();
  VersionPlace versionPlace = VersionPlace::firstByte;
};

/// All of them, in the order of their codes.
[[nodiscard]] std::span<const LogKind> logKinds();
/// The kind of a code, or null when it is not read.
[[nodiscard]] const LogKind* findLogKind(std::uint16_t code);

/// The version that a packet says. The packets of a code that is not read are taken to begin with their version, as
/// most do. Absent for a packet that says none.
[[nodiscard]] std::optional<std::uint8_t> versionOf(const LogPacket& packet);

/// The subpackets of a packet that are not read, in their order. None where its code is not known to be made of any, or
/// they are damaged.
[[nodiscard]] std::vector<Version::Subpacket> unreadSubpacketsOf(const LogPacket& packet);

}  // namespace vesk::diag
