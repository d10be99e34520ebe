#include "messages/common/SystemBand.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "support/ScriptedMessages.h"

namespace vespscope::test {
namespace {

void fillIdleConfig(KCellularGsmIdleConfig& message) {
  message.setArfcnBcch(62);
  message.setMcc(1);
  message.setMnc(1);
  message.setLac(510);
  message.setCi(40961);
  message.setBsic(44);
  message.setDtxFromBs(1);
  message.setRadioLinkTimeout(24);
  message.setMsTxpwr(5);
  message.setRxAccMin(8);
  message.setC2Valid(1);
  message.setCrOffset(2);
  message.setTmpOffset(0);
  message.setT3212(40);
  message.setBsPaMfrms(4);
  message.setEmergCallAllowed(1);
  message.setSi78Broadcast(0);
}

void fillNeighbours(KCellularGsmGrrEventMeasCr& message) {
  for (const std::uint32_t channel : {70U, 75U, 80U}) {
    message.addGsmNcellMeas(part<GsmNcellMeas>([channel](GsmNcellMeas& neighbour) {
      neighbour.setMcc(1);
      neighbour.setMnc(1);
      neighbour.setLac(510);
      neighbour.setCi(40000 + channel);
      neighbour.setBsic(channel % 64);
      neighbour.setArfcn(channel);
      neighbour.setRxlev(channel - 50);
    }));
  }
  message.addUmtsNcellMeas(part<UmtsNcellMeas>([](UmtsNcellMeas& neighbour) {
    neighbour.setCellType(1);
    neighbour.setCpichSc(311);
    neighbour.setDlUarfcn(10737);
    neighbour.setCpichRscp(30);
    neighbour.setCpichEcn0(40);
  }));
  message.addLteNcellMeas(part<LteNcellMeas>([](LteNcellMeas& neighbour) {
    neighbour.setPhysicalCellId(42);
    neighbour.setBandwidth(100);
    neighbour.setRsrp(45);
    neighbour.setEarfcn(1300);
    neighbour.setRsrq(21);
  }));
}

}  // namespace

std::vector<ScriptedMessage> gsmMessages() {
  return {
      scripted<KCellularGsmScellInfo>(metricIdentifier("K_GSM_SCELL_INFO"),
                                      [](KCellularGsmScellInfo& message) {
                                        message.setMcc(1);
                                        message.setMnc(1);
                                        message.setLac(510);
                                        message.setCellId(40961);
                                        message.setGsmBand(SystemBand::SYS_BAND_GSM_EGSM_900);
                                        message.setArfcn(62);
                                        message.setBsic(44);
                                        message.setState(KCellularGsmScellInfo::State::NON_DEDICATED_STATE);
                                        message.setNumMncDigits(2);
                                      }),
      scripted<KCellularGsmIdleConfig>(metricIdentifier("K_GSM_IDLE_CONFIG"), fillIdleConfig),
      scripted<KCellularGsmIdleScellMeasurement>(metricIdentifier("K_GSM_IDLE_SCELL_MEAS"),
                                                 [](KCellularGsmIdleScellMeasurement& message) {
                                                   message.setScellArfcn(62);
                                                   message.setSimplifiedL1State(3);
                                                   message.setCurrentAntenna(1);
                                                   message.setIdleRxlevDBm(-67);
                                                 }),
      scripted<KCellularGsmCsRfMeasurement>(metricIdentifier("K_GSM_CS_RF_MEAS"),
                                            [](KCellularGsmCsRfMeasurement& message) {
                                              message.setScellArfcn(62);
                                              message.setSimplifiedL1State(4);
                                              message.setCurrentAntenna(0);
                                              message.addCsTxPwr(33);
                                              message.addCsTxPwr(-1);
                                              message.setCsRxlevSub(40);
                                              message.setCsRxqualSub(1);
                                              message.setScellBand(44);
                                            }),
      scripted<KCellularGsmGrrEventMeasCr>(metricIdentifier("K_GSM_NCELL_MEAS"), fillNeighbours),
      scripted<KCellularGsmGprsConfig>(metricIdentifier("K_GSM_GPRS_CONFIG"),
                                       [](KCellularGsmGprsConfig& message) {
                                         message.setGprsSup(true);
                                         message.setRac(3);
                                         message.setSpPgCy(false);
                                         message.setNco(0);
                                         message.setNom(2);
                                         message.setCrHyst(3);
                                         message.setPriorityClass(1);
                                       }),
  };
}

}  // namespace vespscope::test
