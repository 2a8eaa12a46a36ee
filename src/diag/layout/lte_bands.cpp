#include "diag/layout/lte_bands.h"

#include <algorithm>
#include <iterator>

namespace vesk::diag {

namespace {

struct Band {
  std::uint32_t first;
  std::uint32_t last;
  std::uint32_t number;
};

/// In the order of the EARFCNs.
constexpr Band kBands[] = {
    {0, 599, 1},        {600, 1199, 2},     {1200, 1949, 3},    {1950, 2399, 4},    {2400, 2649, 5},
    {2650, 2749, 6},    {2750, 3449, 7},    {3450, 3799, 8},    {3800, 4149, 9},    {4150, 4749, 10},
    {4750, 4949, 11},   {5010, 5179, 12},   {5180, 5279, 13},   {5280, 5379, 14},   {5730, 5849, 17},
    {5850, 5999, 18},   {6000, 6149, 19},   {6150, 6449, 20},   {6450, 6599, 21},   {6600, 7399, 22},
    {7500, 7699, 23},   {7700, 8039, 24},   {8040, 8689, 25},   {8690, 9039, 26},   {9040, 9209, 27},
    {9210, 9659, 28},   {9660, 9769, 29},   {9770, 9869, 30},   {9870, 9919, 31},   {9920, 10359, 32},
    {36000, 36199, 33}, {36200, 36349, 34}, {36350, 36949, 35}, {36950, 37549, 36}, {37550, 37749, 37},
    {37750, 38249, 38}, {38250, 38649, 39}, {38650, 39649, 40}, {39650, 41589, 41}, {41590, 43589, 42},
    {43590, 45589, 43}, {45590, 46589, 44}, {46590, 46789, 45}, {46790, 54539, 46}, {54540, 55239, 47},
    {55240, 56739, 48}, {65536, 66435, 65}, {66436, 67335, 66}, {67336, 67535, 67}, {67536, 67835, 68},
    {67836, 68335, 69}, {68336, 68585, 70}, {68586, 68935, 71},
};

}  // namespace

std::optional<std::uint32_t> lteBandOf(std::uint32_t earfcn) {
  const auto* const band = std::lower_bound(std::begin(kBands), std::end(kBands), earfcn,
                                            [](const Band& row, std::uint32_t wanted) { return row.last < wanted; });
  if (band == std::end(kBands) || earfcn < band->first) return std::nullopt;
  return band->number;
}

}  // namespace vesk::diag
