#!/usr/bin/env python3
"""Decodes a capture as a Python programmer would: python-loop.py FOLDER parse|json CAPTURE, FOLDER with the schema."""
import json
import struct
import sys

from google.protobuf import descriptor_pb2, descriptor_pool, json_format, message_factory

MESSAGES = {
    0x3C0013: "KCellularSimCardFiles", 0x3C2E0C: "KCellularGsmScellInfo", 0x3C300C: "KCellularWcdmaCellInfo",
    0x3C40C2: "KCellularLteScellInfo", 0x3C4E04: "KCellularLteRrcState", 0x3C4E18: "KCellularLteCdrxConfig",
    0x3C4F6A: "KCellularLteRsrpRsrqSinr", 0x3CD001: "KCellularGsmIdleConfig",
    0x3CD002: "KCellularGsmIdleScellMeasurement", 0x3CD003: "KCellularGsmCsRfMeasurement",
    0x3CD009: "KCellularGsmGrrEventMeasCr", 0x3CD00C: "KCellularGsmGprsConfig",
    0x3CD102: "KCellularWcdmaScellMeasurement", 0x3CD103: "KCellularWcdmaTxPower",
    0x3CD104: "KCellularWcdmaSelReselCellInfo", 0x3CD105: "KCellularWcdmaNbrCellMeas",
    0x3CD112: "KCellularWcdmaRrcConnectionState", 0x3CD113: "KCellularWcdmaRrcConfiguration",
    0x3CD302: "KCellularLteTxPower", 0x3CD30B: "KCellularLteComponentCarrierInfo",
    0x3CD30E: "KCellularLteSelReselCellInfo", 0x3CD30F: "KCellularLteNbrEutraCellMeas",
    0x3CD310: "KCellularLteNbrInterRatCellMeas", 0x3CD313: "KCellularLteCarrierAggregationStatus",
    0x3CD509: "KCellularMmCommonInfo", 0x3CD50A: "KCellularMmContext", 0x3CD50B: "KCellularGmmContext",
    0x3CD50C: "KCellularEmmContext", 0x3CD50D: "KCellularActivatedBearerContexts",
}


def main():
    folder, way, capture = sys.argv[1:]
    pool, files = descriptor_pool.DescriptorPool(), descriptor_pb2.FileDescriptorSet()
    with open(f"{folder}/schema", "rb") as file:
        files.ParseFromString(file.read())
    left = list(files.file)
    while left:
        for each in list(left):
            if not any(other.name in each.dependency for other in left):
                pool.Add(each)
                left.remove(each)
    factory = message_factory.MessageFactory(pool)
    make = {number: factory.GetPrototype(pool.FindMessageTypeByName("vespscope." + name))
            for number, name in MESSAGES.items()}
    event_class = factory.GetPrototype(pool.FindMessageTypeByName("vespscope.MetricEvent"))
    with open(capture, "rb") as file:
        file.read(24)
        while header := file.read(16):
            seconds, fraction, size, _ = struct.unpack("<IIII", header)
            event = event_class.FromString(file.read(size))
            message = make[event.metric_id].FromString(event.payload) if event.metric_id in make else None
            if way == "json":
                record = message and json_format.MessageToDict(message, preserving_proto_field_name=True)
                sys.stdout.write(json.dumps({"time": f"{seconds}.{fraction:09}", "metric_id": event.metric_id,
                                             "record": record}) + "\n")


main()
