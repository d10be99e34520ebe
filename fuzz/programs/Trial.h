// One trial: a program with arguments, environment, descriptors and limits drawn by a seed, run until it ends or is
// asked to.
#pragma once

#include <array>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <map>
#include <random>
#include <string>
#include <vector>

#include "programs/Ground.h"

namespace vespscope::fuzz {

// What one of the descriptors 0, 1 and 2 is.
enum class End { nothing, null, terminal, pipe, silentPipe, brokenPipe, full, file, folder, otherWay };

struct Trial {
  std::string program;
  std::vector<std::string> arguments;
  std::map<std::string, std::string> variables;
  std::array<End, 3> ends{};
  int descriptors = 0;                // at most so many; 0: as many as there are
  std::uint64_t room = 0;             // bytes of a file; 0: as many as there are
  std::chrono::milliseconds time{0};  // until it is asked to end
  int signal = 0;                     // by which it is asked

  // On the ground and with one seed, always the same.
  static Trial draw(const Ground& ground, std::uint64_t seed);

  // As a line for a shell, unprintable bytes by their numbers.
  [[nodiscard]] std::string words() const;
  // Whether standard output is for data, not for people.
  [[nodiscard]] bool writesData() const;
};

// Runs the trial with the programs in `bin`; returns which rule was broken, else an empty text.
[[nodiscard]] std::string run(const Trial& trial, const std::filesystem::path& bin, const Ground& ground);

}  // namespace vespscope::fuzz
