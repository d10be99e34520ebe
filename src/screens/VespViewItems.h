// The catalogue: the screens and their order. A row's text is also the key of the screen that it opens.
#pragma once

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace vespscope {

struct VespViewItems {
  using Rows = std::vector<std::string>;

  // The process-wide catalogue, made on first use; safe from any thread.
  static const VespViewItems& shared();

  const Rows launchViewItemNames = {"Device Info", "LTE", "UMTS", "GSM"};
  // Maps a launch row's text to its first-level rows.
  const std::map<std::string, Rows> firstLevelViewItems = dictionaryOf({
      {"Device Info", {"IMSI", "IMEISV", "SIM Files"}},
      {"LTE",
       {"NAS", "RRC State", "Serving Cell Info", "Serving Cell Meas", "Tx Power", "Sel Resel Parameters",
        "EUTRA Neighbor Info", "C-DRX", "LTE Neighbor Cell Meas", "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas",
        "CA Status", "Active Bearers"}},
      {"UMTS",
       {"NAS GMM", "NAS MM", "RRC State", "RRC Configuration", "Serving Cell Info", "Serving Cell Meas", "Tx Power",
        "Sel Resel Parameters", "EUTRA Neighbor Info", "UTRA Neighbor Info", "GSM Neighbor Info",
        "LTE Neighbor Cell Meas", "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "Active Bearers"}},
      {"GSM",
       {"NAS GMM", "NAS MM", "Serving Cell Info", "Idle Config", "Idle Serv Cell Meas", "Connected Serv Cell Meas",
        "GSM GPRS Config", "LTE Neighbor Cell Meas", "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas",
        "Active Bearers"}},
  });

  // A duplicate key is a programming error.
  [[nodiscard]] static std::map<std::string, Rows> dictionaryOf(std::vector<std::pair<std::string, Rows>> pairs);
};

}  // namespace vespscope
