// A file that takes its name only when it is whole: until then it is called NAME.partial.EXTENSION, in the same folder.
#pragma once

#include <optional>
#include <string>

#include "values/Result.h"

namespace vespscope::files {

class NewFile {
 public:
  enum class Existing {
    refuse,   // a file of that name stays as it is, and finish() or create() returns a reason
    replace,  // finish() replaces it, unless another program reads it
  };

  // Creates the partial file for its owner alone to read. An earlier partial file is kept: the new one is then called
  // NAME.partial-2.EXTENSION, and so on. Reasons name the file.
  static Result<NewFile> create(const std::string& path, Existing existing);

  NewFile(NewFile&& other) noexcept;
  NewFile& operator=(NewFile&&) = delete;
  // Leaves a partial file where it is.
  ~NewFile();

  // Open for writing, as long as the object lives.
  [[nodiscard]] int descriptor() const { return descriptor_; }
  [[nodiscard]] const std::string& partialName() const { return partialName_; }

  // Brings the contents to the disk and gives the file its name, in place of an existing one if that was wanted. After
  // a failure, whose reason names the file, the partial file is still there.
  [[nodiscard]] std::optional<std::string> finish();
  // Removes the partial file.
  void discard();

 private:
  NewFile(std::string path, Existing existing) : path_(std::move(path)), existing_(existing) {}

  std::string path_;
  std::string partialName_;
  Existing existing_;
  int descriptor_ = -1;
};

// Whether a program holds `path` open through InputFile, as far as the file system has locks.
[[nodiscard]] bool isBeingRead(const std::string& path);

}  // namespace vespscope::files
