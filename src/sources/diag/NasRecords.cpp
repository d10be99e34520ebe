#include "sources/diag/NasRecords.h"

#include "sources/diag/ByteView.h"

namespace vespscope::sources::diag {

Decoded<EmmStateRecord> emmStateOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  if (bytes.u8(0) != 2) return RecordFault::unknownVersion;
  if (!bytes.holds(15, 4)) return RecordFault::tooShort;
  EmmStateRecord record{bytes.u8(1), bytes.u16(2), std::nullopt};
  if (const auto plmn = radio::Plmn::fromOctets(bytes.part(9, radio::Plmn::octetCount))) {
    record.guti = nas::Guti{*plmn, bytes.u16(12), bytes.u8(14), bytes.u32(15)};
  }
  return record;
}

Decoded<BearerStateRecord> bearerStateOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  if (bytes.u8(0) != 1) return RecordFault::unknownVersion;
  if (!bytes.holds(11, 1)) return RecordFault::tooShort;
  const BearerStateRecord record{bytes.u8(2), bytes.u8(3), bytes.u8(11)};
  // The identities below are reserved (3GPP TS 24.007 11.2.3.1.5).
  if (record.bearer < 5 || record.bearer > 15) return RecordFault::outOfRange;
  return record;
}

Decoded<NasMessageRecord> epsMessageOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 4;  // version of the record, then release and version of the protocol
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  if (bytes.u8(0) != 1) return RecordFault::unknownVersion;
  if (!bytes.holds(0, head + 1)) return RecordFault::tooShort;
  return NasMessageRecord{payload.subspan(head)};
}

Decoded<NasMessageRecord> gprsMessageOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 5;  // direction and length
  const ByteView bytes(payload);
  if (!bytes.holds(0, head) || !bytes.holds(head, bytes.u32(1))) return RecordFault::tooShort;
  return NasMessageRecord{bytes.part(head, bytes.u32(1))};
}

Decoded<MobilityStateRecord> mobilityStateOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 3)) return RecordFault::tooShort;
  return MobilityStateRecord{bytes.u8(0), bytes.u8(1), bytes.u8(2)};
}

Decoded<GmmRegistrationRecord> gmmRegistrationOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t areaLength = 6;
  const ByteView bytes(payload);
  if (!bytes.holds(2, areaLength)) return RecordFault::tooShort;
  return GmmRegistrationRecord{bytes.u8(0), bytes.u8(1), nas::routingAreaOf(bytes.part(2, areaLength))};
}

}  // namespace vespscope::sources::diag
