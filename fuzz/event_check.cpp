#include "event_check.h"

#include <algorithm>
#include <vector>

#include "intake/metric_table.h"
#include "messages/registry/metric_classes.h"
#include "property.h"
#include "shown.h"
#include "values/json_form.h"
#include "wire_model.h"

namespace vesk {

namespace {

bool haveSameKeys(const Dictionary& a, const Dictionary& b) {
  return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                    [](const Dictionary::Entry& x, const Dictionary::Entry& y) { return x.key == y.key; });
}

}  // namespace

void checkEvent(ConnectedProgram& program, std::int64_t metricId, std::span<const std::uint8_t> payload) {
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

void checkRecordsAsJson(const Stores& stores) {
  std::string json;
  visitLatestRecords(stores, [&](std::string_view, const LatestRecord& record) {
    if (record) appendJson(json, *record);
  });
  requireHarmless(json);
}

}  // namespace vesk
