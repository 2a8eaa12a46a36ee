#pragma once

#include <optional>

#include "recording/byte_input.h"

namespace vesk::diag {

/// What a file or pipe holds, told by its bytes.
enum class Content {
  nothing,
  /// A capture: frames, as they come from a diagnostic port (QMDL and the like).
  frames,
  /// A capture: log packets without frames (DLF).
  packetList,
  /// Lines of JSON.
  recording,
  /// Other text.
  text,
  /// What other programs capture from networks.
  networkCapture,
  archive,
  unknown,
};

/// How the packets of a capture stand in it.
enum class CaptureForm { frames, packetList };

/// Looks as far ahead in `input`, of which nothing was taken yet, as it needs to, a MiB at most, and takes nothing. A
/// pipe is waited for. Frames are found also behind what is none, as where a capture begins within one.
[[nodiscard]] Content tellContent(ByteInput& input);

/// None for what is no capture.
[[nodiscard]] std::optional<CaptureForm> captureFormOf(Content content);

/// What a file is that holds neither a capture nor a recording, and what to do: "is an archive, …". Null for one that
/// may.
[[nodiscard]] const char* whyUnreadable(Content content);

}  // namespace vesk::diag
