// A stand-in translator manager library for the tests: its translator
// answers recognisable texts, so a test can tell it from the built-in one.
// Built twice: complete, and (FAKE_MANAGER_WITHOUT_CREATE_XLATOR) lacking an
// entry point.
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "errors/translator/cvxlatormgr.h"

#define FAKE_EXPORT extern "C" __attribute__((visibility("default")))

namespace {

int failSessions = 0;
int liveSessions = 0;
int liveXlators = 0;

char* copy(const std::string& text) {
  char* out = static_cast<char*>(std::malloc(text.size() + 1));
  if (out) std::memcpy(out, text.c_str(), text.size() + 1);
  return out;
}

[[maybe_unused]] int32_t staticDesc(void*, int32_t code, int32_t language, int32_t, char** text) {
  *text = copy("managed static " + std::to_string(code) + " in " + std::to_string(language));
  return 0;
}

[[maybe_unused]] int32_t dynamicDesc(void*, const char*, int32_t, int32_t, const char* format,
                                     char** text) {
  if (std::strcmp(format, "json1") != 0) {
    *text = copy("managed: unsupported format");
    return -52029;
  }
  *text = copy(R"({"dynamic":[{"type":"usage","key":"managed","value":"json1"}],"debug":[]})");
  return 0;
}

[[maybe_unused]] void freeText(char* text) {
  std::free(text);
}

}  // namespace

FAKE_EXPORT void fake_cvxlator_setFailSessions(int fail) {
  failSessions = fail;
}
FAKE_EXPORT int fake_cvxlator_live() {
  return liveSessions + liveXlators;
}

FAKE_EXPORT int32_t cvxlatormgr_createSession(void** session) {
  if (failSessions) return -52000;
  *session = &liveSessions;
  ++liveSessions;
  return 0;
}

FAKE_EXPORT int32_t cvxlatormgr_destroySession(void*) {
  --liveSessions;
  return 0;
}

#ifndef FAKE_MANAGER_WITHOUT_CREATE_XLATOR
FAKE_EXPORT int32_t cvxlatormgr_createXlator(void*, const char* name, cvxlatormgr_Xlator* xlator) {
  if (std::strcmp(name, "mxlator_hsdig") != 0) return -1;
  xlator->handle = nullptr;
  xlator->getStaticDesc = staticDesc;
  xlator->getDynamicDesc = dynamicDesc;
  xlator->freeText = freeText;
  ++liveXlators;
  return 0;
}
#endif

FAKE_EXPORT int32_t cvxlatormgr_destroyXlator(void*, cvxlatormgr_Xlator*) {
  --liveXlators;
  return 0;
}
