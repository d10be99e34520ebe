// What the serving GSM cell broadcasts for idle mode; flags are numbers (3GPP TS 44.018, system information).
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularGsmIdleConfig final : public Message<KCellularGsmIdleConfig> {
 public:
  static constexpr std::string_view className = "KCellularGsmIdleConfig";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t arfcnBcch() const noexcept { return _arfcnBcch; }
  void setArfcnBcch(std::uint32_t arfcnBcch) noexcept {
    _arfcnBcch = arfcnBcch;
    _has.set(3);
  }
  void setHasArfcnBcch(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasArfcnBcch() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t mcc() const noexcept { return _mcc; }
  void setMcc(std::uint32_t mcc) noexcept {
    _mcc = mcc;
    _has.set(21);
  }
  void setHasMcc(bool present) noexcept { _has.set(21, present); }
  [[nodiscard]] bool hasMcc() const noexcept { return _has.test(21); }

  [[nodiscard]] std::uint32_t mnc() const noexcept { return _mnc; }
  void setMnc(std::uint32_t mnc) noexcept {
    _mnc = mnc;
    _has.set(22);
  }
  void setHasMnc(bool present) noexcept { _has.set(22, present); }
  [[nodiscard]] bool hasMnc() const noexcept { return _has.test(22); }

  [[nodiscard]] std::uint32_t lac() const noexcept { return _lac; }
  void setLac(std::uint32_t lac) noexcept {
    _lac = lac;
    _has.set(19);
  }
  void setHasLac(bool present) noexcept { _has.set(19, present); }
  [[nodiscard]] bool hasLac() const noexcept { return _has.test(19); }

  [[nodiscard]] std::uint32_t ci() const noexcept { return _ci; }
  void setCi(std::uint32_t ci) noexcept {
    _ci = ci;
    _has.set(11);
  }
  void setHasCi(bool present) noexcept { _has.set(11, present); }
  [[nodiscard]] bool hasCi() const noexcept { return _has.test(11); }

  [[nodiscard]] std::uint32_t bsic() const noexcept { return _bsic; }
  void setBsic(std::uint32_t bsic) noexcept {
    _bsic = bsic;
    _has.set(6);
  }
  void setHasBsic(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasBsic() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t dtxFromBs() const noexcept { return _dtxFromBs; }
  void setDtxFromBs(std::uint32_t dtxFromBs) noexcept {
    _dtxFromBs = dtxFromBs;
    _has.set(14);
  }
  void setHasDtxFromBs(bool present) noexcept { _has.set(14, present); }
  [[nodiscard]] bool hasDtxFromBs() const noexcept { return _has.test(14); }

  [[nodiscard]] std::uint32_t radioLinkTimeout() const noexcept { return _radioLinkTimeout; }
  void setRadioLinkTimeout(std::uint32_t radioLinkTimeout) noexcept {
    _radioLinkTimeout = radioLinkTimeout;
    _has.set(26);
  }
  void setHasRadioLinkTimeout(bool present) noexcept { _has.set(26, present); }
  [[nodiscard]] bool hasRadioLinkTimeout() const noexcept { return _has.test(26); }

  [[nodiscard]] std::uint32_t multibRep() const noexcept { return _multibRep; }
  void setMultibRep(std::uint32_t multibRep) noexcept {
    _multibRep = multibRep;
    _has.set(24);
  }
  void setHasMultibRep(bool present) noexcept { _has.set(24, present); }
  [[nodiscard]] bool hasMultibRep() const noexcept { return _has.test(24); }

  [[nodiscard]] std::uint32_t gsmBand() const noexcept { return _gsmBand; }
  void setGsmBand(std::uint32_t gsmBand) noexcept {
    _gsmBand = gsmBand;
    _has.set(17);
  }
  void setHasGsmBand(bool present) noexcept { _has.set(17, present); }
  [[nodiscard]] bool hasGsmBand() const noexcept { return _has.test(17); }

  [[nodiscard]] std::uint32_t accessTech() const noexcept { return _accessTech; }
  void setAccessTech(std::uint32_t accessTech) noexcept {
    _accessTech = accessTech;
    _has.set(2);
  }
  void setHasAccessTech(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasAccessTech() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t typeOfCurChan() const noexcept { return _typeOfCurChan; }
  void setTypeOfCurChan(std::uint32_t typeOfCurChan) noexcept {
    _typeOfCurChan = typeOfCurChan;
    _has.set(33);
  }
  void setHasTypeOfCurChan(bool present) noexcept { _has.set(33, present); }
  [[nodiscard]] bool hasTypeOfCurChan() const noexcept { return _has.test(33); }

  [[nodiscard]] std::uint32_t msTxpwr() const noexcept { return _msTxpwr; }
  void setMsTxpwr(std::uint32_t msTxpwr) noexcept {
    _msTxpwr = msTxpwr;
    _has.set(23);
  }
  void setHasMsTxpwr(bool present) noexcept { _has.set(23, present); }
  [[nodiscard]] bool hasMsTxpwr() const noexcept { return _has.test(23); }

  [[nodiscard]] std::uint32_t rxAccMin() const noexcept { return _rxAccMin; }
  void setRxAccMin(std::uint32_t rxAccMin) noexcept {
    _rxAccMin = rxAccMin;
    _has.set(28);
  }
  void setHasRxAccMin(bool present) noexcept { _has.set(28, present); }
  [[nodiscard]] bool hasRxAccMin() const noexcept { return _has.test(28); }

  [[nodiscard]] std::uint32_t cbq() const noexcept { return _cbq; }
  void setCbq(std::uint32_t cbq) noexcept {
    _cbq = cbq;
    _has.set(10);
  }
  void setHasCbq(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasCbq() const noexcept { return _has.test(10); }

  [[nodiscard]] std::uint32_t cba() const noexcept { return _cba; }
  void setCba(std::uint32_t cba) noexcept {
    _cba = cba;
    _has.set(8);
  }
  void setHasCba(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasCba() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t c2Valid() const noexcept { return _c2Valid; }
  void setC2Valid(std::uint32_t c2Valid) noexcept {
    _c2Valid = c2Valid;
    _has.set(7);
  }
  void setHasC2Valid(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasC2Valid() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t crOffset() const noexcept { return _crOffset; }
  void setCrOffset(std::uint32_t crOffset) noexcept {
    _crOffset = crOffset;
    _has.set(12);
  }
  void setHasCrOffset(bool present) noexcept { _has.set(12, present); }
  [[nodiscard]] bool hasCrOffset() const noexcept { return _has.test(12); }

  [[nodiscard]] std::uint32_t tmpOffset() const noexcept { return _tmpOffset; }
  void setTmpOffset(std::uint32_t tmpOffset) noexcept {
    _tmpOffset = tmpOffset;
    _has.set(32);
  }
  void setHasTmpOffset(bool present) noexcept { _has.set(32, present); }
  [[nodiscard]] bool hasTmpOffset() const noexcept { return _has.test(32); }

  [[nodiscard]] std::uint32_t penaltyT() const noexcept { return _penaltyT; }
  void setPenaltyT(std::uint32_t penaltyT) noexcept {
    _penaltyT = penaltyT;
    _has.set(25);
  }
  void setHasPenaltyT(bool present) noexcept { _has.set(25, present); }
  [[nodiscard]] bool hasPenaltyT() const noexcept { return _has.test(25); }

  [[nodiscard]] std::uint32_t t3212() const noexcept { return _t3212; }
  void setT3212(std::uint32_t t3212) noexcept {
    _t3212 = t3212;
    _has.set(31);
  }
  void setHasT3212(bool present) noexcept { _has.set(31, present); }
  [[nodiscard]] bool hasT3212() const noexcept { return _has.test(31); }

  [[nodiscard]] std::uint32_t acc() const noexcept { return _acc; }
  void setAcc(std::uint32_t acc) noexcept {
    _acc = acc;
    _has.set(1);
  }
  void setHasAcc(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasAcc() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t bsPaMfrms() const noexcept { return _bsPaMfrms; }
  void setBsPaMfrms(std::uint32_t bsPaMfrms) noexcept {
    _bsPaMfrms = bsPaMfrms;
    _has.set(5);
  }
  void setHasBsPaMfrms(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasBsPaMfrms() const noexcept { return _has.test(5); }

  [[nodiscard]] std::uint32_t csPagemode() const noexcept { return _csPagemode; }
  void setCsPagemode(std::uint32_t csPagemode) noexcept {
    _csPagemode = csPagemode;
    _has.set(13);
  }
  void setHasCsPagemode(bool present) noexcept { _has.set(13, present); }
  [[nodiscard]] bool hasCsPagemode() const noexcept { return _has.test(13); }

  [[nodiscard]] std::uint32_t maxRetransCs() const noexcept { return _maxRetransCs; }
  void setMaxRetransCs(std::uint32_t maxRetransCs) noexcept {
    _maxRetransCs = maxRetransCs;
    _has.set(20);
  }
  void setHasMaxRetransCs(bool present) noexcept { _has.set(20, present); }
  [[nodiscard]] bool hasMaxRetransCs() const noexcept { return _has.test(20); }

  [[nodiscard]] std::uint32_t emergCallAllowed() const noexcept { return _emergCallAllowed; }
  void setEmergCallAllowed(std::uint32_t emergCallAllowed) noexcept {
    _emergCallAllowed = emergCallAllowed;
    _has.set(16);
  }
  void setHasEmergCallAllowed(bool present) noexcept { _has.set(16, present); }
  [[nodiscard]] bool hasEmergCallAllowed() const noexcept { return _has.test(16); }

  [[nodiscard]] std::uint32_t attachAllowed() const noexcept { return _attachAllowed; }
  void setAttachAllowed(std::uint32_t attachAllowed) noexcept {
    _attachAllowed = attachAllowed;
    _has.set(4);
  }
  void setHasAttachAllowed(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasAttachAllowed() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t halfRateSupported() const noexcept { return _halfRateSupported; }
  void setHalfRateSupported(std::uint32_t halfRateSupported) noexcept {
    _halfRateSupported = halfRateSupported;
    _has.set(18);
  }
  void setHasHalfRateSupported(bool present) noexcept { _has.set(18, present); }
  [[nodiscard]] bool hasHalfRateSupported() const noexcept { return _has.test(18); }

  [[nodiscard]] std::uint32_t si78Broadcast() const noexcept { return _si78Broadcast; }
  void setSi78Broadcast(std::uint32_t si78Broadcast) noexcept {
    _si78Broadcast = si78Broadcast;
    _has.set(30);
  }
  void setHasSi78Broadcast(bool present) noexcept { _has.set(30, present); }
  [[nodiscard]] bool hasSi78Broadcast() const noexcept { return _has.test(30); }

  [[nodiscard]] std::uint32_t cbchSupported() const noexcept { return _cbchSupported; }
  void setCbchSupported(std::uint32_t cbchSupported) noexcept {
    _cbchSupported = cbchSupported;
    _has.set(9);
  }
  void setHasCbchSupported(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasCbchSupported() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t reestAllowed() const noexcept { return _reestAllowed; }
  void setReestAllowed(std::uint32_t reestAllowed) noexcept {
    _reestAllowed = reestAllowed;
    _has.set(27);
  }
  void setHasReestAllowed(bool present) noexcept { _has.set(27, present); }
  [[nodiscard]] bool hasReestAllowed() const noexcept { return _has.test(27); }

  [[nodiscard]] std::uint32_t ecsc() const noexcept { return _ecsc; }
  void setEcsc(std::uint32_t ecsc) noexcept {
    _ecsc = ecsc;
    _has.set(15);
  }
  void setHasEcsc(bool present) noexcept { _has.set(15, present); }
  [[nodiscard]] bool hasEcsc() const noexcept { return _has.test(15); }

  [[nodiscard]] std::uint32_t si2TerNeeded() const noexcept { return _si2TerNeeded; }
  void setSi2TerNeeded(std::uint32_t si2TerNeeded) noexcept {
    _si2TerNeeded = si2TerNeeded;
    _has.set(29);
  }
  void setHasSi2TerNeeded(bool present) noexcept { _has.set(29, present); }
  [[nodiscard]] bool hasSi2TerNeeded() const noexcept { return _has.test(29); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "arfcn_bcch", &Self::_arfcnBcch, 3),
        numberField<NumberKind::uint32>(3, "mcc", &Self::_mcc, 21),
        numberField<NumberKind::uint32>(4, "mnc", &Self::_mnc, 22),
        numberField<NumberKind::uint32>(5, "lac", &Self::_lac, 19),
        numberField<NumberKind::uint32>(6, "ci", &Self::_ci, 11),
        numberField<NumberKind::uint32>(7, "bsic", &Self::_bsic, 6),
        numberField<NumberKind::uint32>(8, "dtx_from_bs", &Self::_dtxFromBs, 14),
        numberField<NumberKind::uint32>(9, "radio_link_timeout", &Self::_radioLinkTimeout, 26),
        numberField<NumberKind::uint32>(10, "multib_rep", &Self::_multibRep, 24),
        numberField<NumberKind::uint32>(11, "gsm_band", &Self::_gsmBand, 17),
        numberField<NumberKind::uint32>(12, "access_tech", &Self::_accessTech, 2),
        numberField<NumberKind::uint32>(13, "type_of_cur_chan", &Self::_typeOfCurChan, 33),
        numberField<NumberKind::uint32>(14, "ms_txpwr", &Self::_msTxpwr, 23),
        numberField<NumberKind::uint32>(15, "rx_acc_min", &Self::_rxAccMin, 28),
        numberField<NumberKind::uint32>(16, "cbq", &Self::_cbq, 10),
        numberField<NumberKind::uint32>(17, "cba", &Self::_cba, 8),
        numberField<NumberKind::uint32>(18, "c2_valid", &Self::_c2Valid, 7),
        numberField<NumberKind::uint32>(19, "cr_offset", &Self::_crOffset, 12),
        numberField<NumberKind::uint32>(20, "tmp_offset", &Self::_tmpOffset, 32),
        numberField<NumberKind::uint32>(21, "penalty_t", &Self::_penaltyT, 25),
        numberField<NumberKind::uint32>(22, "t3212", &Self::_t3212, 31),
        numberField<NumberKind::uint32>(23, "acc", &Self::_acc, 1),
        numberField<NumberKind::uint32>(24, "bs_pa_mfrms", &Self::_bsPaMfrms, 5),
        numberField<NumberKind::uint32>(25, "cs_pagemode", &Self::_csPagemode, 13),
        numberField<NumberKind::uint32>(26, "max_retrans_cs", &Self::_maxRetransCs, 20),
        numberField<NumberKind::uint32>(27, "emerg_call_allowed", &Self::_emergCallAllowed, 16),
        numberField<NumberKind::uint32>(28, "attach_allowed", &Self::_attachAllowed, 4),
        numberField<NumberKind::uint32>(29, "half_rate_supported", &Self::_halfRateSupported, 18),
        numberField<NumberKind::uint32>(30, "si_7_8_broadcast", &Self::_si78Broadcast, 30),
        numberField<NumberKind::uint32>(31, "cbch_supported", &Self::_cbchSupported, 9),
        numberField<NumberKind::uint32>(32, "reest_allowed", &Self::_reestAllowed, 27),
        numberField<NumberKind::uint32>(33, "ecsc", &Self::_ecsc, 15),
        numberField<NumberKind::uint32>(34, "si_2_ter_needed", &Self::_si2TerNeeded, 29));
  }

 private:
  friend class Message<KCellularGsmIdleConfig>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _arfcnBcch = 0;
  std::uint32_t _mcc = 0;
  std::uint32_t _mnc = 0;
  std::uint32_t _lac = 0;
  std::uint32_t _ci = 0;
  std::uint32_t _bsic = 0;
  std::uint32_t _dtxFromBs = 0;
  std::uint32_t _radioLinkTimeout = 0;
  std::uint32_t _multibRep = 0;
  std::uint32_t _gsmBand = 0;
  std::uint32_t _accessTech = 0;
  std::uint32_t _typeOfCurChan = 0;
  std::uint32_t _msTxpwr = 0;
  std::uint32_t _rxAccMin = 0;
  std::uint32_t _cbq = 0;
  std::uint32_t _cba = 0;
  std::uint32_t _c2Valid = 0;
  std::uint32_t _crOffset = 0;
  std::uint32_t _tmpOffset = 0;
  std::uint32_t _penaltyT = 0;
  std::uint32_t _t3212 = 0;
  std::uint32_t _acc = 0;
  std::uint32_t _bsPaMfrms = 0;
  std::uint32_t _csPagemode = 0;
  std::uint32_t _maxRetransCs = 0;
  std::uint32_t _emergCallAllowed = 0;
  std::uint32_t _attachAllowed = 0;
  std::uint32_t _halfRateSupported = 0;
  std::uint32_t _si78Broadcast = 0;
  std::uint32_t _cbchSupported = 0;
  std::uint32_t _reestAllowed = 0;
  std::uint32_t _ecsc = 0;
  std::uint32_t _si2TerNeeded = 0;
  Presence<std::uint64_t> _has;
};

extern template class Message<KCellularGsmIdleConfig>;

}  // namespace vespscope
