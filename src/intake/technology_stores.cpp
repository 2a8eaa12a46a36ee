#include "intake/technology_stores.h"

namespace vesk {

RecordList waitingForUpdate() {
  RecordList list;
  list.append(Record{{"Waiting for Update"_text, "Waiting for Update"_text}});
  return list;
}

Record LTE::initialSelReselCellInfo() {
  return {
      {"timestamp"_text, ""_text},
      {"ims_emergency_support"_text, ""_text},
      {"ac_barring_for_emergency"_text, ""_text},
      {"mo_signalling_ac_barring_factor"_text, ""_text},
      {"mo_signalling_ac_barring_time"_text, ""_text},
      {"mo_signalling_ac_barring_for_special_ac"_text, ""_text},
      {"mo_data_ac_barring_factor"_text, ""_text},
      {"mo_data_ac_barring_time"_text, ""_text},
      {"mo_data_ac_barring_for_special_ac"_text, ""_text},
      {"QRxLevMin"_text, ""_text},
      {"QQualMin"_text, ""_text},
      {"Q_hyst"_text, ""_text},
      {"S_non_intra_search_P"_text, ""_text},
      {"S_non_intra_search_Q"_text, ""_text},
      {"S_intra_search_P"_text, ""_text},
      {"S_intra_search_Q"_text, ""_text},
      {"Thresh_serving_lowP"_text, ""_text},
      {"Thresh_serving_lowQ"_text, ""_text},
      {"priority_operating_freq"_text, ""_text},
      {"multi_band_info"_text, ""_text},
  };
}

Record UMTS::initialSelReselCellInfo() {
  return {
      {"timestamp"_text, ""_text},
      {"ims_emergency_support"_text, ""_text},
      {"hsdpa_capable"_text, ""_text},
      {"edch_capable"_text, ""_text},
      {"duplex_mode"_text, ""_text},
      {"cell_barred"_text, ""_text},
      {"fach_meas_occ_info_present"_text, ""_text},
      {"s_rxlev"_text, ""_text},
      {"s_qual"_text, ""_text},
      {"s_intrasearch"_text, ""_text},
      {"s_intersearch"_text, ""_text},
      {"s_search_rat"_text, ""_text},
      {"s_cell_prio"_text, ""_text},
      {"multi_band_info"_text, ""_text},
  };
}

}  // namespace vesk
