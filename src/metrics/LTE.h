// The latest LTE lists and reselection parameters, as the screens show them.
#pragma once

#include "metrics/Placeholder.h"
#include "values/Value.h"

namespace vespscope {

struct LTE {
  // Cell reselection parameters (3GPP TS 36.304 5.2.4). The keys are chosen here, every value empty until the first
  // event; a key that an event lacks leaves the record for good.
  Record SelReselCellInfo = {
      {"timestamp", ""},
      {"ims_emergency_support", ""},
      {"ac_barring_for_emergency", ""},
      {"mo_signalling_ac_barring_factor", ""},
      {"mo_signalling_ac_barring_time", ""},
      {"mo_signalling_ac_barring_for_special_ac", ""},
      {"mo_data_ac_barring_factor", ""},
      {"mo_data_ac_barring_time", ""},
      {"mo_data_ac_barring_for_special_ac", ""},
      {"QRxLevMin", ""},
      {"QQualMin", ""},
      {"S_non_intra_search_P", ""},
      {"S_non_intra_search_Q", ""},
      {"S_intra_search_P", ""},
      {"S_intra_search_Q", ""},
      {"Thresh_serving_lowP", ""},
      {"Thresh_serving_lowQ", ""},
      {"priority_operating_freq", ""},
  };
  RecordList EutraNbrs = waitingForUpdate();  // neighbour frequencies that may be reselected
  RecordList RsrpRsrqSinr = waitingForUpdate();
  RecordList TxPower = waitingForUpdate();
  RecordList EutraNbrsMeas = waitingForUpdate();  // measured neighbour cells, one list per technology
  RecordList UtraNbrsMeas = waitingForUpdate();
  RecordList GeraNbrsMeas = waitingForUpdate();
  RecordList CAStatusList = waitingForUpdate();  // secondary component carriers
  RecordList MMCommonInfo = waitingForUpdate();
  Value IMSI = "Come Back Later";
};

}  // namespace vespscope
