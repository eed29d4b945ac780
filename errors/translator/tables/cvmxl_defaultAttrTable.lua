-- cvmxl_defaultAttrTable: the attributes that every IVI driver session has
-- (the engine's inherent attributes). Used when no driver table loads, and
-- consulted by driver tables for ids they do not define themselves.
--
-- Keys are attribute ids (numbers here; looked up as 8 upper-case hex
-- digits, see cvmxl_utilities.attributeTable); each entry has the
-- attribute's short name and, for enumerated attributes, the names of its
-- values. Names are not translated, so this table has no language variants.

local attributes = {
  [1050002] = { name = "RANGE_CHECK" },
  [1050003] = { name = "QUERY_INSTRUMENT_STATUS" },
  [1050004] = { name = "CACHE" },
  [1050005] = { name = "SIMULATE" },
  [1050006] = { name = "RECORD_COERCIONS" },
  [1050007] = { name = "DRIVER_SETUP" },
  [1050021] = { name = "INTERCHANGE_CHECK" },
  [1050022] = { name = "SPY" },
  [1050023] = { name = "USE_SPECIFIC_SIMULATION" },
  [1050101] = { name = "PRIMARY_ERROR" },
  [1050102] = { name = "SECONDARY_ERROR" },
  [1050103] = { name = "ERROR_ELABORATION" },
  [1050203] = { name = "CHANNEL_COUNT" },
  [1050302] = { name = "SPECIFIC_DRIVER_PREFIX" },
  [1050304] = { name = "IO_RESOURCE_DESCRIPTOR" },
  [1050305] = { name = "LOGICAL_NAME" },
  [1050322] = { name = "IO_SESSION" },
  [1050327] = { name = "SUPPORTED_INSTRUMENT_MODELS" },
  [1050401] = { name = "GROUP_CAPABILITIES" },
  [1050510] = { name = "INSTRUMENT_FIRMWARE_REVISION" },
  [1050511] = { name = "INSTRUMENT_MANUFACTURER" },
  [1050512] = { name = "INSTRUMENT_MODEL" },
  [1050513] = { name = "SPECIFIC_DRIVER_VENDOR" },
  [1050514] = { name = "SPECIFIC_DRIVER_DESCRIPTION" },
  [1050551] = { name = "SPECIFIC_DRIVER_REVISION" },
}

return require("cvmxl_utilities").attributeTable(attributes)
