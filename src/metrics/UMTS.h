// The latest UMTS lists and reselection parameters, as the screens show them.
#pragma once

#include "metrics/Placeholder.h"
#include "values/Value.h"

namespace vespscope {

struct UMTS {
  RecordList rXInfo = waitingForUpdate();
  RecordList TxPower = waitingForUpdate();
  // Cell reselection parameters (3GPP TS 25.304 5.2.6). The keys are chosen here, every value empty until the first
  // event; a key that an event lacks leaves the record for good.
  Record SelReselCellInfo = {
      {"ims_emergency_support", ""},
      {"hsdpa_capable", ""},
      {"edch_capable", ""},
      {"duplex_mode", ""},
      {"cell_barred", ""},
      {"fach_meas_occ_info_present", ""},
      {"s_rxlev", ""},
      {"s_qual", ""},
      {"s_intrasearch", ""},
      {"s_intersearch", ""},
  };
  RecordList eUtraNbrs = waitingForUpdate();  // LTE frequencies with their reselection priorities
  RecordList utraNbrs = waitingForUpdate();
  RecordList geraNbrs = waitingForUpdate();
  RecordList eUtraNbrMeas = waitingForUpdate();  // measured neighbour cells, one list per technology
  RecordList utraNbrMeas = waitingForUpdate();
  RecordList geraNbrMeas = waitingForUpdate();
};

}  // namespace vespscope
