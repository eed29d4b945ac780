/* The scalar and string types of the digitizer driver's C interface.
 *
 * Both roles of the library use them unchanged: the client exports take and
 * return them, and the server hands them to the driver. Widths are fixed by
 * the interface, not by the platform, and are pinned below. */
#ifndef HSDIGREMOTE_VITYPES_H
#define HSDIGREMOTE_VITYPES_H

#include <stdint.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef uint64_t ViUInt64;
typedef int64_t ViInt64;
typedef uint32_t ViUInt32;
typedef int32_t ViInt32;
typedef uint16_t ViUInt16;
typedef int16_t ViInt16;
typedef uint8_t ViUInt8;
typedef int8_t ViInt8;
typedef char ViChar;
typedef unsigned char ViByte;
typedef void* ViAddr;
typedef float ViReal32;
typedef double ViReal64;

typedef ViUInt16 ViBoolean; /* 0 false, 1 true */
typedef ViInt32 ViStatus;   /* negative error, positive warning, 0 success */
typedef ViUInt32 ViVersion;
typedef ViUInt32 ViObject;
typedef ViObject ViSession; /* session handle; 0 is no session */
typedef ViUInt32 ViAttr;    /* attribute id */

typedef ViChar* ViString;
typedef const ViChar* ViConstString;
typedef ViString ViRsrc;
typedef ViConstString ViConstRsrc;
typedef ViByte* ViBuf;
typedef const ViByte* ViConstBuf;

typedef ViUInt64* ViPUInt64;
typedef ViInt64* ViPInt64;
typedef ViUInt32* ViPUInt32;
typedef ViInt32* ViPInt32;
typedef ViUInt16* ViPUInt16;
typedef ViInt16* ViPInt16;
typedef ViReal32* ViPReal32;
typedef ViReal64* ViPReal64;
typedef ViBoolean* ViPBoolean;
typedef ViStatus* ViPStatus;
typedef ViSession* ViPSession;
typedef ViAttr* ViPAttr;
typedef ViChar* ViPChar;
typedef ViAddr* ViPAddr;

typedef ViInt32 ViAInt32[];
typedef ViReal64 ViAReal64[];

#define VI_NULL 0
#define VI_TRUE ((ViBoolean)1)
#define VI_FALSE ((ViBoolean)0)
#define VI_SUCCESS ((ViStatus)0)

#ifdef __cplusplus
} /* extern "C" */

static_assert(sizeof(ViBoolean) == 2, "ViBoolean is 16 bits");
static_assert(sizeof(ViSession) == 4 && ViSession(-1) > 0, "ViSession is unsigned 32 bits");
static_assert(sizeof(ViStatus) == 4 && ViStatus(-1) < 0, "ViStatus is signed 32 bits");
static_assert(sizeof(ViInt64) == 8 && sizeof(ViReal64) == 8, "64-bit scalars");
static_assert(sizeof(ViAttr) == 4, "ViAttr is 32 bits");
#else
_Static_assert(sizeof(ViBoolean) == 2, "ViBoolean is 16 bits");
_Static_assert(sizeof(ViSession) == 4, "ViSession is 32 bits");
_Static_assert(sizeof(ViStatus) == 4, "ViStatus is 32 bits");
#endif

#endif /* HSDIGREMOTE_VITYPES_H */
