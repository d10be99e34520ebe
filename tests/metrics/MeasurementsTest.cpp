// Conversions of raw codes into display units, including their special cases.
#include <array>
#include <cstdint>
#include <limits>
#include <string>

#include <gtest/gtest.h>

#include "metrics/Measurements.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

const BandwidthTable bandwidths = {{0, 1.4F}, {1, 3.0F}, {2, 5.0F}, {3, 10.0F}, {4, 15.0F}, {5, 20.0F}};

// The element's text after the conversion.
std::string converted(Record element, Measured measured) {
  convertMeasurements(element, measured, bandwidths);
  return toText(element);
}

TEST(Measurements, AUmtsRscpOfZeroBecomesMinus116) {
  EXPECT_EQ(converted({{"rscp", 0}}, Measured::umtsNeighbour), "[rscp: -116]");
  EXPECT_EQ(converted({{"rscp", -5}}, Measured::umtsNeighbour), "[rscp: -121]");
  EXPECT_EQ(converted({{"cpich_rscp", std::uint32_t{91}}}, Measured::umtsNeighbour), "[cpich_rscp: -25]");
}

TEST(Measurements, AUmtsEcnoOfZeroBecomesMinus24Point5) {
  EXPECT_EQ(converted({{"ecno", std::uint32_t{0}}}, Measured::umtsNeighbour), "[ecno: -24.5]");
  EXPECT_EQ(converted({{"ecno", std::uint32_t{49}}}, Measured::umtsNeighbour), "[ecno: 0.0]");
  EXPECT_EQ(converted({{"cpich_ecno", std::uint32_t{1}}}, Measured::umtsNeighbour), "[cpich_ecno: -24.0]");
}

TEST(Measurements, AnEcnoSpelledWithTheDigitZeroStaysUnconverted) {
  EXPECT_EQ(converted({{"cpich_ecn0", std::uint32_t{30}}}, Measured::umtsNeighbour), "[cpich_ecn0: 30]");
}

TEST(Measurements, AGsmRxlevOf63BecomesMinus47) {
  EXPECT_EQ(converted({{"rxlev", std::uint32_t{63}}}, Measured::gsmNeighbour), "[rxlev: -47]");
  EXPECT_EQ(converted({{"rxlev", std::uint32_t{0}}}, Measured::gsmNeighbour), "[rxlev: -110]");
}

TEST(Measurements, AnLteRsrpOf97BecomesMinus43) {
  EXPECT_EQ(converted({{"rsrp", std::uint32_t{97}}}, Measured::lteNeighbour), "[rsrp: -43]");
  EXPECT_EQ(converted({{"nbr_rsrp", 44}}, Measured::lteNeighbour), "[nbr_rsrp: -96]");
}

TEST(Measurements, AnLteRsrqOf34BecomesMinus2Point5) {
  EXPECT_EQ(converted({{"rsrq", std::uint32_t{34}}}, Measured::lteNeighbour), "[rsrq: -2.5]");
  EXPECT_EQ(converted({{"nbr_rsrq", 0}}, Measured::lteNeighbour), "[nbr_rsrq: -19.5]");
}

TEST(Measurements, ASinrIsHalved) {
  EXPECT_EQ(converted({{"sinr0", 25}, {"sinr1", -3}}, Measured::antennaPorts), "[sinr0: 12.5, sinr1: -1.5]");
  EXPECT_EQ(converted({{"rsrp0", 50}, {"rsrq0", 20}}, Measured::antennaPorts), "[rsrp0: 50, rsrq0: 20]");
}

TEST(Measurements, ASecondaryCarriersRsrpIsTruncatedTowardZero) {
  EXPECT_EQ(converted({{"rsrp", -9050}}, Measured::secondaryCarrier), "[rsrp: -90]");
  EXPECT_EQ(converted({{"rsrp", -99}, {"rssi", -6199}}, Measured::secondaryCarrier), "[rsrp: 0, rssi: -61]");
}

TEST(Measurements, ASecondaryCarriersRsrqIsDividedByAHundredInFloat) {
  EXPECT_EQ(converted({{"rsrq", -1050}}, Measured::secondaryCarrier), "[rsrq: -10.5]");
  // The nearest 32-bit number to -11.23, shown with the digits that a 32-bit number needs.
  EXPECT_EQ(converted({{"rsrq", -1123}}, Measured::secondaryCarrier), "[rsrq: -11.23]");
}

TEST(Measurements, BandwidthCode5Becomes20AndCode7IsRemoved) {
  EXPECT_EQ(converted({{"dl_bw", std::uint32_t{5}}}, Measured::neighbourFrequency), "[dl_bw: 20.0]");
  EXPECT_EQ(converted({{"earfcn", 1}, {"dl_bw", std::uint32_t{7}}}, Measured::neighbourFrequency), "[earfcn: 1]");
  EXPECT_EQ(converted({{"dl_bandwidth", std::uint32_t{0}}}, Measured::secondaryCarrier), "[dl_bandwidth: 1.4]");
  EXPECT_EQ(converted({{"dl_bandwidth", std::uint32_t{4294967295U}}}, Measured::secondaryCarrier), "[]");
}

TEST(Measurements, EachBandwidthCodeHasItsMegahertz) {
  const std::array<const char*, 6> texts = {"1.4", "3.0", "5.0", "10.0", "15.0", "20.0"};
  for (std::uint32_t code = 0; code < texts.size(); ++code) {
    EXPECT_EQ(converted({{"dl_bw", code}}, Measured::neighbourFrequency), "[dl_bw: " + std::string(texts[code]) + "]");
  }
}

TEST(Measurements, AnEntryThatCannotBeConvertedIsRemoved) {
  EXPECT_EQ(converted({{"psc", 9}, {"rscp", "loud"}, {"ecno", Record{}}}, Measured::umtsNeighbour), "[psc: 9]");
  EXPECT_EQ(converted({{"rxlev", 1.5}}, Measured::gsmNeighbour), "[]");
  EXPECT_EQ(converted({{"rsrp", std::numeric_limits<std::uint64_t>::max()}}, Measured::lteNeighbour), "[]");
  // No 32-bit float holds this number.
  EXPECT_EQ(converted({{"rsrq", std::uint32_t{16777217}}}, Measured::lteNeighbour), "[]");
  EXPECT_EQ(converted({{"dl_bw", 1.5F}}, Measured::neighbourFrequency), "[]");
}

TEST(Measurements, AnAbsentEntryStaysAbsent) {
  EXPECT_EQ(converted({{"earfcn", 1}}, Measured::lteNeighbour), "[earfcn: 1]");
  EXPECT_EQ(converted({}, Measured::secondaryCarrier), "[]");
}

TEST(Measurements, AnEntryIsConvertedOnlyWhereItIsThatMeasurement) {
  EXPECT_EQ(converted({{"rsrp", 1}, {"rscp", 2}, {"rxlev", 3}, {"dl_bw", 4}, {"sinr0", 5}}, Measured::nothing),
            "[rsrp: 1, rscp: 2, rxlev: 3, dl_bw: 4, sinr0: 5]");
  EXPECT_EQ(converted({{"rscp", 0}, {"rxlev", 0}}, Measured::gsmNeighbour), "[rscp: 0, rxlev: -110]");
  EXPECT_EQ(converted({{"dl_bandwidth", 5}}, Measured::neighbourFrequency), "[dl_bandwidth: 5]");
}

TEST(Measurements, AnEntryKeepsItsPlaceAndALevelIsA64BitInteger) {
  Record element = {{"rsrp", std::uint32_t{4294967295U}}, {"earfcn", 5}};
  convertMeasurements(element, Measured::lteNeighbour, bandwidths);
  EXPECT_EQ(element.at(0).key.view(), "rsrp");
  EXPECT_EQ(element.at(0).value, Value(std::int64_t{4294967155}));
}

TEST(MeasurementsDeathTest, ASubtractionBeyondThe64BitRangeStopsTheProcess) {
  Record element = {{"rsrp", std::numeric_limits<std::int64_t>::min() + 139}};
  EXPECT_DEATH(convertMeasurements(element, Measured::lteNeighbour, bandwidths),
               "a measurement code leaves the 64-bit range");
  element = {{"rsrp", std::numeric_limits<std::int64_t>::min() + 140}};
  convertMeasurements(element, Measured::lteNeighbour, bandwidths);
  EXPECT_EQ(*element.find("rsrp"), Value(std::numeric_limits<std::int64_t>::min()));
}

}  // namespace
}  // namespace vespscope::test
