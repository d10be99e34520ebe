-- Reads packets of link type USER0 as metric events: vespscope.MetricEvent, and its payload as the message that its
-- metric_id names. Both are dissected by Wireshark's own Protocol Buffers dissector from the schema in src/.
local metrics = { -- by metric_id: the metric and its message
  [0x3C0013] = { "K_SIM_FILE_INFO", "KCellularSimCardFiles" },
  [0x3C2E0C] = { "K_GSM_SCELL_INFO", "KCellularGsmScellInfo" },
  [0x3C300C] = { "K_UMTS_SCELL_INFO", "KCellularWcdmaCellInfo" },
  [0x3C40C2] = { "K_LTE_SCELL_INFO", "KCellularLteScellInfo" },
  [0x3C4E04] = { "K_LTE_RRC_STATE", "KCellularLteRrcState" },
  [0x3C4E18] = { "K_LTE_CDRX_CONFIG", "KCellularLteCdrxConfig" },
  [0x3C4F6A] = { "K_LTE_RSRP_RSRQ_SINR", "KCellularLteRsrpRsrqSinr" },
  [0x3CD001] = { "K_GSM_IDLE_CONFIG", "KCellularGsmIdleConfig" },
  [0x3CD002] = { "K_GSM_IDLE_SCELL_MEAS", "KCellularGsmIdleScellMeasurement" },
  [0x3CD003] = { "K_GSM_CS_RF_MEAS", "KCellularGsmCsRfMeasurement" },
  [0x3CD009] = { "K_GSM_NCELL_MEAS", "KCellularGsmGrrEventMeasCr" },
  [0x3CD00C] = { "K_GSM_GPRS_CONFIG", "KCellularGsmGprsConfig" },
  [0x3CD102] = { "K_UMTS_SCELL_MEAS", "KCellularWcdmaScellMeasurement" },
  [0x3CD103] = { "K_UMTS_TX_POWER", "KCellularWcdmaTxPower" },
  [0x3CD104] = { "K_UMTS_SEL_RESEL_INFO", "KCellularWcdmaSelReselCellInfo" },
  [0x3CD105] = { "K_UMTS_NCELL_MEAS", "KCellularWcdmaNbrCellMeas" },
  [0x3CD112] = { "K_UMTS_RRC_STATE", "KCellularWcdmaRrcConnectionState" },
  [0x3CD113] = { "K_UMTS_RRC_CONFIG", "KCellularWcdmaRrcConfiguration" },
  [0x3CD301] = { "K_LTE_SCELL_MEAS", "KCellularLteServingCellMeasurement" },
  [0x3CD302] = { "K_LTE_TX_POWER", "KCellularLteTxPower" },
  [0x3CD30B] = { "K_LTE_COMPCARR_INFO", "KCellularLteComponentCarrierInfo" },
  [0x3CD30E] = { "K_LTE_SEL_RESEL_INFO", "KCellularLteSelReselCellInfo" },
  [0x3CD30F] = { "K_LTE_INTRARAT_MEAS", "KCellularLteNbrEutraCellMeas" },
  [0x3CD310] = { "K_LTE_INTERRAT_MEAS", "KCellularLteNbrInterRatCellMeas" },
  [0x3CD313] = { "K_LTE_CA_STATUS", "KCellularLteCarrierAggregationStatus" },
  [0x3CD509] = { "K_CELLULAR_MM_INFO", "KCellularMmCommonInfo" },
  [0x3CD50A] = { "K_CELLULAR_MM_CTXT", "KCellularMmContext" },
  [0x3CD50B] = { "K_CELLULAR_GMM_CTXT", "KCellularGmmContext" },
  [0x3CD50C] = { "K_LTE_EMM_CTXT", "KCellularEmmContext" },
  [0x3CD50D] = { "K_CELLULAR_ACTIVE_BEARER", "KCellularActivatedBearerContexts" },
}

local event = Proto("vespscope", "vespscope metric event")
local fields = {
  metric = ProtoField.string("vespscope.metric", "Metric"),
  message = ProtoField.string("vespscope.message", "Message"),
}
event.fields = { fields.metric, fields.message }

local protobuf = Dissector.get("protobuf")

-- The varint at `offset`: its value in 32 bits, and where it ends; nil past the end.
local function varint(buffer, offset)
  local value, factor = 0, 1
  while offset < buffer:len() do
    local byte = buffer(offset, 1):uint()
    offset = offset + 1
    if factor <= 0x10000000 then value = value + (byte % 128) * factor end
    factor = factor * 128
    if byte < 128 then return value, offset end
  end
end

-- The metric_id of a MetricEvent; nil when there is none.
local function metric_of(buffer)
  local offset, found = 0, nil
  while offset < buffer:len() do
    local key, value
    key, offset = varint(buffer, offset)
    if not key then return found end
    local kind = key % 8
    if kind == 0 then
      value, offset = varint(buffer, offset)
      if not value then return found end
      if key == 8 then found = value end
    elseif kind == 2 then
      value, offset = varint(buffer, offset)
      if not value then return found end
      offset = offset + value
    elseif kind == 1 then
      offset = offset + 8
    elseif kind == 5 then
      offset = offset + 4
    else
      return found
    end
  end
  return found
end

local message -- of the packet being dissected

-- Stands in for the bytes of MetricEvent.payload.
local payload = Proto("vespscope_payload", "vespscope metric message")
function payload.dissector(buffer, pinfo, tree)
  if not message then return 0 end
  pinfo.private["pb_msg_type"] = "message,vespscope." .. message
  return protobuf:call(buffer, pinfo, tree)
end

function event.dissector(buffer, pinfo, tree)
  local metric = metrics[metric_of(buffer)]
  local item = tree:add(event, buffer())
  message = metric and metric[2]
  if metric then
    item:add(fields.metric, metric[1]):set_generated()
    item:add(fields.message, metric[2]):set_generated()
  end
  pinfo.private["pb_msg_type"] = "message,vespscope.MetricEvent"
  protobuf:call(buffer, pinfo, tree)
  pinfo.cols.protocol = "vespscope"
  pinfo.cols.info = metric and (metric[1] .. " " .. metric[2]) or "a metric without a message"
end

DissectorTable.get("wtap_encap"):add(wtap.USER0, event)
DissectorTable.get("protobuf_field"):add("vespscope.MetricEvent.payload", payload)
