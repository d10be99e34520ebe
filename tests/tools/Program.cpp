#include "Program.h"

#include <chrono>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <sstream>
#include <stdexcept>

#include "capture/EventPacket.h"
#include "support/Process.h"

namespace vespscope::test {
namespace {

std::string littleEndian(std::uint32_t number) {
  std::string bytes;
  for (int shift = 0; shift < 32; shift += 8) bytes += static_cast<char>(number >> shift & 0xFF);
  return bytes;
}

}  // namespace

Outcome runProgram(const std::string& program, const std::vector<std::string>& arguments, const std::string& input) {
  const TemporaryFolder folder;
  Process process(std::filesystem::path(VESPSCOPE_BIN_DIR) / program, arguments,
                  {{"TZ", "UTC"}, {"RHOX_ADDRESS", "none"}}, folder.write("input", input));
  const std::optional<ProcessEnd> end = process.wait();
  if (!end) throw std::runtime_error("the program does not end");
  return {end->signalled ? -end->number : end->number, process.output(), process.errors()};
}

std::string contentsOf(const std::string& path) {
  std::ifstream file(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::vector<std::string> linesOf(const std::string& text) {
  std::istringstream stream(text);
  std::vector<std::string> lines;
  for (std::string line; std::getline(stream, line);) lines.push_back(line);
  return lines;
}

std::string binary(const std::string& hexadecimal) {
  std::istringstream stream(hexadecimal);
  std::string bytes;
  for (std::string word; stream >> word;) {
    for (std::size_t index = 0; index + 1 < word.size(); index += 2) {
      bytes += static_cast<char>(std::stoi(word.substr(index, 2), nullptr, 16));
    }
  }
  return bytes;
}

std::string captureOf(const std::vector<std::string>& packets) {
  // Magic number of nanosecond pcap, version 2.4, time zone, accuracy, longest packet, link type.
  std::string file = binary("4d3cb2a1 0200 0400 00000000 00000000 00000400 93000000");
  for (const std::string& packet : packets) file += packet;
  return file;
}

std::string packetAt(std::uint32_t seconds, std::uint32_t nanoseconds, const std::string& bytes) {
  const std::string length = littleEndian(static_cast<std::uint32_t>(bytes.size()));
  return littleEndian(seconds) + littleEndian(nanoseconds) + length + length + bytes;
}

std::string captureOf(const std::vector<MetricEvent>& events) {
  std::vector<std::string> packets;
  for (const MetricEvent& event : events) {
    const Bytes bytes = capture::packetOf(event);
    const auto seconds = std::chrono::floor<std::chrono::seconds>(event.time);
    packets.push_back(packetAt(static_cast<std::uint32_t>(seconds.count()),
                               static_cast<std::uint32_t>((event.time - seconds).count()),
                               std::string(bytes.begin(), bytes.end())));
  }
  return captureOf(packets);
}

}  // namespace vespscope::test
