#include "messages/common/SystemBand.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "support/ScriptedMessages.h"

namespace vespscope::test {
namespace {

std::shared_ptr<RxInfo> receiver(std::int32_t strength) {
  return part<RxInfo>([strength](RxInfo& info) {
    info.setRssi(strength);
    info.setRsrpRange(40);
    info.setRsrqRange(20);
    info.setSnr(7);
  });
}

void fillSelection(KCellularWcdmaSelReselCellInfo& message) {
  message.setHsdpaCapable(1);
  message.setEdchCapable(1);
  message.setDuplexMode(KCellularWcdmaSelReselCellInfo::DuplexMode::FDD);
  message.addMultiBandInfo(1);
  message.addMultiBandInfo(8);
  message.setImsEmergencySupport(0);
  message.setCellBarred(0);
  message.setFachMeasOccInfoPresent(1);
  message.setSRxlev(21);
  message.setSQual(9);
  message.setSIntrasearch(10);
  message.setSSearchRat(4);
  message.setSCellPrio(3);
  message.addEutraPrioInfo(part<EutraFreqInfo>([](EutraFreqInfo& frequency) {
    frequency.setEarfcn(1300);
    frequency.setPrio(6);
  }));
  message.addEutraPrioInfo(part<EutraFreqInfo>([](EutraFreqInfo& frequency) {
    frequency.setEarfcn(6300);
    frequency.setPrio(5);
  }));
  message.addGsmPrioInfo(part<GsmFreqInfo>([](GsmFreqInfo& frequency) {
    frequency.setArfcn(62);
    frequency.setPrio(1);
  }));
}

void fillNeighbours(KCellularWcdmaNbrCellMeas& message) {
  message.addMeasUtraResult(part<UtraCellMeasResult>([](UtraCellMeasResult& neighbour) {
    neighbour.setUarfcn(10737);
    neighbour.setBand(1);
    neighbour.setPsc(311);
    neighbour.setEcno(33);
    neighbour.setRscp(25);
  }));
  message.addMeasUtraResult(part<UtraCellMeasResult>([](UtraCellMeasResult& neighbour) {
    neighbour.setUarfcn(10762);
    neighbour.setBand(1);
    neighbour.setPsc(12);
    neighbour.setEcno(0);
    neighbour.setRscp(-5);
  }));
  message.addMeasGsmResult(part<GsmCellMeasResult>([](GsmCellMeasResult& neighbour) {
    neighbour.setArfcn(62);
    neighbour.setBsic(44);
    neighbour.setRxlev(30);
  }));
  message.addMeasLteResult(part<LteCellMeasResult>([](LteCellMeasResult& neighbour) {
    neighbour.setEarfcn(1300);
    neighbour.setPhyCellId(42);
    neighbour.setEutraBand(3);
    neighbour.setRsrp(50);
    neighbour.setRsrq(20);
  }));
}

}  // namespace

std::vector<ScriptedMessage> umtsMessages() {
  using Rrc = KCellularWcdmaRrcConnectionState;
  return {
      scripted<Rrc>(metricIdentifier("K_UMTS_RRC_STATE"),
                    [](Rrc& message) {
                      message.setState(Rrc::State::KWCDMA_RRC_CONN_STATE_CELL_DCH);
                      message.setEstablishmentCause(Rrc::EstablishmentCause::KRRC_EST_ORIG_BACKGND_CALL);
                      message.setReleaseCause(Rrc::ReleaseCause::KRRC_REL_NO_CAUSE);
                    }),
      scripted<KCellularWcdmaRrcConfiguration>(metricIdentifier("K_UMTS_RRC_CONFIG"),
                                               [](KCellularWcdmaRrcConfiguration& message) {
                                                 message.setDrxCycleLengthMs(640);
                                                 message.setIsMimoConfigured(false);
                                                 message.setIsDcConfigured(true);
                                               }),
      scripted<KCellularWcdmaCellInfo>(metricIdentifier("K_UMTS_SCELL_INFO"),
                                       [](KCellularWcdmaCellInfo& message) {
                                         message.setMcc(1);
                                         message.setMnc(1);
                                         message.setLac(510);
                                         message.setCellId(131588);
                                         message.setWcdmaBand(SystemBand::SYS_BAND_WCDMA_I_IMT_2000);
                                         message.setDlUarfcn(10737);
                                         message.setPsc(310);
                                         message.setNumMncDigits(2);
                                         message.setHspa(
                                             KCellularWcdmaCellInfo::Hspa::SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL);
                                       }),
      scripted<KCellularWcdmaScellMeasurement>(metricIdentifier("K_UMTS_SCELL_MEAS"),
                                               [](KCellularWcdmaScellMeasurement& message) {
                                                 message.setConnectedMode(true);
                                                 message.addRxInfo(receiver(-71));
                                                 message.addRxInfo(receiver(-78));
                                               }),
      scripted<KCellularWcdmaTxPower>(metricIdentifier("K_UMTS_TX_POWER"),
                                      [](KCellularWcdmaTxPower& message) {
                                        message.addTxPowerInfo(part<TxPowerInfo>([](TxPowerInfo& power) {
                                          power.setPuschTxPower(-12);
                                          power.setSubframeIndex(0);
                                        }));
                                      }),
      scripted<KCellularWcdmaSelReselCellInfo>(metricIdentifier("K_UMTS_SEL_RESEL_INFO"), fillSelection),
      scripted<KCellularWcdmaNbrCellMeas>(metricIdentifier("K_UMTS_NCELL_MEAS"), fillNeighbours),
  };
}

}  // namespace vespscope::test
