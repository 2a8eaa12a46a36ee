#include "diag/port/command.h"

#include <algorithm>
#include <utility>

#include "diag/framing/frame.h"
#include "diag/framing/packet_reader.h"
#include "diag/little_endian.h"

namespace vesk::diag {

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::uint8_t kLogCommand = 0x73;
/// What a log command does stands behind three bytes that are 0.
constexpr std::size_t kOperationOffset = 4;
constexpr std::size_t kStatusOffset = 8;
constexpr std::size_t kEquipmentOffset = 12;
constexpr std::size_t kSizesOffset = 12;
constexpr std::size_t kEquipments = 16;
constexpr std::uint8_t kSetMask = 0x03;
/// As many as a log code can name.
constexpr std::uint32_t kMostItems = 0x1000;

constexpr std::size_t kFirmwareTextOffset = 12;

/// A byte that refuses stands before the refused command.
constexpr std::uint8_t kUnknownCommand = 0x13;
constexpr std::uint8_t kLocked = 0x47;

/// What is sent, without what a frame adds.
Bytes contentOf(Request request) {
  static constexpr std::uint8_t kVersion[] = {0x00};
  static constexpr std::uint8_t kFirmware[] = {0x7C};
  static constexpr std::uint8_t kEventsOff[] = {0x60, 0x00};
  static constexpr std::uint8_t kDebugMessagesOff[] = {0x7D, 0x05, 0, 0, 0, 0, 0, 0};
  static constexpr std::uint8_t kLogsOff[] = {kLogCommand, 0, 0, 0, 0x00, 0, 0, 0};
  static constexpr std::uint8_t kLogSizes[] = {kLogCommand, 0, 0, 0, 0x01, 0, 0, 0};
  static constexpr std::uint8_t kLogMask[] = {kLogCommand, 0, 0, 0, kSetMask, 0, 0, 0};
  switch (request) {
    case Request::version:
      return kVersion;
    case Request::firmware:
      return kFirmware;
    case Request::eventsOff:
      return kEventsOff;
    case Request::debugMessagesOff:
      return kDebugMessagesOff;
    case Request::logsOff:
      return kLogsOff;
    case Request::logSizes:
      return kLogSizes;
    case Request::logMask:
      return kLogMask;
  }
  return {};
}

void appendWord(std::vector<std::uint8_t>& out, std::uint32_t word) {
  for (int shift = 0; shift < 32; shift += 8)
    out.push_back(static_cast<std::uint8_t>(word >> shift));
}

bool isRefusal(Bytes content) {
  return kindOf(content[0]) == PacketKind::refusal;
}

/// What can be shown of the text that ends with the first byte 0.
std::string textAt(Bytes content, std::size_t offset) {
  std::string text;
  for (; offset < content.size() && content[offset] != 0; ++offset) {
    if (content[offset] >= ' ' && content[offset] < 0x7F) text += static_cast<char>(content[offset]);
  }
  return text;
}

}  // namespace

Command::Command(Request request, std::uint32_t equipment, std::vector<std::uint8_t> content)
    : request_(request), equipment_(equipment), content_(std::move(content)) {
  appendFrame(frame_, content_);
}

Command Command::make(Request request) {
  const Bytes content = contentOf(request);
  return {request, 0, {content.begin(), content.end()}};
}

Command Command::makeLogMask(std::uint32_t equipment, std::uint32_t itemCount, std::span<const std::uint16_t> codes) {
  itemCount = std::min(itemCount, kMostItems);
  const Bytes start = contentOf(Request::logMask);
  std::vector<std::uint8_t> content(start.begin(), start.end());
  appendWord(content, equipment);
  appendWord(content, itemCount);
  const std::size_t mask = content.size();
  content.resize(mask + (itemCount + 7) / 8);
  for (const std::uint16_t code : codes) {
    const std::uint32_t item = code & 0x0FFF;
    if (code >> 12 == equipment && item < itemCount)
      content[mask + item / 8] = static_cast<std::uint8_t>(content[mask + item / 8] | 1 << item % 8);
  }
  return {Request::logMask, equipment, std::move(content)};
}

bool Command::isAnsweredBy(Bytes content) const {
  if (isRefusal(content)) {
    const Bytes refused = content.subspan(1);
    return !refused.empty() &&
           std::equal(refused.begin(),
                      refused.begin() + static_cast<std::ptrdiff_t>(std::min(refused.size(), content_.size())),
                      content_.begin());
  }
  // What is not a diagnostic port may send back what it gets.
  if (content[0] != content_[0] || std::equal(content.begin(), content.end(), content_.begin(), content_.end()))
    return false;
  if (content[0] != kLogCommand) return true;
  if (content.size() < kStatusOffset + sizeof(std::uint32_t)) return false;
  if (content[kOperationOffset] != content_[kOperationOffset]) return false;
  // A refused mask may come without the equipment.
  const bool namesEquipment =
      request_ == Request::logMask && content.size() >= kEquipmentOffset + sizeof(std::uint32_t);
  return !namesEquipment || readLittleEndian<std::uint32_t>(content, kEquipmentOffset) == equipment_;
}

Answer readAnswer(const Command& command, Bytes content) {
  if (isRefusal(content)) {
    const bool isLocked = content[0] == kUnknownCommand || content[0] == kLocked;
    return {isLocked ? Answer::Kind::locked : Answer::Kind::refused, content[0]};
  }
  Answer answer{Answer::Kind::done};
  if (content[0] == kLogCommand) answer.status = readLittleEndian<std::uint32_t>(content, kStatusOffset);
  if (answer.status != 0) answer.kind = Answer::Kind::refused;
  if (command.request() == Request::firmware) answer.text = textAt(content, kFirmwareTextOffset);
  if (command.request() == Request::logSizes) {
    answer.sizes.resize(kEquipments);
    for (std::size_t equipment = 0; equipment < kEquipments; ++equipment) {
      const std::size_t offset = kSizesOffset + equipment * sizeof(std::uint32_t);
      if (offset + sizeof(std::uint32_t) <= content.size())
        answer.sizes[equipment] = readLittleEndian<std::uint32_t>(content, offset);
    }
  }
  return answer;
}

}  // namespace vesk::diag
