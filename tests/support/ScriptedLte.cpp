#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/lte/LteRrcState.h"
#include "support/ScriptedMessages.h"

namespace vespscope::test {
namespace {

std::shared_ptr<NbrEutra> neighbourFrequency(std::uint32_t earfcn, std::uint32_t bandwidthCode, std::uint32_t band) {
  return part<NbrEutra>([=](NbrEutra& frequency) {
    frequency.setEarfcn(earfcn);
    frequency.setQRxlevMin(-62);
    frequency.setQQualMin(-18);
    frequency.setQOffset(0);
    frequency.setPmax(23);
    frequency.setDlBw(bandwidthCode);
    frequency.setThresXHighP(10);
    frequency.setThresXLowP(4);
    frequency.setPriority(5);
    frequency.setFrameType(NbrEutra::FrameType::FDD);
    frequency.setBand(band);
  });
}

std::shared_ptr<RsrpRsrqSinr> sample(std::int32_t rsrp, std::int32_t rsrq, std::int32_t sinr) {
  return part<RsrpRsrqSinr>([=](RsrpRsrqSinr& values) {
    values.setPhyCellId(185);
    values.setRsrp0(rsrp);
    values.setRsrp1(rsrp - 3);
    values.setRsrq0(rsrq);
    values.setRsrq1(rsrq - 1);
    values.setSinr0(sinr);
    values.setSinr1(sinr - 3);
  });
}

std::shared_ptr<TxPowerInfo> transmitPower(std::int32_t control, std::int32_t shared, std::uint32_t subframe) {
  return part<TxPowerInfo>([=](TxPowerInfo& power) {
    power.setPucchTxPower(control);
    power.setPuschTxPower(shared);
    power.setSubframeIndex(subframe);
  });
}

std::shared_ptr<EgwErrcNbrEutraMeas> eutraNeighbour(std::uint32_t cell, std::int32_t rsrpCode, std::int32_t rsrqCode) {
  return part<EgwErrcNbrEutraMeas>([=](EgwErrcNbrEutraMeas& neighbour) {
    neighbour.setNbrEarfcn(5780);
    neighbour.setNbrPhysCellId(cell);
    neighbour.setFreqBandInd(17);
    neighbour.setNbrRsrp(rsrpCode);
    neighbour.setNbrRsrq(rsrqCode);
  });
}

std::shared_ptr<SecondaryComponentCarrier> secondaryCarrier(std::uint32_t index, std::uint32_t bandwidthCode) {
  return part<SecondaryComponentCarrier>([=](SecondaryComponentCarrier& carrier) {
    carrier.setIndex(index);
    carrier.setState(SecondaryComponentCarrier::State::SCC_STATE_ACTIVATED);
    carrier.setPci(185);
    carrier.setDlEarfcn(700);
    carrier.setDlRfBand(2);
    carrier.setDlBandwidth(bandwidthCode);
    carrier.setHasUplink(false);
    carrier.setRsrp(-9050);
    carrier.setRsrq(-1050);
    carrier.setSnr(1240);
    carrier.setRssi(-6199);
  });
}

void fillSelection(KCellularLteSelReselCellInfo& message) {
  message.addMultiBandInfo(2);
  message.addMultiBandInfo(17);
  message.setImsEmergencySupport(1);
  message.setAcBarringForEmergency(0);
  message.setMoSignallingAcBarringFactor(15);
  message.setMoSignallingAcBarringTime(4);
  message.setMoSignallingAcBarringForSpecialAc(0);
  message.setMoDataAcBarringFactor(12);
  message.setMoDataAcBarringTime(16);
  message.setMoDataAcBarringForSpecialAc(0);
  message.setQRxLevMin(-64);
  message.setQHyst(4);
  message.setSNonIntraSearchP(8);
  message.setSIntraSearchP(31);
  message.setThreshServingLowP(5);
  message.setThreshServingLowQ(3);
  message.setPriorityOperatingFreq(6);
  message.addNbrEutra(neighbourFrequency(700, 5, 2));
  message.addNbrEutra(neighbourFrequency(2175, 7, 4));
}

void fillMobility(KCellularEmmContext& message) {
  message.setRegStatus(RegStatus::KREG_STATUS_NORMAL_SERVICE);
  message.setUpdateStatus(KCellularEmmContext::UpdateStatus::EPS_STATUS_UPDATED);
  message.setUeOpMode(KCellularEmmContext::UeOpMode::EPS_UE_OP_MODE_CSPS_MODE_2);
  for (const std::uint32_t code : {4711U, 4712U}) {
    message.addTaiList(part<KCellularTrackingAreaId>([code](KCellularTrackingAreaId& area) {
      area.setEncodedPlmn({0x00, 0xF1, 0x10});
      area.setTac(code);
    }));
  }
  message.setGuti(part<Guti>([](Guti& identity) {
    identity.setMmegi(32769);
    identity.setMmec(12);
    identity.setMTmsi(3735928559);
  }));
  message.setRejectCause(KCellularEmmContext::RejectCause::EMM_CAUSE_NO_CAUSE);
  message.setRegProc(KCellularEmmContext::RegProc::EMM_PROC_TAU_COMB);
  message.setT3412DurS(3240);
  message.setIsImsVoiceSupported(true);
  message.setIsEmergBearerSupported(false);
}

}  // namespace

std::vector<ScriptedMessage> lteMessages() {
  return {
      scripted<KCellularLteRrcState>(metricIdentifier("K_LTE_RRC_STATE"),
                                     [](KCellularLteRrcState& message) {
                                       message.setState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
                                       message.setPrevState(LteRrcState::KLTE_RRC_STATE_ATMPT_CONNECTION);
                                       message.setPrevStateDurMs(97);
                                       message.setCause(KCellularLteRrcState::Cause::KLTE_RRC_CAUSE_EST_MO_DATA);
                                     }),
      scripted<KCellularLteCdrxConfig>(metricIdentifier("K_LTE_CDRX_CONFIG"),
                                       [](KCellularLteCdrxConfig& message) {
                                         message.setCellStatus(1);
                                         message.setOnDurationMs(10);
                                         message.setDrxInactivityMs(200);
                                         message.setDrxRetxTimerMs(8);
                                         message.setLongDrxCycleMs(320);
                                         message.setShortDrxCycleMs(40);
                                         message.setDrxShortCycleNum(2);
                                         message.setRrcState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
                                         message.setCdrxConfigStatus(1);
                                         message.setTransmissionMode(4);
                                       }),
      scripted<KCellularLteScellInfo>(metricIdentifier("K_LTE_SCELL_INFO"),
                                      [](KCellularLteScellInfo& message) {
                                        message.setPhyCellId(185);
                                        message.setDlFreq(5780);
                                        message.setUlFreq(23780);
                                        message.setDlBw(100);
                                        message.setUlBw(75);
                                        message.setCellId(27447297);
                                        message.setFreqBandInd(17);
                                        message.setTrackingAreaCode(4711);
                                        message.setNumMncDigits(2);
                                        message.setSelPlmnMcc(1);
                                        message.setSelPlmnMnc(1);
                                      }),
      scripted<KCellularLteSelReselCellInfo>(metricIdentifier("K_LTE_SEL_RESEL_INFO"), fillSelection),
      scripted<KCellularLteTxPower>(metricIdentifier("K_LTE_TX_POWER"),
                                    [](KCellularLteTxPower& message) {
                                      message.addTxPowerInfo(transmitPower(-7, 14, 2));
                                      message.addTxPowerInfo(transmitPower(-6, 23, 7));
                                    }),
      scripted<KCellularLteRsrpRsrqSinr>(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"),
                                         [](KCellularLteRsrpRsrqSinr& message) {
                                           message.setCallId("drive-1");
                                           message.setLastXSeconds(5);
                                           message.setLastYSamples(2);
                                           message.setSamplePeriodMs(500);
                                           message.setDurationMs(1000);
                                           message.setNumSamples(2);
                                           message.setAvgValues(sample(-91, -10, 24));
                                           message.addInstValues(sample(-90, -9, 25));
                                           message.addInstValues(sample(-92, -11, 23));
                                         }),
      scripted<KCellularLteComponentCarrierInfo>(metricIdentifier("K_LTE_COMPCARR_INFO"),
                                                 [](KCellularLteComponentCarrierInfo& message) {
                                                   message.setPccEarfcn(5780);
                                                   message.setScc0Earfcn(700);
                                                   message.setPccBandwidth(10);
                                                   message.setScc0Bandwidth(20);
                                                 }),
      scripted<KCellularLteCarrierAggregationStatus>(metricIdentifier("K_LTE_CA_STATUS"),
                                                     [](KCellularLteCarrierAggregationStatus& message) {
                                                       message.addSccList(secondaryCarrier(1, 5));
                                                       message.addSccList(secondaryCarrier(2, 0));
                                                     }),
      scripted<KCellularLteNbrInterRatCellMeas>(
          metricIdentifier("K_LTE_INTERRAT_MEAS"),
          [](KCellularLteNbrInterRatCellMeas& message) {
            message.addMeasNbrUtra(part<EgwErrcNbrUtraMeas>([](EgwErrcNbrUtraMeas& neighbour) {
              neighbour.setUarfcn(10737);
              neighbour.setPsc(311);
              neighbour.setRscp(0);
              neighbour.setEcno(0);
            }));
            message.addMeasNbrGeran(part<EgwErrcNbrGeranMeas>([](EgwErrcNbrGeranMeas& neighbour) {
              neighbour.setArfcn(62);
              neighbour.setBsic(44);
              neighbour.setRxlev(63);
            }));
          }),
      scripted<KCellularLteNbrEutraCellMeas>(metricIdentifier("K_LTE_INTRARAT_MEAS"),
                                             [](KCellularLteNbrEutraCellMeas& message) {
                                               message.addMeasNbrEutra(eutraNeighbour(186, 97, 34));
                                               message.addMeasNbrEutra(eutraNeighbour(309, 41, 17));
                                             }),
      scripted<KCellularEmmContext>(metricIdentifier("K_LTE_EMM_CTXT"), fillMobility),
  };
}

}  // namespace vespscope::test
