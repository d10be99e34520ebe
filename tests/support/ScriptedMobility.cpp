#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/mobility/MmProcFailureCause.h"
#include "messages/mobility/MmRejectCause.h"
#include "support/ScriptedMessages.h"

namespace vespscope::test {
namespace {

const Bytes testNetwork = {0x00, 0xF1, 0x10};  // 001 01

std::shared_ptr<KCellularLocationAreaId> locationArea(std::uint32_t code) {
  return part<KCellularLocationAreaId>([code](KCellularLocationAreaId& area) {
    area.setEncodedPlmn(testNetwork);
    area.setLac(code);
  });
}

std::shared_ptr<BearerContext> bearer(std::uint32_t number, std::string accessPoint, Bytes address) {
  return part<BearerContext>([&](BearerContext& context) {
    context.setCid(number);
    context.setNsapi(number + 4);
    context.setApn(std::move(accessPoint));
    context.setPdpType(BearerContext::PdpType::PDP_TYPE_IPv4);
    context.setPdpAddr(std::move(address));
    context.setPrimaryDnsType(BearerContext::PdpType::PDP_TYPE_IPv4);
    context.setPrimaryDnsAddr({192, 0, 2, 53});
    context.setSecondaryDnsType(BearerContext::PdpType::PDP_TYPE_NONE);
    context.setIsAddrIratMobile(true);
  });
}

std::shared_ptr<ElementaryFile> simFile(std::uint32_t identifier, Bytes content) {
  return part<ElementaryFile>([&](ElementaryFile& file) {
    file.setEfId(identifier);
    file.setContent(std::move(content));
  });
}

}  // namespace

std::vector<ScriptedMessage> mobilityMessages() {
  return {
      scripted<KCellularMmCommonInfo>(metricIdentifier("K_CELLULAR_MM_INFO"),
                                      [](KCellularMmCommonInfo& message) {
                                        message.setImsi({0x09, 0x10, 0x10, 0x21, 0x43, 0x65, 0x87});  // of a test card
                                        message.addEplmnList(
                                            part<Plmn>([](Plmn& network) { network.setEncodedPlmn(testNetwork); }));
                                        message.addRoamingFlaiList(locationArea(9));
                                      }),
      scripted<KCellularMmContext>(metricIdentifier("K_CELLULAR_MM_CTXT"),
                                   [](KCellularMmContext& message) {
                                     message.setRegStatus(RegStatus::KREG_STATUS_LIMITED_SERVICE);
                                     message.setUpdateStatus(KCellularMmContext::UpdateStatus::STATUS_NOT_UPDATED);
                                     message.setLai(locationArea(510));
                                     message.setTmsi(305419896);
                                     message.setT3212DurS(14400);
                                     message.setProcFailureCause(
                                         MmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_REJECTED_BY_NW);
                                     message.setRejectCause(MmRejectCause::KNAS_MM_REJ_CAUSE_LA_NOT_ALLOWED);
                                     message.setIsCombinedProc(false);
                                   }),
      scripted<KCellularGmmContext>(metricIdentifier("K_CELLULAR_GMM_CTXT"),
                                    [](KCellularGmmContext& message) {
                                      message.setRegStatus(RegStatus::KREG_STATUS_NORMAL_SERVICE);
                                      message.setUpdateStatus(KCellularGmmContext::UpdateStatus::GPRS_STATUS_UPDATED);
                                      message.setRai(part<RoutingAreaId>([](RoutingAreaId& area) {
                                        area.setEncodedPlmn(testNetwork);
                                        area.setLac(510);
                                        area.setRac(3);
                                      }));
                                      message.setPTmsi(3221225985);
                                      message.setT3312DurS(3240);
                                      message.setProcFailureCause(MmProcFailureCause::KNAS_MM_PROC_FAILURE_CAUSE_NONE);
                                      message.setRejectCause(99999);  // not a valid cause
                                      message.setRegProc(KCellularGmmContext::RegProc::KNAS_MM_REG_PROC_COMBINED_RAU);
                                    }),
      scripted<KCellularActivatedBearerContexts>(
          metricIdentifier("K_CELLULAR_ACTIVE_BEARER"),
          [](KCellularActivatedBearerContexts& message) {
            message.setBearerContextCount(2);
            message.addBearerContexts(bearer(1, "internet.example", {10, 64, 3, 200}));
            message.addBearerContexts(bearer(2, "ims\n\xFF", {10, 64, 3, 201}));  // not valid text, two lines
          }),
      scripted<KCellularSimCardFiles>(
          metricIdentifier("K_SIM_FILE_INFO"),
          [](KCellularSimCardFiles& message) {
            message.addEfList(simFile(0x2FE2, {0x98, 0x10, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0xF1}));
            message.addEfList(simFile(0x6F07, {0x08, 0x09, 0x10, 0x10, 0x21, 0x43, 0x65, 0x87, 0xF9}));
            message.addEfList(simFile(0x6FAD, {}));
          }),
  };
}

}  // namespace vespscope::test
