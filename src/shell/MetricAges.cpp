#include "shell/MetricAges.h"

#include <algorithm>
#include <string_view>

namespace vespscope {
namespace {

constexpr unsigned lte = 1;
constexpr unsigned umts = 2;
constexpr unsigned gsm = 4;
constexpr unsigned any = lte | umts | gsm;

// An own time this far before the newest one belongs to another round of a recording and is not merely a late report.
constexpr std::chrono::seconds anotherRound{30};

struct Kind {
  unsigned technologies = any;  // the technologies that report the metric while they serve
  bool measurement = false;     // reported periodically while its cell serves
  bool serving = false;         // reported for the serving cell only
};

constexpr Kind kindOf(std::string_view name) {
  Kind kind;
  if (name.starts_with("K_LTE_")) kind.technologies = lte;
  if (name.starts_with("K_UMTS_")) kind.technologies = umts;
  if (name.starts_with("K_GSM_")) kind.technologies = gsm;
  // The contexts of the circuit and packet domains belong to UMTS and GSM (3GPP TS 24.008).
  if (name == "K_CELLULAR_MM_CTXT" || name == "K_CELLULAR_GMM_CTXT") kind.technologies = umts | gsm;
  // RRC states are left out: a technology reports its state once more after the phone has left it.
  for (const std::string_view of : {"K_LTE_SCELL_INFO", "K_UMTS_SCELL_INFO", "K_GSM_SCELL_INFO"}) {
    if (name == of) kind.serving = true;
  }
  for (const std::string_view of :
       {"K_LTE_RSRP_RSRQ_SINR", "K_LTE_SCELL_MEAS", "K_UMTS_SCELL_MEAS", "K_GSM_IDLE_SCELL_MEAS", "K_GSM_CS_RF_MEAS"}) {
    if (name == of) kind.serving = kind.measurement = true;
  }
  for (const std::string_view of : {"K_LTE_TX_POWER", "K_LTE_INTERRAT_MEAS", "K_LTE_INTRARAT_MEAS", "K_UMTS_TX_POWER",
                                    "K_UMTS_NCELL_MEAS", "K_GSM_NCELL_MEAS"}) {
    if (name == of) kind.measurement = true;
  }
  return kind;
}

// In the order of the metrics' rows.
constexpr auto kinds = [] {
  std::array<Kind, metricRows.size()> all{};
  std::transform(metricRows.begin(), metricRows.end(), all.begin(),
                 [](const MetricRow& row) { return kindOf(row.identifierName); });
  return all;
}();

constexpr auto identifiers = [] {
  std::array<std::int64_t, metricRows.size()> all{};
  std::transform(metricRows.begin(), metricRows.end(), all.begin(),
                 [](const MetricRow& row) { return std::int64_t{row.identifier()}; });
  return all;
}();

// The metric's index in the tables; their size if it is not registered.
std::size_t placeOf(std::int64_t identifier) {
  return static_cast<std::size_t>(std::find(identifiers.begin(), identifiers.end(), identifier) - identifiers.begin());
}

}  // namespace

void MetricAges::note(std::int64_t identifier, std::optional<std::chrono::nanoseconds> own, Clock::time_point arrival) {
  const std::size_t place = placeOf(identifier);
  if (place == identifiers.size()) return;
  if (own && newestOwn_ && *own + anotherRound < *newestOwn_) {
    earlierRounds_ += *newestOwn_ - *own;
    newestOwn_ = own;
  } else if (own && (!newestOwn_ || *own > *newestOwn_)) {
    newestOwn_ = own;
  }
  reports_[place] = Report{arrival, own.value_or(newestOwn_.value_or(std::chrono::nanoseconds(0))) + earlierRounds_};
  if (kinds[place].serving) serving_ = kinds[place].technologies;
}

application::ScreenAge MetricAges::ageOf(std::int64_t identifier, const Source& source, Clock::time_point now) const {
  application::ScreenAge age;
  const std::size_t place = placeOf(identifier);
  if (place == identifiers.size() || !reports_[place]) return age;
  const Report& report = *reports_[place];
  age.age = now - report.arrival;
  if (source.recorded) {
    const std::chrono::nanoseconds newest = newestOwn_.value_or(std::chrono::nanoseconds(0));
    age.age = std::max(newest, source.recordingClock.value_or(newest)) + earlierRounds_ - report.recorded;
  }
  age.measurement = kinds[place].measurement;
  age.lastKnown = !source.connected || (serving_ != 0 && (kinds[place].technologies & serving_) == 0);
  return age;
}

}  // namespace vespscope
