// Messages of the non-access stratum byte by byte.
#pragma once

namespace vespscope::test::literal {

// Bearer 5: QCI 9, "internet", 10.1.2.3, an aggregate rate, a cause, options with the servers 192.0.2.53 and
// 198.51.100.53, the first of them twice.
inline constexpr const char* activateDefault =
    "52 01 c1 01 09 09 08 69 6e 74 65 72 6e 65 74 05 01 0a 01 02 03 5e 02 fe fe 58 32 "
    "27 1b 80 80 21 10 02 00 00 10 81 06 c0 00 02 35 83 06 c6 33 64 35 00 0d 04 c0 00 02 35";

// Both domains, T3412 of 54 minutes, area 262-01 1234, the message above, GUTI, LAI, TMSI, T3402, T3423, an equivalent
// network 262-02, IMS voice without emergency bearers, and a T3412 of 2 hours that replaces the other one.
inline constexpr const char* attachAccept =
    "07 42 02 49 06 00 62 f2 10 12 34 00 38 "
    "52 01 c1 01 09 09 08 69 6e 74 65 72 6e 65 74 05 01 0a 01 02 03 5e 02 fe fe 58 32 "
    "27 1b 80 80 21 10 02 00 00 10 81 06 c0 00 02 35 83 06 c6 33 64 35 00 0d 04 c0 00 02 35 "
    "50 0b f6 62 f2 10 80 01 02 c0 00 00 01 13 62 f2 10 27 10 23 05 f4 d0 00 00 02 17 2c 59 49 4a 03 62 f2 20 "
    "64 01 01 5e 01 22";

// Combined attach of a voice-centric phone, with a request for connectivity.
inline constexpr const char* attachRequest =
    "07 41 72 08 29 26 10 90 00 00 00 01 02 e0 e0 00 04 02 01 d0 11 52 62 f2 10 12 34 5c 0a 00 5d 01 00";

// Combined update of a data-centric phone: GUTI, capability, last area, DRX, bearers, LAI, usage setting.
inline constexpr const char* updateRequest =
    "07 48 11 0b f6 62 f2 10 80 01 02 c0 00 00 01 58 02 e0 e0 52 62 f2 10 12 34 5c 0a 00 57 02 20 00 13 62 f2 10 27 10 "
    "5d 01 04";

// Combined result, T3412 of 54 minutes, three lists of areas, bearers, LAI, TMSI, cause 18, both features.
inline constexpr const char* updateAccept =
    "07 49 01 5a 49 54 19 01 62 f2 10 12 34 12 40 22 62 f2 20 20 00 41 62 f2 10 00 01 13 00 14 00 02 "
    "57 02 20 00 13 62 f2 10 27 10 23 05 f4 d0 00 00 02 53 12 64 01 03";

// Packet domain: both domains, T3312 of 54 minutes, area 310-260 7145 18, signature, P-TMSI, TMSI, cause 16, an
// equivalent network.
inline constexpr const char* gmmAttachAccept =
    "08 02 03 49 00 13 00 62 1b e9 12 19 01 02 03 18 05 f4 c0 00 00 01 23 05 f4 d0 00 00 02 25 10 4a 03 62 f2 20";
inline constexpr const char* routingUpdateAccept = "08 09 00 49 13 00 62 1b e9 12 18 05 f4 c0 00 00 01";
inline constexpr const char* gmmAttachRequest =
    "08 01 02 e5 e0 13 0a 00 05 f4 c0 00 00 01 13 00 62 1b e9 12 03 01 02 03";

// Circuit domain: area 310-260 7145, TMSI.
inline constexpr const char* locationUpdateAccept = "05 02 13 00 62 1b e9 17 05 f4 d0 00 00 02";

// NSAPI 5, any address, "internet".
inline constexpr const char* activateContextRequest =
    "0a 41 05 03 03 00 00 00 02 01 21 28 09 08 69 6e 74 65 72 6e 65 74 27 01 80";
// 10.1.2.3, the server 192.0.2.53.
inline constexpr const char* activateContextAccept =
    "8a 42 03 03 00 00 00 04 2b 06 01 21 0a 01 02 03 27 08 80 00 0d 04 c0 00 02 35";

}  // namespace vespscope::test::literal
