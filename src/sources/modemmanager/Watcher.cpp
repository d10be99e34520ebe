#include "sources/modemmanager/Watcher.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <string_view>
#include <utility>

#include "platform/log/Log.h"
#include "sources/modemmanager/Names.h"

namespace vespscope::sources::modemmanager {
namespace {

using bus::BusCall;
using bus::BusClient;
using bus::BusError;
using bus::BusSignal;

constexpr std::uint32_t areaAndCell = 1;  // MMModemLocationSource: 3GPP area and cell
constexpr std::int32_t enabledState = 6;  // MMModemState: 6 and above are enabled

// MMModemState from -1, failed.
constexpr std::array<std::string_view, 13> stateWords = {
    "failed",  "in an unknown state", "initializing", "locked",        "disabled",   "disabling", "enabling",
    "enabled", "searching",           "registered",   "disconnecting", "connecting", "connected"};

std::uint64_t numberOf(const std::string& path) {
  std::uint64_t number = UINT64_MAX;
  const std::size_t slash = path.rfind('/');
  if (slash != std::string::npos) std::from_chars(path.data() + slash + 1, path.data() + path.size(), number);
  return number;
}

bool notOffered(const BusError& error) {
  return error.name == "org.freedesktop.ModemManager1.Error.Core.Unsupported" ||
         error.name == "org.freedesktop.DBus.Error.UnknownMethod";
}

const ipc::Dictionary* dictionaryIn(const bus::Contents& contents, std::size_t index) {
  return index < contents.size() ? contents[index].asDictionary() : nullptr;
}

const ipc::Array* arrayIn(const bus::Contents& contents, std::size_t index) {
  return index < contents.size() ? std::get_if<ipc::Array>(&contents[index].data()) : nullptr;
}

const std::string* textIn(const bus::Contents& contents, std::size_t index) {
  return index < contents.size() ? contents[index].asString() : nullptr;
}

}  // namespace

Watcher::Watcher(std::unique_ptr<BusClient> bus, Pace pace) : pace_(pace), bus_(std::move(bus)) {
  bus_->subscribe(service, [this](const BusSignal& signal) { signalled(signal); });
  bus_->watchOwner(service, [this](const std::string& owner) { ownerChanged(owner); });
}

Watcher::~Watcher() {
  if (owner_.empty() || modem_.empty()) return;
  const auto set = [this](const std::string& interface, std::vector<bus::BusArgument> arguments) {
    bus_->call({service, modem_, interface, "Setup", std::move(arguments)}, pace_.timeout, [](const auto&) {});
  };
  if (rateFound_) set(signalInterface, {*rateFound_});
  if (sourcesFound_) set(locationInterface, {*sourcesFound_, signalsLocation()});
}

bool Watcher::work(Clock::time_point now) {
  if (!bus_->process()) return false;
  ask(now);
  return true;
}

bus::Wait Watcher::wait(Clock::time_point now) const {
  bus::Wait wait = bus_->wait();
  const auto until = [&](const Question& question) {
    if (question.pending || question.refused) return;
    const auto rest =
        std::max(std::chrono::ceil<std::chrono::microseconds>(question.due - now), std::chrono::microseconds(0));
    if (wait.timeout.count() < 0 || rest < wait.timeout) wait.timeout = rest;
  };
  if (owner_.empty()) return wait;
  if (!read_) until(objects_);
  if (modem_.empty()) return wait;
  for (const Question* question : {&signal_, &gathering_}) {
    if (question->due > now) until(*question);
  }
  if (enabled()) {
    if (tree_.has(modem_, locationInterface)) until(location_);
    until(cells_);
  }
  for (const auto& [path, question] : details_) {
    if (question.due > now) until(question);
  }
  return wait;
}

void Watcher::ownerChanged(const std::string& owner) {
  ownerKnown_ = true;
  if (owner == owner_) return;
  owner_ = owner;
  read_ = false;
  objects_ = {};
  tree_.clear();
  followModem({});
}

void Watcher::signalled(const BusSignal& signal) {
  if (signal.interface == propertiesInterface && signal.member == "PropertiesChanged") {
    const std::string* interface = textIn(signal.contents, 0);
    const ipc::Dictionary* changed = dictionaryIn(signal.contents, 1);
    const ipc::Array* invalidated = arrayIn(signal.contents, 2);
    if (interface == nullptr || changed == nullptr || invalidated == nullptr) return;
    tree_.change(signal.path, *interface, *changed, *invalidated);
    // A modem that moves gets another location at once.
    if (signal.path == modem_ && *interface == modem3gppInterface) location_.due = {};
  } else if (signal.interface == objectManagerInterface && read_) {
    const std::string* path = textIn(signal.contents, 0);
    if (path == nullptr) return;
    if (signal.member == "InterfacesAdded" && dictionaryIn(signal.contents, 1) != nullptr) {
      tree_.add(*path, *dictionaryIn(signal.contents, 1));
    } else if (signal.member == "InterfacesRemoved" && arrayIn(signal.contents, 1) != nullptr) {
      tree_.remove(*path, *arrayIn(signal.contents, 1));
    }
    chooseModem();
  }
}

void Watcher::chooseModem() {
  if (!modem_.empty() && tree_.has(modem_, modemInterface)) return;
  const std::vector<std::string> modems = tree_.pathsWith(modemInterface);
  const auto first = std::min_element(
      modems.begin(), modems.end(), [](const auto& one, const auto& other) { return numberOf(one) < numberOf(other); });
  followModem(first == modems.end() ? std::string() : *first);
}

void Watcher::followModem(const std::string& path) {
  for (const auto& [detail, question] : details_) tree_.remove(detail);
  details_.clear();
  modem_ = path;
  ++modemCount_;
  lastModemState_.reset();
  rateFound_.reset();
  answers_ = {};
  sourcesFound_.reset();
  signal_ = {};
  gathering_ = {};
  location_ = {};
  cells_ = {};
}

std::optional<std::int32_t> Watcher::modemState() const { return tree_.at(modem_, modemInterface).integer("State"); }

bool Watcher::enabled() const { return modemState().value_or(0) >= enabledState; }

bool Watcher::begin(Question& question, Clock::time_point now, const BusCall& call, BusClient::AnswerHandler done) {
  if (question.pending || question.refused || now < question.due) return false;
  question.pending = bus_->call(call, pace_.timeout, std::move(done));
  if (!question.pending) question.due = now + pace_.retry;
  return question.pending;
}

void Watcher::failed(Question& question, const std::string& what, const BusError& error) {
  question.due = Clock::now() + pace_.retry;
  question.refused = notOffered(error);
  const std::string line = "ModemManager does not report " + what + ": " + error.words + " (" + error.name + ")";
  if (!question.refused && logged_.insert(what + error.name).second) log::system(line);
}

void Watcher::readObjects() {
  const BusCall call{service, rootPath, objectManagerInterface, "GetManagedObjects", {}};
  begin(objects_, Clock::now(), call, [this, owner = owner_](const BusClient::Answer& answer) {
    if (owner != owner_) return;
    objects_.pending = false;
    const ipc::Dictionary* objects = answer ? dictionaryIn(*answer, 0) : nullptr;
    if (objects == nullptr) {
      failed(objects_, "its modems", answer ? BusError{"", "an answer of an unexpected form"} : answer.reason());
      objects_.refused = false;
      return;
    }
    tree_.replace(*objects);
    read_ = true;
    chooseModem();
  });
}

void Watcher::ask(Clock::time_point now) {
  if (owner_.empty()) return;
  if (!read_) return readObjects();
  if (modem_.empty()) return;
  if (const auto state = modemState(); state != lastModemState_) {
    // A request that was denied in one state may be accepted in another.
    lastModemState_ = state;
    for (Question* question : {&signal_, &gathering_, &location_, &cells_}) question->due = {};
  }
  if (!enabled()) {
    answers_ = {};
  } else {
    askGathering(now);
    askLocation(now);
    askCells(now);
  }
  askSignal(now);
  std::vector<std::string> wanted = bearersOf(tree_, modem_);
  for (const std::string& path : wanted) askObject(path, bearerInterface, now);
  if (const auto sim = simOf(tree_, modem_)) {
    askObject(*sim, simInterface, now);
    wanted.push_back(*sim);
  }
  std::erase_if(details_, [&](const auto& detail) {
    if (std::find(wanted.begin(), wanted.end(), detail.first) != wanted.end()) return false;
    tree_.remove(detail.first);
    return true;
  });
}

// ModemManager measures only at a requested rate; a client that requested a lower rate is served as well.
void Watcher::askSignal(Clock::time_point now) {
  if (!tree_.has(modem_, signalInterface)) return;
  const auto rate = tree_.at(modem_, signalInterface).number("Rate");
  if (rate == pace_.signalSeconds) return;
  const BusCall call{service, modem_, signalInterface, "Setup", {pace_.signalSeconds}};
  const bool asked = begin(signal_, now, call, [this, count = modemCount_](const BusClient::Answer& answer) {
    if (count != modemCount_) return;
    signal_.pending = false;
    signal_.due = Clock::now() + pace_.retry;
    if (!answer) failed(signal_, "its signal measurements", answer.reason());
  });
  if (asked && !rateFound_) rateFound_ = rate.value_or(0);
}

bool Watcher::signalsLocation() const {
  return tree_.at(modem_, locationInterface).flag("SignalsLocation").value_or(false);
}

// ModemManager gathers the area and the cell of a modem that it has enabled, unless a client has turned that off.
// Watcher requests them; signalling them would send them to everyone on the bus.
void Watcher::askGathering(Clock::time_point now) {
  const Told location = tree_.at(modem_, locationInterface);
  const auto sources = location.number("Enabled");
  const std::uint32_t offered = location.number("Capabilities").value_or(0);
  if (!sources || (*sources & areaAndCell) != 0 || (offered & areaAndCell) == 0) return;
  const BusCall call{service, modem_, locationInterface, "Setup", {*sources | areaAndCell, signalsLocation()}};
  const bool asked = begin(gathering_, now, call, [this, count = modemCount_](const BusClient::Answer& answer) {
    if (count != modemCount_) return;
    gathering_.pending = false;
    gathering_.due = Clock::now() + pace_.retry;
    if (!answer) failed(gathering_, "the modem's location", answer.reason());
  });
  if (asked && !sourcesFound_) sourcesFound_ = sources;
}

void Watcher::askLocation(Clock::time_point now) {
  if (!tree_.has(modem_, locationInterface)) return;
  const BusCall call{service, modem_, locationInterface, "GetLocation", {}};
  begin(location_, now, call, [this, count = modemCount_](const BusClient::Answer& answer) {
    if (count != modemCount_) return;
    location_.pending = false;
    location_.due = Clock::now() + pace_.location;
    const std::optional<std::string> before = std::exchange(answers_.location, std::nullopt);
    if (!answer) return failed(location_, "the modem's location", answer.reason());
    answers_.location = Told(dictionaryIn(*answer, 0)).text(std::to_string(areaAndCell));
    if (answers_.location != before) cells_.due = {};
  });
}

void Watcher::askCells(Clock::time_point now) {
  const BusCall call{service, modem_, modemInterface, "GetCellInfo", {}};
  begin(cells_, now, call, [this, count = modemCount_](const BusClient::Answer& answer) {
    if (count != modemCount_) return;
    cells_.pending = false;
    cells_.due = Clock::now() + pace_.cells;
    answers_.cells.clear();
    if (!answer) return failed(cells_, "the modem's cells", answer.reason());
    if (const ipc::Array* cells = arrayIn(*answer, 0)) answers_.cells = *cells;
  });
}

void Watcher::askObject(const std::string& path, const std::string& interface, Clock::time_point now) {
  Question& question = details_[path];
  if (tree_.has(path, interface)) return;
  const BusCall call{service, path, propertiesInterface, "GetAll", {interface}};
  begin(question, now, call, [this, count = modemCount_, path, interface](const BusClient::Answer& answer) {
    const auto found = details_.find(path);
    if (count != modemCount_ || found == details_.end()) return;
    found->second.pending = false;
    found->second.due = Clock::now() + pace_.retry;
    if (!answer) return failed(found->second, path, answer.reason());
    if (const ipc::Dictionary* properties = dictionaryIn(*answer, 0)) tree_.set(path, interface, *properties);
  });
}

ModemState Watcher::state() const { return modem_.empty() ? ModemState() : readModem(tree_, modem_, answers_); }

std::string Watcher::situation() const {
  if (!ownerKnown_) return "asking for ModemManager";
  if (owner_.empty()) return "no ModemManager, waiting for it";
  if (!read_) return "asking ModemManager for its modems";
  if (modem_.empty()) return "no modem, waiting for one";
  const Told modem = tree_.at(modem_, modemInterface);
  std::string words = modem.text("Manufacturer").value_or("");
  if (const auto model = modem.text("Model")) words += (words.empty() ? "" : " ") + *model;
  if (words.empty()) words = "a modem";
  const std::int32_t state = modemState().value_or(0);
  const bool known = state >= -1 && state + 1 < static_cast<std::int32_t>(stateWords.size());
  words += std::string(", ") + std::string(stateWords[known ? static_cast<std::size_t>(state + 1) : 1]);
  const std::size_t count = tree_.pathsWith(modemInterface).size();
  if (count > 1) words += ", one of " + std::to_string(count) + " modems";
  return words;
}

}  // namespace vespscope::sources::modemmanager
