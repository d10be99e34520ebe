#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {
namespace {

using test::bytesOf;

// A record of `version` with a carrier number of two bytes, of four, or of four behind two bytes more.
Bytes recordOf(std::uint8_t version, std::uint8_t type) {
  Bytes bytes;
  if (version < 8) {
    bytes = bytesOf("00 09 0a 01 b9 00 94 16 34 12 00 00 00 00 00 02 00 2a 02");
  } else if (version < 25) {
    bytes = bytesOf("00 09 0a 01 b9 00 94 16 00 00 34 12 00 00 00 00 00 02 00 2a 02");
  } else {
    bytes = bytesOf("00 0f 00 0f 00 01 b9 00 94 16 00 00 34 12 00 00 00 00 00 02 00 2a 02");
  }
  bytes[0] = version;
  bytes[bytes.size() - 9] = type;
  return bytes;
}

struct Numbering {
  std::uint8_t version;
  std::uint8_t downlinkCcch;
};

class RrcMessageVersions : public testing::TestWithParam<Numbering> {};

TEST_P(RrcMessageVersions, FourChannelsFollowOneAnother) {
  const auto [version, first] = GetParam();
  constexpr std::array channels = {RrcChannel::downlinkCcch, RrcChannel::downlinkDcch, RrcChannel::uplinkCcch,
                                   RrcChannel::uplinkDcch};
  for (unsigned type = 0; type < 256; ++type) {
    const Bytes bytes = recordOf(version, static_cast<std::uint8_t>(type));
    const auto decoded = rrcMessageOf(bytes);
    const auto& record = std::get<RrcMessageRecord>(decoded);
    const bool dedicated = type >= first && type < first + channels.size();
    EXPECT_EQ(record.channel, dedicated ? channels[type - first] : RrcChannel::other) << type;
    EXPECT_EQ(record.cell, (CellName{5780, 185}));
    EXPECT_EQ(record.radioBearer, 1);
    EXPECT_EQ(Bytes(record.message.begin(), record.message.end()), bytesOf("2a 02"));
  }
}

TEST_P(RrcMessageVersions, ARecordCutAnywhereIsTooShort) {
  const auto [version, first] = GetParam();
  const Bytes whole = recordOf(version, first);
  for (std::size_t length = 1; length < whole.size(); ++length) {
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(cut)), RecordFault::tooShort) << length;
  }
}

INSTANTIATE_TEST_SUITE_P(Known, RrcMessageVersions,
                         testing::Values(Numbering{2, 5}, Numbering{3, 5}, Numbering{4, 5}, Numbering{6, 5},
                                         Numbering{7, 5}, Numbering{8, 5}, Numbering{13, 5}, Numbering{22, 5},
                                         Numbering{9, 12}, Numbering{12, 12}, Numbering{14, 6}, Numbering{15, 6},
                                         Numbering{16, 6}, Numbering{20, 6}, Numbering{24, 6}, Numbering{25, 6},
                                         Numbering{19, 8}, Numbering{26, 8}, Numbering{27, 8}, Numbering{29, 8},
                                         Numbering{30, 8}, Numbering{31, 8}),
                         [](const auto& parameter) { return "v" + std::to_string(parameter.param.version); });

TEST(RrcMessageRecord, AllOtherVersionsAreUnknown) {
  for (const std::uint8_t version : Bytes{0, 1, 5, 10, 11, 17, 18, 21, 23, 28, 32, 255}) {
    const Bytes bytes = recordOf(version, 5);
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::unknownVersion) << static_cast<int>(version);
  }
}

TEST(RrcMessageRecord, NoByteAtAllIsTooShort) {
  EXPECT_EQ(std::get<RecordFault>(rrcMessageOf({})), RecordFault::tooShort);
}

TEST(RrcMessageRecord, BytesBehindTheMessageAreNotPartOfIt) {
  Bytes bytes = recordOf(8, 6);
  test::append(bytes, bytesOf("ff ff"));
  const auto decoded = rrcMessageOf(bytes);
  EXPECT_EQ(std::get<RrcMessageRecord>(decoded).message.size(), 2U);
}

TEST(RrcMessageRecord, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes bytes = recordOf(9, 12);
  bytes[5] = 0x02;
  EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::outOfRange);
}

}  // namespace
}  // namespace vespscope::sources::diag
