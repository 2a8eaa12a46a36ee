#include "intake/technology_stores.h"

namespace vesk {

namespace {

/// A record of fixed keys that no metric has filled yet.
Record emptyRecord(std::initializer_list<Text> keys) {
  Record record;
  record.reserve(keys.size());
  for (const Text& key : keys)
    record.append(key, ""_text);
  return record;
}

}  // namespace

RecordList waitingForUpdate() {
  RecordList list;
  list.append(Record{{"Waiting for Update"_text, "Waiting for Update"_text}});
  return list;
}

bool isWaitingForUpdate(const RecordList& list) {
  static const RecordList waiting = waitingForUpdate();
  return list.size() == 1 && list[0] == waiting[0];
}

Record LTE::initialSelReselCellInfo() {
  return emptyRecord({
      "timestamp"_text,
      "ims_emergency_support"_text,
      "ac_barring_for_emergency"_text,
      "mo_signalling_ac_barring_factor"_text,
      "mo_signalling_ac_barring_time"_text,
      "mo_signalling_ac_barring_for_special_ac"_text,
      "mo_data_ac_barring_factor"_text,
      "mo_data_ac_barring_time"_text,
      "mo_data_ac_barring_for_special_ac"_text,
      "QRxLevMin"_text,
      "QQualMin"_text,
      "Q_hyst"_text,
      "S_non_intra_search_P"_text,
      "S_non_intra_search_Q"_text,
      "S_intra_search_P"_text,
      "S_intra_search_Q"_text,
      "Thresh_serving_lowP"_text,
      "Thresh_serving_lowQ"_text,
      "priority_operating_freq"_text,
      "multi_band_info"_text,
  });
}

Record UMTS::initialSelReselCellInfo() {
  return emptyRecord({
      "timestamp"_text,
      "ims_emergency_support"_text,
      "hsdpa_capable"_text,
      "edch_capable"_text,
      "duplex_mode"_text,
      "cell_barred"_text,
      "fach_meas_occ_info_present"_text,
      "s_rxlev"_text,
      "s_qual"_text,
      "s_intrasearch"_text,
      "s_intersearch"_text,
      "s_search_rat"_text,
      "s_cell_prio"_text,
      "multi_band_info"_text,
  });
}

}  // namespace vesk
