#pragma once

#include <variant>
#include <vector>

#include "intake/metric_validator.h"

namespace vesk {

/// Everything that an event may change.
struct Stores {
  explicit Stores(const MetricValidator& intake)
      : lte(intake.myLTE), umts(intake.myUMTS), gsm(intake.myGSM), common(intake.myCommon) {
    for (const auto& [name, record] : kLatestRecords)
      records.push_back(intake.*record);
  }

  void putInto(MetricValidator& intake) const {
    intake.myLTE = lte;
    intake.myUMTS = umts;
    intake.myGSM = gsm;
    intake.myCommon = common;
    for (std::size_t index = 0; index < records.size(); ++index)
      intake.*kLatestRecords[index].second = records[index];
  }

  friend bool operator==(const Stores& a, const Stores& b) {
    return a.records == b.records && a.fields() == b.fields();
  }

  LTE lte;
  UMTS umts;
  GSM gsm;
  Common common;
  std::vector<MetricValidator::LatestRecord> records;

 private:
  using Field = std::variant<Record, RecordList, Value>;

  [[nodiscard]] std::vector<Field> fields() const {
    std::vector<Field> all;
    const auto add = [&all](std::string_view, const auto& field) { all.emplace_back(field); };
    visitFields(lte, add);
    visitFields(umts, add);
    visitFields(gsm, add);
    visitFields(common, add);
    return all;
  }
};

}  // namespace vesk
