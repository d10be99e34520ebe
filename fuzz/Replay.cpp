// Runs a fuzz target on every file of the given folders, without a fuzzer, so that earlier findings stay fixed.
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
      std::cout << entry.path().filename().string() << std::endl;  // if the target stops, its input is the last one
                                                                   // printed
      LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(content.data()), content.size());
      ++files;
    }
  }
  std::cout << files << " inputs\n";
  return files == 0 ? 1 : 0;
}
