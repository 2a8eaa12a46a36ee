#pragma once

#include <cstdint>

#include "insight/report.h"
#include "intake/stores.h"

namespace vesk::insight {

/// Reads what the event just stored says: from its record, and from the lists that the intake made of it.
class ReportReader {
 public:
  /// The report is valid until the next one is read.
  const Report& read(std::int64_t metricId, const Dictionary& record, const Stores& stores);

 private:
  /// One for all events, so that lists keep their storage.
  Report report_;
};

}  // namespace vesk::insight
