// A file that gets its name only when it is complete: until then it is called NAME.partial.EXTENSION, in the same
// folder.
#pragma once

#include <optional>
#include <string>

#include "values/Result.h"

namespace vespscope::files {

class NewFile {
 public:
  enum class Existing {
    refuse,   // an existing file stays as it is, and create() or finish() returns an error
    replace,  // finish() replaces it unless another program is reading it
  };

  // Creates the partial file, readable by its owner only. An earlier partial file is kept: the new one is then called
  // NAME.partial-2.EXTENSION, and so on. Errors name the file.
  static Result<NewFile> create(const std::string& path, Existing existing);

  NewFile(NewFile&& other) noexcept;
  NewFile& operator=(NewFile&&) = delete;
  // Leaves an unfinished partial file in place.
  ~NewFile();

  // Open for writing while the object lives.
  [[nodiscard]] int descriptor() const { return descriptor_; }
  [[nodiscard]] const std::string& partialName() const { return partialName_; }

  // Writes the contents to the disk and gives the file its name, replacing an existing file if `replace` was chosen. On
  // failure returns an error that names the file; the partial file remains.
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

// Whether a program is reading `path` through InputFile, as far as the file system supports locks.
[[nodiscard]] bool isBeingRead(const std::string& path);

}  // namespace vespscope::files
