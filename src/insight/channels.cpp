#include "insight/channels.h"

#include <algorithm>
#include <array>
#include <utility>

#include "messages/shared/sys_band.h"

namespace vesk::insight {

namespace {

/// UARFCNs first, first + step, ... last. The downlink is at UARFCN / 5 MHz + offset, the uplink below it by the
/// spacing.
struct UmtsRange {
  std::string_view band;
  int spacing;
  int offset;
  int first;
  int last;
  int step = 1;
};

/// In the order in which a number is looked for. The channels in steps of 25 lie between those of the 200 kHz raster.
// clang-format off
constexpr std::array<UmtsRange, 36> kUmtsRanges{{
    {"I", 1900, 0, 10562, 10838},
    {"II", 800, 0, 9662, 9938},
    {"II", 800, 18501, 412, 687, 25},
    {"III", 950, 15750, 1162, 1513},
    {"IV", 4000, 18050, 1537, 1738},
    {"IV", 4000, 17351, 1887, 2087, 25},
    {"V", 450, 0, 4357, 4458},
    {"V", 450, 6701, 1007, 1032, 25},
    {"V", 450, 6701, 1012, 1087, 25},
    {"VI", 450, 0, 4387, 4413},
    {"VI", 450, 6701, 1037, 1062, 25},
    {"VII", 1200, 21750, 2237, 2563},
    {"VII", 1200, 21051, 2587, 2912, 25},
    {"VIII", 450, 3400, 2937, 3088},
    {"IX", 950, 0, 9237, 9387},
    {"X", 4000, 14900, 3112, 3388},
    {"X", 4000, 14301, 3412, 3687, 25},
    {"XI", 480, 7360, 3712, 3787},
    {"XII", 300, -370, 3842, 3903},
    {"XII", 300, -549, 3932, 3957, 25},
    {"XII", 300, -549, 3962, 3987, 25},
    {"XII", 300, -549, 3992, 3992},
    {"XIII", -310, -550, 4017, 4043},
    {"XIII", -310, -649, 4067, 4092, 25},
    {"XIV", -300, -630, 4117, 4143},
    {"XIV", -300, -729, 4167, 4192, 25},
    {"XIX", 450, 7350, 712, 763},
    {"XIX", 450, 7201, 787, 837, 25},
    {"XX", -410, -1090, 4512, 4638},
    {"XXI", 480, 13260, 862, 912},
    {"XXII", 1000, 25800, 4662, 5038},
    {"XXV", 800, 9100, 5112, 5413},
    {"XXV", 800, 6741, 6292, 6592, 25},
    {"XXVI", 450, -2910, 5762, 5913},
    {"XXVI", 450, -3259, 5937, 6087, 25},
    {"XXVI", 450, -3259, 5992, 6067, 25},
}};
// clang-format on

/// ARFCNs first to last. The uplink is at low + 0.2 MHz * (ARFCN - first), the downlink above it by the spacing.
struct GsmBand {
  std::string_view name;
  int first;
  int last;
  int low;
  int spacing;

  [[nodiscard]] constexpr bool contains(std::int64_t arfcn) const { return arfcn >= first && arfcn <= last; }
  [[nodiscard]] constexpr Channel channel(std::int64_t arfcn) const {
    const int uplink = low + 2 * static_cast<int>(arfcn - first);
    return {name, uplink + spacing, uplink};
  }
};

// clang-format off
constexpr std::array<GsmBand, 9> kGsmBands{{
    {"E-GSM 900", 0, 0, 8900, 450},
    {"P-GSM 900", 1, 124, 8902, 450},
    {"GSM 850", 128, 251, 8242, 450},
    {"GSM 450", 259, 293, 4506, 100},
    {"GSM 480", 306, 340, 4790, 100},
    {"GSM 750", 438, 511, 7772, -300},
    {"DCS 1800", 512, 885, 17102, 950},
    {"R-GSM 900", 955, 974, 8762, 450},
    {"E-GSM 900", 975, 1023, 8802, 450},
}};
constexpr GsmBand kPcs1900{"PCS 1900", 512, 810, 18502, 800};
// clang-format on

}  // namespace

std::optional<Channel> umtsChannel(std::int64_t uarfcn) {
  const auto* found = std::find_if(kUmtsRanges.begin(), kUmtsRanges.end(), [=](const UmtsRange& range) {
    return uarfcn >= range.first && uarfcn <= range.last && (uarfcn - range.first) % range.step == 0;
  });
  if (found == kUmtsRanges.end()) return std::nullopt;
  const int downlink = 2 * static_cast<int>(uarfcn) + found->offset;
  return Channel{found->band, downlink, downlink - found->spacing};
}

std::optional<SharedGsmBand> sharedGsmBand(const Value* bandIndicator) {
  if (bandIndicator == nullptr) return std::nullopt;
  for (const auto& [band, indicated] : {std::pair{metrics::SysBand::SYS_BAND_GSM_DCS_1800, SharedGsmBand::dcs1800},
                                        std::pair{metrics::SysBand::SYS_BAND_GSM_PCS_1900, SharedGsmBand::pcs1900}}) {
    const Text* name = bandIndicator->text();
    const bool isMeant =
        name != nullptr ? *name == nameOf(band) : bandIndicator->integer() == static_cast<std::int32_t>(band);
    if (isMeant) return indicated;
  }
  return std::nullopt;
}

std::optional<GsmChannel> gsmChannel(std::int64_t arfcn, std::optional<SharedGsmBand> indicated) {
  const auto* found =
      std::find_if(kGsmBands.begin(), kGsmBands.end(), [=](const GsmBand& band) { return band.contains(arfcn); });
  if (found == kGsmBands.end()) return std::nullopt;
  const GsmChannel channel{found->channel(arfcn), std::nullopt};
  const bool isOfDcs = found->first == kPcs1900.first;
  if (!isOfDcs || indicated == SharedGsmBand::dcs1800) return channel;
  if (!kPcs1900.contains(arfcn)) return indicated ? std::nullopt : std::optional(channel);
  if (indicated) return GsmChannel{kPcs1900.channel(arfcn), std::nullopt};
  return GsmChannel{channel, kPcs1900.channel(arfcn)};
}

}  // namespace vesk::insight
