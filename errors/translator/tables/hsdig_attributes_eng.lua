-- hsdig_attributes_eng: English names of the digitizer driver's attributes
-- and of the values of its enumerated attributes, used to show attribute
-- ids ("kUsageTypeAttributeId" and its kin) and enum values in error texts.
--
-- Keys are attribute ids (looked up as 8 upper-case hex digits); an entry is
--   [id] = { name = "SHORT_NAME", values = { [value] = "VALUE_NAME", ... } }
-- with `values` only for enumerated attributes. Ids this table lacks are
-- looked up in cvmxl_defaultAttrTable (the attributes every IVI session has).
-- Names are identifiers, not prose; a language table ("hsdig_attributes_fra"
-- ...) exists only where a name must differ, and then has exactly these keys.
--
-- Sections:
--   1. Attributes this system adds to a driver session
--   2. The simulated digitizer's attributes: fill in from its attribute
--      table, one entry per attribute, in id order.

local attributes = {
  -- 1. Attributes this system adds to a driver session -----------------------
  [1199999] = {
    name = "SECM_ATTR_LANGUAGE",
    values = { [0] = "en", [1] = "fr", [2] = "de", [3] = "jp", [4] = "ko", [5] = "ch", [6] = "zz" },
  },

  -- 2. The simulated digitizer's attributes -------------------------------------
}

return require("cvmxl_utilities").attributeTable(attributes, "cvmxl_defaultAttrTable")
