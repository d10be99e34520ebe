// Every mobility, bearer and SIM message against bytes of another encoder: each field read, shown, written, taken away.
#include <gtest/gtest.h>

#include "MessageTesting.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/ElementaryFile.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/mobility/Plmn.h"
#include "messages/mobility/RoutingAreaId.h"

namespace vespscope {
namespace {

TEST(KCellularMmCommonInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 1a 06 0a 04 08 29 26 10 1a 05 "
      "0a 03 13 00 14 22 07 0a 03 62 f2 10 10 00 22 04 10 80 80 04 2a 04 0a 00 10 7f 2a 03 10 80 01 32 16 0a 10 "
      "fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 10 80 80 01 32 03 10 b9 01 3a 0c 0a 04 08 29 26 10 10 ff "
      "ff ff ff 0f 3a 02 10 07";
  const auto read = readFrom<KCellularMmCommonInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, imsi: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, eplmn_list: "
            "[[encoded_plmn: <08 29 26 10>], [encoded_plmn: <13 00 14>]], roaming_flai_list: [[encoded_plmn: <62 "
            "f2 10>, lac: 0], [lac: 65536]], reg_prov_flai_list: [[encoded_plmn: <>, lac: 127], [lac: 128]], "
            "roaming_ftai_list: [[encoded_plmn: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, tac: 16384], "
            "[tac: 185]], reg_prov_ftai_list: [[encoded_plmn: <08 29 26 10>, tac: 4294967295], [tac: 7]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularMmCommonInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_CONTENT(imsi, Imsi, hex("fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01"));
  EXPECT_MESSAGES(eplmnLists, EplmnLists, eplmnList, EplmnList, readAll<Plmn>({"0a 04 08 29 26 10", "0a 03 13 00 14"}));
  EXPECT_MESSAGES(roamingFlaiLists, RoamingFlaiLists, roamingFlaiList, RoamingFlaiList,
                  readAll<KCellularLocationAreaId>({"0a 03 62 f2 10 10 00", "10 80 80 04"}));
  EXPECT_MESSAGES(regProvFlaiLists, RegProvFlaiLists, regProvFlaiList, RegProvFlaiList,
                  readAll<KCellularLocationAreaId>({"0a 00 10 7f", "10 80 01"}));
  EXPECT_MESSAGES(roamingFtaiLists, RoamingFtaiLists, roamingFtaiList, RoamingFtaiList,
                  readAll<KCellularTrackingAreaId>(
                      {"0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 10 80 80 01", "10 b9 01"}));
  EXPECT_MESSAGES(regProvFtaiLists, RegProvFtaiLists, regProvFtaiList, RegProvFtaiList,
                  readAll<KCellularTrackingAreaId>({"0a 04 08 29 26 10 10 ff ff ff ff 0f", "10 07"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(Plmn, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 13 00 14";
  const auto read = readFrom<Plmn>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <13 00 14>]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  Plmn written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("13 00 14"));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLocationAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 62 f2 10 10 ac 02";
  const auto read = readFrom<KCellularLocationAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <62 f2 10>, lac: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLocationAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("62 f2 10"));
  EXPECT_NUMBER(lac, Lac, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularMmContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 00 18 ff ff ff ff ff ff ff ff ff 01 22 06 0a 00 10 ad a0 01 28 94 2d 30 00 38 0f "
      "40 02 48 00";
  const auto read = readFrom<KCellularMmContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: (unknown: -1), "
            "lai: [encoded_plmn: <>, lac: 20525], tmsi: 5780, t3212_dur_s: 0, proc_failure_cause: "
            "KNAS_MM_PROC_FAILURE_CAUSE_OTHER, reject_cause: KNAS_MM_REJ_CAUSE_IMSI_UNKNOWN, is_combined_proc: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularMmContext written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(regStatus, RegStatus, 0);
  EXPECT_NUMBER(updateStatus, UpdateStatus, -1);
  EXPECT_MESSAGE(lai, Lai, readFrom<KCellularLocationAreaId>("0a 00 10 ad a0 01"));
  EXPECT_NUMBER(tmsi, Tmsi, 5780U);
  EXPECT_NUMBER(t3212DurS, T3212DurS, 0U);
  EXPECT_NUMBER(procFailureCause, ProcFailureCause, 15);
  EXPECT_NUMBER(rejectCause, RejectCause, 2);
  EXPECT_NUMBER(isCombinedProc, IsCombinedProc, false);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGmmContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 06 18 03 22 17 0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 18 7f 20 80 "
      "01 28 80 80 01 30 b9 01 38 0e 40 00 48 ff ff ff ff ff ff ff ff ff 01";
  const auto read = readFrom<KCellularGmmContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, reg_status: KREG_STATUS_SERVICE_DETACHED, update_status: (unknown: 3), "
            "rai: [encoded_plmn: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, lac: 127, rac: 128], p_tmsi: "
            "16384, t3312_dur_s: 185, proc_failure_cause: KNAS_MM_PROC_FAILURE_CAUSE_TIMEOUT, reject_cause: "
            "KNAS_MM_REJ_CAUSE_NONE, reg_proc: (unknown: -1)]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGmmContext written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(regStatus, RegStatus, 6);
  EXPECT_NUMBER(updateStatus, UpdateStatus, 3);
  EXPECT_MESSAGE(rai, Rai,
                 readFrom<RoutingAreaId>("0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 18 7f 20 80 01"));
  EXPECT_NUMBER(pTmsi, PTmsi, 16384U);
  EXPECT_NUMBER(t3312DurS, T3312DurS, 185U);
  EXPECT_NUMBER(procFailureCause, ProcFailureCause, 14);
  EXPECT_NUMBER(rejectCause, RejectCause, 0);
  EXPECT_NUMBER(regProc, RegProc, -1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(RoutingAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 04 08 29 26 10 18 ff ff ff ff 0f 20 07";
  const auto read = readFrom<RoutingAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <08 29 26 10>, lac: 4294967295, rac: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RoutingAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("08 29 26 10"));
  EXPECT_NUMBER(lac, Lac, 4294967295U);
  EXPECT_NUMBER(rac, Rac, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularActivatedBearerContexts, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 96 0a 1a 08 08 ad a0 01 30 07 50 01 1a 02 50 01";
  const auto read = readFrom<KCellularActivatedBearerContexts>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, bearer_context_count: 1302, bearer_contexts: [[cid: 20525, "
            "primary_dns_type: PDP_TYPE_NONE, is_addr_irat_mobile: 1], [is_addr_irat_mobile: 1]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularActivatedBearerContexts written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(bearerContextCount, BearerContextCount, 1302U);
  EXPECT_MESSAGES(bearerContexts, BearerContexts, bearerContexts, BearerContexts,
                  readAll<BearerContext>({"08 ad a0 01 30 07 50 01", "50 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(BearerContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 94 2d 10 00 1a 10 69 6e 74 65 72 6e 65 74 2e 65 78 61 6d 70 6c 65 20 01 2a 03 62 f2 10 30 04 3a 00 40 "
      "08 4a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 50 00";
  const auto read = readFrom<BearerContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[cid: 5780, nsapi: 0, apn: internet.example, pdp_type: PDP_TYPE_IPv6, pdp_addr: <62 f2 10>, "
            "primary_dns_type: PDP_TYPE_IPv6_PDN, primary_dns_addr: <>, secondary_dns_type: (unknown: 8), "
            "secondary_dns_addr: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, is_addr_irat_mobile: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  BearerContext written;
  EXPECT_NUMBER(cid, Cid, 5780U);
  EXPECT_NUMBER(nsapi, Nsapi, 0U);
  EXPECT_CONTENT(apn, Apn, std::string("internet.example"));
  EXPECT_NUMBER(pdpType, PdpType, 1);
  EXPECT_CONTENT(pdpAddr, PdpAddr, hex("62 f2 10"));
  EXPECT_NUMBER(primaryDnsType, PrimaryDnsType, 4);
  EXPECT_CONTENT(primaryDnsAddr, PrimaryDnsAddr, hex(""));
  EXPECT_NUMBER(secondaryDnsType, SecondaryDnsType, 8);
  EXPECT_CONTENT(secondaryDnsAddr, SecondaryDnsAddr, hex("fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01"));
  EXPECT_NUMBER(isAddrIratMobile, IsAddrIratMobile, false);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularSimCardFiles, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 08 08 7f 12 04 08 29 26 10 12 05 12 03 13 00 14";
  const auto read = readFrom<KCellularSimCardFiles>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, ef_list: [[ef_id: 127, content: <08 29 26 10>], [content: <13 00 14>]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularSimCardFiles written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(efLists, EfLists, efList, EfList,
                  readAll<ElementaryFile>({"08 7f 12 04 08 29 26 10", "12 03 13 00 14"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(ElementaryFile, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 01 12 03 62 f2 10";
  const auto read = readFrom<ElementaryFile>(encoded);
  EXPECT_EQ(textOf(*read), "[ef_id: 128, content: <62 f2 10>]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  ElementaryFile written;
  EXPECT_NUMBER(efId, EfId, 128U);
  EXPECT_CONTENT(content, Content, hex("62 f2 10"));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope
