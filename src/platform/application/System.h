// What the platform tells a program: its resources, its version, and how it writes dates.
#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
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

  // The bundle beside the running program: its build tree's or installation's resources.
  [[nodiscard]] static Bundle& main();

  // The path of the regular file "name.type" in the first folder that has it; empty when none has.
  [[nodiscard]] std::optional<std::filesystem::path> pathForResource(const std::string& name,
                                                                     const std::string& type) const;

 private:
  std::vector<std::filesystem::path> folders_;
};

// Formats instants with a date pattern (Unicode TR 35 letters y M d H m s S z and quoted text) in the device's time
// zone.
class DateFormatter {
 public:
  // The pattern is only looked at and has to outlive the formatter.
  explicit DateFormatter(std::string_view pattern) : pattern_(pattern) {}
  // `seconds` since 1970-01-01 00:00 UTC. An instant beyond what the calendar can tell gives its seconds as text.
  [[nodiscard]] std::string stringFromSeconds(double seconds) const;

 private:
  std::string_view pattern_;
};

}  // namespace vespscope::application
