// What a modem's port does: which programs hold it, and whether it is a log port that answers.
#pragma once

#include <optional>
#include <string>

#include "platform/files/FileHolders.h"
#include "sources/diag/PortProbe.h"
#include "sources/modemmanager/Probe.h"
#include "values/Result.h"

namespace vespscope::tools {

struct PortDiagnosis {
  std::string name;
  files::Holders holders;
  std::optional<files::Holder> lock;  // that a lock file names
  sources::modemmanager::ModemManagerPort modemManager;
  std::optional<std::string> group;  // whose members may open the port; set where this user may not
  // Empty when the port was not opened: a program holds it, or this user may not.
  std::optional<sources::diag::PortAnswer> answer;

  // Whether the viewer can use the port now.
  [[nodiscard]] bool usable() const;
};

// Whether the words name a port: "/dev/ttyUSB0", "tcp:127.0.0.1:5000", or either behind "diag:".
[[nodiscard]] bool isPort(const std::string& words);

// Fails when there is no such port. A port that another program holds is not opened: two readers of a log take each
// other's bytes.
[[nodiscard]] Result<PortDiagnosis> diagnosePort(const std::string& words);

// As textOf() and jsonOf() of a recording.
[[nodiscard]] std::string textOf(const PortDiagnosis& diagnosis);
[[nodiscard]] std::string jsonOf(const PortDiagnosis& diagnosis);

}  // namespace vespscope::tools
