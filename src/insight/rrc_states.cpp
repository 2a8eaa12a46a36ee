#include "insight/rrc_states.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "insight/enumeration_names.h"

namespace vesk::insight {

namespace {

struct StateClass {
  Technology technology;
  Text state;
  RrcClass meaning;
};

// clang-format off
const std::array kStates{
    StateClass{Technology::lte, "KLTE_RRC_STATE_CONNECTED"_text, RrcClass::connected},
    StateClass{Technology::lte, "KLTE_RRC_STATE_IDLE"_text, RrcClass::idle},
    StateClass{Technology::lte, "KLTE_RRC_STATE_ATMPT_CONNECTION"_text, RrcClass::attempt},
    StateClass{Technology::lte, "KLTE_RRC_STATE_NULL"_text, RrcClass::idle},
    StateClass{Technology::lte, "KLTE_RRC_STATE_ENDING"_text, RrcClass::connected},
    StateClass{Technology::lte, "KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY"_text, RrcClass::connected},
    StateClass{Technology::lte, "KLTE_RRC_STATE_ATMPT_INBND_MOBILITY"_text, RrcClass::connected},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_INVALID"_text, RrcClass::idle},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_INACTIVE"_text, RrcClass::idle},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_IDLE"_text, RrcClass::idle},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_RELEASE"_text, RrcClass::idle},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE"_text, RrcClass::idle},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_ESTABLISH"_text, RrcClass::attempt},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_URA_PCH"_text, RrcClass::connected},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_CELL_PCH"_text, RrcClass::connected},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_CELL_FACH"_text, RrcClass::connected},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_CELL_DCH"_text, RrcClass::connected},
    StateClass{Technology::umts, "KWCDMA_RRC_CONN_STATE_SCRI_SENT"_text, RrcClass::connected},
    StateClass{Technology::gsm, "NON_DEDICATED_STATE"_text, RrcClass::idle},
    StateClass{Technology::gsm, "DEDICATED_STATE"_text, RrcClass::connected},
};
// clang-format on

/// A prefix stands for all causes that begin with it.
constexpr std::array<std::string_view, 6> kLteDrops{
    "REL_OTHER_RECFG_FAIL", "REL_CONN_FAIL_", "REL_T310_EXP", "REL_RND_ACC", "REL_MAX_RLC_RETRANS", "NO_SERVICE",
};
constexpr std::array<std::string_view, 4> kUmtsDrops{
    "RELEASE_OOSA",
    "CONN_REL_LOWER_LAYER_FAILURE_DL",
    "CONN_REL_LOWER_LAYER_FAILURE_UL",
    "HO_FROM_UTRAN_REVERT_BACK_SYNC_FAIL",
};

bool isOneOf(std::string_view name, const auto& prefixes) {
  return std::any_of(prefixes.begin(), prefixes.end(),
                     [name](std::string_view prefix) { return name.starts_with(prefix); });
}

}  // namespace

std::optional<RrcClass> rrcClassOf(Technology technology, const Text& state) {
  const auto* found = std::find_if(kStates.begin(), kStates.end(), [&](const StateClass& each) {
    return each.technology == technology && each.state == state;
  });
  return found == kStates.end() ? std::nullopt : std::optional(found->meaning);
}

std::optional<AttemptKind> attemptKindOf(const std::optional<Text>& cause) {
  if (!cause) return std::nullopt;
  const std::string_view name = shortName(cause->view());
  if (name.starts_with("REEST_")) return AttemptKind::reestablishment;
  return name.starts_with("EST_") ? std::optional(AttemptKind::setUp) : std::nullopt;
}

bool isDrop(Technology technology, const Text& state, const std::optional<Text>& cause) {
  const std::string_view name = cause ? shortName(cause->view()) : std::string_view{};
  switch (technology) {
    case Technology::lte:
      return isOneOf(name, kLteDrops);
    case Technology::umts:
      return state == "KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE"_text || isOneOf(name, kUmtsDrops);
    case Technology::gsm:
      break;
  }
  return false;
}

}  // namespace vesk::insight
