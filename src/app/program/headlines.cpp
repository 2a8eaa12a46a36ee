#include "app/program/headlines.h"

#include <array>
#include <optional>
#include <utility>

#include "insight/readings.h"
#include "insight/umts_chain.h"
#include "screens/detail_text.h"
#include "values/text_form.h"

namespace vesk {

namespace {

struct Headline {
  std::string text;
  std::optional<double> value;
};

/// The RSCP of a receive chain of UMTS, which may have to be reckoned from two keys.
std::optional<Headline> headlineOfChain(const Record& chain) {
  const auto rscp = insight::umtsChainOf(chain).rscp;
  if (!rscp) return std::nullopt;
  return Headline{insight::levelReading(insight::kRscp, *rscp).text, *rscp};
}

/// What tells most about the records of a message class.
struct Telling {
  std::string_view messageClass;
  std::string_view key;
  /// What stands before the value; empty where the value's reading says it all, and stands in its place.
  std::string_view prefix{};
  /// Null where the key tells it.
  std::optional<Headline> (*reckon)(const Record& record) = nullptr;
};

constexpr std::array kTelling{
    Telling{"KCellularEmmContext", "reg_status"},
    Telling{"KCellularLteRrcState", "state"},
    Telling{"KCellularLteScellInfo", "phy_cell_id", "PCI "},
    Telling{"RsrpRsrqSinr", "rsrp0"},
    Telling{"RsrpRsrqSinr", "rsrp1"},
    Telling{"TxPowerInfo", "pusch_tx_power"},
    Telling{"KCellularLteCdrxConfig", "cdrx_config_status"},
    Telling{"EgwErrcNbrEutraMeas", "nbr_rsrp"},
    Telling{"EgwErrcNbrUtraMeas", "rscp"},
    Telling{"EgwErrcNbrGeranMeas", "rxlev"},
    Telling{"SecondaryComponentCarrier", "state"},
    Telling{"KCellularGmmContext", "reg_status"},
    Telling{"KCellularMmContext", "reg_status"},
    Telling{"KCellularWcdmaRrcConnectionState", "state"},
    Telling{"KCellularWcdmaRrcConfiguration", "drx_cycle_length_ms"},
    Telling{"KCellularWcdmaCellInfo", "psc", "PSC "},
    Telling{.messageClass = "RxInfo", .key = {}, .reckon = headlineOfChain},
    Telling{"LteCellMeasResult", "rsrp"},
    Telling{"UtraCellMeasResult", "rscp"},
    Telling{"GsmCellMeasResult", "rxlev"},
    Telling{"KCellularGsmScellInfo", "arfcn", "ARFCN "},
    Telling{"KCellularGsmIdleConfig", "rx_acc_min"},
    Telling{"KCellularGsmIdleScellMeasurement", "idle_rxlev_dBm"},
    Telling{"KCellularGsmCsRfMeasurement", "cs_rxlev_sub"},
    Telling{"KCellularGsmGprsConfig", "nom"},
    Telling{"GsmNcellMeas", "rxlev"},
    Telling{"UmtsNcellMeas", "cpich_rscp"},
    Telling{"LteNcellMeas", "rsrp"},
};

std::optional<Headline> headlineOf(const Telling& telling, const Record& record) {
  if (telling.reckon != nullptr) return telling.reckon(record);
  for (const Dictionary::Entry& entry : record) {
    if (entry.key.view() != telling.key) continue;
    if (!telling.prefix.empty()) {
      return Headline{std::string(telling.prefix) + std::string(detailTextOf(entry.value).view()), std::nullopt};
    }
    if (auto reading = insight::readingOf(telling.messageClass, record, entry))
      return Headline{std::move(reading->text), reading->value};
    return Headline{std::string(detailTextOf(entry.value).view()), std::nullopt};
  }
  return std::nullopt;
}

}  // namespace

std::string headlineOf(const CategorySource& source, const Stores& stores) {
  const RecordList records = shownRecords(source, stores);
  const std::string_view messageClass = messageClassOf(source);
  std::optional<Headline> greatest;
  for (const Telling& telling : kTelling) {
    if (telling.messageClass != messageClass) continue;
    for (const Record& record : records) {
      auto headline = headlineOf(telling, record);
      if (headline && (!greatest || headline->value > greatest->value)) greatest = std::move(headline);
    }
  }
  if (greatest) return greatest->text;
  if (source.kind != SourceKind::storeList || records.size() == 0) return {};
  return counted(records.size(), "entry", "entries");
}

std::string readingOfRow(const CategorySource& source, const Stores& stores, IndexPath at, std::string_view name) {
  const RecordList records = shownRecords(source, stores);
  if (at.section >= records.size()) return {};
  const Record& record = records[at.section];
  if (at.row >= record.size()) return {};
  const Dictionary::Entry& entry = record.begin()[at.row];
  if (entry.key.view() != name) return {};
  const auto reading = insight::readingOf(messageClassOf(source), record, entry);
  return reading ? reading->text : std::string();
}

}  // namespace vesk
