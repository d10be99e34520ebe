// The header of an RRC message record, for every version.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

// A record of `version` with a message of two bytes: carrier numbers of two or four bytes, with or without the mask of
// system information blocks and the second byte of each release.
Bytes recordOf(std::uint8_t version, std::uint8_t type) {
  Bytes bytes = version < 25 ? bytesOf("00 09 0a") : bytesOf("00 0f 00 0f 00");
  append(bytes, version < 8 ? bytesOf("01 b9 00 94 16 34 12") : bytesOf("01 b9 00 94 16 00 00 34 12"));
  bytes.push_back(type);
  if (version > 4) append(bytes, bytesOf("00 00 00 00"));
  append(bytes, bytesOf("02 00 2a 02"));
  bytes[0] = version;
  return bytes;
}

struct Numbering {
  std::uint8_t version;
  std::uint8_t downlinkCcch;
};

class RrcMessageRecordVersions : public testing::TestWithParam<Numbering> {};

TEST_P(RrcMessageRecordVersions, FourChannelsFollowOneAnother) {
  const auto [version, first] = GetParam();
  constexpr std::array channels = {RrcChannel::downlinkCcch, RrcChannel::downlinkDcch, RrcChannel::uplinkCcch,
                                   RrcChannel::uplinkDcch};
  for (unsigned type = 0; type < 256; ++type) {
    const Bytes bytes = recordOf(version, static_cast<std::uint8_t>(type));
    const auto decoded = rrcMessageOf(bytes);
    const auto& record = std::get<RrcMessageRecord>(decoded);
    const bool dedicated = type >= first && type < first + channels.size();
    if (record.narrowband) {
      EXPECT_GE(type, 45U);
      continue;
    }
    EXPECT_EQ(isDedicated(record.channel), dedicated) << type;
    if (dedicated) {
      EXPECT_EQ(record.channel, channels[type - first]) << type;
    }
    EXPECT_EQ(record.cell, (CellName{5780, 185}));
    EXPECT_EQ(record.radioBearer, 1);
    EXPECT_EQ(Bytes(record.message.begin(), record.message.end()), bytesOf("2a 02"));
  }
}

TEST_P(RrcMessageRecordVersions, ARecordCutAnywhereIsTooShort) {
  const auto [version, first] = GetParam();
  const Bytes whole = recordOf(version, first);
  for (std::size_t length = 1; length < whole.size(); ++length) {
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(cut)), RecordFault::tooShort) << length;
  }
}

INSTANTIATE_TEST_SUITE_P(Known, RrcMessageRecordVersions,
                         testing::Values(Numbering{2, 5}, Numbering{3, 5}, Numbering{4, 5}, Numbering{5, 5},
                                         Numbering{6, 5}, Numbering{7, 5}, Numbering{8, 5}, Numbering{13, 5},
                                         Numbering{22, 5}, Numbering{9, 12}, Numbering{12, 12}, Numbering{14, 6},
                                         Numbering{15, 6}, Numbering{16, 6}, Numbering{20, 6}, Numbering{24, 6},
                                         Numbering{25, 6}, Numbering{19, 8}, Numbering{26, 8}, Numbering{27, 8},
                                         Numbering{29, 8}, Numbering{30, 8}, Numbering{31, 8}),
                         [](const auto& parameter) { return "v" + std::to_string(parameter.param.version); });

TEST(RrcMessageRecord, AllOtherVersionsAreUnknown) {
  for (const std::uint8_t version : Bytes{0, 1, 10, 11, 17, 18, 21, 23, 28, 32, 255}) {
    const Bytes bytes = recordOf(version, 5);
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::unknownVersion) << static_cast<int>(version);
  }
}

TEST(RrcMessageRecord, NoByteAtAllIsTooShort) {
  EXPECT_EQ(std::get<RecordFault>(rrcMessageOf({})), RecordFault::tooShort);
}

TEST(RrcMessageRecord, BytesBehindTheMessageMakeItAnotherLayout) {
  for (const std::uint8_t version : Bytes{2, 8, 13, 19, 26, 31}) {
    Bytes bytes = recordOf(version, 6);
    bytes.push_back(0xFF);
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::bytesLeft) << static_cast<int>(version);
  }
}

TEST(RrcMessageRecord, Versions30And31ComeWithAndWithoutThreeBytesAheadOfTheMessage) {
  for (const std::uint8_t version : Bytes{30, 31}) {
    Bytes bytes = recordOf(version, 9);
    const auto without = rrcMessageOf(bytes);
    EXPECT_EQ(std::get<RrcMessageRecord>(without).message.size(), 2U);
    const Bytes extra = bytesOf("a1 a2 a3");
    bytes.insert(bytes.end() - 2, extra.begin(), extra.end());
    const auto with = rrcMessageOf(bytes);
    const auto message = std::get<RrcMessageRecord>(with).message;
    EXPECT_EQ(Bytes(message.begin(), message.end()), bytesOf("2a 02"));
    bytes.push_back(0);
    EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::bytesLeft);
  }
  Bytes other = recordOf(29, 9);
  append(other, bytesOf("a1 a2 a3"));
  EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(other)), RecordFault::bytesLeft);
}

struct Broadcasts {
  std::uint8_t version;
  std::uint8_t broadcast, systemInformation, multicast, paging;
};

class RrcMessageRecordBroadcastVersions : public testing::TestWithParam<Broadcasts> {};

TEST_P(RrcMessageRecordBroadcastVersions, NumberTheirOwnChannels) {
  const auto [version, broadcast, systemInformation, multicast, paging] = GetParam();
  const auto channelOf = [v = version](std::uint8_t type) {
    return std::get<RrcMessageRecord>(rrcMessageOf(recordOf(v, type))).channel;
  };
  EXPECT_EQ(channelOf(broadcast), RrcChannel::broadcast);
  EXPECT_EQ(channelOf(systemInformation), RrcChannel::systemInformation);
  EXPECT_EQ(channelOf(multicast), RrcChannel::multicast);
  EXPECT_EQ(channelOf(paging), RrcChannel::paging);
  EXPECT_EQ(channelOf(0), RrcChannel::other);
}

INSTANTIATE_TEST_SUITE_P(Known, RrcMessageRecordBroadcastVersions,
                         testing::Values(Broadcasts{2, 1, 2, 3, 4}, Broadcasts{8, 1, 2, 3, 4},
                                         Broadcasts{22, 1, 2, 3, 4}, Broadcasts{9, 8, 9, 10, 11},
                                         Broadcasts{12, 8, 9, 10, 11}, Broadcasts{15, 1, 2, 4, 5},
                                         Broadcasts{25, 1, 2, 4, 5}, Broadcasts{19, 1, 3, 6, 7},
                                         Broadcasts{26, 1, 3, 6, 7}, Broadcasts{31, 1, 3, 6, 7}),
                         [](const auto& parameter) { return "v" + std::to_string(parameter.param.version); });

TEST(RrcMessageRecord, NarrowbandChannelsHaveNumbersOfTheirOwn) {
  const auto expectChannels = [](std::uint8_t version, const Bytes& types) {
    constexpr std::array channels = {RrcChannel::broadcast,    RrcChannel::systemInformation, RrcChannel::paging,
                                     RrcChannel::downlinkCcch, RrcChannel::downlinkDcch,      RrcChannel::uplinkCcch,
                                     RrcChannel::uplinkDcch};
    for (std::size_t index = 0; index < channels.size(); ++index) {
      const Bytes bytes = recordOf(version, types[index]);
      const auto decoded = rrcMessageOf(bytes);
      const auto& record = std::get<RrcMessageRecord>(decoded);
      EXPECT_EQ(record.channel, channels[index]) << static_cast<int>(types[index]);
      EXPECT_TRUE(record.narrowband);
    }
  };
  expectChannels(19, {45, 46, 47, 48, 49, 50, 52});
  expectChannels(26, {45, 46, 47, 48, 49, 50, 52});
  expectChannels(20, {54, 55, 56, 57, 58, 59, 61});
  EXPECT_FALSE(std::get<RrcMessageRecord>(rrcMessageOf(recordOf(20, 45))).narrowband);
}

TEST(RrcMessageRecord, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes bytes = recordOf(9, 12);
  bytes[5] = 0x02;
  EXPECT_EQ(std::get<RecordFault>(rrcMessageOf(bytes)), RecordFault::outOfRange);
}

}  // namespace
}  // namespace vespscope::test
