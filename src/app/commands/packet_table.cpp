#include "app/commands/packet_table.h"

#include <cstdint>
#include <cstdio>
#include <string>

#include "diag/translation/log_kind.h"

namespace vesk {

namespace {

constexpr const char* kNone = "-";

void writeRow(DataOutput& output, const std::string& code, const std::string& version, const std::string& name,
              const diag::Tally& tally) {
  char line[160];
  std::snprintf(line, sizeof line, "%-4s  %7s  %-40s  %10llu  %11llu  %10llu", code.c_str(), version.c_str(),
                name.c_str(), static_cast<unsigned long long>(tally.read),
                static_cast<unsigned long long>(tally.passedOver), static_cast<unsigned long long>(tally.damaged));
  output.writeLine(line);
}

void writeRow(DataOutput& output, const char* name, const diag::Tally& tally) {
  if (tally.read + tally.passedOver + tally.damaged > 0) writeRow(output, kNone, kNone, name, tally);
}

void writeCode(DataOutput& output, const diag::CodeTally& row) {
  char code[8];
  std::snprintf(code, sizeof code, "%04X", row.code);
  const diag::LogKind* kind = diag::findLogKind(row.code);
  writeRow(output, code, row.version ? std::to_string(*row.version) : kNone,
           kind == nullptr ? "not known" : std::string(kind->name), row.tally);
}

std::string textOf(const diag::Version& version) {
  if (!version.number) return "all";
  std::string text = std::to_string(*version.number);
  if (version.subpacket)
    text += ':' + std::to_string(version.subpacket->id) + '/' + std::to_string(version.subpacket->version);
  return text;
}

std::string versionsOf(const diag::LogKind& kind, diag::Proof proof) {
  std::string text;
  for (const diag::Version& version : kind.versions()) {
    if (version.proof == proof) text += (text.empty() ? "" : ",") + textOf(version);
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
  output.writeLine("code  version  name                                            read  passed over     damaged");
  for (const diag::CodeTally& row : counts.byCode())
    writeCode(output, row);
  writeRow(output, "log packets of still more codes", counts.ofOtherCodes());
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
