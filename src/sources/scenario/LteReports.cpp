#include "sources/scenario/LteReports.h"

#include <algorithm>
#include <memory>

#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"
#include "sources/scenario/Decibel.h"

namespace vespscope::sources::scenario {
namespace {

// The loss of an antenna below the better one: the cell's own value is never below either of them, TS 36.214 5.1.1.
double belowBest(const LteServing& serving, int antenna) {
  return std::max(0.0, antenna == 0 ? -serving.imbalance : serving.imbalance);
}

std::shared_ptr<RsrpRsrqSinr> instant(const LteServing& serving, std::uint32_t physicalCellId) {
  auto values = std::make_shared<RsrpRsrqSinr>();
  const LteLevel& level = serving.level;
  // An antenna that receives less signal also receives less interference: quality falls by half of the loss.
  const auto rsrp = [&](int antenna) {
    return std::clamp(rounded(level.rsrp - belowBest(serving, antenna)), -140, -44);
  };
  const auto rsrq = [&](int antenna) {
    return std::clamp(rounded(level.rsrq - belowBest(serving, antenna) / 2), -20, -3);
  };
  const auto sinr = [&](int antenna) {
    return std::clamp(rounded(2 * (level.sinr - belowBest(serving, antenna) / 2)), -40, 60);
  };
  values->setPhyCellId(physicalCellId);
  values->setRsrp0(rsrp(0));
  values->setRsrp1(rsrp(1));
  values->setRsrq0(rsrq(0));
  values->setRsrq1(rsrq(1));
  values->setSinr0(sinr(0));
  values->setSinr1(sinr(1));
  return values;
}

std::int32_t hundredths(double value) { return rounded(value * 100); }

std::shared_ptr<SecondaryComponentCarrier> carrierOf(const Secondary& secondary, const RadioMap& map) {
  auto carrier = std::make_shared<SecondaryComponentCarrier>();
  const LteLevel& level = secondary.serving.level;
  const Layer& layer = layers[level.cell.layer];
  carrier->setIndex(secondary.index);
  carrier->setState(static_cast<std::int32_t>(secondary.state));
  carrier->setPci(map.physicalCellId(level.cell));
  carrier->setDlEarfcn(layer.downlink);
  carrier->setDlRfBand(layer.band);
  carrier->setDlBandwidth(layer.bandwidthCode);
  carrier->setHasUplink(false);  // the phone aggregates carriers in the downlink only
  if (secondary.state == SecondaryState::removed) return carrier;
  carrier->setRsrp(hundredths(std::clamp(level.rsrp, -140.0, -44.0)));
  carrier->setRsrq(hundredths(std::clamp(level.rsrq, -30.0, -3.0)));
  carrier->setSnr(rounded(level.sinr));
  carrier->setRssi(hundredths(level.rssi));
  return carrier;
}

}  // namespace

const LteSelection& selectionOf(LayerIndex layer) {
  static constexpr LteSelection capacity{-62, 4, 29, 8, 4, 11, 6};
  static constexpr LteSelection coverage{-64, 4, 29, 8, 4, 9, 5};
  return layer == lte800 ? coverage : capacity;
}

void LteReports::rrc(const LteRrcChange& change) {
  KCellularLteRrcState message;
  message.setState(static_cast<std::int32_t>(change.state));
  message.setPrevState(static_cast<std::int32_t>(change.previous));
  message.setPrevStateDurMs(static_cast<std::uint32_t>(change.previousFor.count()));
  message.setCause(static_cast<std::int32_t>(change.cause));
  outbox_.send(metricIdentifier("K_LTE_RRC_STATE"), message);
}

void LteReports::drx(const LteDrx& drx, bool configured, LteRrc state, std::uint32_t servingCells) {
  KCellularLteCdrxConfig message;
  message.setCellStatus((1U << servingCells) - 1);  // one bit per serving cell, the primary's lowest
  if (configured) {
    message.setOnDurationMs(drx.onDuration);
    message.setDrxInactivityMs(drx.inactivity);
    message.setDrxRetxTimerMs(drx.retransmission);
    message.setLongDrxCycleMs(drx.longCycle);
    message.setShortDrxCycleMs(drx.shortCycle);
    message.setDrxShortCycleNum(drx.shortCycles);
  }
  message.setRrcState(static_cast<std::int32_t>(state));
  message.setCdrxConfigStatus(configured ? 1 : 0);
  if (configured) message.setTransmissionMode(drx.transmissionMode);
  outbox_.send(metricIdentifier("K_LTE_CDRX_CONFIG"), message);
}

void LteReports::servingCell(const Cell& cell) {
  const Layer& layer = layers[cell.layer];
  KCellularLteScellInfo message;
  message.setPhyCellId(map_.physicalCellId(cell));
  message.setDlFreq(layer.downlink);
  message.setUlFreq(layer.uplink);
  message.setDlBw(2 * layer.bandwidthMhz);  // in steps of half a megahertz
  message.setUlBw(2 * layer.bandwidthMhz);
  message.setCellId(map_.eutranCellId(cell));
  message.setFreqBandInd(layer.band);
  message.setTrackingAreaCode(map_.trackingAreaCode(cell));
  message.setNumMncDigits(networkCodeDigits);
  message.setSelPlmnMcc(mobileCountryCode);
  message.setSelPlmnMnc(mobileNetworkCode);
  outbox_.send(metricIdentifier("K_LTE_SCELL_INFO"), message);
}

// The contents of system information blocks 1 to 3 and 5, as raw codes of TS 36.331 6.2.2 and 6.3.1.
void LteReports::selection(const Cell& cell) {
  const LteSelection& own = selectionOf(cell.layer);
  KCellularLteSelReselCellInfo message;
  message.addMultiBandInfo(layers[cell.layer].band);
  message.setImsEmergencySupport(1);
  message.setAcBarringForEmergency(0);
  message.setMoSignallingAcBarringFactor(15);  // p95
  message.setMoSignallingAcBarringTime(0);     // s4
  message.setMoSignallingAcBarringForSpecialAc(0);
  message.setMoDataAcBarringFactor(15);
  message.setMoDataAcBarringTime(0);
  message.setMoDataAcBarringForSpecialAc(0);
  message.setQRxLevMin(own.rxLevelMinimum);
  message.setQQualMin(-20);  // dB, -34..-3
  message.setQHyst(own.hysteresis);
  message.setSNonIntraSearchP(own.nonIntraSearch);
  message.setSNonIntraSearchQ(6);  // dB, 0..31
  message.setSIntraSearchP(own.intraSearch);
  message.setSIntraSearchQ(12);
  message.setThreshServingLowP(own.servingLow);
  message.setThreshServingLowQ(3);
  message.setPriorityOperatingFreq(layers[cell.layer].priority);
  for (const LayerIndex index : lteLayers) {
    if (index == cell.layer) continue;
    const LteSelection& other = selectionOf(index);
    auto frequency = std::make_shared<NbrEutra>();
    frequency->setEarfcn(layers[index].downlink);
    frequency->setQRxlevMin(other.rxLevelMinimum);
    frequency->setQQualMin(-20);
    frequency->setQOffset(0);  // dB, -24..24
    frequency->setPmax(23);    // dBm, -30..33
    frequency->setDlBw(layers[index].bandwidthCode);
    frequency->setThresXHighP(other.high);
    frequency->setThresXLowP(other.low);
    frequency->setThresXHighQ(8);
    frequency->setThresXLowQ(4);
    frequency->setPriority(layers[index].priority);
    frequency->setFrameType(NbrEutra::FrameType::FDD);
    frequency->setBand(layers[index].band);
    message.addNbrEutra(std::move(frequency));
  }
  outbox_.send(metricIdentifier("K_LTE_SEL_RESEL_INFO"), message);
}

void LteReports::servingLevel(const LteServing& serving, bool connected) {
  KCellularLteServingCellMeasurement message;
  message.setIsConnectedMode(connected);
  for (int antenna = 0; antenna < 2; ++antenna) {
    const double below = belowBest(serving, antenna);
    auto rx = std::make_shared<RxInfo>();
    rx->setRssi(rounded(serving.level.rssi - below / 2));
    rx->setRsrpRange(radio::Rsrp::basicCode(serving.level.rsrp - below));
    rx->setRsrqRange(radio::Rsrq::basicCode(serving.level.rsrq - below / 2));
    rx->setSnr(rounded(serving.level.sinr - below / 2));
    message.addRxInfo(std::move(rx));
  }
  outbox_.send(metricIdentifier("K_LTE_SCELL_MEAS"), message);
}

void LteReports::levels(const std::vector<LteServing>& serving, const std::vector<LteServing>& window, Time period,
                        const std::string& callId) {
  KCellularLteRsrpRsrqSinr message;
  if (!callId.empty()) message.setCallId(callId);
  const auto count = static_cast<std::uint32_t>(window.size());
  const auto periodMs = static_cast<std::uint32_t>(period.count());
  LteServing average = serving.front();
  average.level.rsrp = average.level.rsrq = average.level.sinr = average.imbalance = 0;
  for (const LteServing& each : window) {
    average.level.rsrp += each.level.rsrp / count;
    average.level.rsrq += each.level.rsrq / count;
    average.level.sinr += each.level.sinr / count;
    average.imbalance += each.imbalance / count;
  }
  message.setLastXSeconds(static_cast<std::uint32_t>(levelWindow) * periodMs / 1000);
  message.setLastYSamples(static_cast<std::uint32_t>(levelWindow));
  message.setSamplePeriodMs(periodMs);
  message.setDurationMs(count * periodMs);
  message.setNumSamples(count);
  message.setAvgValues(instant(average, map_.physicalCellId(average.level.cell)));
  for (const LteServing& each : serving) {
    message.addInstValues(instant(each, map_.physicalCellId(each.level.cell)));
  }
  outbox_.send(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), message);
}

void LteReports::transmitPower(const std::vector<LteTransmit>& powers) {
  KCellularLteTxPower message;
  for (const LteTransmit& power : powers) {
    auto info = std::make_shared<TxPowerInfo>();
    info->setPucchTxPower(power.pucch);
    info->setPuschTxPower(power.pusch);
    info->setSubframeIndex(static_cast<std::uint32_t>(power.subframe));
    message.addTxPowerInfo(std::move(info));
  }
  outbox_.send(metricIdentifier("K_LTE_TX_POWER"), message);
}

// Bandwidths in megahertz.
void LteReports::carriers(const Cell& primary, const std::vector<Secondary>& secondaries) {
  KCellularLteComponentCarrierInfo message;
  message.setPccEarfcn(layers[primary.layer].downlink);
  message.setPccBandwidth(layers[primary.layer].bandwidthMhz);
  for (const Secondary& each : secondaries) {
    const Layer& layer = layers[each.serving.level.cell.layer];
    if (each.index == 0) {
      message.setScc0Earfcn(layer.downlink);
      message.setScc0Bandwidth(layer.bandwidthMhz);
    } else {
      message.setScc1Earfcn(layer.downlink);
      message.setScc1Bandwidth(layer.bandwidthMhz);
    }
  }
  outbox_.send(metricIdentifier("K_LTE_COMPCARR_INFO"), message);
}

void LteReports::aggregation(const std::vector<Secondary>& secondaries) {
  KCellularLteCarrierAggregationStatus message;
  for (const Secondary& each : secondaries) message.addSccList(carrierOf(each, map_));
  outbox_.send(metricIdentifier("K_LTE_CA_STATUS"), message);
}

void LteReports::lteNeighbours(const std::vector<LteLevel>& neighbours) {
  KCellularLteNbrEutraCellMeas message;
  for (const LteLevel& level : neighbours) {
    auto cell = std::make_shared<EgwErrcNbrEutraMeas>();
    cell->setNbrEarfcn(layers[level.cell.layer].downlink);
    cell->setNbrPhysCellId(map_.physicalCellId(level.cell));
    cell->setFreqBandInd(layers[level.cell.layer].band);
    cell->setNbrRsrp(static_cast<std::int32_t>(radio::Rsrp::basicCode(level.rsrp)));
    cell->setNbrRsrq(static_cast<std::int32_t>(radio::Rsrq::basicCode(level.rsrq)));
    message.addMeasNbrEutra(std::move(cell));
  }
  outbox_.send(metricIdentifier("K_LTE_INTRARAT_MEAS"), message);
}

void LteReports::otherNeighbours(const std::vector<UmtsLevel>& umts, const std::vector<GsmLevel>& gsm) {
  KCellularLteNbrInterRatCellMeas message;
  for (const UmtsLevel& level : umts) {
    auto cell = std::make_shared<EgwErrcNbrUtraMeas>();
    cell->setUarfcn(layers[level.cell.layer].downlink);
    cell->setPsc(map_.scramblingCode(level.cell));
    cell->setRscp(static_cast<std::int32_t>(radio::Rscp::basicCode(level.rscp)));
    cell->setEcno(radio::Ecno::basicCode(level.ecno));
    message.addMeasNbrUtra(std::move(cell));
  }
  for (const GsmLevel& level : gsm) {
    auto cell = std::make_shared<EgwErrcNbrGeranMeas>();
    cell->setArfcn(map_.arfcn(level.cell));
    cell->setBsic(map_.bsic(level.cell));
    cell->setRxlev(radio::Rxlev::basicCode(level.rxlev));
    message.addMeasNbrGeran(std::move(cell));
  }
  outbox_.send(metricIdentifier("K_LTE_INTERRAT_MEAS"), message);
}

}  // namespace vespscope::sources::scenario
