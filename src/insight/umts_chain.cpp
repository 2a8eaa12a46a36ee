#include "insight/umts_chain.h"

#include "insight/report_fields.h"

namespace vesk::insight {

UmtsChain umtsChainOf(const Dictionary& record) {
  OrderedLookup fields(record);
  UmtsChain chain{std::nullopt, decodedLevel(kEcNo, fields.find("rsrq_range"_text), 0.5, -24.5),
                  levelOf(kRssi, fields, "rssi"_text)};
  if (const Value* code = fields.find("rsrp_range"_text)) {
    chain.rscp = decodedLevel(kRscp, code, 1, -116);
  } else if (chain.rssi && chain.ecNo && isPossible(kRscp, *chain.rssi + *chain.ecNo)) {
    chain.rscp = *chain.rssi + *chain.ecNo;
  }
  return chain;
}

}  // namespace vesk::insight
