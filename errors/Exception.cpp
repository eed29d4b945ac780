#include "errors/Exception.h"

#include <cstdio>

namespace hsdig {

namespace {

std::string describe(int32_t code) {
  char text[64];
  std::snprintf(text, sizeof text, "hsdigRemote status %d (0x%08X)", code,
                static_cast<uint32_t>(code));
  return text;
}

}  // namespace

Exception::Exception(int32_t code, const std::source_location& where)
    : status_(code, where), where_(where), what_(describe(code)) {}

Exception::Exception(const Status& status, const std::source_location& where)
    : status_(status), where_(where), what_(describe(status.code())) {
  if (!status_.description().IsObject() || !status_.description().HasMember("file")) {
    // A copied status without a location gets the throw site: force it by
    // setting the code on a fresh status and carrying the description over.
    Status located(status.code(), where);
    if (status_.hasDescription()) {
      auto& doc = located.description();
      for (auto& m : status_.description().GetObject()) {
        if (!doc.HasMember(m.name)) {
          doc.AddMember(rapidjson::Value(m.name, doc.GetAllocator()),
                        rapidjson::Value(m.value, doc.GetAllocator()), doc.GetAllocator());
        }
      }
    }
    status_ = std::move(located);
  }
}

HostErrorException::HostErrorException(int32_t code, const char* text)
    : code_(code), text_(text ? text : "") {}

}  // namespace hsdig
