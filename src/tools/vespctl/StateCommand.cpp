#include <nlohmann/json.hpp>

#include "metrics/MetricValidator.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Input.h"
#include "tools/vespctl/Output.h"
#include "tools/vespctl/Playback.h"
#include "tools/vespctl/State.h"

namespace vespscope::tools {

Problem state(const std::string& file, Sim sim) {
  Result<Input> input = Input::open(file);
  if (!input) return input.reason();
  input->choose(sim);
  MetricValidator validator;
  Problem problem = playInto(validator, *input);
  if (Problem unwritten = writeLine(write(stateOf(validator)))) return unwritten;
  return problem;
}

}  // namespace vespscope::tools
