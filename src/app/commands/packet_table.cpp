#include "app/commands/packet_table.h"

#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>

#include "diag/translation/log_kind.h"

namespace vesk {

namespace {

constexpr const char* kNone = "-";

void writeRow(DataOutput& output, const std::string& code, const std::string& version, const std::string& name,
              const diag::Tally& tally) {
  char line[160];
  std::snprintf(line, sizeof line, "%-4s  %9s  %-38s  %10llu  %11llu  %10llu", code.c_str(), version.c_str(),
                name.c_str(), static_cast<unsigned long long>(tally.read),
                static_cast<unsigned long long>(tally.passedOver), static_cast<unsigned long long>(tally.damaged));
  output.writeLine(line);
}

void writeRow(DataOutput& output, const char* name, const diag::Tally& tally) {
  if (tally.read + tally.passedOver + tally.damaged > 0) writeRow(output, kNone, kNone, name, tally);
}

/// "1", or "1:25/36" for a subpacket 25 of version 36 in a packet of version 1.
std::string textOf(std::uint8_t version, const std::optional<diag::Version::Subpacket>& subpacket) {
  std::string text = std::to_string(version);
  if (subpacket) text += ':' + std::to_string(subpacket->id) + '/' + std::to_string(subpacket->version);
  return text;
}

void writeVariety(DataOutput& output, const diag::PacketVariety& variety, const diag::Tally& tally) {
  char code[8];
  std::snprintf(code, sizeof code, "%04X", variety.code);
  const diag::LogKind* kind = diag::findLogKind(variety.code);
  std::string name = kind == nullptr ? "not known" : std::string(kind->name);
  if (const auto& part = variety.subpacket)
    name = "subpackets " + std::to_string(part->id) + ", version " + std::to_string(part->version);
  writeRow(output, code, variety.version ? textOf(*variety.version, variety.subpacket) : kNone, name, tally);
}

std::string versionsOf(const diag::LogKind& kind, diag::Proof proof) {
  std::string text;
  for (const diag::Version& version : kind.versions()) {
    if (version.proof != proof) continue;
    if (!text.empty()) text += ',';
    text += version.number ? textOf(*version.number, version.subpacket) : "all";
  }
  return text.empty() ? kNone : text;
}

struct OtherKind {
  diag::PacketKind kind;
  const char* name;
};

constexpr OtherKind kOtherKinds[] = {
    {diag::PacketKind::encryptedLog, "encrypted log packets"}, {diag::PacketKind::events, "events of the modem"},
    {diag::PacketKind::debugMessage, "debug messages"},        {diag::PacketKind::answer, "answers to commands"},
    {diag::PacketKind::refusal, "refusals of commands"},       {diag::PacketKind::unknown, "packets of no known kind"},
};

}  // namespace

void writePacketTable(DataOutput& output, const diag::PacketCounts& counts) {
  output.writeLine("code    version  name                                          read  passed over     damaged");
  for (const auto& [variety, tally] : counts.byVariety())
    writeVariety(output, variety, tally);
  writeRow(output, "of still more codes and versions", counts.ofOtherVarieties());
  for (const OtherKind& other : kOtherKinds)
    writeRow(output, other.name, {.read = 0, .passedOver = counts.of(other.kind), .damaged = 0});
  writeRow(output, "packets of SIMs that were not chosen",
           {.read = 0, .passedOver = counts.ofOtherSims(), .damaged = 0});
  writeRow(output, "packets that are none",
           {.read = 0, .passedOver = 0, .damaged = counts.of(diag::PacketKind::damaged)});
  writeRow(output, "frames", {.read = 0, .passedOver = 0, .damaged = counts.damagedFrames()});
}

void writeLayoutTable(DataOutput& output) {
  output.writeLine(
      "code  name                                    proven                   by samples       by the book");
  for (const diag::LogKind& kind : diag::logKinds()) {
    char line[200];
    std::snprintf(line, sizeof line, "%04X  %-38s  %-23s  %-15s  %s", kind.code, std::string(kind.name).c_str(),
                  versionsOf(kind, diag::Proof::checked).c_str(), versionsOf(kind, diag::Proof::sample).c_str(),
                  versionsOf(kind, diag::Proof::byTheBook).c_str());
    output.writeLine(line);
  }
}

}  // namespace vesk
