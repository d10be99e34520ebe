#include "support/Golden.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <optional>
#include <sstream>
#include <string_view>
#include <vector>

namespace vespscope::test {
namespace {

std::vector<std::string> linesOf(const std::string& text) {
  std::vector<std::string> lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) lines.push_back(line);
  return lines;
}

std::optional<std::string> contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  if (!stream) return std::nullopt;
  std::ostringstream content;
  content << stream.rdbuf();
  return content.str();
}

// Each line of both texts once, in order, marked ' ' (both), '-' (expected only) or '+' (actual only).
std::vector<std::pair<char, std::string>> aligned(const std::vector<std::string>& expected,
                                                  const std::vector<std::string>& actual) {
  // common[i][j]: the length of the longest common run of lines of expected[i..] and actual[j..].
  std::vector<std::vector<std::size_t>> common(expected.size() + 1, std::vector<std::size_t>(actual.size() + 1, 0));
  for (std::size_t i = expected.size(); i-- > 0;) {
    for (std::size_t j = actual.size(); j-- > 0;) {
      common[i][j] = expected[i] == actual[j] ? common[i + 1][j + 1] + 1 : std::max(common[i + 1][j], common[i][j + 1]);
    }
  }
  std::vector<std::pair<char, std::string>> lines;
  std::size_t i = 0;
  std::size_t j = 0;
  while (i < expected.size() || j < actual.size()) {
    if (i < expected.size() && j < actual.size() && expected[i] == actual[j]) {
      lines.emplace_back(' ', expected[i]);
      ++i;
      ++j;
    } else if (j == actual.size() || (i < expected.size() && common[i + 1][j] >= common[i][j + 1])) {
      lines.emplace_back('-', expected[i++]);
    } else {
      lines.emplace_back('+', actual[j++]);
    }
  }
  return lines;
}

}  // namespace

std::string lineDifference(const std::string& expected, const std::string& actual) {
  if (expected == actual) return {};
  constexpr std::size_t context = 2;
  const auto lines = aligned(linesOf(expected), linesOf(actual));
  std::vector<bool> shown(lines.size(), false);
  for (std::size_t index = 0; index < lines.size(); ++index) {
    if (lines[index].first == ' ') continue;
    const std::size_t end = std::min(index + context + 1, lines.size());
    for (std::size_t near = index < context ? 0 : index - context; near < end; ++near) shown[near] = true;
  }
  std::string text;
  for (std::size_t index = 0; index < lines.size(); ++index) {
    if (!shown[index]) continue;
    if (index > 0 && !shown[index - 1]) text += "  …\n";
    text += lines[index].first;
    text += ' ' + lines[index].second + '\n';
  }
  return text.empty() ? "the texts end differently\n" : text;
}

::testing::AssertionResult matchesGolden(const std::filesystem::path& golden, const std::string& actual) {
  const std::optional<std::string> expected = contentOf(golden);
  if (expected == actual) return ::testing::AssertionSuccess();
  auto failure = ::testing::AssertionFailure();
  failure << golden.filename().string() << (expected ? " differs:\n" : " is missing:\n")
          << lineDifference(expected.value_or(std::string()), actual);
  const char* update = std::getenv("VESPSCOPE_UPDATE_GOLDEN");
  if (update == nullptr || std::string_view(update) != "1") return failure;
  std::filesystem::create_directories(golden.parent_path());
  std::ofstream(golden, std::ios::binary) << actual;
  return failure << "It was rewritten: look at it, then test without VESPSCOPE_UPDATE_GOLDEN.\n";
}

}  // namespace vespscope::test
