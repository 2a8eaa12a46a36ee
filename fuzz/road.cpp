// The first bytes say which screen is looked at, and how large it is; the others are metric events, each a byte that
// says which metric, a byte with the size of its payload, and the payload.

#include <algorithm>
#include <cstdlib>
#include <ctime>
#include <variant>
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
    K_LTE_CDRX_CONFIG,
    K_LTE_RRC_STATE,
    K_LTE_SCELL_INFO,
    K_LTE_RLF,
    K_LTE_SEL_RESEL_INFO,
    K_LTE_SCELL_MEAS,
    K_LTE_TX_POWER,
    K_LTE_RSRP_RSRQ_SINR,
    K_LTE_COMPCARR_INFO,
    K_LTE_CA_STATUS,
    K_LTE_INTERRAT_MEAS,
    K_LTE_INTRARAT_MEAS,
    K_CELLULAR_MM_INFO,
    K_CELLULAR_MM_CTXT,
    K_LTE_EMM_CTXT,
    K_CELLULAR_ACTIVE_BEARER,
    K_CELLULAR_GMM_CTXT,
    K_UMTS_RRC_STATE,
    K_UMTS_RRC_CONFIG,
    K_UMTS_SCELL_INFO,
    K_UMTS_SCELL_MEAS,
    K_UMTS_TX_POWER,
    K_UMTS_NCELL_MEAS,
    K_UMTS_SEL_RESEL_INFO,
    K_GSM_SCELL_INFO,
    K_GSM_IDLE_CONFIG,
    K_GSM_CS_RF_MEAS,
    K_GSM_IDLE_SCELL_MEAS,
    K_GSM_NCELL_MEAS,
    K_GSM_GPRS_CONFIG,
    K_SIM_FILE_INFO,
    K_LTE_RRC_STATE + 1,
    K_LTE_RRC_STATE >> 16,
    K_LTE_RRC_STATE << 8,
    0,
    -1,
};

/// Everything that an event may change.
struct Stores {
  using Field = std::variant<Record, RecordList, Value>;

  std::vector<MetricValidator::LatestRecord> latest;
  std::vector<Field> fields;

  explicit Stores(const MetricValidator& intake) {
    for (const auto& [name, record] : kLatestRecords)
      latest.push_back(intake.*record);
    const auto add = [this](std::string_view, const auto& field) { fields.emplace_back(field); };
    visitFields(intake.myLTE, add);
    visitFields(intake.myUMTS, add);
    visitFields(intake.myGSM, add);
    visitFields(intake.myCommon, add);
  }

  friend bool operator==(const Stores&, const Stores&) = default;
};

bool haveSameKeys(const Dictionary& a, const Dictionary& b) {
  return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                    [](const Dictionary::Entry& x, const Dictionary::Entry& y) { return x.key == y.key; });
}

void checkEvent(ConnectedProgram& program, std::int64_t metricId, Payload payload) {
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
      require(record == before.latest[index], "an event leaves the records of other metrics as they were");
    }
  }
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

void checkRecordsAsJson(const MetricValidator& intake) {
  std::string json;
  for (const auto& [name, record] : kLatestRecords) {
    if (intake.*record) appendJson(json, *(intake.*record));
  }
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
  checkRecordsAsJson(*program.intake);
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
