#include "platform/console/Console.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Diagnosis.h"
#include "tools/vespctl/Output.h"
#include "tools/vespctl/PortDiagnosis.h"

namespace vespscope::tools {
namespace {

template <class Found>
Problem print(const Found& found, bool json) {
  if (json) return writeLine(jsonOf(found));
  console::outputText(textOf(found));
  return std::nullopt;
}

}  // namespace

Result<bool> doctor(const Examination& examination) {
  if (isPort(examination.subject)) {
    const Result<PortDiagnosis> port = diagnosePort(examination.subject);
    if (!port) return Failure{port.reason()};
    if (Problem unwritten = print(*port, examination.json)) return Failure{*unwritten};
    return port->usable();
  }
  const Result<Diagnosis> recording = diagnose(examination.subject);
  if (!recording) return Failure{recording.reason()};
  if (Problem unwritten = print(*recording, examination.json)) return Failure{*unwritten};
  return recording->filled() != 0;
}

}  // namespace vespscope::tools
