// BearerContext compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/BearerContext.h"

namespace vespscope::test {
namespace {

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

}  // namespace
}  // namespace vespscope::test
