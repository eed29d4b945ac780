// LanguageAccessor: in which language error text for a session is made.
//
// A session registered in the SessionRegistry answers for itself; every
// other session, and session 0, gets the process default. The default starts
// from the host environment's language when the host runtime is in the
// process ("French" 1, "German" 2, "Japanese" 3, "Korean" 4, "ChineseS" 5,
// anything else 0) and is 0 without it; session open changes it from the
// option string.
//
// Language codes: 0 English, 1 French, 2 German, 3 Japanese, 4 Korean,
// 5 Simplified Chinese, 6 none of these.
//
// Threads: getLanguage takes the registry's reader side, then its own reader
// side; setDefaultLanguage takes only its own writer side.
#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "session/IviWrapperInterface.h"
#include "session/ReadersWriterGate.h"
#include "session/SessionRegistry.h"

namespace hsdig {

class LanguageAccessorInterface {
 public:
  virtual ~LanguageAccessorInterface() = default;
  virtual uint32_t getLanguage(IviWrapperInterface& wrapper) = 0;
  virtual void setDefaultLanguage(uint32_t language) = 0;
};

template <class SessionT>
class LanguageAccessor : public LanguageAccessorInterface {
 public:
  LanguageAccessor(SessionRegistryInterface<SessionT>& registry, uint32_t defaultLanguage)
      : registry_(registry), defaultLanguage_(defaultLanguage) {}

  uint32_t getLanguage(IviWrapperInterface& wrapper) override {
    const ViSession handle = wrapper.getSessionHandle();
    if (handle != 0) {
      if (auto session = registry_.find(handle)) return session->getLanguage();
    }
    ReadersWriterGate::ReadGuard guard(gate_);
    return defaultLanguage_;
  }

  void setDefaultLanguage(uint32_t language) override {
    ReadersWriterGate::WriteGuard guard(gate_);
    defaultLanguage_ = language;
  }

 private:
  SessionRegistryInterface<SessionT>& registry_;
  uint32_t defaultLanguage_;  // guarded by gate_
  ReadersWriterGate gate_;
};

// The host environment's language name, or nothing when its runtime is not
// in the process. The host-environment layer installs the query; until then
// there is no host runtime.
using HostLanguageQuery = std::function<std::optional<std::string>()>;
void setHostLanguageQuery(HostLanguageQuery query);

// The language code for a host language name.
uint32_t languageFromHostName(std::string_view name);
// The default language a new LanguageAccessor starts with under `query`.
uint32_t defaultLanguageFromHost(const HostLanguageQuery& query);

// The process's accessor, created on first use together with the registry;
// its default comes from the host query installed at that moment.
LanguageAccessor<Session>& languageAccessor();

}  // namespace hsdig
