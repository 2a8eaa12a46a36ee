#include "insight/cause_counts.h"

#include "insight/enumeration_names.h"

namespace vesk::insight {

void CauseCounts::add(const std::optional<Text>& cause) {
  ++total_;
  const std::string_view name = cause ? shortName(cause->view()) : "NONE";
  const auto found = byCause_.find(name);
  if (found != byCause_.end()) {
    ++found->second;
  } else if (byCause_.size() < kMostCauses) {
    byCause_.emplace(name, 1);
  }
}

}  // namespace vesk::insight
