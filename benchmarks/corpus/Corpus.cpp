#include "corpus/Corpus.h"

#include <algorithm>
#include <array>
#include <string>
#include <string_view>

#include "corpus/Random.h"
#include "messages/MessageOperations.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "registry/MetricRows.h"

namespace vespscope::bench {
namespace {

constexpr std::uint64_t firstTimestamp = 1'700'000'000'000;  // ms
constexpr std::size_t simCardFiles = 12;

// Writes messages with random content straight into the wire format.
class Filler {
 public:
  Filler(Random& random, const CorpusShape& shape, std::uint64_t timestamp)
      : random_(random), shape_(shape), timestamp_(timestamp) {}

  template <class Message>
  void fill(WireWriter& writer) {
    fields::forEach<Message>([&](const auto& field) { writeField(writer, field); });
  }

 private:
  [[nodiscard]] bool present() { return random_.chance(shape_.presence); }

  template <class Message>
  void embed(WireWriter& writer, std::uint32_t number) {
    const auto mark = writer.placeMark(number);
    fill<Message>(writer);
    writer.recallMark(mark);
  }

  template <NumberKind Kind, class Owner, class Stored>
  void writeField(WireWriter& writer, const NumberField<Kind, Owner, Stored>& field) {
    if (!present()) return;
    if constexpr (Kind == NumberKind::enumeration) {
      const EnumerationName& value = field.names[random_.below(field.names.size())];
      writeNumber<Kind>(writer, value.number, field.number);
    } else if constexpr (Kind == NumberKind::uint64) {
      writeNumber<Kind>(writer, timestamp_, field.number);
    } else {
      writeNumber<Kind>(writer, static_cast<Stored>(number(field.name, Kind)), field.number);
    }
  }

  template <class Owner, class Content>
  void writeField(WireWriter& writer, const ContentField<Owner, Content>& field) {
    if (!present()) return;
    if constexpr (std::is_same_v<Content, Bytes>) {
      Bytes bytes(contentSize(field.name));
      for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(random_.below(256));
      writer.writeBytes(bytes, field.number);
    } else {
      static constexpr std::array<std::string_view, 4> texts = {"ims", "internet", "web.operator.example",
                                                                "mms.mnc001.mcc001.gprs"};
      writer.writeString(texts[random_.below(texts.size())], field.number);
    }
  }

  template <class Owner, class Embedded>
  void writeField(WireWriter& writer, const MessageField<Owner, Embedded>& field) {
    if (present()) embed<Embedded>(writer, field.number);
  }

  template <class Owner, class Element>
  void writeField(WireWriter& writer, const MessageListField<Owner, Element>& field) {
    const std::size_t count = field.name == "ef_list" ? simCardFiles : elements();
    for (std::size_t index = 0; index < count; ++index) embed<Element>(writer, field.number);
  }

  template <NumberKind Kind, class Owner, class Stored>
  void writeField(WireWriter& writer, const NumberListField<Kind, Owner, Stored>& field) {
    const auto mark = writer.placeMark(field.number);
    for (std::size_t count = elements(); count > 0; --count) {
      writeNumber<Kind>(writer, static_cast<Stored>(number(field.name, Kind)), WireWriter::noField);
    }
    writer.recallMark(mark);
  }

  [[nodiscard]] std::size_t elements() {
    return shape_.leastElements + random_.below(shape_.mostElements - shape_.leastElements + 1);
  }

  [[nodiscard]] std::size_t contentSize(std::string_view name) {
    if (name == "encoded_plmn") return 3;                                // 3GPP TS 24.008 10.5.1.3
    if (name == "imsi") return 8;                                        // 3GPP TS 24.008 10.5.1.4
    if (name.ends_with("_addr")) return random_.chance(0.5) ? 4U : 16U;  // IPv4, IPv6
    return 2 + random_.below(40);                                        // elementary files
  }

  // As wide as such a quantity is: channels, identities and codes differ in how many bytes they take.
  [[nodiscard]] std::int64_t number(std::string_view name, NumberKind kind) {
    const auto has = [name](std::string_view part) { return name.find(part) != std::string_view::npos; };
    if (kind == NumberKind::boolean) return static_cast<std::int64_t>(random_.below(2));
    if (kind == NumberKind::sint32) return static_cast<std::int64_t>(random_.below(160)) - 140;
    if (has("tmsi")) return static_cast<std::int64_t>(random_.below(std::uint64_t{1} << 32));
    if (has("phy") || has("psc") || has("pci")) return static_cast<std::int64_t>(random_.below(504));
    if (has("cell_id")) return static_cast<std::int64_t>(random_.below(1 << 28));
    if (has("arfcn") || has("freq") || has("tac") || has("lac") || has("tracking_area_code")) {
      return static_cast<std::int64_t>(random_.below(1 << 16));
    }
    if (has("_ms") || has("mcc") || has("mnc")) return static_cast<std::int64_t>(random_.below(1000));
    return static_cast<std::int64_t>(random_.below(random_.chance(0.8) ? 100 : 1000));
  }

  Random& random_;
  const CorpusShape& shape_;
  const std::uint64_t timestamp_;
};

using Fill = Bytes (*)(Random&, const CorpusShape&, std::uint64_t);

template <class Message>
Bytes payloadOf(Random& random, const CorpusShape& shape, std::uint64_t timestamp) {
  WireWriter writer;
  Filler(random, shape, timestamp).fill<Message>(writer);
  return writer.takeBytes();
}

struct Metric {
  std::int32_t identifier;
  Fill payload;
};

constexpr std::array<Metric, 29> metrics = {{
    {metricIdentifier("K_LTE_RRC_STATE"), &payloadOf<KCellularLteRrcState>},
    {metricIdentifier("K_LTE_CDRX_CONFIG"), &payloadOf<KCellularLteCdrxConfig>},
    {metricIdentifier("K_LTE_SCELL_INFO"), &payloadOf<KCellularLteScellInfo>},
    {metricIdentifier("K_LTE_SEL_RESEL_INFO"), &payloadOf<KCellularLteSelReselCellInfo>},
    {metricIdentifier("K_LTE_TX_POWER"), &payloadOf<KCellularLteTxPower>},
    {metricIdentifier("K_LTE_RSRP_RSRQ_SINR"), &payloadOf<KCellularLteRsrpRsrqSinr>},
    {metricIdentifier("K_LTE_COMPCARR_INFO"), &payloadOf<KCellularLteComponentCarrierInfo>},
    {metricIdentifier("K_LTE_CA_STATUS"), &payloadOf<KCellularLteCarrierAggregationStatus>},
    {metricIdentifier("K_LTE_INTERRAT_MEAS"), &payloadOf<KCellularLteNbrInterRatCellMeas>},
    {metricIdentifier("K_LTE_INTRARAT_MEAS"), &payloadOf<KCellularLteNbrEutraCellMeas>},
    {metricIdentifier("K_LTE_EMM_CTXT"), &payloadOf<KCellularEmmContext>},
    {metricIdentifier("K_CELLULAR_MM_INFO"), &payloadOf<KCellularMmCommonInfo>},
    {metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), &payloadOf<KCellularActivatedBearerContexts>},
    {metricIdentifier("K_CELLULAR_MM_CTXT"), &payloadOf<KCellularMmContext>},
    {metricIdentifier("K_CELLULAR_GMM_CTXT"), &payloadOf<KCellularGmmContext>},
    {metricIdentifier("K_UMTS_RRC_STATE"), &payloadOf<KCellularWcdmaRrcConnectionState>},
    {metricIdentifier("K_UMTS_RRC_CONFIG"), &payloadOf<KCellularWcdmaRrcConfiguration>},
    {metricIdentifier("K_UMTS_SCELL_INFO"), &payloadOf<KCellularWcdmaCellInfo>},
    {metricIdentifier("K_UMTS_SCELL_MEAS"), &payloadOf<KCellularWcdmaScellMeasurement>},
    {metricIdentifier("K_UMTS_TX_POWER"), &payloadOf<KCellularWcdmaTxPower>},
    {metricIdentifier("K_UMTS_SEL_RESEL_INFO"), &payloadOf<KCellularWcdmaSelReselCellInfo>},
    {metricIdentifier("K_UMTS_NCELL_MEAS"), &payloadOf<KCellularWcdmaNbrCellMeas>},
    {metricIdentifier("K_GSM_SCELL_INFO"), &payloadOf<KCellularGsmScellInfo>},
    {metricIdentifier("K_GSM_IDLE_CONFIG"), &payloadOf<KCellularGsmIdleConfig>},
    {metricIdentifier("K_GSM_IDLE_SCELL_MEAS"), &payloadOf<KCellularGsmIdleScellMeasurement>},
    {metricIdentifier("K_GSM_CS_RF_MEAS"), &payloadOf<KCellularGsmCsRfMeasurement>},
    {metricIdentifier("K_GSM_NCELL_MEAS"), &payloadOf<KCellularGsmGrrEventMeasCr>},
    {metricIdentifier("K_GSM_GPRS_CONFIG"), &payloadOf<KCellularGsmGprsConfig>},
    {metricIdentifier("K_SIM_FILE_INFO"), &payloadOf<KCellularSimCardFiles>},
}};

}  // namespace

std::vector<MetricEvent> makeCorpus(const CorpusShape& shape) {
  Random random(shape.seed);
  std::vector<MetricEvent> events;
  events.reserve(metrics.size() * shape.eventsPerMetric);
  for (const Metric& metric : metrics) {
    for (std::size_t count = 0; count < shape.eventsPerMetric; ++count) {
      const std::uint64_t timestamp = firstTimestamp + events.size() * 100;
      MetricEvent event;
      event.metricID = metric.identifier;
      event.payload = metric.payload(random, shape, timestamp);
      event.time = std::chrono::milliseconds(timestamp);
      events.push_back(std::move(event));
    }
  }
  if (shape.mixed) {
    for (std::size_t left = events.size(); left > 1; --left) std::swap(events[left - 1], events[random.below(left)]);
  }
  return events;
}

MetricEvent makeNeighbours(std::size_t elements, std::uint32_t seed) {
  Random random(seed);
  CorpusShape shape;
  shape.leastElements = shape.mostElements = elements;
  shape.presence = 1;
  MetricEvent event;
  event.metricID = metricIdentifier("K_LTE_INTRARAT_MEAS");
  event.payload = payloadOf<KCellularLteNbrEutraCellMeas>(random, shape, firstTimestamp);
  event.time = std::chrono::milliseconds(firstTimestamp);
  return event;
}

}  // namespace vespscope::bench
