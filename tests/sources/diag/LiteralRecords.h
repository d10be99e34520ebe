// Log records byte by byte, without the header. Bits that belong to no field are set, to show that they are ignored.
#pragma once

namespace vespscope::test::literal {

// version, PCI 185, EARFCN 5780 and 23780, 50 and 25 blocks, cell identity, TAC, band 17, 310-410 (three digits)
inline constexpr const char* servingCellV3 =
    "03 b9 00 94 16 00 00 e4 5c 00 00 32 19 01 02 03 04 34 12 11 00 00 00 36 01 03 9a 01 00";
// version, PCI 503, EARFCN 1300 and 19300, 100 and 75 blocks, cell identity, TAC, band 3, 262-01 (two digits)
inline constexpr const char* servingCellV2 =
    "02 f7 01 14 05 64 4b 64 4b ff ff ff 0f fe ff 03 00 00 00 06 01 02 01 00 00";

// One subpacket 25: the primary cell 5780/185.
inline constexpr const char* measurementV19 =
    "01 01 00 00 19 13 50 00 94 16 00 00 01 00 00 00 b9 f0 ff ff ff e7 ff ff ff ff ff ff ff ff ff ff "
    "ff c7 d0 ff ff 8f 46 ff ff 8f 46 ff ff 2f d5 ff 4c fd 2f d5 ff bf 85 35 ac f9 ff ff ff ff ff ff "
    "ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff fc ec fd ff";
// One subpacket 25: the second secondary cell 1300/503.
inline constexpr const char* measurementV22 =
    "01 01 00 00 19 16 5c 00 14 05 00 00 01 00 00 00 f7 b5 a5 a5 05 92 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "a5 3d 95 a5 a5 c5 4e a5 a5 a5 a5 a5 a5 f5 54 a5 a5 85 93 a5 1f a5 a5 a5 a5 e1 a4 a5 a5 5d ab 51 "
    "a5 a5 a5 a5 d7 a2 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a6 92 a6 a5";

// The cell of version 19 in version 18, which has no word with the number of cells.
inline constexpr const char* measurementV18 =
    "01 01 00 00 19 12 4c 00 94 16 00 00 b9 f0 ff ff ff e7 ff ff ff ff ff ff ff ff ff ff ff c7 d0 ff "
    "ff 8f 46 ff ff 8f 46 ff ff 2f d5 ff 4c fd 2f d5 ff bf 85 35 ac f9 ff ff ff ff ff ff ff ff ff ff "
    "ff ff ff ff ff ff ff ff ff ff ff ff fc ec fd ff ";
// One subpacket 25 with two cells of four antennas, three of them in the mask: the primary 2500/302 and the first
// secondary, 2500/17.
inline constexpr const char* measurementV36 =
    "01 01 00 00 19 24 0c 01 c4 09 00 00 02 00 07 00 2e b1 a5 a5 05 92 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "a5 41 95 a5 a5 85 52 a5 a5 c5 4e a5 5f 04 2d a5 a5 a5 a5 a5 40 a5 85 92 a5 81 f4 8f 40 a5 a5 a5 "
    "a0 82 94 a5 58 82 8f a5 a0 a2 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "45 6d a6 a5 13 4b a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 11 b2 a5 a5 05 92 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "a5 01 97 a5 a5 05 5a a5 a5 05 58 a5 70 05 34 a5 a5 a5 a5 a5 50 a5 85 94 a5 01 85 93 50 a5 a5 a5 "
    "00 83 97 a5 d0 02 96 a5 00 a3 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "5e a9 a6 a5 4a 81 a6 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 "
    "a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 a5 ";
// One subpacket 25 with one cell of four antennas: 66536/411.
inline constexpr const char* measurementV48 =
    "01 01 00 00 19 30 54 00 e8 03 01 00 01 00 0f 00 a5 a5 a5 a5 9b b1 a5 a5 e8 9f a5 a5 a5 a5 a5 a5 "
    "a5 a5 a5 a5 a5 01 99 a5 a5 05 63 a5 a5 05 60 a5 a5 a5 a5 a5 e0 05 3c a5 a5 a5 a5 a5 60 a5 85 95 "
    "a5 41 85 94 60 a5 a5 a5 70 03 9b a5 40 83 99 a5 70 a3 a5 a5 a5 a5 a5 a5 ";

// Serving 5780/185 at -109.375 dBm and -9.125 dB; neighbours 210 at -118.5, -18.0625 and 503 at -121, -19.5; one
// detected cell.
inline constexpr const char* neighboursV4 =
    "04 00 00 00 00 00 00 00 94 16 00 00 b9 00 00 00 6a 04 00 00 4e 01 00 00 02 01 00 00 "
    "d2 00 d8 03 d8 03 bf 00 bf 00 00 00 f7 01 b0 03 b0 03 a8 00 a8 00 00 00 "
    "ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff";

// One subpacket 31 of connected mode: carrier 5780 with the cells 210 at -118.5 and -18.0625, 503 at -121 and -19.5.
inline constexpr const char* connectedNeighbours =
    "01 01 00 00 1f 04 74 00 94 16 00 00 c2 ff ff ff "
    "d2 fc ff ff ff ff ff ff ff ff ff ff d8 f3 ff ff ff ff ff ff ff ff f2 ff ff ff ff ff ff ff ff ff "
    "ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff ff "
    "f7 01 00 00 00 00 00 00 00 00 00 00 b0 03 00 00 00 00 00 00 00 a0 02 00 00 00 00 00 00 00 00 00 "
    "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00";
// One subpacket 27 of idle mode: carrier 1300 with the cell 1 at -100 and -10.
inline constexpr const char* idleNeighbours =
    "01 01 00 00 1b 04 40 00 14 05 00 00 01 00 00 00 "
    "01 00 00 00 00 00 00 00 00 00 00 00 00 05 00 00 00 00 00 00 00 00 05 00 00 00 00 00 00 00 00 00 "
    "00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00";

// 0x4127, the serving cell of UMTS: UARFCNs 9490 and 9890, cell identity, URA, flags, access, PSC 293, 310-260, LAC
// 7145, RAC 18.
inline constexpr const char* wcdmaCell =
    "12 25 00 00 a2 26 00 00 04 03 02 01 00 00 07 00 50 12 03 01 00 02 06 00 e9 1b 00 00 12 00 00 00";

// GSM system information: type 3 of the cell 262-01 10000 4660, type 4 of a cell in the same area, type 13 with the
// routing area 18.
inline constexpr const char* gsmType3 = "49 06 1b 12 34 62 f2 10 27 10 4b 03 0a 15 65 06 9d 04 01 c5 69 42 ab";
inline constexpr const char* gsmType4 = "31 06 1c 62 f2 10 27 10 65 06 9d 04 01 64 11 22 33 2b 2b 2b";
inline constexpr const char* gsmType13 = "01 06 00 92 a4 cc 0a 84 b9 53 8c a2 a7 2b 2b 2b 2b 2b 2b 2b 2b 2b 2b";

}  // namespace vespscope::test::literal
