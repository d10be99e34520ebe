// What the platform provides to a program: its version and its resources.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace vespscope::application {

struct Version {
  int major = 0;
  int minor = 0;
  int patch = 0;
  friend auto operator<=>(const Version&, const Version&) = default;
};

// The platform's version, 13.0.0 or later; tests inject an older one.
[[nodiscard]] bool isPlatformAtLeast(Version version);
void setPlatformVersion(Version version);

// The main resource bundle: files shipped with the program, looked up by name and type.
class Bundle {
 public:
  explicit Bundle(std::vector<std::filesystem::path> folders) : folders_(std::move(folders)) {}

  // The bundle next to the running program: the resources of its build tree or installation.
  [[nodiscard]] static Bundle& main();

  // The path of the regular file "name.type" in the first folder that contains it; empty when none does.
  [[nodiscard]] std::optional<std::filesystem::path> pathForResource(const std::string& name,
                                                                     const std::string& type) const;

 private:
  std::vector<std::filesystem::path> folders_;
};

}  // namespace vespscope::application
