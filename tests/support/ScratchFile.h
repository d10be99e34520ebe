// A file that is removed at the end of the test.
#pragma once

#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <string>

#include "values/Value.h"

namespace vespscope::test {

class ScratchFile {
 public:
  explicit ScratchFile(const std::string& name, const Bytes& content = {})
      : folder_(std::filesystem::temp_directory_path() / ("vespscope-test-" + std::to_string(::getpid()))),
        path_(folder_ / name) {
    std::filesystem::create_directories(folder_);
    write(content);
  }
  ScratchFile(const ScratchFile&) = delete;
  ScratchFile& operator=(const ScratchFile&) = delete;
  ~ScratchFile() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
    std::filesystem::remove(folder_, ignored);  // only if it is empty
  }

  void write(const Bytes& content) const {
    std::ofstream file(path_, std::ios::binary | std::ios::trunc);
    file.write(reinterpret_cast<const char*>(content.data()), static_cast<std::streamsize>(content.size()));
  }
  [[nodiscard]] Bytes content() const {
    std::ifstream file(path_, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }
  [[nodiscard]] std::string path() const { return path_.string(); }

 private:
  std::filesystem::path folder_;
  std::filesystem::path path_;
};

}  // namespace vespscope::test
