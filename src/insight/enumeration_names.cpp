#include "insight/enumeration_names.h"

#include <algorithm>
#include <array>
#include <limits>
#include <unordered_map>

#include "messages/nas/nas.h"
#include "messages/shared/sys_band.h"

namespace vesk::insight {

namespace {

/// No prefix begins another one's names. The last is that of the circuit-switched update status only.
constexpr std::array<std::string_view, 19> kPrefixes{
    "KLTE_RRC_STATE_",
    "KLTE_RRC_CAUSE_",
    "SCC_STATE_",
    "KREG_STATUS_",
    "EMM_PROC_",
    "EMM_CAUSE_",
    "KNAS_MM_REG_PROC_",
    "KNAS_MM_PROC_FAILURE_CAUSE_",
    "KNAS_MM_REJ_CAUSE_",
    "PDP_TYPE_",
    "EPS_STATUS_",
    "GPRS_STATUS_",
    "EPS_UE_OP_MODE_",
    "KWCDMA_RRC_CONN_STATE_",
    "KRRC_EST_",
    "KRRC_REL_",
    "SYS_HS_IND_",
    "SYS_BAND_",
    "STATUS_",
};

using CodesByName = std::unordered_map<std::string_view, std::int32_t>;

/// The names are literals: they outlive the texts that lead to them.
template <class Cause>
void addCauses(CodesByName& codes) {
  constexpr std::int32_t kLastCode = 255;
  for (std::int32_t code = 0; code <= kLastCode; ++code) {
    const Text name = nameOf(static_cast<Cause>(code));
    if (!isUnknownName(name.view())) codes.emplace(name.view(), code);
  }
}

CodesByName causes() {
  CodesByName codes;
  addCauses<metrics::EmmCause>(codes);
  addCauses<metrics::NasMmRejectCause>(codes);
  return codes;
}

}  // namespace

std::string_view shortName(std::string_view name) {
  const auto* prefix =
      std::find_if(kPrefixes.begin(), kPrefixes.end(), [&](std::string_view each) { return name.starts_with(each); });
  return prefix == kPrefixes.end() ? name : name.substr(prefix->size());
}

std::string withBlanks(std::string_view name) {
  std::string out(name);
  std::replace(out.begin(), out.end(), '_', ' ');
  return out;
}

bool isUnknownName(std::string_view name) {
  return name.starts_with("(unknown: ");
}

std::optional<std::int32_t> causeCode(std::string_view name) {
  static const CodesByName kCauses = causes();
  const auto found = kCauses.find(name);
  return found == kCauses.end() ? std::nullopt : std::optional(found->second);
}

std::optional<std::string_view> bandName(std::int64_t number) {
  if (number < 0 || number > std::numeric_limits<std::int32_t>::max()) return std::nullopt;
  const Text name = nameOf(static_cast<metrics::SysBand>(number));
  // The name of a band is a literal, and outlives the text.
  return isUnknownName(name.view()) ? std::nullopt : std::optional(name.view());
}

}  // namespace vesk::insight
