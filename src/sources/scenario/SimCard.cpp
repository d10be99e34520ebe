#include "sources/scenario/SimCard.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace vespscope::sources::scenario {
namespace {

constexpr std::string_view imsi = "001010123456789";                  // a subscriber of the test network
constexpr std::string_view iccidWithoutCheck = "899901000000000001";  // 89: telecommunication, 999: no country
constexpr std::string_view number = "15550100";                       // of EF_MSISDN, after +; reserved for fiction

Bytes padded(Bytes bytes, std::size_t size) {
  bytes.resize(size, 0xFF);
  return bytes;
}

// Two digits per byte, the first in the low half, padded with F.
Bytes swappedDigits(std::string_view digits) {
  Bytes bytes;
  for (std::size_t i = 0; i < digits.size(); i += 2) {
    const auto low = static_cast<unsigned>(digits[i] - '0');
    const unsigned high = i + 1 < digits.size() ? static_cast<unsigned>(digits[i + 1] - '0') : 0xFU;
    bytes.push_back(static_cast<std::uint8_t>(high << 4U | low));
  }
  return bytes;
}

// ITU-T E.118: the last digit makes the Luhn sum a multiple of ten.
std::string withCheckDigit(std::string_view digits) {
  int sum = 0;
  bool twice = true;
  for (auto digit = digits.rbegin(); digit != digits.rend(); ++digit, twice = !twice) {
    const int value = (*digit - '0') * (twice ? 2 : 1);
    sum += value > 9 ? value - 9 : value;
  }
  return std::string(digits) + static_cast<char>('0' + (10 - sum % 10) % 10);
}

Bytes joined(std::initializer_list<Bytes> parts) {
  Bytes all;
  for (const Bytes& part : parts) all.insert(all.end(), part.begin(), part.end());
  return all;
}

Bytes text(std::string_view content) { return {content.begin(), content.end()}; }

// The service table, TS 31.102 4.2.8: bit (n - 1) % 8 of byte (n - 1) / 8 is for service n.
Bytes serviceTable(std::initializer_list<unsigned> services, std::size_t size) {
  Bytes table(size, 0);
  for (const unsigned service : services) {
    std::uint8_t& byte = table[(service - 1) / 8];
    byte = static_cast<std::uint8_t>(byte | 1U << ((service - 1) % 8));
  }
  return table;
}

}  // namespace

// The first digit shares its byte with the type of the identity (1, an IMSI) and the odd/even flag.
Bytes testImsi() {
  Bytes bytes = {static_cast<std::uint8_t>(static_cast<unsigned>(imsi.front() - '0') << 4U | 0x9U)};
  const Bytes rest = swappedDigits(imsi.substr(1));
  bytes.insert(bytes.end(), rest.begin(), rest.end());
  return bytes;
}

std::vector<CardFile> testCardFiles() {
  const Bytes plmn = operatorPlmn().octets();
  const Bytes unset(4, 0xFF);
  const Bytes subscriber = testImsi();
  return {
      // EF_ICCID, TS 102 221 13.2
      {0x2FE2, padded(swappedDigits(withCheckDigit(iccidWithoutCheck)), 10)},
      // EF_PL, TS 102 221 13.3: English
      {0x2F05, text("en")},
      // EF_IMSI, TS 31.102 4.2.2: length, then the identity
      {0x6F07, joined({{static_cast<std::uint8_t>(subscriber.size())}, subscriber})},
      // EF_AD, 4.2.18: type approval operation of a test card, two digits of network code
      {0x6FAD, {0x80, 0x00, 0x00, 0x02}},
      // EF_UST, 4.2.8: local phone book, SMS, MSISDN, service provider name, EMM information and others
      {0x6F38, serviceTable({1, 10, 12, 19, 20, 21, 27, 33, 42, 43, 71, 85}, 12)},
      // EF_SPN, 4.2.12: the name, not required if the network's own is shown
      {0x6F46, padded(joined({{0x01}, text("Test Network")}), 17)},
      // EF_HPPLMN, 4.2.6: a search for the home network every 60 minutes (ten times six)
      {0x6F31, {0x0A}},
      // EF_ACC, 4.2.15: access class 9, the last digit of the identity
      {0x6F78, {0x02, 0x00}},
      // EF_FPLMN, 4.2.16: no forbidden networks
      {0x6F7B, padded({}, 12)},
      // EF_HPLMNwAcT, 4.2.54: the home network in E-UTRAN, UTRAN and GSM
      {0x6F62, joined({plmn, {0xC0, 0x80}})},
      // EF_MSISDN, 4.2.26: no name, length, international number, no extension
      {0x6F40, joined({padded({}, 14), {0x05, 0x91}, padded(swappedDigits(number), 10), {0xFF, 0xFF}})},
      // EF_LOCI, 4.2.17: no TMSI, home network without a location area, not updated
      {0x6F7E, joined({unset, plmn, {0xFF, 0xFE, 0xFF, 0x01}})},
      // EF_PSLOCI, 4.2.23: no P-TMSI nor signature, no routing area, not updated
      {0x6F73, joined({unset, {0xFF, 0xFF, 0xFF}, plmn, {0xFF, 0xFE, 0xFF, 0x01}})},
      // EF_EPSLOCI, 4.2.91: no GUTI, home network without a tracking area, not updated
      {0x6FE3, joined({padded({}, 12), plmn, {0xFF, 0xFE, 0x01}})},
  };
}

}  // namespace vespscope::sources::scenario
