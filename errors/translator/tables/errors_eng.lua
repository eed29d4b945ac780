-- errors_eng: English static descriptions of status codes.
--
-- Keys are status codes, written as the driver reports them (0xBFFA...
-- literals) or, for infrastructure codes, as their original value before
-- mapping (-52000 ...): a mapped code is looked up by its original value.
-- Every other language table ("errors_fra", "errors_deu", "errors_jpn",
-- "errors_kor", "errors_chs") has exactly these keys.
--
-- Sections, in order:
--   1. IVI engine status codes that this system raises
--   2. Remoting layer: sessions, reservation and privileges
--   3. Remoting layer: transport and protocol
--   4. Infrastructure codes (mapped into 0xBFFA9400 to 0xBFFA9500)
--   5. Host-environment and system codes
--   6. The stand-in IVI engine's own codes (add them here)
--   7. The simulated digitizer driver's own codes (add them here)

local entries = {
  -- 1. IVI engine status codes that this system raises ----------------------
  [0xBFFA0000] = "Unrecoverable failure. The IVI engine library could not be loaded, or it failed in a way " ..
    "that the driver cannot recover from.",
  [0xBFFA0009] = "A function that this operation needs is missing from the IVI engine library.",
  [0xBFFA000F] = "Invalid parameter. A parameter of the function has a value that is not allowed, " ..
    "for example a negative buffer size or a missing output pointer.",
  [0xBFFA0010] = "Invalid value. A requested number of samples or points is out of range, or a record is " ..
    "longer than the number of samples requested.",
  [0xBFFA0013] = "The value is not supported. The requested data type or size cannot be handled by this " ..
    "operation.",
  [0xBFFA004A] = "The option string could not be changed. Check the syntax of the option string and of " ..
    "its DriverSetup entry.",
  [0xBFFA004C] = "The option string or its DriverSetup entry contains an invalid value.",
  [0xBFFA0056] = "The system ran out of memory or could not create a shared resource.",
  [0xBFFA0058] = "A required pointer parameter is NULL.",
  [0xBFFA0060] = "The resource name or logical name is not known to the system configuration.",

  -- 2. Remoting layer: sessions, reservation and privileges -----------------
  [0xBFFA1190] = "The session handle is not valid. The session was never opened or has already been closed.",
  [0xBFFA402B] = "The waveform request returns more than one record, but multiple records are not " ..
    "allowed for this call.",
  [0xBFFA402E] = "The resource is reserved by another process, or the session does not have the " ..
    "privilege that this operation needs.",
  [0xBFFA40BA] = "The fetch, read or query operation failed in the process that owns the instrument.",
  [0xBFFA8BF0] = "The debug session settings of the devices are not identical. All devices used " ..
    "together must have the same debug session settings.",
  [0xBFFA8CF0] = "The DriverSetup entry of the option string does not name its resources correctly.",
  [0xBFFA9175] = "The resource name is ambiguous: more than one device matches it.",
  [0xBFFA9178] = "A server for this resource already exists for another driver session.",
  [0xBFFA9181] = "The session does not have enough privilege for this operation. Another session " ..
    "controls the instrument.",
  [0xBFFA9182] = "The operation failed in the process that owns the instrument.",

  -- 3. Remoting layer: transport and protocol --------------------------------
  [0xBFFA914E] = "The remote call failed: the server answered with an application error, for example " ..
    "a missing result or a reply out of sequence.",
  [0xBFFA914F] = "The remote call failed: the message could not be encoded or decoded.",
  [0xBFFA9150] = "The remote call failed: the message contains invalid data.",
  [0xBFFA9151] = "The remote call failed: the message contains a negative size.",
  [0xBFFA9152] = "The remote call failed: the message exceeds a size limit.",
  [0xBFFA9153] = "The remote call failed: the message has a protocol version that is not supported.",
  [0xBFFA9154] = "The remote call failed: the message uses a protocol feature that is not implemented.",
  [0xBFFA9155] = "The remote call failed: the connection to the server reported an error.",
  [0xBFFA9156] = "The connection to the server could not be opened. Make sure that the process that " ..
    "owns the instrument is running.",
  [0xBFFA9157] = "The connection to the server timed out.",
  [0xBFFA9158] = "The connection to the server was closed unexpectedly.",
  [0xBFFA9159] = "The connection to the server was interrupted.",
  [0xBFFA915A] = "The connection to the server was used with invalid arguments.",
  [0xBFFA915B] = "The data received from the server is corrupted.",
  [0xBFFA915C] = "The connection to the server failed because of an internal error.",

  -- 4. Infrastructure codes (original values; reported as 0xBFFA9400 + n) ----
  [-52000] = "Not enough memory is available to complete the operation.",
  [-52003] = "An internal error occurred.",
  [-52005] = "An invalid handle or argument was passed to an internal function.",
  [-52006] = "The file handle is invalid or the file could not be opened.",
  [-52008] = "A system call failed.",
  [-52027] = "The text could not be converted between character encodings.",
  [-52029] = "The error description has a format that is not supported.",

  -- 5. Host-environment and system codes -------------------------------------
  [0xBFFF0000] = "An unexpected system error occurred.",
  [0xBFFF0011] = "The device was not found, or it is not a device that this driver supports.",
  [0xBFFF003C] = "Not enough memory is available to resize the array.",
  [0xBFFF0078] = "The array could not be resized: the memory manager of the host environment refused " ..
    "the request.",

  -- 6. The stand-in IVI engine's own codes -------------------------------------

  -- 7. The simulated digitizer driver's own codes ------------------------------
}

return require("cvmxl_utilities").stringTable(entries)
