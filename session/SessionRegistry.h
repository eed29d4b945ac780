// Session and SessionRegistry: a process-wide map from IVI session handle to
// a shared Session object.
//
// Nothing in this library adds sessions today; the registry is consulted by
// LanguageAccessor, so a component that wants a per-session error-text
// language registers a Session that answers it.
//
// Threads: readers (get, find) share the gate, writers (add, remove) have it
// alone.
#pragma once

#include <cstdint>
#include <map>
#include <memory>

#include "errors/Exception.h"
#include "hsdigRemote/vitypes.h"
#include "session/ReadersWriterGate.h"

namespace hsdig {

inline constexpr ViStatus kInvalidSessionHandle = static_cast<ViStatus>(0xBFFA1190);

class Session {
 public:
  virtual ~Session() = default;
  // The session's error-text language (0 English ... 5 Simplified Chinese).
  virtual uint32_t getLanguage() const = 0;
};

template <class SessionT>
class SessionRegistryInterface {
 public:
  virtual ~SessionRegistryInterface() = default;
  // Inserts; a handle already present keeps its first object.
  virtual void add(ViSession handle, std::shared_ptr<SessionT> session) = 0;
  // Erases; an absent handle is ignored.
  virtual void remove(ViSession handle) = 0;
  // The session; Exception(kInvalidSessionHandle) when absent.
  virtual std::shared_ptr<SessionT> get(ViSession handle) = 0;
  // The session, or empty when absent.
  virtual std::shared_ptr<SessionT> find(ViSession handle) = 0;
};

template <class SessionT>
class SessionRegistry : public SessionRegistryInterface<SessionT> {
 public:
  void add(ViSession handle, std::shared_ptr<SessionT> session) override {
    ReadersWriterGate::WriteGuard guard(gate_);
    sessions_.emplace(handle, std::move(session));
  }
  void remove(ViSession handle) override {
    ReadersWriterGate::WriteGuard guard(gate_);
    sessions_.erase(handle);
  }
  std::shared_ptr<SessionT> get(ViSession handle) override {
    if (auto session = find(handle)) return session;
    throw Exception(kInvalidSessionHandle);
  }
  std::shared_ptr<SessionT> find(ViSession handle) override {
    ReadersWriterGate::ReadGuard guard(gate_);
    auto it = sessions_.find(handle);
    return it == sessions_.end() ? nullptr : it->second;
  }

 private:
  std::map<ViSession, std::shared_ptr<SessionT>> sessions_;  // guarded by gate_
  ReadersWriterGate gate_;
};

// The process's registry, created on first use.
SessionRegistry<Session>& sessionRegistry();

}  // namespace hsdig
