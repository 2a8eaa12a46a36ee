#include "event_check.h"

#include <algorithm>
#include <vector>

#include "intake/metric_table.h"
#include "messages/registry/metric_classes.h"
#include "property.h"
#include "shown.h"
#include "stores.h"
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

  const Stores before(*program.intake);
  std::vector<std::int64_t> arrived;
  program.intake->setArrivalObserver([&](std::int64_t id) { arrived.push_back(id); });
  program.raise(metricId, payload);
  program.deliverAll();
  program.intake->setArrivalObserver({});

  if (!fields) {
    require(arrived.empty(), "no payload arrives that is not decodable");
    require(Stores(*program.intake) == before, "an event that is not taken leaves every store as it was");
    return;
  }
  require(arrived == std::vector{metricId}, "a decodable payload arrives");
  for (std::size_t index = 0; index < kLatestRecords.size(); ++index) {
    const auto& record = (*program.intake).*kLatestRecords[index].second;
    if (kLatestRecords[index].second == metric->record) {
      require(record.has_value() && haveSameKeys(*record, *fields), "the latest record has the fields of its payload");
    } else {
      require(record == before.records[index], "an event leaves the records of other metrics as they were");
    }
  }
}

void checkRecordsAsJson(const MetricValidator& intake) {
  std::string json;
  for (const auto& [name, record] : kLatestRecords) {
    if (intake.*record) appendJson(json, *(intake.*record));
  }
  requireHarmless(json);
}

}  // namespace vesk
