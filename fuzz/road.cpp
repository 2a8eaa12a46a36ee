// The first bytes say which screen is looked at, and how large it is; the others are metric events, each a byte that
// says which metric, a byte with the size of its payload, and the payload.

#include <algorithm>
#include <cstdlib>
#include <ctime>
#include <vector>

#include "app/connected_program.h"
#include "intake/metric_table.h"
#include "messages/wire_model.h"
#include "property.h"
#include "screens/vesk_view_items.h"
#include "shown.h"
#include "support/pictures.h"
#include "support/recorded_output.h"
#include "toolkit/table_view_controller.h"
#include "values/json_form.h"

namespace vesk {

namespace {

using Payload = std::span<const std::uint8_t>;

/// Those that are handled, those that are known, and some that are neither.
constexpr std::int64_t kMetrics[] = {
#define KNOWN_METRIC(constant, identifier, label) constant,
#include "messages/registry/metrics.def"
    K_LTE_RRC_STATE + 1, K_LTE_RRC_STATE >> 16, K_LTE_RRC_STATE << 8, 0, -1,
};

bool haveSameKeys(const Dictionary& a, const Dictionary& b) {
  return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                    [](const Dictionary::Entry& x, const Dictionary::Entry& y) { return x.key == y.key; });
}

void checkEvent(ConnectedProgram& program, std::int64_t metricId, Payload payload) {
  const HandledMetric* metric = findHandledMetric(metricId);
  std::optional<Dictionary> fields;
  if (metric != nullptr) fields = modelledDictionary(findMetricClass(metricId)->name, payload);

  const Stores before = program.intake->stores;
  std::vector<std::int64_t> arrived;
  program.intake->setArrivalObserver([&](std::int64_t id) { arrived.push_back(id); });
  program.raise(metricId, payload);
  program.deliverAll();
  program.intake->setArrivalObserver({});

  if (!fields) {
    require(arrived.empty(), "no payload arrives that is not decodable");
    require(program.intake->stores == before, "an event that is not taken leaves every store as it was");
    return;
  }
  require(arrived == std::vector{metricId}, "a decodable payload arrives");
  const Stores& after = program.intake->stores;
  const LatestRecord& record = after.*metric->record;
  require(record.has_value() && haveSameKeys(*record, *fields), "the latest record has the fields of its payload");
  Stores expected = before;
  expected.*metric->record = record;
  expected.myLTE = after.myLTE;
  expected.myUMTS = after.myUMTS;
  expected.myGSM = after.myGSM;
  expected.myCommon = after.myCommon;
  require(after == expected, "an event leaves the records of other metrics as they were");
}

void checkScreen(NavigationController& root, std::size_t area, std::size_t category, Size size) {
  const auto select = [&](std::size_t row) {
    dynamic_cast<TableViewController&>(*root.topViewController()).selectRow({0, row});
  };
  const VeskViewItems& menu = VeskViewItems::shared();
  const Text& areaName = menu.launchViewItemNames[area % menu.launchViewItemNames.size()];
  select(area % menu.launchViewItemNames.size());
  select(category % menu.categoriesOf(areaName.view()).size());

  Desk desk(root, size);
  requireDrawable(desk.grid(), size);
  desk.type(U"/1");
  requireDrawable(desk.grid(), size);
}

void checkRecordsAsJson(const Stores& stores) {
  std::string json;
  visitLatestRecords(stores, [&](std::string_view, const LatestRecord& record) {
    if (record) appendJson(json, *record);
  });
  requireHarmless(json);
}

void checkRoad(Payload events, std::size_t screen, Size size) {
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
  vesk::checkRoad({data + 3, size - 3}, data[0], {data[1] % 130, data[2] % 60});
  return 0;
}
