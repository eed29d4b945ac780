-- commonTerms_eng: English texts of the keys in structured error
-- descriptions. Always present; every other language falls back to it, and a
-- key missing here is shown as the key itself.
--
-- Sections:
--   1. Usage types: the key shown before ": " and the value
--   2. DriverSetup and session-information messages (elaborations)
--   3. Other elaboration texts (the key is the English text)
--   4. Debug item keys
-- Every other language table ("commonTerms_fra", ...) has exactly these keys.

local entries = {
  -- 1. Usage types -------------------------------------------------------------
  kUsageTypeAffectedAttribute = "Affected attribute",
  kUsageTypeAttributeId = "Attribute",
  kUsageTypeAttributeIdentifier = "Attribute identifier",
  kUsageTypeConflictingAttr = "Conflicting attribute",
  kUsageTypeConflictingProperty = "Conflicting property",
  kUsageTypeDevice = "Device",
  kUsageTypeFilePath = "File path",
  kUsageTypeInvalidIdentifier = "Invalid identifier",
  kUsageTypeParameterName = "Parameter name",
  kUsageTypeRequestedDeviceName = "Requested device name",
  kUsageTypeRequestedValue = "Requested value",
  kUsageTypeUnspecifiedProperty = "Unspecified property",
  kSidlUsageTypeErrno = "Value of errno from system call.",

  -- 2. DriverSetup and session-information messages ---------------------------
  kSidlSetupContainsEqual = "DriverSetup string cannot contain a '='",
  kSidlSetupNotParsed = "DriverSetup string cannot be parsed! Please refer to documentation for the string format.",
  kSidlInvalidTag = "Invalid DriverSetup tag",
  kSidlRepeatedTag = "Repeated DriverSetup tag.",
  kSidlNotInteger = "DriverSetup value is not an integer.",
  kSidlNotBoolean = "DriverSetup value is not a boolean. Please use either 0 or 1.",
  kSidlNoTag = "DriverSetup tag is not specified. Please check the DriverSetup string.",
  kSidlNoValue = "DriverSetup contains an entry with no value.",
  kSidlInvalidLanguage = "The language specified in DriverSetup is invalid.",
  kSidlInvalidResourceName = "Invalid resource name.",
  kSidlRepeatedResourceName = "The DriverSetup string contains repeated resource names. Only list a resource " ..
    "name once in the DriverSetup.",
  kSidlNoResourceName = "The DriverSetup tag in the Option String is missing the ResourceName field. Refer to " ..
    "the Option String documentation for the accepted string format.",
  kSidlInvalidFileHandle = "Invalid file handle.",
  kSidlInitialization = "The session information could not be initialized.",
  kSidlMaxNumSessionsExceeded = "The maximum number of sessions has been exceeded.",
  kSidlSharedMemMutex = "The lock of the shared session information could not be acquired.",

  -- 3. Other elaboration texts --------------------------------------------------
  ["Oversized session information table data section"] = "Oversized session information table data section",
  ["You must set the CloseFunctionPtr prior to calling any functions."] =
    "You must set the CloseFunctionPtr prior to calling any functions.",
  ["Windows generated an error"] = "The operating system reported an error",
  ["Windows Error Code:"] = "System error code",
  ["Windows Error Message:"] = "System error message",

  -- 4. Debug item keys ----------------------------------------------------------
  Component = "Component",
  File = "File",
  Line = "Line",
  ["Internal Error"] = "Internal error",
  -- The parts of a description the translator did not use, shown as JSON;
  -- the key is a name and stays the same in every language.
  rest_of_input_json = "rest_of_input_json",
}

return require("cvmxl_utilities").stringTable(entries)
