#include "messages/shared/lte_bands.h"

#include <algorithm>
#include <array>

namespace vesk {

namespace {

constexpr LteBand fdd(int number, LteChannelRange downlink, LteChannelRange uplink) {
  return {number, Duplex::FDD, downlink, uplink};
}

constexpr LteBand tdd(int number, LteChannelRange both) {
  return {number, Duplex::TDD, both, both};
}

constexpr LteBand sdl(int number, LteChannelRange downlink) {
  // No channel is in a range that ends before it begins.
  return {number, Duplex::SDL, downlink, {0, 1, 0}};
}

/// Number, then downlink and uplink: frequency of the first channel, first and last channel. In the order of downlink
/// channels.
// clang-format off
constexpr std::array kBands{
    fdd(1, {21100, 0, 599}, {19200, 18000, 18599}),
    fdd(2, {19300, 600, 1199}, {18500, 18600, 19199}),
    fdd(3, {18050, 1200, 1949}, {17100, 19200, 19949}),
    fdd(4, {21100, 1950, 2399}, {17100, 19950, 20399}),
    fdd(5, {8690, 2400, 2649}, {8240, 20400, 20649}),
    fdd(6, {8750, 2650, 2749}, {8300, 20650, 20749}),
    fdd(7, {26200, 2750, 3449}, {25000, 20750, 21449}),
    fdd(8, {9250, 3450, 3799}, {8800, 21450, 21799}),
    fdd(9, {18449, 3800, 4149}, {17499, 21800, 22149}),
    fdd(10, {21100, 4150, 4749}, {17100, 22150, 22749}),
    fdd(11, {14759, 4750, 4949}, {14279, 22750, 22949}),
    fdd(12, {7290, 5010, 5179}, {6990, 23010, 23179}),
    fdd(13, {7460, 5180, 5279}, {7770, 23180, 23279}),
    fdd(14, {7580, 5280, 5379}, {7880, 23280, 23379}),
    fdd(17, {7340, 5730, 5849}, {7040, 23730, 23849}),
    fdd(18, {8600, 5850, 5999}, {8150, 23850, 23999}),
    fdd(19, {8750, 6000, 6149}, {8300, 24000, 24149}),
    fdd(20, {7910, 6150, 6449}, {8320, 24150, 24449}),
    fdd(21, {14959, 6450, 6599}, {14479, 24450, 24599}),
    fdd(22, {35100, 6600, 7399}, {34100, 24600, 25399}),
    fdd(23, {21800, 7500, 7699}, {20000, 25500, 25699}),
    fdd(24, {15250, 7700, 8039}, {16265, 25700, 26039}),
    fdd(25, {19300, 8040, 8689}, {18500, 26040, 26689}),
    fdd(26, {8590, 8690, 9039}, {8140, 26690, 27039}),
    fdd(27, {8520, 9040, 9209}, {8070, 27040, 27209}),
    fdd(28, {7580, 9210, 9659}, {7030, 27210, 27659}),
    sdl(29, {7170, 9660, 9769}),
    fdd(30, {23500, 9770, 9869}, {23050, 27660, 27759}),
    fdd(31, {4625, 9870, 9919}, {4525, 27760, 27809}),
    sdl(32, {14520, 9920, 10359}),
    tdd(33, {19000, 36000, 36199}),
    tdd(34, {20100, 36200, 36349}),
    tdd(35, {18500, 36350, 36949}),
    tdd(36, {19300, 36950, 37549}),
    tdd(37, {19100, 37550, 37749}),
    tdd(38, {25700, 37750, 38249}),
    tdd(39, {18800, 38250, 38649}),
    tdd(40, {23000, 38650, 39649}),
    tdd(41, {24960, 39650, 41589}),
    tdd(42, {34000, 41590, 43589}),
    tdd(43, {36000, 43590, 45589}),
    tdd(44, {7030, 45590, 46589}),
    tdd(45, {14470, 46590, 46789}),
    tdd(46, {51500, 46790, 54539}),
    tdd(47, {58550, 54540, 55239}),
    tdd(48, {35500, 55240, 56739}),
    tdd(49, {35500, 56740, 58239}),
    tdd(50, {14320, 58240, 59089}),
    tdd(51, {14270, 59090, 59139}),
    tdd(52, {33000, 59140, 60139}),
    tdd(53, {24835, 60140, 60254}),
    fdd(65, {21100, 65536, 66435}, {19200, 131072, 131971}),
    fdd(66, {21100, 66436, 67335}, {17100, 131972, 132671}),
    sdl(67, {7380, 67336, 67535}),
    fdd(68, {7530, 67536, 67835}, {6980, 132672, 132971}),
    sdl(69, {25700, 67836, 68335}),
    fdd(70, {19950, 68336, 68585}, {16950, 132972, 133121}),
    fdd(71, {6170, 68586, 68935}, {6630, 133122, 133471}),
    fdd(72, {4610, 68936, 68985}, {4510, 133472, 133521}),
    fdd(73, {4600, 68986, 69035}, {4500, 133522, 133571}),
    fdd(74, {14750, 69036, 69465}, {14270, 133572, 134001}),
    sdl(75, {14320, 69466, 70315}),
    sdl(76, {14270, 70316, 70365}),
    fdd(85, {7280, 70366, 70545}, {6980, 134002, 134181}),
    fdd(87, {4200, 70546, 70595}, {4100, 134182, 134231}),
    fdd(88, {4220, 70596, 70645}, {4120, 134232, 134281}),
};
// clang-format on

constexpr bool isBefore(const LteBand& a, const LteBand& b) {
  return a.downlink.last < b.downlink.first;
}
static_assert(std::is_sorted(kBands.begin(), kBands.end(), isBefore));

template <class Condition>
const LteBand* findBand(Condition isMeant) {
  const auto* found = std::find_if(kBands.begin(), kBands.end(), isMeant);
  return found == kBands.end() ? nullptr : found;
}

}  // namespace

std::string_view nameOf(Duplex duplex) {
  switch (duplex) {
    case Duplex::FDD:
      return "FDD";
    case Duplex::TDD:
      return "TDD";
    case Duplex::SDL:
      return "SDL";
  }
  return {};
}

std::optional<int> LteBand::uplinkFrequencyOf(std::int64_t downlinkChannel) const {
  const std::int64_t channel = uplink.first + (downlinkChannel - downlink.first);
  return uplink.contains(channel) ? std::optional(uplink.frequencyOf(channel)) : std::nullopt;
}

const LteBand* findLteBand(std::int64_t number) {
  return findBand([=](const LteBand& band) { return band.number == number; });
}

const LteBand* lteBandOfDownlink(std::int64_t earfcn) {
  const auto* found =
      std::lower_bound(kBands.begin(), kBands.end(), earfcn,
                       [](const LteBand& band, std::int64_t each) { return band.downlink.last < each; });
  return found != kBands.end() && found->downlink.contains(earfcn) ? found : nullptr;
}

const LteBand* lteBandOfUplink(std::int64_t earfcn) {
  return findBand([=](const LteBand& band) { return band.uplink.contains(earfcn); });
}

}  // namespace vesk
