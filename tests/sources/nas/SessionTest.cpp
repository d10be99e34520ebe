// GPRS session messages of literal bytes (3GPP TS 24.008 9.5).
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/Session.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using testing::ElementsAre;

TEST(Session, ARequestNamesItsContextAndTheAnswerItsAddress) {
  const Bytes request = bytesOf(literal::activateContextRequest);
  const auto asked = sessionMessageOf(request);
  ASSERT_TRUE(asked);
  EXPECT_EQ(asked->kind, SessionKind::activateRequest);
  EXPECT_EQ(asked->transaction, 0);
  EXPECT_EQ(asked->accessPointId, 5);
  EXPECT_EQ(asked->accessPoint, "internet");
  const Bytes accept = bytesOf(literal::activateContextAccept);
  const auto given = sessionMessageOf(accept);
  ASSERT_TRUE(given);
  EXPECT_EQ(given->kind, SessionKind::activateAccept);
  EXPECT_EQ(given->transaction, 0);
  EXPECT_EQ(given->address, (PacketAddress{AddressKind::ipv4, bytesOf("0a 01 02 03")}));
  EXPECT_THAT(given->nameServers, ElementsAre(bytesOf("c0 00 02 35")));
}

TEST(Session, OtherMessagesGiveNothing) {
  for (const char* dump : {"", "0a", "7a", "7a 85", "0a 48", "08 41", "0a 41 05 03 03 00"}) {
    EXPECT_FALSE(sessionMessageOf(bytesOf(dump))) << dump;
  }
  EXPECT_EQ(sessionMessageOf(bytesOf("7a 85 46 24"))->transaction, 5);
  EXPECT_EQ(sessionMessageOf(bytesOf("9a 43 1f"))->kind, SessionKind::activateReject);
}

}  // namespace
}  // namespace vespscope::test
