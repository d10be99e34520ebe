#include "sources/playback/SourceSpec.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <optional>
#include <vector>

namespace vespscope::sources {
namespace {

using Problem = std::optional<std::string>;

constexpr std::string_view expected = "scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager";

// Splits at single commas; two commas in a row mean one that belongs to the piece.
std::vector<std::string> split(std::string_view text) {
  std::vector<std::string> pieces(1);
  for (std::size_t index = 0; index < text.size(); ++index) {
    if (text[index] != ',') {
      pieces.back() += text[index];
    } else if (index + 1 < text.size() && text[index + 1] == ',') {
      pieces.back() += ',';
      ++index;
    } else {
      pieces.emplace_back();
    }
  }
  return pieces;
}

template <class Number>
std::optional<Number> parseNumber(std::string_view text) {
  Number number{};
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  if (text.empty() || error != std::errc() || end != text.data() + text.size()) return std::nullopt;
  return number;
}

Problem parseSpeed(std::string_view value, SourceSpec& spec) {
  if (value == "max") {
    spec.playback.speed = PlaybackOptions::maximum;
    return std::nullopt;
  }
  const std::optional<double> speed = parseNumber<double>(value);
  if (!speed || !(*speed >= 0.01 && *speed <= 10'000)) return "speed is a number from 0.01 to 10000, or max";
  spec.playback.speed = *speed;
  return std::nullopt;
}

Problem parseStart(std::string_view value, SourceSpec& spec) {
  constexpr double longest = 1e8;  // seconds, about three years
  const std::optional<double> seconds = parseNumber<double>(value);
  if (!seconds || !(*seconds >= 0 && *seconds <= longest)) return "start is a number of seconds, not negative";
  spec.playback.start = std::chrono::nanoseconds(std::llround(*seconds * 1e9));
  return std::nullopt;
}

Problem parseSeed(std::string_view value, SourceSpec& spec) {
  const std::optional<std::uint64_t> seed = parseNumber<std::uint64_t>(value);
  if (!seed) return "seed is a whole number, not negative";
  spec.seed = *seed;
  return std::nullopt;
}

Problem parseSim(std::string_view value, SourceSpec& spec) {
  const std::optional<std::int32_t> sim = parseNumber<std::int32_t>(value);
  if (!sim || *sim < 1 || *sim > 4) return "sim is the number of a SIM card, from 1 to 4";
  spec.sim = sim;
  return std::nullopt;
}

bool isPortSpec(const SourceSpec& spec) { return spec.kind == SourceSpec::Kind::diagPort; }

Problem parseOption(const std::string& option, SourceSpec& spec) {
  const bool scenario = spec.kind == SourceSpec::Kind::scenario;
  const std::size_t equals = option.find('=');
  const std::string_view name = std::string_view(option).substr(0, equals);
  const std::string_view value = equals == std::string::npos ? "" : std::string_view(option).substr(equals + 1);
  if (name == "sim") {
    if (scenario) return "the simulated phone has one SIM card";
    if (spec.kind == SourceSpec::Kind::modemManager) return "ModemManager reports one SIM card, the active one";
    return parseSim(value, spec);
  }
  if (spec.isLive()) return "a live modem takes no options" + std::string(isPortSpec(spec) ? " but sim" : "");
  if (name == "speed") return parseSpeed(value, spec);
  if (name == "start") return parseStart(value, spec);
  if (name == "seed" && scenario) return parseSeed(value, spec);
  if (option == "loop" && !scenario) {
    spec.playback.loop = true;
    return std::nullopt;
  }
  if (name == "gaps" && !scenario) {
    if (value != "real") return "gaps can only be real";
    spec.playback.realGaps = true;
    return std::nullopt;
  }
  return "there is no option \"" + option + "\"" + (scenario ? "" : " (a comma in a file's name is written twice)");
}

Problem parseOptions(const std::vector<std::string>& options, SourceSpec& spec) {
  std::vector<std::string> names;
  for (const std::string& option : options) {
    if (Problem problem = parseOption(option, spec)) return problem;
    names.push_back(option.substr(0, option.find('=')));
  }
  std::sort(names.begin(), names.end());
  const auto twice = std::adjacent_find(names.begin(), names.end());
  if (twice != names.end()) return *twice + " is given twice";
  return std::nullopt;
}

std::optional<SourceSpec::Kind> kindNamed(std::string_view name) {
  if (name == "scenario") return SourceSpec::Kind::scenario;
  if (name == "replay") return SourceSpec::Kind::replay;
  if (name == "diag") return SourceSpec::Kind::diag;
  if (name == "modemmanager") return SourceSpec::Kind::modemManager;
  return std::nullopt;
}

// A live log comes from a device or over TCP; standard input also has names in /dev.
bool isPort(std::string_view file) {
  if (file.starts_with("/dev/stdin") || file.starts_with("/dev/fd/")) return false;
  return file.starts_with("/dev/") || file.starts_with("tcp:");
}

}  // namespace

Result<SourceSpec> SourceSpec::parse(std::string_view words) {
  const std::size_t end = std::min(words.find_first_of(":,"), words.size());
  const std::optional<Kind> kind = kindNamed(words.substr(0, end));
  const auto refusal = [words](const std::string& reason) {
    return Failure{"source \"" + std::string(words) + "\": " + reason};
  };
  if (!kind) return refusal("a source is " + std::string(expected));
  SourceSpec spec;
  spec.kind = *kind;
  const bool needsFile = *kind == Kind::replay || *kind == Kind::diag;
  std::vector<std::string> pieces;
  if (end < words.size()) pieces = split(words.substr(end + 1));
  if (needsFile) {
    if (end == words.size() || words[end] != ':' || pieces.front().empty()) return refusal("it names no file");
    spec.file = pieces.front();
    pieces.erase(pieces.begin());
  }
  if (*kind == Kind::diag && isPort(spec.file)) spec.kind = Kind::diagPort;
  if (Problem problem = parseOptions(pieces, spec)) return refusal(*problem);
  return spec;
}

}  // namespace vespscope::sources
