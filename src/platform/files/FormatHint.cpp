#include "platform/files/FormatHint.h"

#include <algorithm>
#include <array>

#include "platform/files/UnpackedFile.h"

namespace vespscope::files {
namespace {

using namespace std::string_view_literals;

struct Format {
  std::string_view mark;
  std::string_view hint;
  std::size_t offset = 0;  // of the mark
};

constexpr std::string_view capture = "it is a packet capture: vespscope's own are played with replay:FILE";

constexpr std::array formats = {
    Format{"\xA1\xB2\xC3\xD4"sv, capture},
    Format{"\xD4\xC3\xB2\xA1"sv, capture},
    Format{"\xA1\xB2\x3C\x4D"sv, capture},
    Format{"\x4D\x3C\xB2\xA1"sv, capture},
    Format{"\x0A\x0D\x0D\x0A"sv, capture},
    Format{"ustar"sv, "it is a tar archive: unpack it first", 257},
    Format{"PK\x03\x04"sv, "it is a ZIP archive: unpack it first"},
    Format{"7z\xBC\xAF\x27\x1C"sv, "it is a 7z archive: unpack it first"},
    Format{"Rar!\x1A\x07"sv, "it is a RAR archive: unpack it first"},
    Format{"BZh"sv, "it is compressed with bzip2: unpack it first"},
    Format{"\x28\xB5\x2F\xFD"sv, "it is compressed with zstd: unpack it first"},
    Format{"\x04\x22\x4D\x18"sv, "it is compressed with LZ4: unpack it first"},
    Format{"SQLite format 3\0"sv, "it is an SQLite database"},
    Format{"\x7F"
           "ELF"sv,
           "it is a program"},
    Format{"MZ"sv, "it is a program"},
    Format{"\x89PNG"sv, "it is a picture"},
    Format{"\xFF\xD8\xFF"sv, "it is a picture"},
    Format{"%PDF-"sv, "it is a PDF document"},
};

bool isPrintable(std::uint8_t byte) { return (byte >= ' ' && byte < 0x7F) || (byte >= '\t' && byte <= '\r'); }

}  // namespace

std::string_view formatHint(std::span<const std::uint8_t> head) {
  for (const Format& format : formats) {
    if (head.size() < format.offset + format.mark.size()) continue;
    const auto same = [](char mark, std::uint8_t byte) { return static_cast<std::uint8_t>(mark) == byte; };
    const auto place = head.begin() + static_cast<std::ptrdiff_t>(format.offset);
    if (std::equal(format.mark.begin(), format.mark.end(), place, same)) return format.hint;
  }
  if (!head.empty() && std::all_of(head.begin(), head.end(), isPrintable)) return "it is text";
  return {};
}

std::string_view formatHintOf(const std::string& path) {
  if (path == "-") return {};
  const auto file = UnpackedFile::open(path);
  if (!file || !(*file)->canRewind()) return {};
  std::array<std::uint8_t, formatHintLength> head{};
  std::size_t held = 0;
  while (held < head.size()) {
    const auto count = (*file)->read(std::span(head).subspan(held));
    if (!count || *count == 0) break;
    held += *count;
  }
  return formatHint(std::span(head).first(held));
}

}  // namespace vespscope::files
