#include "sources/modemmanager/ReadModem.h"

#include <arpa/inet.h>

#include <algorithm>
#include <array>

#include "radio/AreaCode.h"
#include "radio/CellIdentity.h"
#include "sources/modemmanager/Names.h"

namespace vespscope::sources::modemmanager {
namespace {

// ModemManager's MMModemAccessTechnology.
constexpr std::uint32_t gsmTechnologies = 1U << 1U | 1U << 2U | 1U << 3U | 1U << 4U;
constexpr std::uint32_t umts = 1U << 5U;
constexpr std::uint32_t hsdpa = 1U << 6U;
constexpr std::uint32_t hsupa = 1U << 7U;
constexpr std::uint32_t hspa = 1U << 8U | 1U << 9U;  // both directions, including HSPA+
constexpr std::uint32_t lteTechnologies = 1U << 14U | 1U << 16U | 1U << 17U;

// MMModemCapability.
constexpr std::uint32_t gsmUmtsCapability = 1U << 2U;
constexpr std::uint32_t lteCapability = 1U << 3U;

constexpr std::uint32_t anyNumber = 0xFFFFFFFF;

bool onlyDigits(std::string_view text) {
  return std::all_of(text.begin(), text.end(), [](char each) { return each >= '0' && each <= '9'; });
}

std::optional<std::string> digits(const std::optional<std::string>& text, std::size_t least, std::size_t most) {
  if (!text || text->size() < least || text->size() > most || !onlyDigits(*text)) return std::nullopt;
  return text;
}

std::optional<std::uint32_t> areaCode(std::optional<std::uint32_t> number) {
  const auto area = radio::AreaCode::fromNumber(number.value_or(0));
  if (!area) return std::nullopt;
  return area->number();
}

// ModemManager reports an unknown cell as zero. The identity has 28 bits in both UTRAN and E-UTRAN.
std::optional<std::uint32_t> cellIdentity(std::optional<std::uint32_t> number) {
  const auto cell = radio::EutraCellIdentity::fromNumber(number.value_or(0));
  if (!cell || cell->number() == 0) return std::nullopt;
  return cell->number();
}

void readTechnology(Told modem, ModemState& state) {
  const std::uint32_t bits = modem.number("AccessTechnologies").value_or(0);
  const std::uint32_t umtsTechnologies = umts | hsdpa | hsupa | hspa;
  if ((bits & lteTechnologies) != 0) {
    state.technology = Technology::lte;
  } else if ((bits & umtsTechnologies) != 0) {
    state.technology = Technology::umts;
  } else if ((bits & gsmTechnologies) != 0) {
    state.technology = Technology::gsm;
  }
  state.hsdpa = (bits & (hsdpa | hspa)) != 0;
  state.hsupa = (bits & (hsupa | hspa)) != 0;
  const std::uint32_t capabilities = modem.number("CurrentCapabilities").value_or(0);
  state.mayUseGsmOrUmts = (capabilities & gsmUmtsCapability) != 0;
  state.mayUseLte = (capabilities & lteCapability) != 0;
}

void readRegistration(Told modem3gpp, ModemState& state) {
  const auto registration = modem3gpp.number("RegistrationState");
  if (registration && *registration <= static_cast<std::uint32_t>(Registration::attachedRlos) &&
      *registration != static_cast<std::uint32_t>(Registration::unknown)) {
    state.registration = static_cast<Registration>(*registration);
  }
  const auto packet = modem3gpp.number("PacketServiceState");  // 0 unknown, 1 detached, 2 attached
  if (packet == 1U || packet == 2U) state.packetAttached = packet == 2U;
  const auto mode = modem3gpp.number("EpsUeModeOperation");
  if (mode && *mode >= 1 && *mode <= 4) state.epsMode = mode;
  if (const auto code = modem3gpp.text("OperatorCode")) state.network = networkOf(*code);
}

void readLocation(const std::optional<std::string>& location, ModemState& state) {
  if (!location) return;
  std::array<std::string_view, 5> fields;
  std::string_view rest = *location;
  for (std::size_t index = 0; index < fields.size(); ++index) {
    const std::size_t comma = rest.find(',');
    if ((comma == std::string_view::npos) != (index + 1 == fields.size())) return;  // an unknown form
    fields[index] = rest.substr(0, comma);
    rest = comma == std::string_view::npos ? std::string_view() : rest.substr(comma + 1);
  }
  if (!state.network) state.network = networkOf(std::string(fields[0]) + std::string(fields[1]));
  state.lac = areaCode(parseHexadecimal(fields[2], 0xFFFF));
  state.cellId = cellIdentity(parseHexadecimal(fields[3], anyNumber));
  state.tac = areaCode(parseHexadecimal(fields[4], 0xFFFF));
}

void readSignal(Told signal, ModemState& state) {
  const Told lte = signal.within("Lte");
  state.lte = {lte.quantity("rsrp"), lte.quantity("rsrq"), lte.quantity("snr")};
  const Told wcdma = signal.within("Umts");
  state.umts = {wcdma.quantity("rssi"), wcdma.quantity("rscp"), wcdma.quantity("ecio")};
  state.gsmRssi = signal.within("Gsm").quantity("rssi");
}

Cell gsmCell(Told told) {
  Cell cell;
  cell.technology = Technology::gsm;
  cell.area = areaCode(told.hexadecimal("lac", 0xFFFF));
  cell.cellId = cellIdentity(told.hexadecimal("ci", 0xFFFF));
  cell.channel = told.number("arfcn");
  cell.code = told.hexadecimal("base-station-id", 0x3F);
  if (const auto level = told.number("rx-level"); level && *level <= 63) cell.levelCode = level;
  return cell;
}

Cell umtsCell(Told told) {
  Cell cell;
  cell.technology = Technology::umts;
  cell.area = areaCode(told.hexadecimal("lac", 0xFFFF));
  cell.cellId = cellIdentity(told.hexadecimal("ci", anyNumber));
  cell.channel = told.number("uarfcn");
  if (const auto code = told.number("psc"); code && *code <= 511) cell.code = code;
  cell.power = told.quantity("rscp");
  cell.quality = told.quantity("ecio");
  return cell;
}

Cell lteCell(Told told) {
  Cell cell;
  cell.technology = Technology::lte;
  cell.area = areaCode(told.hexadecimal("tac", 0xFFFF));
  cell.cellId = cellIdentity(told.hexadecimal("ci", anyNumber));
  cell.channel = told.number("earfcn");
  cell.code = told.hexadecimal("physical-ci", 503);
  cell.power = told.quantity("rsrp");
  cell.quality = told.quantity("rsrq");
  return cell;
}

// Reads the answer to GetCellInfo; cells of other technologies are ignored.
void readCells(const ipc::Array& cells, ModemState& state) {
  for (const ipc::Object& each : cells) {
    const Told told(each.asDictionary());
    Cell cell;
    switch (told.number("cell-type").value_or(0)) {  // MMCellType
      case 2:
        cell = gsmCell(told);
        break;
      case 3:
        cell = umtsCell(told);
        break;
      case 5:
        cell = lteCell(told);
        break;
      default:
        continue;
    }
    cell.serving = told.flag("serving").value_or(false);
    if (const auto code = told.text("operator-id")) cell.network = networkOf(*code);
    state.cells.push_back(cell);
  }
}

Bytes addressOf(const std::optional<std::string>& text, int family) {
  Bytes address(family == AF_INET ? 4 : 16);
  if (!text || ::inet_pton(family, text->c_str(), address.data()) != 1) return {};
  return address;
}

Bearer readBearer(Told told) {
  Bearer bearer;
  if (const auto context = told.integer("ProfileId"); context && *context > 0) {
    bearer.contextId = static_cast<std::uint32_t>(*context);
  }
  const Told properties = told.within("Properties");
  bearer.accessPoint = properties.text("apn");
  bearer.families = properties.number("ip-type");
  const Told ipv4 = told.within("Ip4Config");
  const Told ipv6 = told.within("Ip6Config");
  bearer.ipv4 = addressOf(ipv4.text("address"), AF_INET);
  bearer.ipv6 = addressOf(ipv6.text("address"), AF_INET6);
  for (const char* name : {"dns1", "dns2", "dns3"}) {
    if (Bytes server = addressOf(ipv4.text(name), AF_INET); !server.empty()) bearer.dns.push_back(std::move(server));
  }
  for (const char* name : {"dns1", "dns2", "dns3"}) {
    if (Bytes server = addressOf(ipv6.text(name), AF_INET6); !server.empty()) bearer.dns.push_back(std::move(server));
  }
  return bearer;
}

SimCard readSim(Told told) {
  SimCard card;
  card.iccid = digits(told.text("SimIdentifier"), 18, 20);
  card.imsi = digits(told.text("Imsi"), 6, 15);
  card.operatorCode = digits(told.text("OperatorIdentifier"), 5, 6);
  card.operatorName = told.text("OperatorName");
  card.gid1 = told.bytes("Gid1");
  card.gid2 = told.bytes("Gid2");
  return card;
}

}  // namespace

std::optional<radio::Plmn> networkOf(std::string_view operatorCode) {
  if (operatorCode.starts_with("000")) return std::nullopt;  // ModemManager does not know the network
  return radio::Plmn::fromText(operatorCode);
}

std::vector<std::string> bearersOf(const ObjectTree& tree, const std::string& modem) {
  std::vector<std::string> paths = tree.at(modem, modemInterface).paths("Bearers");
  const auto initial = tree.at(modem, modem3gppInterface).path("InitialEpsBearer");
  if (initial && std::find(paths.begin(), paths.end(), *initial) == paths.end()) paths.insert(paths.begin(), *initial);
  return paths;
}

std::optional<std::string> simOf(const ObjectTree& tree, const std::string& modem) {
  return tree.at(modem, modemInterface).path("Sim");
}

ModemState readModem(const ObjectTree& tree, const std::string& modem, const Answers& answers) {
  ModemState state;
  readTechnology(tree.at(modem, modemInterface), state);
  readRegistration(tree.at(modem, modem3gppInterface), state);
  readLocation(answers.location, state);
  readSignal(tree.at(modem, signalInterface), state);
  readCells(answers.cells, state);
  const std::vector<std::string> bearers = bearersOf(tree, modem);
  state.bearersKnown = std::all_of(bearers.begin(), bearers.end(),
                                   [&tree](const std::string& path) { return tree.has(path, bearerInterface); });
  for (const std::string& path : bearers) {
    const Told bearer = tree.at(path, bearerInterface);
    if (bearer.flag("Connected") == true) state.bearers.push_back(readBearer(bearer));
  }
  if (const auto sim = simOf(tree, modem)) state.sim = readSim(tree.at(*sim, simInterface));
  return state;
}

}  // namespace vespscope::sources::modemmanager
