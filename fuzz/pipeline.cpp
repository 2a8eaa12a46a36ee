// The first bytes say which screen is looked at, and how large it is; the others are metric events, each a byte that
// says which metric, a byte with the size of its payload, and the payload.

#include <algorithm>
#include <cstdlib>

#include "event_check.h"
#include "messages/registry/metric_identifiers.h"
#include "screens/vesk_view_items.h"
#include "shown.h"
#include "support/pictures.h"
#include "support/recorded_output.h"
#include "toolkit/table_view_controller.h"

namespace vesk {
namespace {

using Payload = std::span<const std::uint8_t>;

/// Those that are known, and some that are not.
constexpr std::int64_t kMetrics[] = {
#define KNOWN_METRIC(constant, identifier, label) constant,
#include "messages/registry/metrics.def"
    K_LTE_RRC_STATE + 1, K_LTE_RRC_STATE >> 16, K_LTE_RRC_STATE << 8, 0, -1,
};

void checkScreen(NavigationController& root, std::size_t area, std::size_t category, Size size) {
  const auto select = [&](std::size_t row) {
    dynamic_cast<TableViewController&>(*root.topViewController()).selectRow({0, row});
  };
  const VeskViewItems& menu = VeskViewItems::shared();
  select(area);
  select(category % menu.categoriesOf(menu.launchViewItemNames[area].view()).size());

  Desk desk(root, size);
  requireDrawable(desk.grid(), size);
  desk.type(U"/1");
  requireDrawable(desk.grid(), size);
}

void checkPipeline(Payload events, std::size_t screen, Size size) {
  RecordedOutput output;
  ConnectedProgram program;
  const int status = program.run([&](NavigationController& root) {
    while (events.size() >= 2) {
      const std::int64_t metricId = kMetrics[events[0] % std::size(kMetrics)];
      const Payload payload = events.subspan(2, std::min<std::size_t>(events[1], events.size() - 2));
      checkEvent(program, metricId, payload);
      events = events.subspan(2 + payload.size());
    }
    checkScreen(root, screen % 4, screen / 4, size);
  });
  require(status == 0, "the program ends well");
  checkRecordsAsJson(program.intake->stores);
  for (const std::string& line : output.lines())
    requireHarmless(line);
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const bool kIsInUtc = setenv("TZ", "UTC", 1) == 0;
  if (size < 3 || !kIsInUtc) return 0;
  vesk::checkPipeline({data + 3, size - 3}, data[0], {data[1] % 130, data[2] % 60});
  return 0;
}
