#include "screens/vesk_view_items.h"

namespace vesk {

VeskViewItems::VeskViewItems()
    : launchViewItemNames{"Device Info"_text, "LTE"_text, "UMTS"_text, "GSM"_text},
      firstLevelViewItems{
          {"Device Info",
           {
               "IMSI"_text,
               "IMEISV"_text,
               "SIM Files"_text,
           }},
          {"LTE",
           {
               "NAS"_text,
               "RRC State"_text,
               "Serving Cell Info"_text,
               "Serving Cell Meas"_text,
               "Tx Power"_text,
               "Sel Resel Parameters"_text,
               "EUTRA Neighbor Info"_text,
               "C-DRX"_text,
               "LTE Neighbor Cell Meas"_text,
               "UMTS Neighbor Cell Meas"_text,
               "GSM Neighbor Cell Meas"_text,
               "CA Status"_text,
               "Active Bearers"_text,
           }},
          {"UMTS",
           {
               "NAS GMM"_text,
               "NAS MM"_text,
               "RRC State"_text,
               "RRC Configuration"_text,
               "Serving Cell Info"_text,
               "Serving Cell Meas"_text,
               "Tx Power"_text,
               "Sel Resel Parameters"_text,
               "EUTRA Neighbor Info"_text,
               "UTRA Neighbor Info"_text,
               "GSM Neighbor Info"_text,
               "LTE Neighbor Cell Meas"_text,
               "UMTS Neighbor Cell Meas"_text,
               "GSM Neighbor Cell Meas"_text,
               "Active Bearers"_text,
           }},
          {"GSM",
           {
               "NAS GMM"_text,
               "NAS MM"_text,
               "Serving Cell Info"_text,
               "Idle Config"_text,
               "Idle Serv Cell Meas"_text,
               "Connected Serv Cell Meas"_text,
               "GSM GPRS Config"_text,
               "LTE Neighbor Cell Meas"_text,
               "UMTS Neighbor Cell Meas"_text,
               "GSM Neighbor Cell Meas"_text,
               "Active Bearers"_text,
           }},
      } {}

const std::vector<Text>& VeskViewItems::categoriesOf(std::string_view area) const {
  static const std::vector<Text> kNone;
  const auto found = firstLevelViewItems.find(area);
  return found == firstLevelViewItems.end() ? kNone : found->second;
}

const VeskViewItems& VeskViewItems::shared() {
  static const VeskViewItems theItems;
  return theItems;
}

}  // namespace vesk
