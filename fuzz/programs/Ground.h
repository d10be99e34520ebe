// Where one trial of a program takes place: a folder with inputs of every kind, good and bad, a folder for outputs, and
// sockets that never answer.
#pragma once

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace vespscope::fuzz {

class Ground {
 public:
  // Copies captures and logs from `corpus`.
  explicit Ground(const std::filesystem::path& corpus);
  Ground(const Ground&) = delete;
  Ground& operator=(const Ground&) = delete;
  ~Ground();

  [[nodiscard]] const std::filesystem::path& folder() const { return folder_; }
  // Paths that may be read: files, folders, pipes, links, devices, names that do not exist.
  [[nodiscard]] const std::vector<std::string>& inputs() const { return inputs_; }
  // Good captures among them.
  [[nodiscard]] const std::vector<std::string>& captures() const { return captures_; }
  // Paths that may be written.
  [[nodiscard]] const std::vector<std::string>& outputs() const { return outputs_; }
  // A TCP port where connections are taken and nothing is said.
  [[nodiscard]] int silentPort() const { return silentPort_; }
  [[nodiscard]] std::string silentSocket() const { return (folder_ / "silent").string(); }

  // Empties the folder of outputs.
  void clear() const;
  // Returns which input is not as it was, else an empty text.
  [[nodiscard]] std::string changedInput() const;
  // Returns which output has its final name without being a whole capture, or which socket was left, else an empty
  // text.
  [[nodiscard]] std::string badOutput() const;

 private:
  void add(const std::string& name, const std::string& contents, bool isCapture = false);
  [[nodiscard]] std::map<std::string, std::string> contents() const;

  std::filesystem::path folder_;
  std::vector<std::string> inputs_;
  std::vector<std::string> captures_;
  std::vector<std::string> outputs_;
  std::map<std::string, std::string> before_;
  int listening_[2] = {-1, -1};
  int silentPort_ = 0;
};

}  // namespace vespscope::fuzz
