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

#endif /* HSDIGREMOTE_HSDIGREMOTE_H */
