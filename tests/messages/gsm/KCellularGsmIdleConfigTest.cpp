// KCellularGsmIdleConfig compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmIdleConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 96 0a 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 50 b9 01 "
      "58 ff ff ff ff 0f 60 07 68 ac 02 70 96 0a 78 ad a0 01 80 01 94 2d 88 01 00 90 01 80 80 04 98 01 7f a0 01 "
      "80 01 a8 01 80 80 01 b0 01 b9 01 b8 01 ff ff ff ff 0f c0 01 07 c8 01 ac 02 d0 01 96 0a d8 01 ad a0 01 e0 "
      "01 94 2d e8 01 00 f0 01 80 80 04 f8 01 7f 80 02 80 01 88 02 80 80 01 90 02 b9 01";
  const auto read = readFrom<KCellularGsmIdleConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, arfcn_bcch: 1302, mcc: 20525, mnc: 5780, lac: 0, ci: 65536, bsic: 127, "
            "dtx_from_bs: 128, radio_link_timeout: 16384, multib_rep: 185, gsm_band: 4294967295, access_tech: 7, "
            "type_of_cur_chan: 300, ms_txpwr: 1302, rx_acc_min: 20525, cbq: 5780, cba: 0, c2_valid: 65536, "
            "tmp_offset: 128, penalty_t: 16384, t3212: 185, acc: 4294967295, bs_pa_mfrms: 7, cs_pagemode: 300, "
            "max_retrans_cs: 1302, emerg_call_allowed: 20525, attach_allowed: 5780, half_rate_supported: 0, "
            "si_7_8_broadcast: 65536, cbch_supported: 127, reest_allowed: 128, ecsc: 16384, si_2_ter_needed: 185]");
  // All except field 19, whose number is a metric tag: it is written but never read.
  EXPECT_EQ(
      read->encoded(),
      hex("08 b5 88 86 fe ea 31 10 96 0a 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 50 b9 01 "
          "58 ff ff ff ff 0f 60 07 68 ac 02 70 96 0a 78 ad a0 01 80 01 94 2d 88 01 00 90 01 80 80 04 a0 01 80 01 a8 "
          "01 80 80 01 b0 01 b9 01 b8 01 ff ff ff ff 0f c0 01 07 c8 01 ac 02 d0 01 96 0a d8 01 ad a0 01 e0 01 94 2d "
          "e8 01 00 f0 01 80 80 04 f8 01 7f 80 02 80 01 88 02 80 80 01 90 02 b9 01"));

  KCellularGsmIdleConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(arfcnBcch, ArfcnBcch, 1302U);
  EXPECT_NUMBER(mcc, Mcc, 20525U);
  EXPECT_NUMBER(mnc, Mnc, 5780U);
  EXPECT_NUMBER(lac, Lac, 0U);
  EXPECT_NUMBER(ci, Ci, 65536U);
  EXPECT_NUMBER(bsic, Bsic, 127U);
  EXPECT_NUMBER(dtxFromBs, DtxFromBs, 128U);
  EXPECT_NUMBER(radioLinkTimeout, RadioLinkTimeout, 16384U);
  EXPECT_NUMBER(multibRep, MultibRep, 185U);
  EXPECT_NUMBER(gsmBand, GsmBand, 4294967295U);
  EXPECT_NUMBER(accessTech, AccessTech, 7U);
  EXPECT_NUMBER(typeOfCurChan, TypeOfCurChan, 300U);
  EXPECT_NUMBER(msTxpwr, MsTxpwr, 1302U);
  EXPECT_NUMBER(rxAccMin, RxAccMin, 20525U);
  EXPECT_NUMBER(cbq, Cbq, 5780U);
  EXPECT_NUMBER(cba, Cba, 0U);
  EXPECT_NUMBER(c2Valid, C2Valid, 65536U);
  EXPECT_FALSE(read->hasCrOffset());
  written.setCrOffset(127U);
  EXPECT_TRUE(written.hasCrOffset());
  EXPECT_EQ(written.crOffset(), 127U);
  EXPECT_NUMBER(tmpOffset, TmpOffset, 128U);
  EXPECT_NUMBER(penaltyT, PenaltyT, 16384U);
  EXPECT_NUMBER(t3212, T3212, 185U);
  EXPECT_NUMBER(acc, Acc, 4294967295U);
  EXPECT_NUMBER(bsPaMfrms, BsPaMfrms, 7U);
  EXPECT_NUMBER(csPagemode, CsPagemode, 300U);
  EXPECT_NUMBER(maxRetransCs, MaxRetransCs, 1302U);
  EXPECT_NUMBER(emergCallAllowed, EmergCallAllowed, 20525U);
  EXPECT_NUMBER(attachAllowed, AttachAllowed, 5780U);
  EXPECT_NUMBER(halfRateSupported, HalfRateSupported, 0U);
  EXPECT_NUMBER(si78Broadcast, Si78Broadcast, 65536U);
  EXPECT_NUMBER(cbchSupported, CbchSupported, 127U);
  EXPECT_NUMBER(reestAllowed, ReestAllowed, 128U);
  EXPECT_NUMBER(ecsc, Ecsc, 16384U);
  EXPECT_NUMBER(si2TerNeeded, Si2TerNeeded, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
