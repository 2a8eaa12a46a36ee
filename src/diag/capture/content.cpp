#include "diag/capture/content.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "diag/framing/frame_reader.h"
#include "diag/framing/packet_list_reader.h"
#include "diag/translation/log_kind.h"

namespace vesk::diag {

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::size_t kFarthest = std::size_t{1} << 20;
/// Among so many frames, one must be sound.
constexpr int kFramesToTry = 32;

constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
constexpr std::string_view kBlanks = " \t\r\n";

struct Beginning {
  std::string_view bytes;
  Content content;
};

constexpr Beginning kBeginnings[] = {
    {"\xD4\xC3\xB2\xA1", Content::networkCapture},
    {"\xA1\xB2\xC3\xD4", Content::networkCapture},
    {"\x4D\x3C\xB2\xA1", Content::networkCapture},
    {"\xA1\xB2\x3C\x4D", Content::networkCapture},
    {"\x0A\x0D\x0D\x0A", Content::networkCapture},
    {"PK\x03\x04", Content::archive},
    {"7z\xBC\xAF\x27\x1C", Content::archive},
    {"\xFD"
     "7zXZ",
     Content::archive},
    {"\x28\xB5\x2F\xFD", Content::archive},
    {"BZh", Content::archive},
};

/// Of as many packets without frames, each must be one.
constexpr int kPacketsToTry = 32;
/// 2100: no modem's clock says more. In milliseconds since 1970.
constexpr std::uint64_t kLatestTime = 4'102'444'800'000;

std::string_view asText(Bytes bytes) {
  return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

/// Whether an object begins here, and a key in it.
bool beginsAsEvent(std::string_view line) {
  const std::size_t brace = line.find_first_not_of(kBlanks);
  if (brace == std::string_view::npos || line[brace] != '{') return false;
  const std::size_t quote = line.find_first_not_of(kBlanks, brace + 1);
  return quote != std::string_view::npos && line[quote] == '"';
}

bool hasLineOfRecording(std::string_view text) {
  if (text.starts_with(kByteOrderMark)) text.remove_prefix(kByteOrderMark.size());
  while (!beginsAsEvent(text)) {
    const std::size_t lineFeed = text.find('\n');
    if (lineFeed == std::string_view::npos) return false;
    text.remove_prefix(lineFeed + 1);
  }
  return true;
}

bool isText(Bytes bytes) {
  return std::none_of(bytes.begin(), bytes.end(), [](std::uint8_t byte) {
    return byte == 0x7F || (byte < 0x20 && (byte < '\t' || byte > '\r') && byte != 0x1B);
  });
}

/// Nothing marks a packet: any bytes may be one, but hardly several that follow each other. One that stands alone must
/// be of a code that is read.
bool mayBePacketList(Bytes bytes) {
  PacketListReader list;
  list.take(bytes);
  int count = 0;
  bool isFirstRead = false;
  for (; count < kPacketsToTry; ++count) {
    const std::optional<LogPacket> packet = list.next();
    if (!packet) break;
    if (packet->milliseconds >= kLatestTime) return false;
    if (count == 0) isFirstRead = findLogKind(packet->code) != nullptr;
  }
  return count > 1 || isFirstRead;
}

Content tellWithoutFrames(Bytes bytes) {
  const std::string_view text = asText(bytes);
  if (bytes.empty()) return Content::nothing;
  for (const Beginning& beginning : kBeginnings) {
    if (text.starts_with(beginning.bytes)) return beginning.content;
  }
  if (isText(bytes)) return Content::text;
  return mayBePacketList(bytes) ? Content::packetList : Content::unknown;
}

}  // namespace

Content tellContent(ByteInput& input) {
  FrameReader frames;
  int tried = 0;
  for (std::size_t seen = 0;;) {
    const Bytes ahead = input.lookFurther();
    const Bytes bytes = ahead.first(std::min(ahead.size(), kFarthest));
    frames.take(bytes.subspan(seen));
    while (const std::optional<Frame> frame = frames.next()) {
      if (frame->isSound) return Content::frames;
      if (++tried == kFramesToTry) break;
    }
    // A pipe is not waited for where lines have come.
    if (hasLineOfRecording(asText(bytes))) return Content::recording;
    if (asText(bytes).find('\n') != std::string_view::npos && isText(bytes)) return Content::text;
    const bool isAll = bytes.size() == seen || bytes.size() == kFarthest;
    if (isAll || tried == kFramesToTry) return tellWithoutFrames(bytes);
    seen = bytes.size();
  }
}

const char* whyUnreadable(Content content) {
  switch (content) {
    case Content::networkCapture:
      return "is a capture of a network (pcap), and not of a diagnostic port";
    case Content::archive:
      return "is an archive or compressed in a way that is not read: unpack it first";
    case Content::nothing:
    case Content::frames:
    case Content::packetList:
    case Content::recording:
    case Content::text:
      return nullptr;
    case Content::unknown:
      return "is neither a recording nor a capture: it begins with no line of JSON, no frame and no log packet";
  }
  return nullptr;
}

std::optional<CaptureForm> captureFormOf(Content content) {
  if (content == Content::frames) return CaptureForm::frames;
  if (content == Content::packetList) return CaptureForm::packetList;
  return std::nullopt;
}

}  // namespace vesk::diag
