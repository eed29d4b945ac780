// Session open and close for the process that hosts the driver, and the
// boundary's error recording.
#include <cstring>

#include "Boundary.h"
#include "Values.h"

namespace hsdig::sim {

void recordStatus(ViSession vi, ViStatus code, ViStatus secondary, const std::string& elaboration) {
  // Without overwrite the engine keeps a pending error and lets an error
  // replace a warning, which is the rule a driver call follows.
  if (Ivi_SetErrorInfo(vi, VI_FALSE, code, secondary, elaboration.c_str()) < 0 && vi != 0) {
    Ivi_SetErrorInfo(0, VI_FALSE, code, secondary, elaboration.c_str());
  }
}

std::string& pendingWarningText() {
  thread_local std::string text;
  return text;
}

namespace {

struct Setup {
  const Model* model = &defaultModel();
  std::string serial;
};

std::string trim(std::string s) {
  size_t a = s.find_first_not_of(" \t"), b = s.find_last_not_of(" \t");
  return a == std::string::npos ? "" : s.substr(a, b - a + 1);
}

// "Model:HSD-2; Serial:1234": entries "tag:value" separated by ";". Tags
// are compared without regard to case; tags of other layers are ignored.
Setup parseDriverSetup(const std::string& text) {
  Setup s;
  size_t pos = 0;
  while (pos <= text.size()) {
    size_t end = text.find(';', pos);
    std::string entry =
        trim(text.substr(pos, end == std::string::npos ? std::string::npos : end - pos));
    pos = end == std::string::npos ? text.size() + 1 : end + 1;
    size_t colon = entry.find(':');
    if (colon == std::string::npos) continue;
    std::string tag = trim(entry.substr(0, colon)), value = trim(entry.substr(colon + 1));
    for (char& c : tag) c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    if (tag == "model") {
      s.model = findModel(value);
      if (!s.model) {
        std::string names;
        for (const Model& m : allModels())
          names += (names.empty() ? "" : ", ") + std::string(m.name);
        fail(HSDIG_ERROR_INVALID_MODEL,
             "DriverSetup names model \"" + value + "\"; the models are " + names + ".");
      }
    } else if (tag == "serial") {
      s.serial = value;
    }
  }
  return s;
}

std::string serialFor(const std::string& resource) {
  std::uint32_t h = 2166136261u;
  for (unsigned char c : resource) h = (h ^ c) * 16777619u;
  char buf[16];
  std::snprintf(buf, sizeof buf, "SIM%08X", h);
  return buf;
}

}  // namespace
}  // namespace hsdig::sim

using namespace hsdig::sim;

extern "C" {

ViStatus hsdig_InitWithOptions(ViRsrc resourceName, ViBoolean idQuery, ViBoolean resetDevice,
                               ViConstString optionString, ViSession* newVi) {
  (void)idQuery;  // the simulated instrument always answers with its model
  ViSession vi = 0;
  try {
    requirePointer(newVi, "newVi");
    *newVi = 0;
    requirePointer(resourceName, "resourceName");
    checkEngine(Ivi_SpecificDriverNew("hsdig", optionString ? optionString : "", &vi),
                "Reading the option string.");
    std::string driverSetup = getString(vi, "", IVI_ATTR_DRIVER_SETUP);
    Setup setup = parseDriverSetup(driverSetup);
    setInternal(vi, "", IVI_ATTR_IO_RESOURCE_DESCRIPTOR, std::string(resourceName));
    defineAttributes(vi, *setup.model,
                     setup.serial.empty() ? serialFor(resourceName) : setup.serial);
    auto d = std::make_unique<Digitizer>(vi, *setup.model, resourceName);
    addDigitizer(vi, std::move(d));
    *newVi = vi;
  } catch (const DriverError& e) {
    if (vi) Ivi_Dispose(vi);
    Ivi_SetErrorInfo(0, VI_TRUE, e.code, e.secondary,
                     ("hsdig_InitWithOptions: " + e.elaboration).c_str());
    return e.code;
  } catch (...) {
    if (vi) Ivi_Dispose(vi);
    Ivi_SetErrorInfo(0, VI_TRUE, HSDIG_ERROR_INTERNAL, 0, "hsdig_InitWithOptions: out of memory.");
    return HSDIG_ERROR_INTERNAL;
  }
  if (resetDevice) return hsdig_reset(vi);
  return VI_SUCCESS;
}

ViStatus hsdig_close(ViSession vi) {
  ViBoolean locked = VI_FALSE;
  if (Ivi_LockSession(vi, &locked) < 0) {
    recordStatus(0, HSDIG_ERROR_INVALID_SESSION, 0,
                 "hsdig_close: session " + std::to_string(vi) + " is not open.");
    return HSDIG_ERROR_INVALID_SESSION;
  }
  try {
    digitizerOf(vi);
  } catch (const DriverError& e) {
    Ivi_SetErrorInfo(vi, VI_FALSE, e.code, 0, ("hsdig_close: " + e.elaboration).c_str());
    Ivi_UnlockSession(vi, &locked);
    return e.code;
  }
  // Removed under the session lock, so no call of another thread still uses
  // it; disposing the engine session ends the lock for every waiter.
  removeDigitizer(vi);
  Ivi_Dispose(vi);
  return VI_SUCCESS;
}

}  // extern "C"
