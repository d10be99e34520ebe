// Modified and truncated messages harm no reader.
#include <random>

#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/EpsMobility.h"
#include "sources/nas/EpsSession.h"
#include "sources/nas/Mobility.h"
#include "sources/nas/Session.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;

// Reads the bytes as every kind of message; returns how many readers accepted them.
int readAll(Span bytes) {
  int read = 0;
  read += epsMobilityMessageOf(bytes) ? 1 : 0;
  read += epsSessionMessageOf(bytes) ? 1 : 0;
  read += mobilityMessageOf(bytes) ? 1 : 0;
  read += sessionMessageOf(bytes) ? 1 : 0;
  return read;
}

// For any bytes, reading stays within them; the sanitizers run this test too.
TEST(OctetsAnyBytes, ChangedAndCutMessagesDoNoHarm) {
  std::mt19937 random(1);
  int read = 0;
  for (const char* dump :
       {literal::activateDefault, literal::attachAccept, literal::attachRequest, literal::updateRequest,
        literal::updateAccept, literal::gmmAttachAccept, literal::routingUpdateAccept, literal::gmmAttachRequest,
        literal::locationUpdateAccept, literal::activateContextRequest, literal::activateContextAccept}) {
    const Bytes whole = bytesOf(dump);
    for (int round = 0; round < 3'000; ++round) {
      // A separate allocation, so that a read past the end is detected.
      Bytes bytes(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(random() % (whole.size() + 1)));
      for (unsigned changes = random() % 4; changes > 0 && bytes.size() > 2; --changes) {
        bytes[2 + random() % (bytes.size() - 2)] = static_cast<std::uint8_t>(random());
      }
      bytes.shrink_to_fit();
      read += readAll(bytes);
    }
  }
  EXPECT_GT(read, 10'000);
}

}  // namespace
}  // namespace vespscope::test
