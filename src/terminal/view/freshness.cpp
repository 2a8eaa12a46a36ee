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

Freshness freshnessOf(const Arrivals& arrivals, Clock::Instant now) {
  if (!arrivals.last || arrivals.count == 0) return {"never"};
  const auto age =
      std::max(std::chrono::duration_cast<std::chrono::seconds>(now - *arrivals.last), std::chrono::seconds(0));
  const Unit& unit =
      *std::find_if(kUnits.begin(), kUnits.end() - 1, [&](const Unit& each) { return each.length <= age; });
  const auto amount = age / unit.length;
  Freshness freshness;
  appendDecimal(freshness.text, std::int64_t{amount});
  freshness.text += unit.name;
  freshness.text += " ago, ";
  if (arrivals.count == 1) {
    freshness.text += "once";
  } else {
    appendDecimal(freshness.text, arrivals.count);
    freshness.text += " times";
  }
  freshness.nextChange = *arrivals.last + (amount + 1) * unit.length;
  return freshness;
}

}  // namespace vesk
