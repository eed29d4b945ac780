/* The digitizer driver's C interface as the remoting server calls it: the
 * 103 hsdig_ functions (the table in hsdigFunctions.h), the two records
 * that cross the interface, the attribute ids, values and measurement ids
 * (hsdigAttributes.h) and the status codes (hsdigErrors.h).
 *
 * libhsdig.so, the simulated digitizer in outside/digitizer, implements it;
 * its README describes the models, the signals and the behaviour behind
 * these declarations. Sessions are IVI engine sessions: each function takes
 * the engine's session lock for its whole run, so calls on one session are
 * serialised and calls on different sessions run in parallel. */
#ifndef HSDIG_H
#define HSDIG_H

#include "hsdigAttributes.h"
#include "hsdigErrors.h"
#include "hsdigFunctions.h"
#include "hsdigRemote/vitypes.h"

#ifdef __cplusplus
extern "C" {
#endif

#define HSDIG_DRIVER_API __attribute__((visibility("default")))

/* Timing and scaling of one fetched record (waveform). The fetch functions
 * fill one entry per record; an entry left all zero means "no record".
 * volts = sample x gain + offset for the binary formats; gain 1 and offset 0
 * for the scaled ones. Times in seconds: relativeInitialX is the time of the
 * first sample relative to the trigger, absoluteInitialX the same instant
 * relative to the start of the session. */
typedef struct hsdigWfmInfo {
  ViReal64 absoluteInitialX;
  ViReal64 relativeInitialX;
  ViReal64 xIncrement;
  ViInt32 actualSamples;
  ViInt32 reservedPadding; /* always 0 */
  ViReal64 offset;
  ViReal64 gain;
  ViReal64 reserved1;
  ViReal64 reserved2;
} hsdigWfmInfo;

/* One set of scaling or normalization coefficients: value = code x gain +
 * offset. */
typedef struct hsdigCoefficientInfo {
  ViReal64 offset;
  ViReal64 gain;
  ViReal64 reserved1;
  ViReal64 reserved2;
} hsdigCoefficientInfo;

#define HSDIG_DECLARE(name, params, args) HSDIG_DRIVER_API ViStatus hsdig_##name params;
HSDIG_DRIVER_FUNCTIONS(HSDIG_DECLARE)
HSDIG_HOST_FUNCTIONS(HSDIG_DECLARE)
#undef HSDIG_DECLARE

/* The number of functions in HSDIG_DRIVER_FUNCTIONS. */
#define HSDIG_DRIVER_FUNCTION_COUNT 103

#ifdef __cplusplus
} /* extern "C" */

#include <cstddef>
static_assert(sizeof(hsdigWfmInfo) == 64, "the timing record is 64 bytes");
static_assert(offsetof(hsdigWfmInfo, absoluteInitialX) == 0 &&
                  offsetof(hsdigWfmInfo, relativeInitialX) == 8 &&
                  offsetof(hsdigWfmInfo, xIncrement) == 16 &&
                  offsetof(hsdigWfmInfo, actualSamples) == 24 &&
                  offsetof(hsdigWfmInfo, offset) == 32 && offsetof(hsdigWfmInfo, gain) == 40 &&
                  offsetof(hsdigWfmInfo, reserved1) == 48 &&
                  offsetof(hsdigWfmInfo, reserved2) == 56,
              "timing record layout");
static_assert(sizeof(hsdigCoefficientInfo) == 32 && offsetof(hsdigCoefficientInfo, gain) == 8 &&
                  offsetof(hsdigCoefficientInfo, reserved2) == 24,
              "coefficient record layout");
#else
_Static_assert(sizeof(hsdigWfmInfo) == 64, "the timing record is 64 bytes");
_Static_assert(sizeof(hsdigCoefficientInfo) == 32, "the coefficient record is 32 bytes");
#endif

#endif /* HSDIG_H */
