#include "sources/scenario/GsmReports.h"

#include <algorithm>
#include <memory>

#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"
#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

constexpr std::int32_t band = SystemBand::SYS_BAND_GSM_PGSM_900;

// The activities of the physical layer, as numbers of the metrics.
constexpr std::uint32_t camped = 1;
constexpr std::uint32_t inDedicatedMode = 2;

}  // namespace

void GsmReports::servingCell(const Cell& cell, bool dedicated) {
  KCellularGsmScellInfo message;
  message.setMcc(mobileCountryCode);
  message.setMnc(mobileNetworkCode);
  message.setLac(map_.locationAreaCode(cell));
  message.setCellId(map_.geranCellId(cell));
  message.setGsmBand(band);
  message.setArfcn(map_.arfcn(cell));
  message.setBsic(map_.bsic(cell));
  message.setState(dedicated ? KCellularGsmScellInfo::State::DEDICATED_STATE
                             : KCellularGsmScellInfo::State::NON_DEDICATED_STATE);
  message.setNumMncDigits(networkCodeDigits);
  outbox_.send(metricIdentifier("K_GSM_SCELL_INFO"), message);
}

// System information 3 and 4 as raw codes, TS 44.018 9.1.35 and 10.5.2, TS 45.008 9.
void GsmReports::idleConfiguration(const Cell& cell) {
  KCellularGsmIdleConfig message;
  message.setArfcnBcch(map_.arfcn(cell));
  message.setMcc(mobileCountryCode);
  message.setMnc(mobileNetworkCode);
  message.setLac(map_.locationAreaCode(cell));
  message.setCi(map_.geranCellId(cell));
  message.setBsic(map_.bsic(cell));
  message.setDtxFromBs(1);         // uplink DTX: 0 may, 1 shall, 2 shall not be used
  message.setRadioLinkTimeout(5);  // 24 SACCH blocks: 4 * (code + 1)
  message.setMultibRep(0);
  message.setGsmBand(static_cast<std::uint32_t>(band));
  message.setAccessTech(0);     // GSM
  message.setTypeOfCurChan(1);  // BCCH with CCCH
  message.setMsTxpwr(5);        // 33 dBm
  message.setRxAccMin(6);       // -104 dBm
  message.setCbq(0);
  message.setCba(0);
  message.setC2Valid(1);
  message.setCrOffset(0);      // steps of 2 dB, 0..63
  message.setTmpOffset(1);     // 10 dB, 0..7
  message.setPenaltyT(2);      // 60 s: 20 s * (code + 1)
  message.setT3212(10);        // tenths of an hour
  message.setAcc(0);           // no access class barred
  message.setBsPaMfrms(2);     // 4 multiframes between pagings: code + 2
  message.setCsPagemode(0);    // normal paging
  message.setMaxRetransCs(2);  // 4 retransmissions
  message.setEmergCallAllowed(1);
  message.setAttachAllowed(1);
  message.setHalfRateSupported(1);
  message.setSi78Broadcast(0);
  message.setCbchSupported(0);
  message.setReestAllowed(1);
  message.setEcsc(1);  // early classmark sending
  message.setSi2TerNeeded(1);
  outbox_.send(metricIdentifier("K_GSM_IDLE_CONFIG"), message);
}

// System information 13 and the reselection parameters of packet mode, TS 44.018 10.5.2.37b, TS 44.060 12.24.
void GsmReports::gprsConfiguration(const Cell& cell) {
  KCellularGsmGprsConfig message;
  message.setGprsSup(true);
  message.setRac(map_.routingAreaCode(cell));
  message.setSpPgCy(true);
  message.setNco(0);     // the phone reselects autonomously
  message.setNom(0);     // network mode of operation I: combined registration
  message.setCrHyst(3);  // steps of 2 dB
  message.setAccThr(6);  // packet access for all priorities, 3..6
  message.setExtUplTbfSupported(true);
  message.setPriorityClass(0);
  message.setCellBarAccess2(0);
  outbox_.send(metricIdentifier("K_GSM_GPRS_CONFIG"), message);
}

void GsmReports::idleLevel(const GsmLevel& serving, std::uint32_t antenna) {
  KCellularGsmIdleScellMeasurement message;
  message.setScellArfcn(map_.arfcn(serving.cell));
  message.setSimplifiedL1State(camped);
  message.setCurrentAntenna(antenna);
  message.setIdleRxlevDBm(std::clamp(rounded(serving.rxlev), -110, -47));
  outbox_.send(metricIdentifier("K_GSM_IDLE_SCELL_MEAS"), message);
}

void GsmReports::callLevel(const GsmCallLevel& level) {
  KCellularGsmCsRfMeasurement message;
  message.setScellArfcn(map_.arfcn(level.cell));
  message.setSimplifiedL1State(inDedicatedMode);
  message.setCurrentAntenna(level.antenna);
  for (const int power : level.transmit) message.addCsTxPwr(power);
  message.setCsRxlevSub(radio::Rxlev::basicCode(level.rxlev));
  message.setCsRxqualSub(level.rxqual);
  message.setScellBand(static_cast<std::uint32_t>(band));
  outbox_.send(metricIdentifier("K_GSM_CS_RF_MEAS"), message);
}

void GsmReports::neighbours(const std::vector<GsmLevel>& gsm, const std::vector<UmtsLevel>& umts,
                            const std::vector<LteLevel>& lte) {
  KCellularGsmGrrEventMeasCr message;
  for (const GsmLevel& level : gsm) {
    auto cell = std::make_shared<GsmNcellMeas>();
    cell->setMcc(mobileCountryCode);
    cell->setMnc(mobileNetworkCode);
    cell->setLac(map_.locationAreaCode(level.cell));
    cell->setCi(map_.geranCellId(level.cell));
    cell->setBsic(map_.bsic(level.cell));
    cell->setArfcn(map_.arfcn(level.cell));
    cell->setRxlev(radio::Rxlev::basicCode(level.rxlev));
    message.addGsmNcellMeas(std::move(cell));
  }
  for (const UmtsLevel& level : umts) {
    auto cell = std::make_shared<UmtsNcellMeas>();
    cell->setCellType(0);  // FDD
    cell->setCpichSc(map_.scramblingCode(level.cell));
    cell->setDlUarfcn(layers[level.cell.layer].downlink);
    cell->setCpichRscp(radio::Rscp::basicCode(level.rscp));
    cell->setCpichEcn0(radio::Ecno::basicCode(level.ecno));
    message.addUmtsNcellMeas(std::move(cell));
  }
  for (const LteLevel& level : lte) {
    auto cell = std::make_shared<LteNcellMeas>();
    cell->setPhysicalCellId(map_.physicalCellId(level.cell));
    cell->setBandwidth(layers[level.cell.layer].bandwidthCode);
    cell->setRsrp(radio::Rsrp::basicCode(level.rsrp));
    cell->setEarfcn(layers[level.cell.layer].downlink);
    cell->setRsrq(radio::Rsrq::basicCode(level.rsrq));
    message.addLteNcellMeas(std::move(cell));
  }
  outbox_.send(metricIdentifier("K_GSM_NCELL_MEAS"), message);
}

}  // namespace vespscope::sources::scenario
