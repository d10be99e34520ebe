#include "tools/vespctl/Input.h"

#include <utility>

#include "platform/console/Console.h"
#include "sources/RecogniseFile.h"

namespace vespscope::tools {

Result<Input> Input::open(const std::string& file) {
  auto reader = capture::CaptureReader::open(file);
  if (reader) return Input(file, std::move(*reader));
  if (sources::isModemLog(file)) {
    return Failure{file + ": is a modem log, not a capture; convert it first: vespctl convert " +
                   sources::sourceWords(sources::FileKind::modemLog, file) + " OUT.pcap"};
  }
  return Failure{reader.reason()};
}

std::optional<MetricEvent> Input::next() {
  while (true) {
    auto event = reader_.next();
    if (event) {
      if (!*event) return std::nullopt;
      const std::int32_t sim = (*event)->profileID;
      if (sim != 0) sims_.insert(sim);
      if (!sim_ || sim == 0 || sim == *sim_) return std::move(*event);
      continue;
    }
    if (problem_) console::error("vespctl: " + *problem_);
    problem_ = event.reason();
  }
}

Problem Input::problem() const {
  if (problem_ || !sim_ || sims_.empty() || sims_.contains(*sim_)) return problem_;
  std::string others;
  for (const std::int32_t sim : sims_) others += (others.empty() ? "" : ", ") + std::to_string(sim);
  return file_ + ": has no event of SIM " + std::to_string(*sim_) + ", only of SIM " + others;
}

}  // namespace vespscope::tools
