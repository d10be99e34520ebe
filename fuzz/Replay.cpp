// Runs a fuzz target over every file of the folders it is given, without a fuzzer: what once was found stays mended.
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <vector>

#include "Fuzz.h"

int main(int count, char** folders) {
  std::size_t files = 0;
  for (int index = 1; index < count; ++index) {
    for (const auto& entry : std::filesystem::directory_iterator(folders[index])) {
      std::ifstream file(entry.path(), std::ios::binary);
      const std::vector<char> content{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
      std::cout << entry.path().filename().string() << std::endl;  // the last one named is the one that stops it
      LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(content.data()), content.size());
      ++files;
    }
  }
  std::cout << files << " inputs\n";
  return files == 0 ? 1 : 0;
}
