#include "sources/modemmanager/CardFiles.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <optional>

namespace vespscope::sources::modemmanager {
namespace {

constexpr std::uint8_t untold = 0xFF;
constexpr std::size_t nameBytes = 16;  // of EF_SPN, after its first byte

unsigned digit(char character) { return static_cast<unsigned>(character - '0'); }

// Two digits per byte, the first in the low half, padded with F.
Bytes swappedDigits(std::string_view digits) {
  Bytes bytes;
  for (std::size_t index = 0; index < digits.size(); index += 2) {
    const unsigned high = index + 1 < digits.size() ? digit(digits[index + 1]) : 0xFU;
    bytes.push_back(static_cast<std::uint8_t>(high << 4U | digit(digits[index])));
  }
  return bytes;
}

Bytes padded(Bytes bytes, std::size_t size) {
  bytes.resize(size, untold);
  return bytes;
}

// Returns the code points of a UTF-8 text; empty when it is not valid UTF-8.
std::optional<std::u32string> codePoints(std::string_view text) {
  std::u32string points;
  for (std::size_t index = 0; index < text.size();) {
    const auto first = static_cast<unsigned char>(text[index]);
    const std::size_t length = first < 0x80 ? 1 : first < 0xC0 ? 0 : first < 0xE0 ? 2 : first < 0xF0 ? 3 : 4;
    if (length == 0 || index + length > text.size()) return std::nullopt;
    char32_t point = length == 1 ? first : first & (0x7FU >> length);
    for (std::size_t more = 1; more < length; ++more) {
      point = point << 6U | (static_cast<unsigned char>(text[index + more]) & 0x3FU);
    }
    points.push_back(point);
    index += length;
  }
  return points;
}

// The default alphabet, 3GPP TS 23.038 6.2.1, in the order of its codes; U+FFFF for a code without a character.
constexpr std::u32string_view defaultAlphabet =
    U"@£$¥èéùìòÇ\nØø\rÅåΔ_ΦΓΛΩΠΨΣΘΞ\uFFFFÆæßÉ !\"#¤%&'()*+,-./0123456789:;<=>?"
    U"¡ABCDEFGHIJKLMNOPQRSTUVWXYZÄÖÑÜ§¿abcdefghijklmnopqrstuvwxyzäöñüà";
static_assert(defaultAlphabet.size() == 128);

std::optional<Bytes> inDefaultAlphabet(const std::u32string& points) {
  Bytes bytes;
  for (const char32_t point : points) {
    const std::size_t code = defaultAlphabet.find(point);
    if (code == std::u32string_view::npos || point == U'\uFFFF') return std::nullopt;
    bytes.push_back(static_cast<std::uint8_t>(code));
  }
  return bytes;
}

// 16-bit characters after a byte 80, ETSI TS 102 221 annex A.
std::optional<Bytes> inUcs2(const std::u32string& points) {
  Bytes bytes = {0x80};
  for (const char32_t point : points) {
    if (point > 0xFFFF) return std::nullopt;
    bytes.push_back(static_cast<std::uint8_t>(point >> 8U));
    bytes.push_back(static_cast<std::uint8_t>(point & 0xFFU));
  }
  return bytes;
}

// ModemManager does not report whether the network's own name is to be shown as well (the first byte). A name that
// exceeds the file's size is not from the file.
std::optional<Bytes> providerName(std::string_view name) {
  const auto points = codePoints(name);
  if (!points) return std::nullopt;
  std::optional<Bytes> coded = inDefaultAlphabet(*points);
  if (!coded) coded = inUcs2(*points);
  if (!coded || coded->size() > nameBytes) return std::nullopt;
  coded->insert(coded->begin(), untold);
  return padded(*std::move(coded), 1 + nameBytes);
}

}  // namespace

// The first digit shares its byte with the type of the identity (1, an IMSI) and the odd/even flag.
Bytes encodedImsi(std::string_view digits) {
  const unsigned kind = digits.size() % 2 == 1 ? 0x9U : 0x1U;
  Bytes bytes = {static_cast<std::uint8_t>(digit(digits.front()) << 4U | kind)};
  const Bytes rest = swappedDigits(digits.substr(1));
  bytes.insert(bytes.end(), rest.begin(), rest.end());
  return bytes;
}

std::vector<CardFile> cardFiles(const SimCard& card) {
  std::vector<CardFile> files;
  // EF_ICCID, TS 102 221 13.2
  if (card.iccid) files.push_back({0x2FE2, padded(swappedDigits(*card.iccid), 10)});
  // EF_IMSI, TS 31.102 4.2.2: length, then the identity
  if (card.imsi) {
    const Bytes identity = encodedImsi(*card.imsi);
    Bytes content = {static_cast<std::uint8_t>(identity.size())};
    content.insert(content.end(), identity.begin(), identity.end());
    files.push_back({0x6F07, padded(std::move(content), 9)});
  }
  // EF_AD, 4.2.18: of its four bytes only the last is reported, the number of digits of the network code
  if (card.operatorCode) {
    files.push_back({0x6FAD, {untold, untold, untold, static_cast<std::uint8_t>(card.operatorCode->size() - 3)}});
  }
  // EF_SPN, 4.2.12
  if (card.operatorName) {
    if (std::optional<Bytes> name = providerName(*card.operatorName)) files.push_back({0x6F46, *std::move(name)});
  }
  // EF_GID1 and EF_GID2, 4.2.10 and 4.2.11
  if (card.gid1) files.push_back({0x6F3E, *card.gid1});
  if (card.gid2) files.push_back({0x6F3F, *card.gid2});
  return files;
}

}  // namespace vespscope::sources::modemmanager
