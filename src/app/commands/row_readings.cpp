#include "app/commands/row_readings.h"

#include "insight/readings.h"
#include "intake/metric_validator.h"
#include "screens/category_sources.h"

namespace vesk {

std::optional<insight::Reading> readingOfRow(std::string_view area, std::string_view category, std::size_t section,
                                             std::size_t row) {
  const CategorySource& source = sourceOf(area, category);
  const RecordList records = shownRecords(source, MetricValidator::shared()->stores);
  if (section >= records.size() || row >= records[section].size()) return std::nullopt;
  const Record& record = records[section];
  return insight::readingOf(messageClassOf(source), record, record.begin()[row]);
}

}  // namespace vesk
