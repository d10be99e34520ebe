// KCellularGsmGprsConfig compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmGprsConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 00 18 07 20 01 28 ac 02 30 96 0a 38 ad a0 01 40 94 2d 48 01 50 00 58 80 80 04";
  const auto read = readFrom<KCellularGsmGprsConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, gprs_sup: 0, rac: 7, sp_pg_cy: 1, nco: 300, nom: 1302, cr_hyst: 20525, "
            "acc_thr: 5780, ext_upl_tbf_supported: 1, priority_class: 0, cell_bar_access_2: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmGprsConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(gprsSup, GprsSup, false);
  EXPECT_NUMBER(rac, Rac, 7U);
  EXPECT_NUMBER(spPgCy, SpPgCy, true);
  EXPECT_NUMBER(nco, Nco, 300U);
  EXPECT_NUMBER(nom, Nom, 1302U);
  EXPECT_NUMBER(crHyst, CrHyst, 20525U);
  EXPECT_NUMBER(accThr, AccThr, 5780U);
  EXPECT_NUMBER(extUplTbfSupported, ExtUplTbfSupported, true);
  EXPECT_NUMBER(priorityClass, PriorityClass, 0U);
  EXPECT_NUMBER(cellBarAccess2, CellBarAccess2, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
