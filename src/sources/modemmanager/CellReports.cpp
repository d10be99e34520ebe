// Reports a modem's serving and neighbour cells as metric messages with the raw codes of measurement reports.
#include <algorithm>
#include <cmath>
#include <memory>

#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "radio/Channel.h"
#include "radio/Levels.h"
#include "registry/MetricRows.h"
#include "sources/modemmanager/Reports.h"

namespace vespscope::sources::modemmanager {
namespace {

using radio::Direction;
using radio::Earfcn;
using radio::Ecno;
using radio::rounded;
using radio::Rscp;
using radio::Rsrp;
using radio::Rsrq;
using radio::sinrSteps;

// Returns the code of a level if a receiver can have measured it.
template <class Level>
std::optional<std::int32_t> codeOf(const std::optional<double>& measured) {
  const auto level = measured ? Level::fromLevel(*measured) : std::nullopt;
  if (!level) return std::nullopt;
  return level->code();
}

// The same for an unsigned field.
template <class Level>
std::optional<std::uint32_t> unsignedCodeOf(const std::optional<double>& measured) {
  const auto code = codeOf<Level>(measured);
  if (!code) return std::nullopt;
  return static_cast<std::uint32_t>(std::max(*code, 0));
}

std::optional<std::uint32_t> bandOf(std::uint32_t earfcn) {
  const auto channel = Earfcn::fromNumber(earfcn, Direction::downlink);
  if (!channel) return std::nullopt;
  return channel->band();
}

// Whether a receiver can report this RSSI.
bool isRssi(const std::optional<double>& dBm) { return dBm && *dBm >= -150 && *dBm <= 0; }

const Cell* servingCell(const ModemState& state) {
  if (state.technology == Technology::none) return nullptr;
  const auto found = std::find_if(state.cells.begin(), state.cells.end(), [&state](const Cell& cell) {
    return cell.serving && cell.technology == state.technology;
  });
  return found == state.cells.end() ? nullptr : &*found;
}

// The serving cell according to two answers, the modem's location and its cells. They are given at different moments:
// if they name different cells, values that only the second answer has are omitted.
struct Serving {
  explicit Serving(const ModemState& state) : network(state.network), cellId(state.cellId) {
    area = state.technology == Technology::lte ? state.tac : state.lac;
    const Cell* cell = servingCell(state);
    if (cell == nullptr || (cellId && cell->cellId && cellId != cell->cellId)) return;
    channel = cell->channel;
    code = cell->code;
    power = cell->power;
    quality = cell->quality;
    levelCode = cell->levelCode;
    if (!cellId) cellId = cell->cellId;
    if (!area) area = cell->area;
    if (!network) network = cell->network;
  }

  std::optional<radio::Plmn> network;
  std::optional<std::uint32_t> area;
  std::optional<std::uint32_t> cellId;
  std::optional<std::uint32_t> channel;
  std::optional<std::uint32_t> code;
  std::optional<double> power;
  std::optional<double> quality;
  std::optional<std::uint32_t> levelCode;
};

template <class Message>
void setNetwork(Message& message, const std::optional<radio::Plmn>& network) {
  if (!network) return;
  message.setMcc(network->mcc());
  message.setMnc(network->mnc());
  message.setNumMncDigits(network->mncDigits());
}

KCellularLteScellInfo lteServing(const Serving& serving) {
  KCellularLteScellInfo message;
  if (serving.code) message.setPhyCellId(*serving.code);
  if (serving.channel) {
    message.setDlFreq(*serving.channel);
    if (const auto band = bandOf(*serving.channel)) message.setFreqBandInd(*band);
  }
  if (serving.cellId) message.setCellId(*serving.cellId);
  if (serving.area) message.setTrackingAreaCode(*serving.area);
  if (serving.network) {
    message.setNumMncDigits(serving.network->mncDigits());
    message.setSelPlmnMcc(serving.network->mcc());
    message.setSelPlmnMnc(serving.network->mnc());
  }
  return message;
}

KCellularWcdmaCellInfo umtsServing(const Serving& serving, bool hsdpa, bool hsupa) {
  using Hspa = KCellularWcdmaCellInfo::Hspa;
  KCellularWcdmaCellInfo message;
  setNetwork(message, serving.network);
  if (serving.area) message.setLac(*serving.area);
  if (serving.cellId) message.setCellId(*serving.cellId);
  if (serving.channel) message.setDlUarfcn(*serving.channel);
  if (serving.code) message.setPsc(*serving.code);
  if (hsdpa && hsupa) {
    message.setHspa(Hspa::SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL);
  } else if (hsdpa || hsupa) {
    message.setHspa(hsdpa ? Hspa::SYS_HS_IND_HSDPA_SUPP_CELL : Hspa::SYS_HS_IND_HSUPA_SUPP_CELL);
  }
  return message;
}

KCellularGsmScellInfo gsmServing(const Serving& serving) {
  KCellularGsmScellInfo message;
  setNetwork(message, serving.network);
  if (serving.area) message.setLac(*serving.area);
  if (serving.cellId && *serving.cellId <= 0xFFFF) message.setCellId(*serving.cellId);
  if (serving.channel) message.setArfcn(*serving.channel);
  if (serving.code) message.setBsic(*serving.code);
  return message;
}

// A neighbour of each technology with the field names of the serving cell.

std::shared_ptr<EgwErrcNbrEutraMeas> lteFromLte(const Cell& cell) {
  auto element = std::make_shared<EgwErrcNbrEutraMeas>();
  if (cell.channel) {
    element->setNbrEarfcn(*cell.channel);
    if (const auto band = bandOf(*cell.channel)) element->setFreqBandInd(*band);
  }
  if (cell.code) element->setNbrPhysCellId(*cell.code);
  if (const auto code = codeOf<Rsrp>(cell.power)) element->setNbrRsrp(*code);
  if (const auto code = codeOf<Rsrq>(cell.quality)) element->setNbrRsrq(*code);
  return element;
}

std::shared_ptr<EgwErrcNbrUtraMeas> umtsFromLte(const Cell& cell) {
  auto element = std::make_shared<EgwErrcNbrUtraMeas>();
  if (cell.channel) element->setUarfcn(*cell.channel);
  if (cell.code) element->setPsc(*cell.code);
  if (const auto code = codeOf<Rscp>(cell.power)) element->setRscp(*code);
  if (const auto code = unsignedCodeOf<Ecno>(cell.quality)) element->setEcno(*code);
  return element;
}

std::shared_ptr<UtraCellMeasResult> umtsFromUmts(const Cell& cell) {
  auto element = std::make_shared<UtraCellMeasResult>();
  if (cell.channel) element->setUarfcn(*cell.channel);
  if (cell.code) element->setPsc(*cell.code);
  if (const auto code = unsignedCodeOf<Ecno>(cell.quality)) element->setEcno(*code);
  if (const auto code = codeOf<Rscp>(cell.power)) element->setRscp(*code);
  return element;
}

std::shared_ptr<LteCellMeasResult> lteFromUmts(const Cell& cell) {
  auto element = std::make_shared<LteCellMeasResult>();
  if (cell.channel) {
    element->setEarfcn(*cell.channel);
    if (const auto band = bandOf(*cell.channel)) element->setEutraBand(*band);
  }
  if (cell.code) element->setPhyCellId(*cell.code);
  if (const auto code = codeOf<Rsrp>(cell.power)) element->setRsrp(*code);
  if (const auto code = codeOf<Rsrq>(cell.quality)) element->setRsrq(*code);
  return element;
}

// Sets the same fields in two messages.
template <class Element>
std::shared_ptr<Element> gsmNeighbour(const Cell& cell) {
  auto element = std::make_shared<Element>();
  if (cell.channel) element->setArfcn(*cell.channel);
  if (cell.code) element->setBsic(*cell.code);
  if (cell.levelCode) element->setRxlev(*cell.levelCode);
  return element;
}

std::shared_ptr<GsmNcellMeas> gsmFromGsm(const Cell& cell) {
  auto element = gsmNeighbour<GsmNcellMeas>(cell);
  if (cell.network) {
    element->setMcc(cell.network->mcc());
    element->setMnc(cell.network->mnc());
  }
  if (cell.area) element->setLac(*cell.area);
  if (cell.cellId) element->setCi(*cell.cellId);
  return element;
}

std::shared_ptr<UmtsNcellMeas> umtsFromGsm(const Cell& cell) {
  auto element = std::make_shared<UmtsNcellMeas>();
  if (cell.code) element->setCpichSc(*cell.code);
  if (cell.channel) element->setDlUarfcn(*cell.channel);
  if (const auto code = unsignedCodeOf<Rscp>(cell.power)) element->setCpichRscp(*code);
  if (const auto code = unsignedCodeOf<Ecno>(cell.quality)) element->setCpichEcn0(*code);
  return element;
}

std::shared_ptr<LteNcellMeas> lteFromGsm(const Cell& cell) {
  auto element = std::make_shared<LteNcellMeas>();
  if (cell.code) element->setPhysicalCellId(*cell.code);
  if (const auto code = unsignedCodeOf<Rsrp>(cell.power)) element->setRsrp(*code);
  if (cell.channel) element->setEarfcn(*cell.channel);
  if (const auto code = unsignedCodeOf<Rsrq>(cell.quality)) element->setRsrq(*code);
  return element;
}

std::vector<const Cell*> neighbours(const ModemState& state, Technology serving, Technology technology) {
  std::vector<const Cell*> cells;
  if (state.technology != serving) return cells;
  for (const Cell& cell : state.cells) {
    if (!cell.serving && cell.technology == technology) cells.push_back(&cell);
  }
  return cells;
}

}  // namespace

void Reports::tellServingCell(const ModemState& state) {
  const Serving serving(state);
  KCellularLteScellInfo lte;
  KCellularWcdmaCellInfo umts;
  KCellularGsmScellInfo gsm;
  if (state.technology == Technology::lte) lte = lteServing(serving);
  if (state.technology == Technology::umts) umts = umtsServing(serving, state.hsdpa, state.hsupa);
  if (state.technology == Technology::gsm) gsm = gsmServing(serving);
  tell(metricIdentifier("K_LTE_SCELL_INFO"), lte);
  tell(metricIdentifier("K_UMTS_SCELL_INFO"), umts);
  tell(metricIdentifier("K_GSM_SCELL_INFO"), gsm);
}

void Reports::tellSignal(const ModemState& state) {
  const Serving serving(state);
  // ModemManager reports one value for the cell, not one per antenna.
  KCellularLteRsrpRsrqSinr lte;
  if (state.technology == Technology::lte) {
    const auto power = state.lte.rsrp ? state.lte.rsrp : serving.power;
    const auto quality = state.lte.rsrq ? state.lte.rsrq : serving.quality;
    auto instant = std::make_shared<RsrpRsrqSinr>();
    if (power && Rsrp::isMeasurable(*power)) instant->setRsrp0(rounded(*power));
    if (quality && Rsrq::isMeasurable(*quality)) instant->setRsrq0(rounded(*quality));
    if (state.lte.snr && std::abs(*state.lte.snr) <= 60) instant->setSinr0(sinrSteps(*state.lte.snr));
    const bool measured = !instant->encoded().empty();
    if (measured && serving.code) instant->setPhyCellId(*serving.code);
    if (measured) lte.addInstValues(std::move(instant));
  }
  if (emptied(ListName::lteInstants, lte.instValuesCount())) lte.addInstValues(std::make_shared<RsrpRsrqSinr>());
  tell(metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), lte);

  KCellularWcdmaScellMeasurement umts;
  if (state.technology == Technology::umts) {
    auto receiver = std::make_shared<RxInfo>();
    if (isRssi(state.umts.rssi)) receiver->setRssi(rounded(*state.umts.rssi));
    if (const auto code = unsignedCodeOf<Rscp>(state.umts.rscp ? state.umts.rscp : serving.power))
      receiver->setRsrpRange(*code);
    if (const auto code = unsignedCodeOf<Ecno>(state.umts.ecio ? state.umts.ecio : serving.quality))
      receiver->setRsrqRange(*code);
    if (!receiver->encoded().empty()) umts.addRxInfo(std::move(receiver));
  }
  if (emptied(ListName::umtsReceivers, umts.rxInfosCount())) umts.addRxInfo(std::make_shared<RxInfo>());
  tell(metricIdentifier("K_UMTS_SCELL_MEAS"), umts);

  KCellularGsmIdleScellMeasurement gsm;
  if (state.technology == Technology::gsm) {
    if (isRssi(state.gsmRssi)) {
      gsm.setIdleRxlevDBm(rounded(*state.gsmRssi));
    } else if (const auto level = radio::Rxlev::fromCode(static_cast<std::int32_t>(serving.levelCode.value_or(64)))) {
      gsm.setIdleRxlevDBm(rounded(level->level()));
    }
    if (gsm.hasIdleRxlevDBm() && serving.channel) gsm.setScellArfcn(*serving.channel);
  }
  tell(metricIdentifier("K_GSM_IDLE_SCELL_MEAS"), gsm);
}

void Reports::tellNeighbours(const ModemState& state) {
  using enum Technology;
  // Fills one list of a message, or clears it.
  const auto fill = [&](ListName name, Technology serving, Technology technology, auto make, auto add) {
    const std::vector<const Cell*> cells = neighbours(state, serving, technology);
    for (const Cell* cell : cells) add(make(*cell));
    if (emptied(name, cells.size())) add(make(Cell{}));
  };

  KCellularLteNbrEutraCellMeas intra;
  fill(ListName::lteNeighbours, lte, lte, lteFromLte, [&](auto cell) { intra.addMeasNbrEutra(std::move(cell)); });
  tell(metricIdentifier("K_LTE_INTRARAT_MEAS"), intra);

  KCellularLteNbrInterRatCellMeas inter;
  fill(ListName::lteUtraNeighbours, lte, umts, umtsFromLte, [&](auto cell) { inter.addMeasNbrUtra(std::move(cell)); });
  fill(ListName::lteGeranNeighbours, lte, gsm, gsmNeighbour<EgwErrcNbrGeranMeas>,
       [&](auto cell) { inter.addMeasNbrGeran(std::move(cell)); });
  tell(metricIdentifier("K_LTE_INTERRAT_MEAS"), inter);

  KCellularWcdmaNbrCellMeas ofUmts;
  fill(ListName::umtsUtraNeighbours, umts, umts, umtsFromUmts,
       [&](auto cell) { ofUmts.addMeasUtraResult(std::move(cell)); });
  fill(ListName::umtsGeranNeighbours, umts, gsm, gsmNeighbour<GsmCellMeasResult>,
       [&](auto cell) { ofUmts.addMeasGsmResult(std::move(cell)); });
  fill(ListName::umtsEutraNeighbours, umts, lte, lteFromUmts,
       [&](auto cell) { ofUmts.addMeasLteResult(std::move(cell)); });
  tell(metricIdentifier("K_UMTS_NCELL_MEAS"), ofUmts);

  KCellularGsmGrrEventMeasCr ofGsm;
  fill(ListName::gsmGeranNeighbours, gsm, gsm, gsmFromGsm, [&](auto cell) { ofGsm.addGsmNcellMeas(std::move(cell)); });
  fill(ListName::gsmUtraNeighbours, gsm, umts, umtsFromGsm,
       [&](auto cell) { ofGsm.addUmtsNcellMeas(std::move(cell)); });
  fill(ListName::gsmEutraNeighbours, gsm, lte, lteFromGsm, [&](auto cell) { ofGsm.addLteNcellMeas(std::move(cell)); });
  tell(metricIdentifier("K_GSM_NCELL_MEAS"), ofGsm);
}

}  // namespace vespscope::sources::modemmanager
