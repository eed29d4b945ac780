// The exported boundary's helpers: every hsdig_ function runs its body
// through callDriver, which takes the engine's session lock, finds the
// session's digitizer, turns a DriverError into the returned status and the
// session's error information, and never lets an exception out.
#pragma once

#include <new>
#include <string>

#include "Digitizer.h"

namespace hsdig::sim {

// Records a status in the error information of `vi` (or of the calling
// thread's session 0 when `vi` is no session). The first error of a call
// stays; a warning is recorded only when nothing is pending.
void recordStatus(ViSession vi, ViStatus code, ViStatus secondary, const std::string& elaboration);

// A warning that the body wants recorded with its own text; set by the body,
// read and cleared by callDriver.
std::string& pendingWarningText();

template <class Body>
ViStatus callDriver(ViSession vi, const char* function, Body&& body) noexcept {
  ViBoolean locked = VI_FALSE;
  ViStatus status = VI_SUCCESS;
  try {
    pendingWarningText().clear();
    if (ViStatus st = Ivi_LockSession(vi, &locked); st < 0) {
      fail(HSDIG_ERROR_INVALID_SESSION, "Session " + std::to_string(vi) + " is not open.", st);
    }
    Digitizer& d = digitizerOf(vi);
    status = body(d);
    if (status > 0 && statusText(status)) {
      std::string text = pendingWarningText().empty() ? statusText(status) : pendingWarningText();
      recordStatus(vi, status, 0, std::string(function) + ": " + text);
    }
  } catch (const DriverError& e) {
    status = e.code;
    recordStatus(locked ? vi : 0, e.code, e.secondary,
                 std::string(function) + ": " + e.elaboration);
  } catch (const std::bad_alloc&) {
    status = HSDIG_ERROR_INTERNAL;
    recordStatus(locked ? vi : 0, status, 0, std::string(function) + ": out of memory.");
  } catch (...) {
    status = HSDIG_ERROR_INTERNAL;
    recordStatus(locked ? vi : 0, status, 0, std::string(function) + ": an internal failure.");
  }
  if (locked) Ivi_UnlockSession(vi, &locked);
  return status;
}

}  // namespace hsdig::sim
