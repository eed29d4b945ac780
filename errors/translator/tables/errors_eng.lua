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
  [0xBFFA0009] = "A function that this operation needs is missing from the IVI engine library or the " ..
    "driver library.",
  [0xBFFA000F] = "Invalid parameter. A parameter of the function has a value that is not allowed, " ..
    "for example a negative buffer size or a missing output pointer.",
  [0xBFFA0010] = "Invalid value. A parameter or attribute has a value out of range, for example a " ..
    "requested number of samples or points, or a record longer than the number of samples requested.",
  [0xBFFA0013] = "The value is not supported. The requested data type or size cannot be handled by this " ..
    "operation.",
  [0xBFFA004A] = "The option string contains an unknown option name or could not be changed. Check the " ..
    "syntax of the option string and of its DriverSetup entry.",
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
  -- Codes the engine shares with section 1 (0xBFFA0000, 0xBFFA0009, 0xBFFA000F,
  -- 0xBFFA0010, 0xBFFA0013, 0xBFFA004A, 0xBFFA004C, 0xBFFA0058) and section 2
  -- (0xBFFA1190) keep their text there. The engine defines no warnings.
  [0xBFFA0002] = "A file could not be opened, for example because it does not exist or this " ..
    "process may not read it.",
  [0xBFFA0003] = "An error occurred while reading a file.",
  [0xBFFA000C] = "The attribute ID is not recognized by the IVI engine session.",
  [0xBFFA000D] = "The attribute is read-only and cannot be set.",
  [0xBFFA000E] = "The attribute is write-only and cannot be read.",
  [0xBFFA0011] = "The function is not supported by the IVI engine.",
  [0xBFFA0012] = "The attribute is not supported by this session.",
  [0xBFFA0014] = "The type is not a valid attribute type.",
  [0xBFFA0015] = "The attribute and the function that reads or writes it do not have the same data type.",
  [0xBFFA0017] = "The item already exists, for example an attribute or a channel name added twice.",
  [0xBFFA0018] = "The logical-name configuration file contains a line that is not valid.",
  [0xBFFA001B] = "The attribute has no range table.",
  [0xBFFA001C] = "The range table is not valid.",
  [0xBFFA001F] = "The session has no channel table.",
  [0xBFFA0020] = "The channel name or repeated capability name is not known to the session.",
  [0xBFFA0021] = "A system resource could not be allocated.",
  [0xBFFA0030] = "The calling thread does not hold the lock of the session.",
  [0xBFFA0031] = "The attribute needs a channel name or repeated capability name.",
  [0xBFFA0032] = "The attribute does not take a channel name or repeated capability name.",
  -- Parameter position errors: parameter 1 to 8 of the function has an invalid value.
  [0xBFFC0001] = "Parameter 1 of the function has an invalid value.",
  [0xBFFC0002] = "Parameter 2 of the function has an invalid value.",
  [0xBFFC0003] = "Parameter 3 of the function has an invalid value.",
  [0xBFFC0004] = "Parameter 4 of the function has an invalid value.",
  [0xBFFC0005] = "Parameter 5 of the function has an invalid value.",
  [0xBFFC0006] = "Parameter 6 of the function has an invalid value.",
  [0xBFFC0007] = "Parameter 7 of the function has an invalid value.",
  [0xBFFC0008] = "Parameter 8 of the function has an invalid value.",

  -- 7. The simulated digitizer driver's own codes ------------------------------
  -- Errors 0xBFFA5000 to 0xBFFA5014, then warnings from 0x3FFA5000.
  [0xBFFA5000] = "The session handle does not name an open session of the digitizer driver.",
  [0xBFFA5001] = "The channel name or channel list is not valid for this instrument.",
  [0xBFFA5002] = "The attribute ID is not an attribute of the digitizer driver, or the instrument does " ..
    "not support it.",
  [0xBFFA5003] = "The attribute has a different data type than the function that reads or writes it.",
  [0xBFFA5004] = "A value is outside the range that the instrument accepts.",
  [0xBFFA5005] = "A required pointer argument is a null pointer.",
  [0xBFFA5006] = "The buffer is too small to hold the data.",
  [0xBFFA5007] = "The acquisition did not complete within the time-out, or it cannot complete while the " ..
    "fetch waits for it.",
  [0xBFFA5008] = "No acquisition has been initiated or completed, so there is no data to return.",
  [0xBFFA5009] = "The attribute cannot be written because it is read-only, or cannot be read because it " ..
    "is write-only.",
  [0xBFFA500A] = "The saved attribute configuration is damaged, incomplete or made for another model.",
  [0xBFFA500B] = "The file cannot be opened, read or written.",
  [0xBFFA500C] = "The register offset or size is not valid, or the register is read-only.",
  [0xBFFA500D] = "The records of the acquisition need more samples per channel than the acquisition " ..
    "memory of the instrument holds.",
  [0xBFFA500E] = "The trigger source or terminal is not valid for this kind of trigger or for this " ..
    "instrument.",
  [0xBFFA500F] = "The channel list and the number of records do not give the number of waveforms that " ..
    "the operation needs, for example exactly one for a scalar measurement.",
  [0xBFFA5010] = "The measurement cannot be made on this waveform.",
  [0xBFFA5011] = "The DriverSetup entry of the option string names a model that the driver does not know.",
  [0xBFFA5012] = "The function, sample format or mode is not supported.",
  [0xBFFA5013] = "The option string is not valid: it contains an unknown option name or an invalid value.",
  [0xBFFA5014] = "The driver ran out of memory or system resources, or met an internal failure.",
  [0x3FFA5000] = "Some samples reached an edge of the vertical range and were clipped.",
}

return require("cvmxl_utilities").stringTable(entries)
