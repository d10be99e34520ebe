#include "tools/vespctl/Input.h"

#include <utility>

#include "platform/console/Console.h"
#include "sources/RecogniseFile.h"

namespace vespscope::tools {

Result<Input> Input::open(const std::string& file) {
  auto reader = capture::CaptureReader::open(file);
  if (reader) return Input(std::move(*reader));
  if (sources::isModemLog(file)) {
    return Failure{file + ": is a modem log, not a capture; convert it first: vespctl convert " +
                   sources::sourceWords(sources::FileKind::modemLog, file) + " OUT.pcap"};
  }
  return Failure{reader.reason()};
}

std::optional<MetricEvent> Input::next() {
  while (true) {
    auto event = reader_.next();
    if (event) return std::move(*event);
    if (problem_) console::error("vespctl: " + *problem_);
    problem_ = event.reason();
  }
}

}  // namespace vespscope::tools
