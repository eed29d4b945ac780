/* The IVI engine's C interface: sessions, attributes, locks, error
 * information, channel and repeated-capability tables, range tables.
 *
 * A specific driver (the simulated digitizer) keeps its sessions here: it
 * creates them with Ivi_SpecificDriverNew, defines its attributes with
 * Ivi_AddAttribute..., reads and writes them with Ivi_Get/Set/CheckAttribute...
 * and records failures with Ivi_SetErrorInfo. The remoting library reaches the
 * engine only through its run-time binding (dlopen of "libcvivi.so").
 *
 * IVI_ENGINE_FUNCTIONS below is the one table of engine functions. Each row:
 *   X(C name, wrapper operation name, REQ|OPT, STATUS|VALUE|CLASS,
 *     IMPL|NSUP, return type, S|N, (parameters), (argument names))
 * - REQ/OPT: whether the binding refuses an engine that lacks the function.
 * - STATUS: returns a status (negative error, positive warning, 0 success);
 *   VALUE: returns a value; CLASS: a class-driver check (a status, bound like
 *   a value).
 * - IMPL/NSUP: NSUP functions exist but answer IVI_ERROR_FUNCTION_NOT_SUPPORTED
 *   (value-returning ones answer 0).
 * - S: the first parameter is the session; N: no session parameter.
 * The table drives the declarations below, the stand-in's not-supported
 * bodies, the remoting library's binding and its IviWrapper operations, in
 * this order.
 *
 * Strings are NUL-terminated. Outputs named buffer/bufferSize follow the IVI
 * string rule: size 0 returns the size needed (with terminator) and writes
 * nothing; a smaller buffer receives a truncated, terminated text and the call
 * returns the size needed; a big enough buffer receives the whole text and the
 * call returns 0. Every function is safe to call from any thread. */
#ifndef IVI_ENGINE_H
#define IVI_ENGINE_H

#include "hsdigRemote/vitypes.h"

#ifdef __cplusplus
extern "C" {
#endif

#define IVI_ENGINE_API __attribute__((visibility("default")))

/* ---- Value types (Ivi_GetAttributeType, Ivi_ValidateAttribute) ---- */
#define IVI_VAL_INT32 1
#define IVI_VAL_REAL64 4
#define IVI_VAL_STRING 5
#define IVI_VAL_ADDR 10
#define IVI_VAL_SESSION 11
#define IVI_VAL_BOOLEAN 13
#define IVI_VAL_INT64 14

/* ---- Attribute flags (Ivi_AddAttribute..., Ivi_Get/SetAttributeFlags) ---- */
#define IVI_VAL_NOT_SUPPORTED 0x0001     /* every access fails */
#define IVI_VAL_NOT_READABLE 0x0002      /* no read at all */
#define IVI_VAL_NOT_WRITABLE 0x0004      /* no write at all */
#define IVI_VAL_NOT_USER_READABLE 0x0008 /* no read with IVI_VAL_DIRECT_USER_CALL */
#define IVI_VAL_NOT_USER_WRITABLE 0x0010 /* no write with IVI_VAL_DIRECT_USER_CALL */
#define IVI_VAL_HIDDEN (IVI_VAL_NOT_USER_READABLE | IVI_VAL_NOT_USER_WRITABLE)
#define IVI_VAL_NEVER_CACHE 0x0020   /* every get calls the read callback */
#define IVI_VAL_ALWAYS_CACHE 0x0040  /* cached even when caching is off */
#define IVI_VAL_MULTI_CHANNEL 0x0800 /* one value per channel */

/* ---- Option flags of Ivi_Set/Get/CheckAttribute... ---- */
#define IVI_VAL_DIRECT_USER_CALL \
  0x0001 /* the driver's user asked: user flags apply, marks set by user */
#define IVI_VAL_SET_CACHE_ONLY 0x0002 /* store the value without the write callback */
#define IVI_VAL_DONT_MARK_AS_SET_BY_USER 0x0004

/* ---- Engine attributes present in every session ---- */
#define IVI_ATTR_CACHE 1050004                   /* ViBoolean, option "Cache" */
#define IVI_ATTR_RANGE_CHECK 1050002             /* ViBoolean, option "RangeCheck" */
#define IVI_ATTR_QUERY_INSTRUMENT_STATUS 1050003 /* ViBoolean, option "QueryInstrStatus" */
#define IVI_ATTR_RECORD_COERCIONS 1050006        /* ViBoolean, option "RecordCoercions" */
#define IVI_ATTR_SIMULATE 1050005                /* ViBoolean, option "Simulate" */
#define IVI_ATTR_INTERCHANGE_CHECK 1050021       /* ViBoolean, option "InterchangeCheck" */
#define IVI_ATTR_DRIVER_SETUP 1050007            /* ViString, option "DriverSetup" */
#define IVI_ATTR_SPY 1050022                     /* ViBoolean, always false */
#define IVI_ATTR_USE_SPECIFIC_SIMULATION 1050023 /* ViBoolean, follows "Simulate" */
#define IVI_ATTR_PRIMARY_ERROR 1050101           /* ViInt32 */
#define IVI_ATTR_SECONDARY_ERROR 1050102         /* ViInt32 */
#define IVI_ATTR_ERROR_ELABORATION 1050103       /* ViString */
#define IVI_ATTR_CHANNEL_COUNT 1050203           /* ViInt32, size of the channel table */
#define IVI_ATTR_SPECIFIC_DRIVER_PREFIX 1050302  /* ViString */
#define IVI_ATTR_IO_RESOURCE_DESCRIPTOR 1050304  /* ViString, set by the driver */
#define IVI_ATTR_LOGICAL_NAME 1050305            /* ViString, set by the driver */
#define IVI_ATTR_IO_SESSION 1050322              /* ViSession, Ivi_IOSession */

/* The repeated capability that Ivi_BuildChannelTable fills. */
#define IVI_REPCAP_CHANNEL "Channel"

/* ---- Status codes of the engine ---- */
#define IVI_ERROR_BASE ((ViStatus)0xBFFA0000)
#define IVI_ERROR_CANNOT_RECOVER ((ViStatus)0xBFFA0000)
#define IVI_ERROR_CANNOT_OPEN_FILE ((ViStatus)0xBFFA0002)
#define IVI_ERROR_READING_FILE ((ViStatus)0xBFFA0003)
#define IVI_ERROR_FUNCTION_NOT_FOUND ((ViStatus)0xBFFA0009)
#define IVI_ERROR_INVALID_ATTRIBUTE ((ViStatus)0xBFFA000C)
#define IVI_ERROR_ATTRIBUTE_NOT_WRITABLE ((ViStatus)0xBFFA000D)
#define IVI_ERROR_ATTRIBUTE_NOT_READABLE ((ViStatus)0xBFFA000E)
#define IVI_ERROR_INVALID_PARAMETER ((ViStatus)0xBFFA000F)
#define IVI_ERROR_INVALID_VALUE ((ViStatus)0xBFFA0010)
#define IVI_ERROR_FUNCTION_NOT_SUPPORTED ((ViStatus)0xBFFA0011)
#define IVI_ERROR_ATTRIBUTE_NOT_SUPPORTED ((ViStatus)0xBFFA0012)
#define IVI_ERROR_VALUE_NOT_SUPPORTED ((ViStatus)0xBFFA0013)
#define IVI_ERROR_INVALID_TYPE ((ViStatus)0xBFFA0014)
#define IVI_ERROR_TYPES_DO_NOT_MATCH ((ViStatus)0xBFFA0015)
#define IVI_ERROR_ITEM_ALREADY_EXISTS ((ViStatus)0xBFFA0017)
#define IVI_ERROR_INVALID_CONFIGURATION ((ViStatus)0xBFFA0018)
#define IVI_ERROR_NO_RANGE_TABLE ((ViStatus)0xBFFA001B)
#define IVI_ERROR_INVALID_RANGE_TABLE ((ViStatus)0xBFFA001C)
#define IVI_ERROR_NO_CHANNEL_TABLE ((ViStatus)0xBFFA001F)
#define IVI_ERROR_UNKNOWN_CHANNEL_NAME ((ViStatus)0xBFFA0020)
#define IVI_ERROR_SYS_RSRC_ALLOC ((ViStatus)0xBFFA0021)
#define IVI_ERROR_SESSION_NOT_LOCKED ((ViStatus)0xBFFA0030)
#define IVI_ERROR_CHANNEL_NAME_REQUIRED ((ViStatus)0xBFFA0031)
#define IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED ((ViStatus)0xBFFA0032)
#define IVI_ERROR_BAD_OPTION_NAME ((ViStatus)0xBFFA004A)
#define IVI_ERROR_BAD_OPTION_VALUE ((ViStatus)0xBFFA004C)
#define IVI_ERROR_NULL_POINTER ((ViStatus)0xBFFA0058)
#define IVI_ERROR_INVALID_SESSION_HANDLE ((ViStatus)0xBFFA1190)
/* Ivi_ParamPositionError: positions 1 to 8; any other position gives
 * IVI_ERROR_INVALID_PARAMETER. */
#define IVI_ERROR_PARAMETER1 ((ViStatus)0xBFFC0001)
#define IVI_ERROR_PARAMETER8 ((ViStatus)0xBFFC0008)

/* Ivi_GetErrorMessage and the buffers of Ivi_GetInfoFromResourceName hold
 * this many characters with the terminator. */
#define IVI_MAX_MESSAGE_BUF_SIZE 256
#define IVI_MAX_RESOURCE_BUF_SIZE 256

/* ---- Range tables ---- */
#define IVI_VAL_DISCRETE 0 /* the value must equal an entry */
#define IVI_VAL_RANGED 1   /* the value must lie within an entry's [min, max] */
#define IVI_VAL_COERCED 2  /* within an entry's [min, max]; coerced to its coercedValue */

/* Marks the entry after the last one (cmdString of the end entry). */
#define IVI_RANGE_TABLE_END_STRING ((ViString)(-1))

typedef struct IviRangeTableEntry {
  ViReal64 discreteOrMinValue;
  ViReal64 maxValue;
  ViReal64 coercedValue;
  ViString cmdString; /* IVI_RANGE_TABLE_END_STRING in the end entry */
  ViInt32 cmdValue;
  /* The same values for 64-bit integer attributes; Ivi_SetRangeTableEntry
   * and Ivi_SetRangeTableEntryViInt64 fill both forms. */
  ViInt64 discreteOrMinValueViInt64;
  ViInt64 maxValueViInt64;
  ViInt64 coercedValueViInt64;
} IviRangeTableEntry;

typedef struct IviRangeTable {
  ViInt32 type; /* IVI_VAL_DISCRETE, IVI_VAL_RANGED or IVI_VAL_COERCED */
  ViBoolean hasMin;
  ViBoolean hasMax;
  ViString customInfo;
  IviRangeTableEntry* rangeValues; /* ends with the end entry */
} IviRangeTable;
typedef IviRangeTable* IviRangeTablePtr;

/* A value/name table for Ivi_GetStringFromTable; ends with a NULL string. */
typedef struct IviStringValueTableEntry {
  ViInt32 value;
  ViConstString string;
} IviStringValueTableEntry;
typedef IviStringValueTableEntry* IviStringValueTable;

/* Ivi_GetViReal64Type and Ivi_GetPtrToSpecialViReal64Value */
#define IVI_VAL_TYPE_NORMAL 0
#define IVI_VAL_TYPE_NAN 1
#define IVI_VAL_TYPE_PINF 2
#define IVI_VAL_TYPE_NINF 3

/* Ivi_SetAttrCallback / Ivi_GetAttrCallback kinds */
#define IVI_CALLBACK_READ 0
#define IVI_CALLBACK_WRITE 1
#define IVI_CALLBACK_CHECK 2
#define IVI_CALLBACK_COERCE 3
#define IVI_CALLBACK_COMPARE 4

/* ---- Callbacks ----
 * Called with the session lock held, so a callback may call the engine on
 * the same session. Read callbacks of string attributes deliver their value
 * with Ivi_SetValInStringCallback; string coerce callbacks likewise deliver the
 * coerced value (otherwise the value stays as given). Compare callbacks store
 * 0 in *result when the two values count as equal. */
#define IVI_DECLARE_CALLBACKS(T, In)                                                               \
  typedef ViStatus (*IviReadCallback##T)(ViSession vi, ViSession io, ViConstString channelName,    \
                                         ViAttr attributeId, Vi##T##Out value);                    \
  typedef ViStatus (*IviWriteCallback##T)(ViSession vi, ViSession io, ViConstString channelName,   \
                                          ViAttr attributeId, In value);                           \
  typedef ViStatus (*IviCheckCallback##T)(ViSession vi, ViConstString channelName,                 \
                                          ViAttr attributeId, In value);                           \
  typedef ViStatus (*IviCoerceCallback##T)(ViSession vi, ViConstString channelName,                \
                                           ViAttr attributeId, In value, Vi##T##Out coercedValue); \
  typedef ViStatus (*IviCompareCallback##T)(ViSession vi, ViConstString channelName,               \
                                            ViAttr attributeId, In coercedNewValue, In cacheValue, \
                                            ViInt32 * result);
typedef ViInt32* ViViInt32Out;
typedef ViInt64* ViViInt64Out;
typedef ViReal64* ViViReal64Out;
typedef ViConstString ViViStringOut; /* strings: the current value, read only */
typedef ViBoolean* ViViBooleanOut;
typedef ViSession* ViViSessionOut;
typedef ViAddr* ViViAddrOut;
IVI_DECLARE_CALLBACKS(ViInt32, ViInt32)
IVI_DECLARE_CALLBACKS(ViInt64, ViInt64)
IVI_DECLARE_CALLBACKS(ViReal64, ViReal64)
IVI_DECLARE_CALLBACKS(ViString, ViConstString)
IVI_DECLARE_CALLBACKS(ViBoolean, ViBoolean)
IVI_DECLARE_CALLBACKS(ViSession, ViSession)
IVI_DECLARE_CALLBACKS(ViAddr, ViAddr)
#undef IVI_DECLARE_CALLBACKS
typedef ViStatus (*IviRangeTableCallback)(ViSession vi, ViConstString channelName,
                                          ViAttr attributeId, IviRangeTablePtr* rangeTable);

/* clang-format off */
#define IVI_ENGINE_FUNCTIONS(X) \
  /* Sessions and drivers */ \
  X(Ivi_SpecificDriverNew, specificDriverNew, REQ, STATUS, IMPL, ViStatus, N, (ViConstString driverPrefix, ViConstString optionString, ViSession* newVi), (driverPrefix, optionString, newVi)) \
  X(Ivi_ApplyDefaultSetup, applyDefaultSetup, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_GetSpecificDriverStatusDesc, getSpecificDriverStatusDesc, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViStatus statusCode, ViInt32 bufferSize, ViChar buffer[]), (vi, statusCode, bufferSize, buffer)) \
  X(Ivi_NeedToCheckStatus, needToCheckStatus, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_SetNeedToCheckStatus, setNeedToCheckStatus, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean needToCheck), (vi, needToCheck)) \
  X(Ivi_QueueInstrSpecificError, queueInstrSpecificError, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 errorCode, ViConstString errorMessage), (vi, errorCode, errorMessage)) \
  X(Ivi_DequeueInstrSpecificError, dequeueInstrSpecificError, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32* errorCode, ViInt32 bufferSize, ViChar errorMessage[]), (vi, errorCode, bufferSize, errorMessage)) \
  X(Ivi_ClearInstrSpecificErrorQueue, clearInstrSpecificErrorQueue, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_InstrSpecificErrorQueueSize, instrSpecificErrorQueueSize, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32* queueSize), (vi, queueSize)) \
  X(Ivi_ReadToFile, readToFile, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession io, ViConstString fileName, ViInt32 maxBytesToRead, ViInt32 fileAction, ViInt32* totalBytesWritten), (vi, io, fileName, maxBytesToRead, fileAction, totalBytesWritten)) \
  X(Ivi_WriteFromFile, writeFromFile, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession io, ViConstString fileName, ViInt32 numBytesToWrite, ViInt32 byteOffset, ViInt32* returnCount), (vi, io, fileName, numBytesToWrite, byteOffset, returnCount)) \
  X(Ivi_viWrite, viWrite, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession io, ViConstBuf buffer, ViInt64 count, ViInt64* returnCount), (vi, io, buffer, count, returnCount)) \
  X(Ivi_viRead, viRead, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession io, ViInt64 count, ViBuf buffer, ViInt64* returnCount), (vi, io, count, buffer, returnCount)) \
  X(Ivi_PerformClassInterchangeCheck, performClassInterchangeCheck, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_ClassDriverNew, classDriverNew, REQ, STATUS, NSUP, ViStatus, N, (ViConstString classPrefix, ViConstString logicalName, ViSession* newClassVi, ViSession* newSpecificVi), (classPrefix, logicalName, newClassVi, newSpecificVi)) \
  X(Ivi_ClassFunctionCapabilities, classFunctionCapabilities, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName, ViBoolean* supported), (vi, functionName, supported)) \
  X(Ivi_GetClassDriverStatusDesc, getClassDriverStatusDesc, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViStatus statusCode, ViInt32 bufferSize, ViChar buffer[]), (vi, statusCode, bufferSize, buffer)) \
  X(Ivi_SpecificDriverSession, specificDriverSession, OPT, VALUE, IMPL, ViSession, S, (ViSession vi), (vi)) \
  X(Ivi_SetSpecificDriverSession, setSpecificDriverSession, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession specificVi), (vi, specificVi)) \
  X(Ivi_LoadSimulationDriver, loadSimulationDriver, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString simulationDriverPrefix), (vi, simulationDriverPrefix)) \
  X(Ivi_GetSimulationSession, getSimulationSession, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViSession* simulationVi), (vi, simulationVi)) \
  X(Ivi_CloseSimulationSession, closeSimulationSession, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_GetFunctionPtr, getFunctionPtr, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViInt32 functionIndex, ViAddr* functionPtr), (vi, functionIndex, functionPtr)) \
  X(Ivi_GetFunctionPtrByName, getFunctionPtrByName, REQ, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName, ViAddr* functionPtr), (vi, functionName, functionPtr)) \
  X(Ivi_GetSimulationDriverFunctionPtr, getSimulationDriverFunctionPtr, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName, ViAddr* functionPtr), (vi, functionName, functionPtr)) \
  X(Ivi_SimulationDriverNew, simulationDriverNew, OPT, STATUS, NSUP, ViStatus, N, (ViConstString driverPrefix, ViConstString optionString, ViSession* newVi), (driverPrefix, optionString, newVi)) \
  X(Ivi_ApplySimulationDriverDefaultSetup, applySimulationDriverDefaultSetup, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_ValidateSession, validateSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_SessionIsAvailable, sessionIsAvailable, OPT, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_Dispose, dispose, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_LockSession, lockSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean* callerHasLock), (vi, callerHasLock)) \
  X(Ivi_UnlockSession, unlockSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean* callerHasLock), (vi, callerHasLock)) \
  /* Channels and repeated capabilities */ \
  X(Ivi_BuildChannelTable, buildChannelTable, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelList), (vi, channelList)) \
  X(Ivi_AddToChannelTable, addToChannelTable, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelsToAdd), (vi, channelsToAdd)) \
  X(Ivi_RestrictAttrToChannels, restrictAttrToChannels, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString channels), (vi, attributeId, channels)) \
  X(Ivi_ValidateAttrForChannel, validateAttrForChannel, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  X(Ivi_CoerceChannelName, coerceChannelName, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViConstString* coercedChannelName), (vi, channelName, coercedChannelName)) \
  X(Ivi_GetChannelIndex, getChannelIndex, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViInt32* index), (vi, channelName, index)) \
  X(Ivi_GetNthChannelString, getNthChannelString, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 index, ViConstString* channelName), (vi, index, channelName)) \
  X(Ivi_GetUserChannelName, getUserChannelName, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViConstString* userChannelName), (vi, channelName, userChannelName)) \
  X(Ivi_BuildRepCapTable, buildRepCapTable, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViConstString repCapNames), (vi, repCapIdentifier, repCapNames)) \
  X(Ivi_AddToRepCapTable, addToRepCapTable, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViConstString namesToAdd), (vi, repCapIdentifier, namesToAdd)) \
  X(Ivi_RestrictAttrToInstances, restrictAttrToInstances, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString instances), (vi, attributeId, instances)) \
  X(Ivi_ValidateAttrForRepCapName, validateAttrForRepCapName, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString repCapName), (vi, attributeId, repCapName)) \
  X(Ivi_CoerceRepCapName, coerceRepCapName, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString repCapName, ViConstString* coercedName), (vi, attributeId, repCapName, coercedName)) \
  X(Ivi_GetRepCapIndex, getRepCapIndex, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViConstString repCapName, ViInt32* index), (vi, repCapIdentifier, repCapName, index)) \
  X(Ivi_GetNthRepCapName, getNthRepCapName, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViInt32 index, ViConstString* repCapName), (vi, repCapIdentifier, index, repCapName)) \
  X(Ivi_GetAttributeRepCapName, getAttributeRepCapName, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 bufferSize, ViChar repCapIdentifier[]), (vi, attributeId, bufferSize, repCapIdentifier)) \
  /* Attribute definition */ \
  X(Ivi_ValidateAttribute, validateAttribute, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 valueType), (vi, attributeId, valueType)) \
  X(Ivi_AttributeIsAvailable, attributeIsAvailable, OPT, VALUE, IMPL, ViBoolean, S, (ViSession vi, ViAttr attributeId), (vi, attributeId)) \
  X(Ivi_ResetAttribute, resetAttribute, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  X(Ivi_DeleteAttribute, deleteAttribute, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId), (vi, attributeId)) \
  X(Ivi_AddAttributeViInt32, addAttributeViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViInt32 defaultValue, ViInt32 flags, IviReadCallbackViInt32 readCallback, IviWriteCallbackViInt32 writeCallback, IviRangeTablePtr rangeTable), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable)) \
  X(Ivi_AddAttributeViInt64, addAttributeViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViInt64 defaultValue, ViInt32 flags, IviReadCallbackViInt64 readCallback, IviWriteCallbackViInt64 writeCallback, IviRangeTablePtr rangeTable), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable)) \
  X(Ivi_AddAttributeViReal64, addAttributeViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViReal64 defaultValue, ViInt32 flags, IviReadCallbackViReal64 readCallback, IviWriteCallbackViReal64 writeCallback, IviRangeTablePtr rangeTable, ViInt32 comparePrecision), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable, comparePrecision)) \
  X(Ivi_AddAttributeViString, addAttributeViString, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViConstString defaultValue, ViInt32 flags, IviReadCallbackViString readCallback, IviWriteCallbackViString writeCallback), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddAttributeViBoolean, addAttributeViBoolean, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViBoolean defaultValue, ViInt32 flags, IviReadCallbackViBoolean readCallback, IviWriteCallbackViBoolean writeCallback), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddAttributeViSession, addAttributeViSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViSession defaultValue, ViInt32 flags, IviReadCallbackViSession readCallback, IviWriteCallbackViSession writeCallback), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddAttributeViAddr, addAttributeViAddr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString name, ViAddr defaultValue, ViInt32 flags, IviReadCallbackViAddr readCallback, IviWriteCallbackViAddr writeCallback), (vi, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddRepeatedAttributeViInt32, addRepeatedAttributeViInt32, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViInt32 defaultValue, ViInt32 flags, IviReadCallbackViInt32 readCallback, IviWriteCallbackViInt32 writeCallback, IviRangeTablePtr rangeTable), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable)) \
  X(Ivi_AddRepeatedAttributeViInt64, addRepeatedAttributeViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViInt64 defaultValue, ViInt32 flags, IviReadCallbackViInt64 readCallback, IviWriteCallbackViInt64 writeCallback, IviRangeTablePtr rangeTable), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable)) \
  X(Ivi_AddRepeatedAttributeViReal64, addRepeatedAttributeViReal64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViReal64 defaultValue, ViInt32 flags, IviReadCallbackViReal64 readCallback, IviWriteCallbackViReal64 writeCallback, IviRangeTablePtr rangeTable, ViInt32 comparePrecision), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback, rangeTable, comparePrecision)) \
  X(Ivi_AddRepeatedAttributeViString, addRepeatedAttributeViString, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViConstString defaultValue, ViInt32 flags, IviReadCallbackViString readCallback, IviWriteCallbackViString writeCallback), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddRepeatedAttributeViBoolean, addRepeatedAttributeViBoolean, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViBoolean defaultValue, ViInt32 flags, IviReadCallbackViBoolean readCallback, IviWriteCallbackViBoolean writeCallback), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddRepeatedAttributeViSession, addRepeatedAttributeViSession, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViSession defaultValue, ViInt32 flags, IviReadCallbackViSession readCallback, IviWriteCallbackViSession writeCallback), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  X(Ivi_AddRepeatedAttributeViAddr, addRepeatedAttributeViAddr, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString repCapIdentifier, ViAttr attributeId, ViConstString name, ViAddr defaultValue, ViInt32 flags, IviReadCallbackViAddr readCallback, IviWriteCallbackViAddr writeCallback), (vi, repCapIdentifier, attributeId, name, defaultValue, flags, readCallback, writeCallback)) \
  /* Attribute access */ \
  X(Ivi_SetAttributeViInt32, setAttributeViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt32 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViInt64, setAttributeViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt64 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViReal64, setAttributeViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViReal64 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViString, setAttributeViString, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViConstString value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViBoolean, setAttributeViBoolean, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViBoolean value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViSession, setAttributeViSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViSession value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_SetAttributeViAddr, setAttributeViAddr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViAddr value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViInt32, checkAttributeViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt32 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViInt64, checkAttributeViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt64 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViReal64, checkAttributeViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViReal64 value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViString, checkAttributeViString, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViConstString value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViBoolean, checkAttributeViBoolean, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViBoolean value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViSession, checkAttributeViSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViSession value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_CheckAttributeViAddr, checkAttributeViAddr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViAddr value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViInt32, getAttributeViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt32* value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViInt64, getAttributeViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt64* value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViReal64, getAttributeViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViReal64* value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViString, getAttributeViString, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViInt32 bufferSize, ViChar value[]), (vi, channelName, attributeId, optionFlags, bufferSize, value)) \
  X(Ivi_GetAttributeViBoolean, getAttributeViBoolean, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViBoolean* value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViSession, getAttributeViSession, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViSession* value), (vi, channelName, attributeId, optionFlags, value)) \
  X(Ivi_GetAttributeViAddr, getAttributeViAddr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 optionFlags, ViAddr* value), (vi, channelName, attributeId, optionFlags, value)) \
  /* Caching and coercion */ \
  X(Ivi_InvalidateAttribute, invalidateAttribute, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  X(Ivi_InvalidateAllAttributes, invalidateAllAttributes, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_AddAttributeInvalidation, addAttributeInvalidation, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViAttr attributeToInvalidate, ViBoolean sameChannel), (vi, attributeId, attributeToInvalidate, sameChannel)) \
  X(Ivi_DeleteAttributeInvalidation, deleteAttributeInvalidation, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViAttr attributeToInvalidate), (vi, attributeId, attributeToInvalidate)) \
  X(Ivi_GetInvalidationList, getInvalidationList, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32* count, ViAttr** invalidationList), (vi, attributeId, count, invalidationList)) \
  X(Ivi_DisposeInvalidationList, disposeInvalidationList, REQ, VALUE, IMPL, ViStatus, S, (ViSession vi, ViAttr* invalidationList), (vi, invalidationList)) \
  X(Ivi_AttributeIsCached, attributeIsCached, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViBoolean* isCached), (vi, channelName, attributeId, isCached)) \
  X(Ivi_GetCoercedValViInt32, getCoercedValViInt32, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 value, ViInt32* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  X(Ivi_GetCoercedValViReal64, getCoercedValViReal64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViReal64 value, ViReal64* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  X(Ivi_GetNextCoercionInfo, getNextCoercionInfo, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 bufferSize, ViChar coercionRecord[]), (vi, bufferSize, coercionRecord)) \
  X(Ivi_GetNextCoercionString, getNextCoercionString, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 bufferSize, ViChar coercionRecord[]), (vi, bufferSize, coercionRecord)) \
  /* Callbacks */ \
  X(Ivi_SetAttrRangeTableCallback, setAttrRangeTableCallback, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, IviRangeTableCallback rangeTableCallback), (vi, attributeId, rangeTableCallback)) \
  X(Ivi_DefaultCheckCallbackViInt32, defaultCheckCallbackViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 value), (vi, channelName, attributeId, value)) \
  X(Ivi_DefaultCoerceCallbackViInt32, defaultCoerceCallbackViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32 value, ViInt32* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  X(Ivi_DefaultCheckCallbackViInt64, defaultCheckCallbackViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt64 value), (vi, channelName, attributeId, value)) \
  X(Ivi_DefaultCoerceCallbackViInt64, defaultCoerceCallbackViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt64 value, ViInt64* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  X(Ivi_DefaultCheckCallbackViReal64, defaultCheckCallbackViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViReal64 value), (vi, channelName, attributeId, value)) \
  X(Ivi_DefaultCoerceCallbackViReal64, defaultCoerceCallbackViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViReal64 value, ViReal64* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  X(Ivi_DefaultCompareCallbackViReal64, defaultCompareCallbackViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViReal64 coercedNewValue, ViReal64 cacheValue, ViInt32* result), (vi, channelName, attributeId, coercedNewValue, cacheValue, result)) \
  X(Ivi_DefaultCoerceCallbackViBoolean, defaultCoerceCallbackViBoolean, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViBoolean value, ViBoolean* coercedValue), (vi, channelName, attributeId, value, coercedValue)) \
  IVI_ENGINE_CALLBACK_SETTERS(X, Read, ViInt32, ViInt64, ViReal64, ViString, ViBoolean, ViSession, ViAddr) \
  IVI_ENGINE_CALLBACK_SETTERS(X, Write, ViInt32, ViInt64, ViReal64, ViString, ViBoolean, ViSession, ViAddr) \
  IVI_ENGINE_CALLBACK_SETTERS(X, Check, ViInt32, ViInt64, ViReal64, ViString, ViBoolean, ViSession, ViAddr) \
  IVI_ENGINE_CALLBACK_SETTERS(X, Coerce, ViInt32, ViInt64, ViReal64, ViString, ViBoolean, ViAddr, ViSession) \
  IVI_ENGINE_CALLBACK_SETTERS(X, Compare, ViInt32, ViInt64, ViReal64, ViString, ViBoolean, ViSession, ViAddr) \
  /* Session state */ \
  X(Ivi_IOSession, iOSession, REQ, VALUE, IMPL, ViSession, S, (ViSession vi), (vi)) \
  X(Ivi_RangeChecking, rangeChecking, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_QueryInstrStatus, queryInstrStatus, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_Simulating, simulating, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_UseSpecificSimulation, useSpecificSimulation, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_Spying, spying, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_InterchangeCheck, interchangeCheck, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi), (vi)) \
  X(Ivi_SetAttrComparePrecision, setAttrComparePrecision, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 comparePrecision), (vi, attributeId, comparePrecision)) \
  X(Ivi_GetAttrComparePrecision, getAttrComparePrecision, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32* comparePrecision), (vi, attributeId, comparePrecision)) \
  /* Attribute information */ \
  X(Ivi_GetNumAttributes, getNumAttributes, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32* numAttributes), (vi, numAttributes)) \
  X(Ivi_GetNthAttribute, getNthAttribute, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 index, ViAttr* attributeId), (vi, index, attributeId)) \
  X(Ivi_GetAttributeFlags, getAttributeFlags, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32* flags), (vi, attributeId, flags)) \
  X(Ivi_SetAttributeFlags, setAttributeFlags, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 flags), (vi, attributeId, flags)) \
  X(Ivi_GetAttributeType, getAttributeType, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32* valueType), (vi, attributeId, valueType)) \
  X(Ivi_GetAttributeName, getAttributeName, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 bufferSize, ViChar name[]), (vi, attributeId, bufferSize, name)) \
  X(Ivi_GetAttrMinMaxViInt32, getAttrMinMaxViInt32, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt32* minValue, ViInt32* maxValue, ViBoolean* hasMin, ViBoolean* hasMax), (vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax)) \
  X(Ivi_GetAttrMinMaxViInt64, getAttrMinMaxViInt64, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViInt64* minValue, ViInt64* maxValue, ViBoolean* hasMin, ViBoolean* hasMax), (vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax)) \
  X(Ivi_GetAttrMinMaxViReal64, getAttrMinMaxViReal64, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViReal64* minValue, ViReal64* maxValue, ViBoolean* hasMin, ViBoolean* hasMax), (vi, channelName, attributeId, minValue, maxValue, hasMin, hasMax)) \
  X(Ivi_AttributeWasSetByUser, attributeWasSetByUser, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  X(Ivi_AttributeEverSetByUser, attributeEverSetByUser, REQ, VALUE, IMPL, ViBoolean, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  /* Error information */ \
  X(Ivi_SetErrorInfo, setErrorInfo, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean overwrite, ViStatus primaryError, ViStatus secondaryError, ViConstString elaboration), (vi, overwrite, primaryError, secondaryError, elaboration)) \
  X(Ivi_GetErrorInfo, getErrorInfo, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViStatus* primaryError, ViStatus* secondaryError, ViInt32 bufferSize, ViChar elaboration[]), (vi, primaryError, secondaryError, bufferSize, elaboration)) \
  X(Ivi_ClearErrorInfo, clearErrorInfo, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_GetErrorMessage, getErrorMessage, REQ, STATUS, IMPL, ViStatus, N, (ViStatus statusCode, ViChar message[IVI_MAX_MESSAGE_BUF_SIZE]), (statusCode, message)) \
  /* Range tables */ \
  X(Ivi_GetAttrRangeTable, getAttrRangeTable, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, IviRangeTablePtr* rangeTable), (vi, channelName, attributeId, rangeTable)) \
  X(Ivi_ValidateRangeTable, validateRangeTable, REQ, STATUS, IMPL, ViStatus, N, (IviRangeTablePtr rangeTable), (rangeTable)) \
  X(Ivi_GetRangeTableNumEntries, getRangeTableNumEntries, REQ, STATUS, IMPL, ViStatus, N, (IviRangeTablePtr rangeTable, ViInt32* numEntries), (rangeTable, numEntries)) \
  IVI_ENGINE_RANGE_ENTRY_GETTERS(X, ViInt32, REQ) \
  IVI_ENGINE_RANGE_ENTRY_GETTERS(X, ViInt64, OPT) \
  IVI_ENGINE_RANGE_ENTRY_GETTERS(X, ViReal64, REQ) \
  X(Ivi_GetStoredRangeTablePtr, getStoredRangeTablePtr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, IviRangeTablePtr* rangeTable), (vi, attributeId, rangeTable)) \
  X(Ivi_SetStoredRangeTablePtr, setStoredRangeTablePtr, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, IviRangeTablePtr rangeTable), (vi, attributeId, rangeTable)) \
  X(Ivi_RangeTableNew, rangeTableNew, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 numEntries, ViInt32 typeOfTable, ViBoolean hasMin, ViBoolean hasMax, IviRangeTablePtr* rangeTable), (vi, numEntries, typeOfTable, hasMin, hasMax, rangeTable)) \
  X(Ivi_RangeTableFree, rangeTableFree, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, IviRangeTablePtr rangeTable, ViBoolean freeCmdStrings), (vi, rangeTable, freeCmdStrings)) \
  X(Ivi_SetRangeTableEntry, setRangeTableEntry, REQ, STATUS, IMPL, ViStatus, N, (IviRangeTablePtr rangeTable, ViInt32 index, ViReal64 discreteOrMinValue, ViReal64 maxValue, ViReal64 coercedValue, ViConstString cmdString, ViInt32 cmdValue), (rangeTable, index, discreteOrMinValue, maxValue, coercedValue, cmdString, cmdValue)) \
  X(Ivi_SetRangeTableEntryViInt64, setRangeTableEntryViInt64, OPT, STATUS, IMPL, ViStatus, N, (IviRangeTablePtr rangeTable, ViInt32 index, ViInt64 discreteOrMinValue, ViInt64 maxValue, ViInt64 coercedValue, ViConstString cmdString, ViInt32 cmdValue), (rangeTable, index, discreteOrMinValue, maxValue, coercedValue, cmdString, cmdValue)) \
  X(Ivi_SetRangeTableEnd, setRangeTableEnd, REQ, STATUS, IMPL, ViStatus, N, (IviRangeTablePtr rangeTable, ViInt32 index), (rangeTable, index)) \
  /* Configuration store and logical names */ \
  X(Ivi_GetConfigStoreHandle, getConfigStoreHandle, OPT, STATUS, NSUP, ViStatus, N, (ViAddr* configStoreHandle), (configStoreHandle)) \
  X(Ivi_AttachToConfigStoreHandle, attachToConfigStoreHandle, OPT, STATUS, NSUP, ViStatus, N, (ViAddr configStoreHandle), (configStoreHandle)) \
  X(Ivi_GetInfoFromResourceName, getInfoFromResourceName, OPT, STATUS, IMPL, ViStatus, N, (ViConstString resourceName, ViConstString optionString, ViChar newResourceName[IVI_MAX_RESOURCE_BUF_SIZE], ViChar newOptionString[IVI_MAX_RESOURCE_BUF_SIZE], ViBoolean* isLogicalName), (resourceName, optionString, newResourceName, newOptionString, isLogicalName)) \
  X(Ivi_GetLogicalNamesList, getLogicalNamesList, REQ, STATUS, IMPL, ViStatus, N, (ViConstString driverPrefix, ViInt32* count, ViAddr* logicalNamesList), (driverPrefix, count, logicalNamesList)) \
  X(Ivi_GetNthLogicalName, getNthLogicalName, REQ, STATUS, IMPL, ViStatus, N, (ViAddr logicalNamesList, ViInt32 index, ViInt32 bufferSize, ViChar logicalName[]), (logicalNamesList, index, bufferSize, logicalName)) \
  X(Ivi_DisposeLogicalNamesList, disposeLogicalNamesList, REQ, VALUE, IMPL, ViStatus, N, (ViAddr logicalNamesList), (logicalNamesList)) \
  /* Interchange checking, memory, tables, numbers */ \
  X(Ivi_GetNextInterchangeCheckString, getNextInterchangeCheckString, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViInt32 bufferSize, ViChar warning[]), (vi, bufferSize, warning)) \
  X(Ivi_ClearInterchangeWarnings, clearInterchangeWarnings, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_ResetInterchangeCheck, resetInterchangeCheck, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_LogInterchangeWarning, logInterchangeWarning, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString channelName, ViConstString warning), (vi, channelName, warning)) \
  X(Ivi_Alloc, alloc, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViInt32 memBlockSize, ViAddr* memBlock), (vi, memBlockSize, memBlock)) \
  X(Ivi_Free, free, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAddr memBlock), (vi, memBlock)) \
  X(Ivi_FreeAll, freeAll, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi), (vi)) \
  X(Ivi_SetValInStringCallback, setValInStringCallback, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViConstString value), (vi, attributeId, value)) \
  X(Ivi_GetStringFromTable, getStringFromTable, REQ, STATUS, IMPL, ViStatus, N, (IviStringValueTable table, ViInt32 value, ViConstString* string), (table, value, string)) \
  X(Ivi_GetValueFromTable, getValueFromTable, REQ, STATUS, IMPL, ViStatus, N, (IviStringValueTable table, ViConstString string, ViInt32* value), (table, string, value)) \
  X(Ivi_CheckNumericRange, checkNumericRange, REQ, STATUS, IMPL, ViStatus, N, (ViReal64 value, ViReal64 minValue, ViReal64 maxValue, ViStatus errorCode), (value, minValue, maxValue, errorCode)) \
  X(Ivi_CheckBooleanRange, checkBooleanRange, REQ, STATUS, IMPL, ViStatus, N, (ViBoolean value, ViStatus errorCode), (value, errorCode)) \
  X(Ivi_CoerceBoolean, coerceBoolean, REQ, STATUS, IMPL, ViStatus, N, (ViBoolean* value), (value)) \
  X(Ivi_CompareWithPrecision, compareWithPrecision, REQ, STATUS, IMPL, ViStatus, N, (ViInt32 digitsOfPrecision, ViReal64 a, ViReal64 b, ViInt32* result), (digitsOfPrecision, a, b, result)) \
  X(Ivi_GetViReal64Type, getViReal64Type, OPT, STATUS, IMPL, ViStatus, N, (ViReal64 value, ViInt32* type), (value, type)) \
  X(Ivi_GetPtrToSpecialViReal64Value, getPtrToSpecialViReal64Value, OPT, VALUE, IMPL, ViAddr, N, (ViInt32 type), (type)) \
  X(Ivi_LockSession_Class, lockSession_Class, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean* callerHasLock), (vi, callerHasLock)) \
  X(Ivi_UnlockSession_Class, unlockSession_Class, OPT, STATUS, IMPL, ViStatus, S, (ViSession vi, ViBoolean* callerHasLock), (vi, callerHasLock)) \
  X(Ivi_SetAttrCallback, setAttrCallback, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 callbackType, ViAddr callback), (vi, attributeId, callbackType, callback)) \
  X(Ivi_GetAttrCallback, getAttrCallback, REQ, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, ViInt32 callbackType, ViAddr* callback), (vi, attributeId, callbackType, callback)) \
  X(Ivi_GetErrorMessageLocalized, getErrorMessageLocalized, OPT, STATUS, NSUP, ViStatus, N, (ViStatus statusCode, ViConstString locale, ViInt32 bufferSize, ViChar message[]), (statusCode, locale, bufferSize, message)) \
  X(Ivi_GetSpyingFromLogicalName, getSpyingFromLogicalName, OPT, STATUS, NSUP, ViStatus, N, (ViConstString logicalName, ViBoolean* spying), (logicalName, spying)) \
  X(Ivi_LogInterchangeWarning2, logInterchangeWarning2, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId, ViConstString warning), (vi, channelName, attributeId, warning)) \
  X(Ivi_ParamPositionError, paramPositionError, REQ, STATUS, IMPL, ViStatus, N, (ViInt32 parameterPosition), (parameterPosition)) \
  X(Ivi_InterchangeCheckAttribute, interchangeCheckAttribute, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString channelName, ViAttr attributeId), (vi, channelName, attributeId)) \
  X(Ivi_PerformInterchangeCheck, performInterchangeCheck, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(Ivi_SetInterchangeCheckMethod, setInterchangeCheckMethod, OPT, STATUS, NSUP, ViStatus, S, (ViSession vi, ViAddr checkMethod), (vi, checkMethod)) \
  /* Class drivers */ \
  X(IviDCPwr_InterchangeCheck, iviDCPwr_InterchangeCheck, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(IviDmm_InterchangeCheck, iviDmm_InterchangeCheck, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(IviFgen_InterchangeCheck, iviFgen_InterchangeCheck, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(IviScope_InterchangeCheck, iviScope_InterchangeCheck, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(IviSwtch_InterchangeCheck, iviSwtch_InterchangeCheck, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi, ViConstString functionName), (vi, functionName)) \
  X(IviDmm_DisableUnusedExtensions, iviDmm_DisableUnusedExtensions, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(IviFgen_DisableUnusedExtensions, iviFgen_DisableUnusedExtensions, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi), (vi)) \
  X(IviScope_DisableUnusedExtensions, iviScope_DisableUnusedExtensions, OPT, CLASS, NSUP, ViStatus, S, (ViSession vi), (vi))

/* The seven setters of one callback kind, in the given type order. Every
 * ViInt64 setter is optional. */
#define IVI_ENGINE_CALLBACK_SETTERS(X, Kind, T1, T2, T3, T4, T5, T6, T7) \
  IVI_ENGINE_CALLBACK_SETTER(X, Kind, T1) IVI_ENGINE_CALLBACK_SETTER(X, Kind, T2) \
  IVI_ENGINE_CALLBACK_SETTER(X, Kind, T3) IVI_ENGINE_CALLBACK_SETTER(X, Kind, T4) \
  IVI_ENGINE_CALLBACK_SETTER(X, Kind, T5) IVI_ENGINE_CALLBACK_SETTER(X, Kind, T6) \
  IVI_ENGINE_CALLBACK_SETTER(X, Kind, T7)
#define IVI_ENGINE_CALLBACK_SETTER(X, Kind, T) \
  X(Ivi_SetAttr##Kind##Callback##T, setAttr##Kind##Callback##T, IVI_ENGINE_AVAIL_##T, STATUS, IMPL, ViStatus, S, (ViSession vi, ViAttr attributeId, Ivi##Kind##Callback##T callback), (vi, attributeId, callback))
#define IVI_ENGINE_AVAIL_ViInt32 REQ
#define IVI_ENGINE_AVAIL_ViInt64 OPT
#define IVI_ENGINE_AVAIL_ViReal64 REQ
#define IVI_ENGINE_AVAIL_ViString REQ
#define IVI_ENGINE_AVAIL_ViBoolean REQ
#define IVI_ENGINE_AVAIL_ViSession REQ
#define IVI_ENGINE_AVAIL_ViAddr REQ

/* The five entry lookups of one value type. Each finds the entry that
 * matches and fills the outputs that are not NULL; no entry gives
 * IVI_ERROR_INVALID_VALUE. */
#define IVI_ENGINE_RANGE_ENTRY_GETTERS(X, T, Avail) \
  X(Ivi_Get##T##EntryFromValue, get##T##EntryFromValue, Avail, STATUS, IMPL, ViStatus, N, (T value, IviRangeTablePtr rangeTable, T* discreteOrMinValue, T* maxValue, T* coercedValue, ViInt32* tableIndex, ViString* cmdString, ViInt32* cmdValue), (value, rangeTable, discreteOrMinValue, maxValue, coercedValue, tableIndex, cmdString, cmdValue)) \
  X(Ivi_Get##T##EntryFromString, get##T##EntryFromString, Avail, STATUS, IMPL, ViStatus, N, (ViConstString string, IviRangeTablePtr rangeTable, T* discreteOrMinValue, T* maxValue, T* coercedValue, ViInt32* tableIndex, ViInt32* cmdValue), (string, rangeTable, discreteOrMinValue, maxValue, coercedValue, tableIndex, cmdValue)) \
  X(Ivi_Get##T##EntryFromIndex, get##T##EntryFromIndex, Avail, STATUS, IMPL, ViStatus, N, (ViInt32 index, IviRangeTablePtr rangeTable, T* discreteOrMinValue, T* maxValue, T* coercedValue, ViString* cmdString, ViInt32* cmdValue), (index, rangeTable, discreteOrMinValue, maxValue, coercedValue, cmdString, cmdValue)) \
  X(Ivi_Get##T##EntryFromCmdValue, get##T##EntryFromCmdValue, Avail, STATUS, IMPL, ViStatus, N, (ViInt32 cmdValue, IviRangeTablePtr rangeTable, T* discreteOrMinValue, T* maxValue, T* coercedValue, ViInt32* tableIndex, ViString* cmdString), (cmdValue, rangeTable, discreteOrMinValue, maxValue, coercedValue, tableIndex, cmdString)) \
  X(Ivi_Get##T##EntryFromCoercedVal, get##T##EntryFromCoercedVal, Avail, STATUS, IMPL, ViStatus, N, (T coercedValue, IviRangeTablePtr rangeTable, T* discreteOrMinValue, T* maxValue, ViInt32* tableIndex, ViString* cmdString, ViInt32* cmdValue), (coercedValue, rangeTable, discreteOrMinValue, maxValue, tableIndex, cmdString, cmdValue))
/* clang-format on */

/* Two-level paste for consumers of the table: a row's REQ/OPT, STATUS/VALUE/
 * CLASS, IMPL/NSUP and S/N may arrive unexpanded. */
#define IVI_ENGINE_CAT(a, b) IVI_ENGINE_CAT_I(a, b)
#define IVI_ENGINE_CAT_I(a, b) a##b

#define IVI_ENGINE_DECLARE(cname, method, avail, kind, support, ret, sess, params, args) \
  IVI_ENGINE_API ret cname params;
IVI_ENGINE_FUNCTIONS(IVI_ENGINE_DECLARE)
#undef IVI_ENGINE_DECLARE

#ifdef __cplusplus
} /* extern "C" */
#endif

#endif /* IVI_ENGINE_H */
