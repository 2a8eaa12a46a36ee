#include "terminal/view/freshness.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "values/text_form.h"

namespace vesk {

namespace {

struct Unit {
  std::chrono::seconds length;
  std::string_view name;
};

/// From the longest on: an age is told in the first that is no longer than it.
constexpr std::array kUnits{
    Unit{std::chrono::hours(24), " d"},
    Unit{std::chrono::hours(1), " h"},
    Unit{std::chrono::minutes(1), " min"},
    Unit{std::chrono::seconds(1), " s"},
};

}  // namespace

Freshness ageOf(const Arrivals& arrivals, std::chrono::milliseconds now) {
  using std::chrono::milliseconds;
  if (!arrivals.last || arrivals.count == 0) return {};
  const milliseconds age = std::max(now - *arrivals.last, milliseconds(0));
  const Unit& unit =
      *std::find_if(kUnits.begin(), kUnits.end() - 1, [&](const Unit& each) { return each.length <= age; });
  const std::int64_t amount = age / milliseconds(unit.length);
  Freshness freshness;
  appendDecimal(freshness.text, amount);
  freshness.text += unit.name;
  freshness.untilChange = (amount + 1) * milliseconds(unit.length) - age;
  return freshness;
}

Freshness freshnessOf(const Arrivals& arrivals, std::chrono::milliseconds now) {
  Freshness freshness = ageOf(arrivals, now);
  if (freshness.text.empty()) return {"never"};
  freshness.text += " ago, ";
  if (arrivals.count == 1) {
    freshness.text += "once";
  } else {
    appendDecimal(freshness.text, arrivals.count);
    freshness.text += " times";
  }
  if (arrivals.isWithoutList) freshness.text += ", without this list";
  return freshness;
}

}  // namespace vesk
