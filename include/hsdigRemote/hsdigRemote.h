/* The public C interface of libhsdigRemote.so.
 *
 * Client role: the hsdigRemote_ functions mirror the digitizer driver's C
 * interface one for one; each call runs remotely in the process that owns
 * the instrument and returns the driver's own status.
 * Server role: the owning process allocates a server for its driver session.
 *
 * Only the names declared with HSDIGREMOTE_API are exported by the library. */
#ifndef HSDIGREMOTE_HSDIGREMOTE_H
#define HSDIGREMOTE_HSDIGREMOTE_H

#include "hsdigRemote/vitypes.h"

#define HSDIGREMOTE_API __attribute__((visibility("default")))

#ifdef __cplusplus
extern "C" {
#endif

/* ---- Errors ----
 * A failing or warning call leaves its error in the session's error
 * information (primary error, secondary error, elaboration); session 0 holds
 * the error of a failed open and of every close. */

/* The pending error of `vi` and its description in the session's language.
 * Text follows the IVI string rule: bufferSize 0 returns the size needed; a
 * smaller buffer receives a truncated, terminated text and the size needed
 * is returned; a negative size promises a big enough buffer. The pending
 * error is not cleared. */
HSDIGREMOTE_API ViStatus hsdigRemote_GetError(ViSession vi, ViStatus* errorCode, ViInt32 bufferSize,
                                              ViChar description[]);
/* The text of any status code, without contacting the server. bufferSize 0
 * returns the text length; otherwise at most bufferSize bytes are written,
 * zero-filled after a shorter text. A negative size gives 0xBFFA000F. */
HSDIGREMOTE_API ViStatus hsdigRemote_GetErrorMessage(ViSession vi, ViStatus errorCode,
                                                     ViInt32 bufferSize, ViChar message[]);
/* Clears the pending error of `vi`. */
HSDIGREMOTE_API ViStatus hsdigRemote_ClearError(ViSession vi);
/* The same for the graphical development environment. */
HSDIGREMOTE_API ViStatus hsdigRemote_QLGetError(ViSession vi, ViStatus* errorCode,
                                                ViInt32 bufferSize, ViChar description[]);
HSDIGREMOTE_API ViStatus hsdigRemote_QLGetErrorMessage(ViSession vi, ViStatus errorCode,
                                                       ViInt32 bufferSize, ViChar message[]);

#ifdef __cplusplus
} /* extern "C" */
#endif

#endif /* HSDIGREMOTE_HSDIGREMOTE_H */
