#include "diag/translation/log_kind.h"

#include <algorithm>
#include <iterator>

#include "diag/gsm/gsm_logs.h"
#include "diag/lte/lte_logs.h"
#include "diag/lte/subpackets.h"
#include "diag/nas/nas_logs.h"
#include "diag/umts/umts_logs.h"

namespace vesk::diag {

namespace {

using enum Proof;
using enum VersionPlace;

// clang-format off
constexpr LogKind kLogKinds[] = {
    {0x4005, "UMTS ranked cells",                    readUmtsRankedCells,           umtsRankedCellVersions, twoBitsOfFirstByte},
    {0x4125, "UMTS RRC state",                       readUmtsRrcState,              unversioned<byTheBook>, none},
    {0x4127, "UMTS serving cell",                    readUmtsServingCell,           unversioned<sample>,    none},
    {0x5071, "GSM neighbour list",                   readGsmNeighbourList,          unversioned<sample>,    none},
    {0x507A, "GSM serving level",                    readGsmServingLevel,           unversioned<sample>,    none},
    {0x507B, "GSM neighbour levels",                 readGsmNeighbourLevels,        unversioned<sample>,    none},
    {0x512F, "GSM RR message",                       readGsmRrMessage,              unversioned<checked>,   none},
    {0x5134, "GSM serving cell",                     readGsmServingCell,            unversioned<sample>,    none},
    {0x51FC, "GSM reselection",                      readGsmReselection,            unversioned<byTheBook>, none},
    {0x7130, "GMM state",                            readGmmState,                  unversioned<checked>,   none},
    {0x7131, "MM state",                             readMmState,                   unversioned<checked>,   none},
    {0x713A, "MM and GMM message",                   readNasMessage,                unversioned<checked>,   none},
    {0xB0C0, "LTE RRC message",                      readLteRrcMessage,             lteRrcMessageVersions},
    {0xB0C2, "LTE serving cell",                     readLteServingCell,            lteServingCellVersions},
    {0xB0E2, "ESM message to the phone",             readEpsNasMessage,             onlyVersion<1, checked>},
    {0xB0E3, "ESM message from the phone",           readEpsNasMessage,             onlyVersion<1, checked>},
    {0xB0EC, "EMM message to the phone",             readEpsNasMessage,             onlyVersion<1, checked>},
    {0xB0ED, "EMM message from the phone",           readEpsNasMessage,             onlyVersion<1, checked>},
    {0xB0EE, "EMM state",                            readEmmState,                  onlyVersion<2, checked>},
    {0xB139, "LTE PUSCH power",                      readLtePuschPower,             ltePuschPowerVersions},
    {0xB13C, "LTE PUCCH power",                      readLtePucchPower,             ltePucchPowerVersions},
    {0xB16E, "LTE PUSCH power control",              readLtePuschPowerControl,      ltePuschPowerControlVersions},
    {0xB16F, "LTE PUCCH power control",              readLtePucchPowerControl,      ltePucchPowerControlVersions},
    {0xB179, "LTE neighbours, connected, filtered",  readLteFilteredNeighbours,     lteFilteredNeighbourVersions},
    {0xB17F, "LTE serving measurement, idle",        readLteIdleServingMeasurement, lteIdleServingMeasurementVersions},
    {0xB180, "LTE neighbours, idle",                 readLteIdleNeighbours,         lteIdleNeighbourVersions},
    {0xB192, "LTE neighbours, idle, as measured",    readLteIdleMeasuredNeighbours, lteIdleMeasuredNeighbourVersions},
    {0xB193, "LTE serving measurement",              readLteServingMeasurement,     lteServingMeasurementVersions},
    {0xB195, "LTE neighbours, connected, as measured", readLteMeasuredNeighbours,   lteMeasuredNeighbourVersions},
};
// clang-format on

}  // namespace

std::span<const LogKind> logKinds() {
  return kLogKinds;
}

const LogKind* findLogKind(std::uint16_t code) {
  const auto* const kind = std::lower_bound(std::begin(kLogKinds), std::end(kLogKinds), code,
                                            [](const LogKind& row, std::uint16_t wanted) { return row.code < wanted; });
  return kind != std::end(kLogKinds) && kind->code == code ? kind : nullptr;
}

std::optional<std::uint8_t> versionOf(const LogPacket& packet) {
  const LogKind* kind = findLogKind(packet.code);
  const VersionPlace place = kind == nullptr ? firstByte : kind->versionPlace;
  if (place == none || packet.body.empty()) return std::nullopt;
  const std::uint8_t first = packet.body.front();
  return place == firstByte ? first : static_cast<std::uint8_t>(first >> 6);
}

std::vector<Version::Subpacket> unreadSubpacketsOf(const LogPacket& packet) {
  const LogKind* kind = findLogKind(packet.code);
  const Versions read = kind == nullptr ? Versions{} : kind->versions();
  if (read.empty() || !read.front().subpacket) return {};
  std::vector<Version::Subpacket> unread;
  const Reading reading = readSubpackets(packet, [&](const Subpacket& each) {
    const Version::Subpacket found{each.id, each.version};
    const bool isRead =
        std::any_of(read.begin(), read.end(), [&found](const Version& version) { return version.subpacket == found; });
    if (!isRead) unread.push_back(found);
    return Reading::passedOver;
  });
  return reading == Reading::damaged ? std::vector<Version::Subpacket>{} : unread;
}

}  // namespace vesk::diag
