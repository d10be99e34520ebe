#include <nlohmann/json.hpp>

#include "capture/CaptureReader.h"
#include "metrics/MetricValidator.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Output.h"
#include "tools/vespctl/Playback.h"
#include "tools/vespctl/State.h"

namespace vespscope::tools {

Problem state(const std::string& file) {
  Result<capture::CaptureReader> reader = capture::CaptureReader::open(file);
  if (!reader) return reader.reason();
  MetricValidator validator;
  Problem problem = playInto(validator, *reader);
  if (Problem unwritten = writeLine(write(stateOf(validator)))) return unwritten;
  return problem;
}

}  // namespace vespscope::tools
