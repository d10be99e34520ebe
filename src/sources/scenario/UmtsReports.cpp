#include "sources/scenario/UmtsReports.h"

#include <algorithm>
#include <memory>

#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"
#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

// Broadcast in system information block 3, TS 25.331 10.3.2.3.
constexpr int qualityMinimum = -18;      // dB, Qqualmin
constexpr int levelMinimum = -115;       // dBm, Qrxlevmin
constexpr std::int32_t intraSearch = 5;  // -16..10, in steps of 2 dB, like the two below
constexpr std::int32_t interSearch = 4;
constexpr std::int32_t searchRat = 2;
constexpr std::uint32_t firstGsmCarrier = 62;

std::int32_t bandOf(LayerIndex layer) {
  return layer == umts2100 ? SystemBand::SYS_BAND_WCDMA_I_IMT_2000 : SystemBand::SYS_BAND_WCDMA_VIII_900;
}

}  // namespace

void UmtsReports::rrc(UmtsRrc state, std::optional<UmtsEstablishment> establishment,
                      std::optional<UmtsRelease> release) {
  KCellularWcdmaRrcConnectionState message;
  message.setState(static_cast<std::int32_t>(state));
  if (establishment) message.setEstablishmentCause(static_cast<std::int32_t>(*establishment));
  if (release) message.setReleaseCause(static_cast<std::int32_t>(*release));
  outbox_.send(metricIdentifier("K_UMTS_RRC_STATE"), message);
}

void UmtsReports::configuration(Time drxCycle, bool dualCarrier) {
  KCellularWcdmaRrcConfiguration message;
  message.setDrxCycleLengthMs(static_cast<std::uint32_t>(drxCycle.count()));
  message.setIsMimoConfigured(false);
  message.setIsDcConfigured(dualCarrier);
  outbox_.send(metricIdentifier("K_UMTS_RRC_CONFIG"), message);
}

void UmtsReports::servingCell(const Cell& cell) {
  KCellularWcdmaCellInfo message;
  message.setMcc(mobileCountryCode);
  message.setMnc(mobileNetworkCode);
  message.setLac(map_.locationAreaCode(cell));
  message.setCellId(map_.utranCellId(cell));
  message.setWcdmaBand(bandOf(cell.layer));
  message.setDlUarfcn(layers[cell.layer].downlink);
  message.setPsc(map_.scramblingCode(cell));
  message.setNumMncDigits(networkCodeDigits);
  message.setHspa(KCellularWcdmaCellInfo::Hspa::SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL);
  outbox_.send(metricIdentifier("K_UMTS_SCELL_INFO"), message);
}

void UmtsReports::selection(const UmtsLevel& serving) {
  KCellularWcdmaSelReselCellInfo message;
  const LayerIndex own = serving.cell.layer;
  message.setHsdpaCapable(1);
  message.setEdchCapable(1);
  message.setDuplexMode(KCellularWcdmaSelReselCellInfo::DuplexMode::FDD);
  message.addMultiBandInfo(layers[own].band);
  message.setImsEmergencySupport(0);
  message.setCellBarred(0);
  message.setFachMeasOccInfoPresent(1);
  message.setSRxlev(rounded(serving.rscp) - levelMinimum);  // TS 25.304 5.2.3.1.2, like the one below
  message.setSQual(rounded(std::max(serving.ecno, -24.5)) - qualityMinimum);
  message.setSIntrasearch(intraSearch);
  message.setSIntersearch(interSearch);
  message.setSSearchRat(searchRat);
  message.setSCellPrio(layers[own].priority);
  for (const LayerIndex index : lteLayers) {
    auto info = std::make_shared<EutraFreqInfo>();
    info->setEarfcn(layers[index].downlink);
    info->setPrio(layers[index].priority);
    message.addEutraPrioInfo(std::move(info));
  }
  for (const LayerIndex index : umtsLayers) {
    if (index == own) continue;
    auto info = std::make_shared<UtraFreqInfo>();
    info->setUarfcn(layers[index].downlink);
    info->setPrio(layers[index].priority);
    message.addUtraPrioInfo(std::move(info));
  }
  auto gsm = std::make_shared<GsmFreqInfo>();
  gsm->setArfcn(firstGsmCarrier);
  gsm->setPrio(layers[gsm900].priority);
  message.addGsmPrioInfo(std::move(gsm));
  outbox_.send(metricIdentifier("K_UMTS_SEL_RESEL_INFO"), message);
}

// The entries are shared with LTE: the CPICH's RSCP and Ec/No codes are in those for RSRP and RSRQ, and the
// signal-to-noise ratio is that of the CPICH after despreading by 256 chips (24 dB).
void UmtsReports::servingLevel(const UmtsServing& serving, bool connected) {
  KCellularWcdmaScellMeasurement message;
  message.setConnectedMode(connected);
  for (int antenna = 0; antenna < 2; ++antenna) {
    const double below = std::max(0.0, antenna == 0 ? -serving.imbalance : serving.imbalance);
    auto rx = std::make_shared<RxInfo>();
    const double rscp = serving.level.rscp - below;
    const double rssi = std::max(serving.level.rssi - below, umtsNoise);
    rx->setRssi(rounded(rssi));
    rx->setRsrpRange(radio::Rscp::basicCode(rscp));
    rx->setRsrqRange(radio::Ecno::basicCode(rscp - rssi));
    rx->setSnr(std::clamp(rounded(rscp - rssi + 24), -20, 30));
    message.addRxInfo(std::move(rx));
  }
  outbox_.send(metricIdentifier("K_UMTS_SCELL_MEAS"), message);
}

// The entries are shared with LTE: the control channel's power and the total.
void UmtsReports::transmitPower(const std::vector<UmtsTransmit>& powers) {
  KCellularWcdmaTxPower message;
  for (const UmtsTransmit& power : powers) {
    auto info = std::make_shared<TxPowerInfo>();
    info->setPucchTxPower(power.control);
    info->setPuschTxPower(power.total);
    info->setSubframeIndex(static_cast<std::uint32_t>(power.subframe));
    message.addTxPowerInfo(std::move(info));
  }
  outbox_.send(metricIdentifier("K_UMTS_TX_POWER"), message);
}

void UmtsReports::neighbours(const std::vector<UmtsLevel>& umts, const std::vector<GsmLevel>& gsm,
                             const std::vector<LteLevel>& lte) {
  KCellularWcdmaNbrCellMeas message;
  for (const UmtsLevel& level : umts) {
    auto cell = std::make_shared<UtraCellMeasResult>();
    cell->setUarfcn(layers[level.cell.layer].downlink);
    cell->setBand(layers[level.cell.layer].band);
    cell->setPsc(map_.scramblingCode(level.cell));
    cell->setEcno(radio::Ecno::basicCode(level.ecno));
    cell->setRscp(static_cast<std::int32_t>(radio::Rscp::basicCode(level.rscp)));
    message.addMeasUtraResult(std::move(cell));
  }
  for (const GsmLevel& level : gsm) {
    auto cell = std::make_shared<GsmCellMeasResult>();
    cell->setArfcn(map_.arfcn(level.cell));
    cell->setBsic(map_.bsic(level.cell));
    cell->setRxlev(radio::Rxlev::basicCode(level.rxlev));
    message.addMeasGsmResult(std::move(cell));
  }
  for (const LteLevel& level : lte) {
    auto cell = std::make_shared<LteCellMeasResult>();
    cell->setEarfcn(layers[level.cell.layer].downlink);
    cell->setPhyCellId(map_.physicalCellId(level.cell));
    cell->setEutraBand(layers[level.cell.layer].band);
    cell->setRsrp(static_cast<std::int32_t>(radio::Rsrp::basicCode(level.rsrp)));
    cell->setRsrq(static_cast<std::int32_t>(radio::Rsrq::basicCode(level.rsrq)));
    message.addMeasLteResult(std::move(cell));
  }
  outbox_.send(metricIdentifier("K_UMTS_NCELL_MEAS"), message);
}

}  // namespace vespscope::sources::scenario
