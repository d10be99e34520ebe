#include "tools/vespctl/RecordScreens.h"

#include <algorithm>
#include <array>

#include "sources/diag/GsmSystemInformation.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/NasRecords.h"
#include "sources/diag/NrRecords.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::tools {
namespace {

using namespace sources::diag;

template <std::size_t Count>
using Keys = std::array<std::string_view, Count>;

constexpr Keys<10> lteRrc = {"LTE RRC State",
                             "LTE Serving Cell Info",
                             "LTE Serving Cell Meas",
                             "LTE Sel Resel Parameters",
                             "LTE EUTRA Neighbor Info",
                             "LTE C-DRX",
                             "LTE LTE Neighbor Cell Meas",
                             "LTE UMTS Neighbor Cell Meas",
                             "LTE GSM Neighbor Cell Meas",
                             "LTE CA Status"};
constexpr Keys<1> lteCell = {"LTE Serving Cell Info"};
constexpr Keys<3> lteLevels = {"LTE Serving Cell Meas", "LTE CA Status", "LTE Serving Cell Info"};
constexpr Keys<2> lteCarrier = {"LTE LTE Neighbor Cell Meas", "LTE Serving Cell Meas"};
constexpr Keys<1> lteNeighbours = {"LTE LTE Neighbor Cell Meas"};
constexpr Keys<1> lteState = {"LTE NAS"};
constexpr Keys<3> bearers = {"LTE Active Bearers", "UMTS Active Bearers", "GSM Active Bearers"};
constexpr Keys<6> registration = {"LTE NAS",     "LTE Active Bearers", "UMTS Active Bearers", "GSM Active Bearers",
                                  "UMTS NAS MM", "GSM NAS MM"};
constexpr Keys<1> umtsCell = {"UMTS Serving Cell Info"};
constexpr Keys<8> umtsRrc = {
    "UMTS RRC State", "UMTS Serving Cell Info", "UMTS NAS GMM",      "UMTS NAS MM", "GSM NAS GMM",
    "GSM NAS MM",     "UMTS Active Bearers",    "GSM Active Bearers"};
constexpr Keys<2> gsmMessages = {"GSM Serving Cell Info", "GSM Idle Config"};
constexpr Keys<2> packetState = {"UMTS NAS GMM", "GSM NAS GMM"};
constexpr Keys<2> circuitState = {"UMTS NAS MM", "GSM NAS MM"};
constexpr Keys<7> gprs = {"UMTS NAS GMM",       "UMTS NAS MM",         "GSM NAS GMM",       "GSM NAS MM",
                          "LTE Active Bearers", "UMTS Active Bearers", "GSM Active Bearers"};

constexpr auto rows = std::to_array<RecordScreens>({
    {wcdmaCellCode, "cells of UMTS", "cells", umtsCell},
    {wcdmaRrcCode, "RRC messages of UMTS", "RRC messages", umtsRrc},
    {gsmMessageCode, "RR messages of GSM", "RR messages", gsmMessages},
    {gmmStateCode, "states of the packet registration", "NAS", packetState},
    {mmStateCode, "states of the circuit registration", "NAS", circuitState},
    {gmmRegistrationCode, "packet registrations", "NAS", packetState},
    {gprsMessageCode, "NAS messages of UMTS and GSM", "NAS", gprs},
    {rrcMessageCode, "RRC messages of LTE", "RRC messages", lteRrc},
    {servingCellCode, "serving cells of LTE", "cells", lteCell},
    {securedEsmInCode, "session messages of LTE as received", "NAS", bearers},
    {securedEsmOutCode, "session messages of LTE as sent", "NAS", bearers},
    {esmMessageInCode, "session messages of LTE received", "NAS", bearers},
    {esmMessageOutCode, "session messages of LTE sent", "NAS", bearers},
    {bearerStateCode, "bearer states of LTE", "NAS", bearers},
    {securedEmmInCode, "registration messages of LTE as received", "NAS", registration},
    {securedEmmOutCode, "registration messages of LTE as sent", "NAS", registration},
    {emmMessageInCode, "registration messages of LTE received", "NAS", registration},
    {emmMessageOutCode, "registration messages of LTE sent", "NAS", registration},
    {emmStateCode, "registration states of LTE", "NAS", lteState},
    {neighbourMeasurementCode, "levels of LTE by carrier", "levels", lteCarrier},
    {idleNeighboursCode, "neighbour levels of LTE in idle mode", "levels", lteNeighbours},
    {servingMeasurementCode, "levels of the LTE serving cells", "levels", lteLevels},
    {connectedNeighboursCode, "neighbour levels of LTE while connected", "levels", lteNeighbours},
    {nrRrcMessageCode, "RRC messages of NR", "RRC messages", {}},
});

static_assert(std::is_sorted(rows.begin(), rows.end(),
                             [](const auto& left, const auto& right) { return left.code < right.code; }));

}  // namespace

std::span<const RecordScreens> recordScreens() { return rows; }

const RecordScreens* findRecordScreens(std::uint16_t code) {
  const auto found = std::find_if(rows.begin(), rows.end(), [code](const auto& row) { return row.code == code; });
  return found == rows.end() ? nullptr : &*found;
}

std::string_view technologyOf(std::uint16_t code) {
  if (code >= 0xB800 && code <= 0xB9FF) return "NR";
  switch (code >> 12U) {
    case 0x4:
      return "UMTS";
    case 0x5:
      return "GSM";
    case 0x7:
      return "UMTS and GSM";
    case 0xB:
      return "LTE";
    default:
      return {};
  }
}

}  // namespace vespscope::tools
