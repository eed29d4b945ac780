/* The status codes of the simulated digitizer: one table,
 * HSDIG_DRIVER_STATUS(X), with X(NAME, code, English text).
 *
 * Every failing driver function returns one of the errors and leaves it in
 * the session's error information (primary error = the code, secondary
 * error = the engine status behind it or 0, elaboration = what exactly was
 * wrong: the argument, the value, the accepted range). A call on a handle
 * that is no session records HSDIG_ERROR_INVALID_SESSION on the calling
 * thread's session 0. Warnings are recorded the same way when no error is
 * pending. The codes lie in the driver's own block 0xBFFA5000..0xBFFA50FF
 * (errors) and 0x3FFA5000..0x3FFA50FF (warnings). */
#ifndef HSDIG_ERRORS_H
#define HSDIG_ERRORS_H

/* clang-format off */
#define HSDIG_DRIVER_STATUS(X) \
  X(HSDIG_ERROR_INVALID_SESSION, 0xBFFA5000, "The session handle does not name an open session of the digitizer driver.") \
  X(HSDIG_ERROR_INVALID_CHANNEL, 0xBFFA5001, "The channel name or channel list is not valid for this instrument.") \
  X(HSDIG_ERROR_INVALID_ATTRIBUTE, 0xBFFA5002, "The attribute id is not an attribute of the digitizer driver.") \
  X(HSDIG_ERROR_ATTRIBUTE_TYPE, 0xBFFA5003, "The attribute has another type than the function reads or writes.") \
  X(HSDIG_ERROR_VALUE_OUT_OF_RANGE, 0xBFFA5004, "A value is outside the range that the instrument accepts.") \
  X(HSDIG_ERROR_NULL_POINTER, 0xBFFA5005, "A required pointer argument is a null pointer.") \
  X(HSDIG_ERROR_BUFFER_TOO_SMALL, 0xBFFA5006, "The buffer is too small for the data.") \
  X(HSDIG_ERROR_FETCH_TIMEOUT, 0xBFFA5007, "The acquisition did not complete within the time-out.") \
  X(HSDIG_ERROR_NO_ACQUISITION, 0xBFFA5008, "No acquisition has been initiated or completed.") \
  X(HSDIG_ERROR_ATTRIBUTE_ACCESS, 0xBFFA5009, "The attribute cannot be written (read-only) or read this way.") \
  X(HSDIG_ERROR_CONFIGURATION_DATA, 0xBFFA500A, "The attribute configuration is damaged, incomplete or made for another model.") \
  X(HSDIG_ERROR_FILE_ACCESS, 0xBFFA500B, "The file cannot be opened, read or written.") \
  X(HSDIG_ERROR_INVALID_REGISTER, 0xBFFA500C, "The register offset or size is not valid, or the register is read-only.") \
  X(HSDIG_ERROR_ACQUISITION_MEMORY, 0xBFFA500D, "The acquisition does not fit in the instrument's memory.") \
  X(HSDIG_ERROR_INVALID_TRIGGER_SOURCE, 0xBFFA500E, "The trigger source or terminal is not valid for this trigger kind or instrument.") \
  X(HSDIG_ERROR_TOO_MANY_WAVEFORMS, 0xBFFA500F, "The channel list and record count yield more waveforms than the outputs hold.") \
  X(HSDIG_ERROR_MEASUREMENT, 0xBFFA5010, "The measurement cannot be made on this waveform.") \
  X(HSDIG_ERROR_INVALID_MODEL, 0xBFFA5011, "The option string names an unknown model or driver-setup item.") \
  X(HSDIG_ERROR_NOT_SUPPORTED, 0xBFFA5012, "The function, sample format or mode is not supported.") \
  X(HSDIG_ERROR_OPTION_STRING, 0xBFFA5013, "The option string is not valid.") \
  X(HSDIG_ERROR_INTERNAL, 0xBFFA5014, "The driver ran out of memory or met an internal failure.") \
  X(HSDIG_WARN_DATA_CLIPPED, 0x3FFA5000, "Some samples reached an edge of the vertical range and are clipped.")
/* clang-format on */

#define HSDIG_STATUS_CODE(NAME, code, text) NAME = (int)code,
enum hsdigStatusCode { HSDIG_DRIVER_STATUS(HSDIG_STATUS_CODE) };
#undef HSDIG_STATUS_CODE

#endif /* HSDIG_ERRORS_H */
