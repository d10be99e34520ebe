// The reader of RRC messages: no value is outside the bytes or its declared range, values nest, bytes after a message
// change nothing in it, and a rejected message leaves nothing.
#include <array>
#include <vector>

#include "Fuzz.h"
#include "rrc/Message.h"
#include "rrc/lte/CellInformation.h"
#include "rrc/lte/Connection.h"
#include "rrc/lte/MeasurementReport.h"
#include "rrc/lte/Reconfiguration.h"
#include "rrc/lte/Release.h"
#include "rrc/lte/Reselection.h"
#include "rrc/nr/MasterInformation.h"
#include "rrc/nr/MeasurementReport.h"
#include "rrc/nr/Reconfiguration.h"

using namespace vespscope::rrc;
using vespscope::fuzz::require;

namespace {

using Bytes = std::span<const std::uint8_t>;

// The first byte of an input chooses; add new ones at the end.
constexpr std::array pdus = {
    Pdu::lteBcchBch,
    Pdu::lteBcchDlSch,
    Pdu::lteMcch,
    Pdu::ltePcch,
    Pdu::lteDlCcch,
    Pdu::lteDlDcch,
    Pdu::lteUlCcch,
    Pdu::lteUlDcch,
    Pdu::nbBcchBch,
    Pdu::nbBcchDlSch,
    Pdu::nbPcch,
    Pdu::nbDlCcch,
    Pdu::nbDlDcch,
    Pdu::nbUlCcch,
    Pdu::nbUlDcch,
    Pdu::nrBcchBch,
    Pdu::nrBcchDlSch,
    Pdu::nrPcch,
    Pdu::nrDlCcch,
    Pdu::nrDlDcch,
    Pdu::nrUlCcch,
    Pdu::nrUlCcch1,
    Pdu::nrUlDcch,
    Pdu::nrReconfiguration,
    Pdu::nrMib,
    Pdu::nrRadioBearerConfig,
    Pdu::nrReconfigurationComplete,
    Pdu::lteCapability,
    Pdu::nrCapability,
    Pdu::nrDualCapability,
};

bool isWithin(const Type& type, std::int64_t value) {
  const Range& range = grammar::ranges[type.range];
  return type.extensible != 0 || (value >= range.lower && value <= range.upper);
}

void checkValue(const Node& node, std::size_t bits) {
  const Type& type = grammar::types[node.type];
  require(std::size_t{node.bit} + node.bits <= bits, "a value outside the bytes");
  switch (type.kind()) {
    case Kind::boolean:
      require(node.value == 0 || node.value == 1, "a boolean of another value");
      break;
    case Kind::integer:
    case Kind::list:
      require(isWithin(type, node.value), "a number or a list outside its range");
      break;
    case Kind::bitString:
      require(isWithin(type, node.bits), "a string of bits outside its sizes");
      break;
    case Kind::octetString:
      require(isWithin(type, node.bits / 8), "a string of bytes outside its sizes");
      break;
    case Kind::enumerated:
    case Kind::choice:
      require(node.value >= 0 && (type.extensible != 0 || node.value < type.count), "an index outside its values");
      break;
    case Kind::unknown:
    case Kind::null:
    case Kind::sequence:
      break;
  }
}

// Calls every accessor of a value and its parts; returns the number of values.
std::size_t checkView(const View& view, std::size_t level) {
  require(level <= 128, "values nested without end");
  require(static_cast<bool>(view), "an absent value among others");
  require(view.bytes().size() == (view.bits() + 7) / 8, "a string of another length");
  require(view.item().size() < 100 && view.name().size() < 100, "a name without end");
  (void)view.itemNumber();
  (void)view.number();
  (void)view.chosen();
  std::size_t count = 1;
  for (const View child : view) count += checkView(child, level + 1);
  return count;
}

void checkStructs(const Message& message) {
  (void)lte::masterInformationOf(message);
  (void)lte::cellInformationOf(message);
  (void)lte::systemInformationOf(message);
  (void)lte::connectionSetupOf(message);
  (void)lte::reestablishmentOf(message);
  (void)lte::measurementReportOf(message);
  (void)lte::releaseOf(message);
  (void)lte::connectionRequestOf(message);
  (void)lte::connectionRejectOf(message);
  (void)lte::connectionSetupCompleteOf(message);
  (void)lte::reestablishmentRequestOf(message);
  (void)lte::securityModeOf(message);
  (void)lte::mobilityFromLteOf(message);
  (void)lte::pagingOf(message);
  (void)lte::transferredNasOf(message);
  (void)nr::masterInformationOf(message);
  (void)nr::measurementReportOf(message);
  (void)nr::reconfigurationOf(message);
  if (const auto reconfiguration = lte::reconfigurationOf(message)) {
    (void)nr::reconfigurationOf(reconfiguration->nrConfiguration);
  }
}

void checkMessage(const Message& message, std::size_t size) {
  const std::span<const Node> nodes = message.nodes();
  require(!nodes.empty() && nodes[0].end == nodes.size(), "a message that does not hold its values");
  std::vector<std::uint32_t> ends;
  for (std::uint32_t index = 0; index < nodes.size(); ++index) {
    while (!ends.empty() && ends.back() == index) ends.pop_back();
    require(nodes[index].end > index && (ends.empty() || nodes[index].end <= ends.back()), "values that do not nest");
    ends.push_back(nodes[index].end);
    checkValue(nodes[index], 8 * size);
  }
  require(checkView(message.root(), 0) == nodes.size(), "another number of values on the way through the message");
  checkStructs(message);
}

bool isSame(const Node& one, const Node& other) {
  return one.type == other.type && one.name == other.name && one.unreadable == other.unreadable &&
         one.end == other.end && one.bit == other.bit && one.bits == other.bits && one.value == other.value;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  const Pdu pdu = pdus[data[0] % pdus.size()];
  // A separate allocation, so that a read past the end is detected.
  const std::vector<std::uint8_t> bytes(data + 1, data + size);
  static Message message;
  if (const auto fault = message.read(pdu, bytes)) {
    require(fault->bit <= 8 * bytes.size(), "a fault outside the bytes");
    require(!textOf(fault->kind).empty(), "a fault without a text");
    require(message.nodes().empty() && !message.root(), "a refused message that leaves values");
    checkStructs(message);
    return 0;
  }
  checkMessage(message, bytes.size());
  const std::size_t used = (message.root().bits() + 7) / 8;
  const std::vector<std::uint8_t> needed(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(used));
  Message again;
  require(!again.read(pdu, needed), "a message without its padding is refused");
  require(
      std::equal(message.nodes().begin(), message.nodes().end(), again.nodes().begin(), again.nodes().end(), isSame),
      "what follows a message changes it");
  return 0;
}
