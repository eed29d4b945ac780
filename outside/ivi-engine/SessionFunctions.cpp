// Session life, locking, session state and error information.
#include <cstdlib>
#include <cstring>

#include "EngineSession.h"
#include "OptionString.h"

using namespace cvivi;

namespace {

ViBoolean booleanState(ViSession vi, ViAttr id) {
  ViBoolean result = VI_FALSE;
  withSession(vi, [&](Session& s) {
    result = directBoolean(s, id) ? VI_TRUE : VI_FALSE;
    return VI_SUCCESS;
  });
  return result;
}

void addEngineAttributes(Session& s, std::string_view prefix, const SessionOptions& o) {
  auto b = [](bool v) { return Value{ViBoolean(v ? VI_TRUE : VI_FALSE)}; };
  addInherentAttribute(s, IVI_ATTR_CACHE, "IVI_ATTR_CACHE", IVI_VAL_BOOLEAN, b(o.cache), 0);
  addInherentAttribute(s, IVI_ATTR_RANGE_CHECK, "IVI_ATTR_RANGE_CHECK", IVI_VAL_BOOLEAN,
                       b(o.rangeCheck), 0);
  addInherentAttribute(s, IVI_ATTR_QUERY_INSTRUMENT_STATUS, "IVI_ATTR_QUERY_INSTRUMENT_STATUS",
                       IVI_VAL_BOOLEAN, b(o.queryInstrStatus), 0);
  addInherentAttribute(s, IVI_ATTR_RECORD_COERCIONS, "IVI_ATTR_RECORD_COERCIONS", IVI_VAL_BOOLEAN,
                       b(o.recordCoercions), 0);
  addInherentAttribute(s, IVI_ATTR_SIMULATE, "IVI_ATTR_SIMULATE", IVI_VAL_BOOLEAN, b(o.simulate),
                       0);
  addInherentAttribute(s, IVI_ATTR_INTERCHANGE_CHECK, "IVI_ATTR_INTERCHANGE_CHECK", IVI_VAL_BOOLEAN,
                       b(o.interchangeCheck), 0);
  addInherentAttribute(s, IVI_ATTR_DRIVER_SETUP, "IVI_ATTR_DRIVER_SETUP", IVI_VAL_STRING,
                       o.driverSetup, IVI_VAL_NOT_USER_WRITABLE);
  addInherentAttribute(s, IVI_ATTR_SPY, "IVI_ATTR_SPY", IVI_VAL_BOOLEAN, b(false), 0);
  addInherentAttribute(s, IVI_ATTR_USE_SPECIFIC_SIMULATION, "IVI_ATTR_USE_SPECIFIC_SIMULATION",
                       IVI_VAL_BOOLEAN, b(o.simulate), 0);
  addInherentAttribute(s, IVI_ATTR_PRIMARY_ERROR, "IVI_ATTR_PRIMARY_ERROR", IVI_VAL_INT32,
                       ViInt32{0}, 0);
  addInherentAttribute(s, IVI_ATTR_SECONDARY_ERROR, "IVI_ATTR_SECONDARY_ERROR", IVI_VAL_INT32,
                       ViInt32{0}, 0);
  addInherentAttribute(s, IVI_ATTR_ERROR_ELABORATION, "IVI_ATTR_ERROR_ELABORATION", IVI_VAL_STRING,
                       std::string(), 0);
  addInherentAttribute(s, IVI_ATTR_CHANNEL_COUNT, "IVI_ATTR_CHANNEL_COUNT", IVI_VAL_INT32,
                       ViInt32{0}, IVI_VAL_NOT_WRITABLE);
  addInherentAttribute(s, IVI_ATTR_SPECIFIC_DRIVER_PREFIX, "IVI_ATTR_SPECIFIC_DRIVER_PREFIX",
                       IVI_VAL_STRING, std::string(prefix), IVI_VAL_NOT_USER_WRITABLE);
  addInherentAttribute(s, IVI_ATTR_IO_RESOURCE_DESCRIPTOR, "IVI_ATTR_IO_RESOURCE_DESCRIPTOR",
                       IVI_VAL_STRING, std::string(), IVI_VAL_NOT_USER_WRITABLE);
  addInherentAttribute(s, IVI_ATTR_LOGICAL_NAME, "IVI_ATTR_LOGICAL_NAME", IVI_VAL_STRING,
                       std::string(), IVI_VAL_NOT_USER_WRITABLE);
  addInherentAttribute(s, IVI_ATTR_IO_SESSION, "IVI_ATTR_IO_SESSION", IVI_VAL_SESSION, ViSession{0},
                       IVI_VAL_NOT_USER_WRITABLE);
}

ViStatus lock(ViSession vi, ViBoolean* callerHasLock) {
  if (callerHasLock && *callerHasLock) {
    // The caller already holds it through this flag; validate only.
    return findSession(vi) ? VI_SUCCESS : IVI_ERROR_INVALID_SESSION_HANDLE;
  }
  return guarded([&] {
    SessionPtr s = findSession(vi);
    if (!s) return IVI_ERROR_INVALID_SESSION_HANDLE;
    ViStatus st = s->acquire();
    if (st >= 0 && callerHasLock) *callerHasLock = VI_TRUE;
    return st;
  });
}

ViStatus unlock(ViSession vi, ViBoolean* callerHasLock) {
  if (callerHasLock && !*callerHasLock) return VI_SUCCESS;
  return guarded([&] {
    SessionPtr s = findSession(vi);
    if (!s) return IVI_ERROR_INVALID_SESSION_HANDLE;
    ViStatus st = s->release();
    if (st >= 0 && callerHasLock) *callerHasLock = VI_FALSE;
    return st;
  });
}

}  // namespace

ViStatus Ivi_SpecificDriverNew(ViConstString driverPrefix, ViConstString optionString,
                               ViSession* newVi) {
  return guarded([&] {
    if (!newVi) return recordOnSessionZero(IVI_ERROR_NULL_POINTER, "newVi is NULL.");
    *newVi = 0;
    if (!driverPrefix || !*driverPrefix) {
      return recordOnSessionZero(IVI_ERROR_INVALID_PARAMETER, "The driver prefix is empty.");
    }
    SessionOptions options;
    std::string problem;
    if (ViStatus st = parseSessionOptions(optionString ? optionString : "", options, problem);
        st < 0) {
      return recordOnSessionZero(st, problem);
    }
    SessionPtr s = createSession();
    if (ViStatus st = s->acquire(); st < 0) return st;
    addEngineAttributes(*s, driverPrefix, options);
    s->release();
    *newVi = s->handle();
    return VI_SUCCESS;
  });
}

ViStatus Ivi_Dispose(ViSession vi) {
  if (vi == 0) return IVI_ERROR_INVALID_SESSION_HANDLE;
  return withSession(vi, [&](Session& s) {
    unregisterSession(vi);
    for (void* p : s.allocations) std::free(p);
    s.allocations.clear();
    forgetRangeTables(s);
    s.markDisposed();
    return VI_SUCCESS;
  });
}

ViStatus Ivi_ValidateSession(ViSession vi) {
  if (vi == 0) return IVI_ERROR_INVALID_SESSION_HANDLE;
  return findSession(vi) ? VI_SUCCESS : IVI_ERROR_INVALID_SESSION_HANDLE;
}

ViBoolean Ivi_SessionIsAvailable(ViSession vi) {
  return Ivi_ValidateSession(vi) == VI_SUCCESS ? VI_TRUE : VI_FALSE;
}

ViSession Ivi_SpecificDriverSession(ViSession vi) {
  return Ivi_ValidateSession(vi) == VI_SUCCESS ? vi : 0;
}

ViStatus Ivi_ApplyDefaultSetup(ViSession vi) {
  // Logical names of this engine carry no default attribute values.
  return Ivi_ValidateSession(vi);
}

ViStatus Ivi_LockSession(ViSession vi, ViBoolean* callerHasLock) {
  return lock(vi, callerHasLock);
}
ViStatus Ivi_UnlockSession(ViSession vi, ViBoolean* callerHasLock) {
  return unlock(vi, callerHasLock);
}
ViStatus Ivi_LockSession_Class(ViSession vi, ViBoolean* callerHasLock) {
  return lock(vi, callerHasLock);
}
ViStatus Ivi_UnlockSession_Class(ViSession vi, ViBoolean* callerHasLock) {
  return unlock(vi, callerHasLock);
}

ViBoolean Ivi_RangeChecking(ViSession vi) {
  return booleanState(vi, IVI_ATTR_RANGE_CHECK);
}
ViBoolean Ivi_QueryInstrStatus(ViSession vi) {
  return booleanState(vi, IVI_ATTR_QUERY_INSTRUMENT_STATUS);
}
ViBoolean Ivi_Simulating(ViSession vi) {
  return booleanState(vi, IVI_ATTR_SIMULATE);
}
ViBoolean Ivi_UseSpecificSimulation(ViSession vi) {
  return booleanState(vi, IVI_ATTR_USE_SPECIFIC_SIMULATION);
}
ViBoolean Ivi_Spying(ViSession vi) {
  return booleanState(vi, IVI_ATTR_SPY);
}
ViBoolean Ivi_InterchangeCheck(ViSession vi) {
  return booleanState(vi, IVI_ATTR_INTERCHANGE_CHECK);
}

ViSession Ivi_IOSession(ViSession vi) {
  ViSession io = 0;
  withSession(vi, [&](Session& s) {
    if (Value* v = directValue(s, IVI_ATTR_IO_SESSION)) io = std::get<ViSession>(*v);
    return VI_SUCCESS;
  });
  return io;
}

ViBoolean Ivi_NeedToCheckStatus(ViSession vi) {
  ViBoolean result = VI_FALSE;
  withSession(vi, [&](Session& s) {
    result = s.needToCheckStatus ? VI_TRUE : VI_FALSE;
    return VI_SUCCESS;
  });
  return result;
}

ViStatus Ivi_SetNeedToCheckStatus(ViSession vi, ViBoolean needToCheck) {
  return withSession(vi, [&](Session& s) {
    s.needToCheckStatus = needToCheck != VI_FALSE;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_QueueInstrSpecificError(ViSession vi, ViInt32 errorCode, ViConstString errorMessage) {
  return withSession(vi, [&](Session& s) {
    s.instrErrors.emplace_back(errorCode, errorMessage ? errorMessage : "");
    return VI_SUCCESS;
  });
}

ViStatus Ivi_DequeueInstrSpecificError(ViSession vi, ViInt32* errorCode, ViInt32 bufferSize,
                                       ViChar errorMessage[]) {
  return withSession(vi, [&](Session& s) {
    if (s.instrErrors.empty()) {
      if (errorCode) *errorCode = 0;
      return copyOut("", bufferSize, errorMessage);
    }
    const auto& front = s.instrErrors.front();
    if (errorCode) *errorCode = front.first;
    ViStatus st = copyOut(front.second, bufferSize, errorMessage);
    // The entry leaves the queue only once its whole text was delivered.
    if (st == VI_SUCCESS) s.instrErrors.pop_front();
    return st;
  });
}

ViStatus Ivi_ClearInstrSpecificErrorQueue(ViSession vi) {
  return withSession(vi, [&](Session& s) {
    s.instrErrors.clear();
    return VI_SUCCESS;
  });
}

ViStatus Ivi_InstrSpecificErrorQueueSize(ViSession vi, ViInt32* queueSize) {
  if (!queueSize) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    *queueSize = static_cast<ViInt32>(s.instrErrors.size());
    return VI_SUCCESS;
  });
}

ViStatus Ivi_SetErrorInfo(ViSession vi, ViBoolean overwrite, ViStatus primaryError,
                          ViStatus secondaryError, ViConstString elaboration) {
  return withSession(vi, [&](Session& s) {
    setErrorInfo(s, overwrite != VI_FALSE, primaryError, secondaryError,
                 elaboration ? elaboration : "");
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetErrorInfo(ViSession vi, ViStatus* primaryError, ViStatus* secondaryError,
                          ViInt32 bufferSize, ViChar elaboration[]) {
  return withSession(vi, [&](Session& s) {
    const ViStatus primary = std::get<ViInt32>(*directValue(s, IVI_ATTR_PRIMARY_ERROR));
    const ViStatus secondary = std::get<ViInt32>(*directValue(s, IVI_ATTR_SECONDARY_ERROR));
    const std::string text = std::get<std::string>(*directValue(s, IVI_ATTR_ERROR_ELABORATION));
    if (primaryError) *primaryError = primary;
    if (secondaryError) *secondaryError = secondary;
    ViStatus st = bufferSize == 0 ? VI_SUCCESS : copyOut(text, bufferSize, elaboration);
    // Reading hands the error over: it is cleared unless this was only a
    // size query or the text did not fit.
    if (st == VI_SUCCESS && bufferSize != 0) setErrorInfo(s, true, 0, 0, "");
    return bufferSize == 0 ? copyOut(text, 0, nullptr) : st;
  });
}

ViStatus Ivi_ClearErrorInfo(ViSession vi) {
  return withSession(vi, [&](Session& s) {
    setErrorInfo(s, true, 0, 0, "");
    return VI_SUCCESS;
  });
}
