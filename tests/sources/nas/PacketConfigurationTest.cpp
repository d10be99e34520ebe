// Addresses, access point names and servers of literal octets (3GPP TS 24.008 10.5.6).
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/diag/Bytes.h"
#include "sources/nas/PacketConfiguration.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using testing::ElementsAre;

TEST(PacketConfiguration, AddressesOfEachKindAreRead) {
  EXPECT_EQ(pdnAddressOf(bytesOf("02 00 00 00 00 00 00 00 01")),
            (PacketAddress{AddressKind::ipv6, bytesOf("00 00 00 00 00 00 00 01")}));
  EXPECT_EQ(pdnAddressOf(bytesOf("03 00 00 00 00 00 00 00 01 0a 01 02 03")),
            (PacketAddress{AddressKind::dual, bytesOf("0a 01 02 03 00 00 00 00 00 00 00 01")}));
  for (const char* dump : {"", "01 0a 01 02", "02 00", "03 00 00 00 00 00 00 00 01 0a", "05 00", "07"}) {
    EXPECT_FALSE(pdnAddressOf(bytesOf(dump))) << dump;
  }
  EXPECT_EQ(pdpAddressOf(bytesOf("01 57")), (PacketAddress{AddressKind::ipv6, {}}));
  EXPECT_EQ(pdpAddressOf(bytesOf("01 8d 0a 01 02 03 20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 01"))->kind,
            AddressKind::dual);
  for (const char* dump : {"", "01", "00 01", "01 21 0a", "01 57 00", "01 99"}) {
    EXPECT_FALSE(pdpAddressOf(bytesOf(dump))) << dump;
  }
}

TEST(PacketConfiguration, NamesOfAccessPointsAreLabelsWithDots) {
  EXPECT_EQ(accessPointNameOf(bytesOf("03 69 6d 73 03 61 2d 31")), "ims.a-1");
  for (const char* dump : {"", "00", "04 69 6d 73", "03 69 00 73", "03 69 2e 73", "03 69 1b 73"}) {
    EXPECT_FALSE(accessPointNameOf(bytesOf(dump))) << dump;
  }
}

TEST(PacketConfiguration, ServersOfBothProtocolsKeepTheirOrder) {
  EXPECT_THAT(
      nameServersOf(bytesOf("80 00 03 10 20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 53 00 0d 04 c0 00 02 35")),
      ElementsAre(bytesOf("20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 53"), bytesOf("c0 00 02 35")));
  // No previous request, an address of zeros, a request instead of an answer, lengths past the end.
  for (const char* dump :
       {"", "80", "80 00 0d 00", "80 00 0d 04 00 00 00 00", "80 80 21 0a 01 00 00 0a 81 06 c0 00 02 35",
        "80 00 0d 05 c0 00 02 35", "80 80 21 06 02 00 00 06 81 01"}) {
    EXPECT_TRUE(nameServersOf(bytesOf(dump)).empty()) << dump;
  }
}

}  // namespace
}  // namespace vespscope::test
