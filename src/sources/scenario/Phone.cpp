#include "sources/scenario/Phone.h"

#include "sources/scenario/SimCard.h"

namespace vespscope::sources::scenario {

using namespace std::chrono_literals;

Phone::Phone(std::uint64_t seed, std::chrono::nanoseconds start)
    : outbox_(seed, start),
      random_(hashOf(seed, 50)),
      map_(seed),
      propagation_(map_, seed),
      vehicle_(seed),
      traffic_(seed),
      context_{.map = map_, .propagation = propagation_, .random = random_},
      lteReports_(outbox_, map_),
      umtsReports_(outbox_, map_),
      gsmReports_(outbox_, map_),
      nasReports_(outbox_),
      nas_(nasReports_, seed),
      lte_(lteReports_, nas_),
      umts_(umtsReports_, nas_),
      gsm_(gsmReports_, nas_) {
  // At power-on the card is read first, then a cell searched.
  cardRead_.start(0ms, 250ms);
  journey_ = Journey{{Technology::lte, false}, {}};
  journey_->arrival.start(0ms, 900ms);
}

void Phone::arrive(const Departure& departure) {
  technology_ = departure.to;
  traffic_.entered(technology_, context_.now);
  switch (technology_) {
    case Technology::lte:
      lte_.enter(context_, departure.connected);
      break;
    case Technology::umts:
      umts_.enter(context_, departure.connected);
      break;
    case Technology::gsm:
      gsm_.enter(context_, departure.connected);
      break;
  }
}

void Phone::tick() {
  context_.now += frame;
  outbox_.begin(context_.now);
  vehicle_.tick(context_.now);
  context_.place = map_.roadAt(vehicle_.along());
  traffic_.tick(context_.now);
  context_.demand = traffic_.demand();
  context_.demand.signalling = nas_.wantsSignalling();
  if (cardRead_.expired(context_.now)) nasReports_.cardFiles(testCardFiles());
  if (journey_) {
    if (!journey_->arrival.expired(context_.now)) return;
    const Departure departure = journey_->departure;
    journey_.reset();
    arrive(departure);
    return;
  }
  nas_.tick(context_);
  std::optional<Departure> departure;
  switch (technology_) {
    case Technology::lte:
      departure = lte_.tick(context_);
      break;
    case Technology::umts:
      departure = umts_.tick(context_);
      break;
    case Technology::gsm:
      departure = gsm_.tick(context_);
      break;
  }
  if (!departure) return;
  journey_ = Journey{*departure, {}};
  // A handover interrupts for a fraction of a second; before a reselection the phone reads the new cell's system
  // information.
  const Time duration(departure->connected ? random_.between(80, 250) : random_.between(350, 1100));
  journey_->arrival.start(context_.now, duration);
}

}  // namespace vespscope::sources::scenario
