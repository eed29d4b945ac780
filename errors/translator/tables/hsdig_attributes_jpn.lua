-- hsdig_attributes_jpn: Japanese names of the digitizer driver's attributes
-- and of the values of its enumerated attributes, used to show attribute
-- ids ("kUsageTypeAttributeId" and its kin) and enum values in error texts.
--
-- Exactly the keys of hsdig_attributes_eng, in its sections and order. Short
-- names and value names are identifiers (the constants of the driver's
-- header without their prefix), which a user types into code and searches
-- for in the documentation; they read the same in every language, so every
-- entry equals the English one.
--
-- Keys are attribute ids (looked up as 8 upper-case hex digits); an entry is
--   [id] = { name = "SHORT_NAME", values = { [value] = "VALUE_NAME", ... } }
-- with `values` only for enumerated attributes. Ids this table lacks are
-- looked up in cvmxl_defaultAttrTable (the attributes every IVI session has).
--
-- Sections:
--   1. Attributes this system adds to a driver session
--   2. The simulated digitizer's attributes (driver/hsdigAttributes.h), one
--      entry per attribute in id order and grouped as there.

local attributes = {
  -- 1. Attributes this system adds to a driver session -----------------------
  [1199999] = {
    name = "SECM_ATTR_LANGUAGE",
    values = { [0] = "en", [1] = "fr", [2] = "de", [3] = "jp", [4] = "ko", [5] = "ch", [6] = "zz" },
  },

  -- 2. The simulated digitizer's attributes -------------------------------------
  -- Vertical, per channel
  [1250001] = { name = "VERTICAL_RANGE" },
  [1250002] = { name = "VERTICAL_OFFSET" },
  [1250003] = { name = "VERTICAL_COUPLING", values = { [0] = "AC", [1] = "DC", [2] = "GND" } },
  [1250004] = { name = "PROBE_ATTENUATION" },
  [1250005] = { name = "CHANNEL_ENABLED" },
  [1250006] = { name = "INPUT_IMPEDANCE" },
  [1250007] = { name = "MAX_INPUT_FREQUENCY" },
  [1250008] = { name = "CHANNEL_LABEL" },
  [1250009] = { name = "EQUALIZATION_FILTER_ENABLED" },
  -- The simulated input signal, per channel
  [1250101] = {
    name = "SIGNAL_SHAPE",
    values = {
      [0] = "SHAPE_DC",
      [1] = "SHAPE_SINE",
      [2] = "SHAPE_SQUARE",
      [3] = "SHAPE_TRIANGLE",
      [4] = "SHAPE_SAWTOOTH",
    },
  },
  [1250102] = { name = "SIGNAL_FREQUENCY" },
  [1250103] = { name = "SIGNAL_AMPLITUDE" },
  [1250104] = { name = "SIGNAL_OFFSET" },
  [1250105] = { name = "SIGNAL_NOISE" },
  [1250106] = { name = "SIGNAL_PHASE" },
  [1250107] = { name = "SIGNAL_DUTY_CYCLE" },
  -- Horizontal and acquisition
  [1250201] = { name = "SAMPLE_RATE" },
  [1250202] = { name = "RECORD_LENGTH" },
  [1250203] = { name = "NUM_RECORDS" },
  [1250204] = { name = "REF_POSITION" },
  [1250205] = { name = "ENFORCE_REALTIME" },
  [1250206] = { name = "ACQUISITION_TYPE", values = { [0] = "NORMAL", [1] = "FLEXRES", [2] = "DDC" } },
  [1250207] = { name = "SAMPLE_MODE", values = { [0] = "REAL_TIME", [1] = "EQUIVALENT_TIME" } },
  [1250208] = { name = "ACQUISITION_START_TIME" },
  [1250209] = { name = "ACQUISITION_COUNT" },
  -- Trigger
  [1250301] = {
    name = "TRIGGER_TYPE",
    values = {
      [1] = "EDGE_TRIGGER",
      [2] = "HYSTERESIS_TRIGGER",
      [3] = "DIGITAL_TRIGGER",
      [4] = "WINDOW_TRIGGER",
      [5] = "SOFTWARE_TRIGGER",
      [6] = "IMMEDIATE_TRIGGER",
      [7] = "WIDTH_TRIGGER",
      [8] = "RUNT_TRIGGER",
      [9] = "GLITCH_TRIGGER",
      [10] = "VIDEO_TRIGGER",
    },
  },
  [1250302] = { name = "TRIGGER_SOURCE" },
  [1250303] = { name = "TRIGGER_LEVEL" },
  [1250304] = { name = "TRIGGER_SLOPE", values = { [0] = "NEGATIVE", [1] = "POSITIVE" } },
  [1250305] = {
    name = "TRIGGER_COUPLING",
    values = {
      [0] = "TRIGGER_COUPLING_AC",
      [1] = "TRIGGER_COUPLING_DC",
      [2] = "TRIGGER_COUPLING_HF_REJECT",
      [3] = "TRIGGER_COUPLING_LF_REJECT",
      [4] = "TRIGGER_COUPLING_AC_PLUS_HF_REJECT",
    },
  },
  [1250306] = { name = "TRIGGER_HOLDOFF" },
  [1250307] = { name = "TRIGGER_DELAY" },
  [1250308] = { name = "TRIGGER_HYSTERESIS" },
  [1250309] = { name = "TRIGGER_LOW_LEVEL" },
  [1250310] = { name = "TRIGGER_HIGH_LEVEL" },
  [1250311] = { name = "TRIGGER_WINDOW_MODE", values = { [0] = "ENTERING_WINDOW", [1] = "LEAVING_WINDOW" } },
  [1250312] = {
    name = "TRIGGER_POLARITY",
    values = { [0] = "POLARITY_POSITIVE", [1] = "POLARITY_NEGATIVE", [2] = "POLARITY_EITHER" },
  },
  [1250313] = { name = "TRIGGER_WIDTH_LOW" },
  [1250314] = { name = "TRIGGER_WIDTH_HIGH" },
  [1250315] = { name = "TRIGGER_WIDTH_CONDITION", values = { [0] = "WITHIN", [1] = "OUTSIDE" } },
  [1250316] = { name = "TRIGGER_GLITCH_WIDTH" },
  [1250317] = { name = "TRIGGER_GLITCH_CONDITION", values = { [0] = "LESS_THAN", [1] = "GREATER_THAN" } },
  [1250318] = { name = "TRIGGER_VIDEO_DC_RESTORE" },
  [1250319] = {
    name = "TRIGGER_VIDEO_FORMAT",
    values = { [0] = "NTSC", [1] = "PAL", [2] = "SECAM", [3] = "M_PAL" },
  },
  [1250320] = {
    name = "TRIGGER_VIDEO_EVENT",
    values = {
      [0] = "VIDEO_ANY_FIELD",
      [1] = "VIDEO_FIELD1",
      [2] = "VIDEO_FIELD2",
      [3] = "VIDEO_ANY_LINE",
      [4] = "VIDEO_LINE_NUMBER",
    },
  },
  [1250321] = { name = "TRIGGER_VIDEO_LINE" },
  -- Clock, exported signals, signal outputs
  [1250401] = { name = "INPUT_CLOCK_SOURCE" },
  [1250402] = { name = "OUTPUT_CLOCK_SOURCE" },
  [1250403] = { name = "CLOCK_SYNC_PULSE_SOURCE" },
  [1250404] = { name = "MASTER_ENABLED" },
  [1250405] = { name = "SAMPLE_CLOCK_DELAY" },
  [1250410] = { name = "EXPORTED_REF_CLOCK_TERMINAL" },
  [1250411] = { name = "EXPORTED_START_TRIGGER_TERMINAL" },
  [1250412] = { name = "EXPORTED_REF_TRIGGER_TERMINAL" },
  [1250413] = { name = "EXPORTED_END_OF_RECORD_TERMINAL" },
  [1250414] = { name = "EXPORTED_READY_FOR_START_TERMINAL" },
  [1250420] = { name = "PROBE_COMPENSATION_ENABLED" },
  [1250421] = { name = "CABLE_SENSE_ENABLED" },
  -- Instrument
  [1250501] = {
    name = "PRIVILEGE_LEVEL",
    values = {
      [0] = "PRIVILEGE_NONE",
      [1] = "PRIVILEGE_OBSERVE",
      [2] = "PRIVILEGE_CONFIGURE",
      [3] = "PRIVILEGE_CONTROL",
    },
  },
  [1250502] = { name = "MODEL" },
  [1250503] = { name = "SERIAL_NUMBER" },
  [1250504] = { name = "RESOLUTION" },
  [1250505] = { name = "MAX_SAMPLE_RATE" },
  [1250506] = { name = "BANDWIDTH" },
  [1250507] = { name = "DEVICE_TEMPERATURE" },
  [1250508] = { name = "LAST_CAL_TEMPERATURE" },
  [1250509] = { name = "REFERENCE_SESSION" },
  [1250510] = { name = "FETCH_RELATIVE_TO", values = { [0] = "START_RELATIVE", [1] = "TRIGGER_RELATIVE" } },
  [1250511] = { name = "FETCH_OFFSET" },
}

return require("cvmxl_utilities").attributeTable(attributes, "cvmxl_defaultAttrTable")
