// The stand-in engine's session store: sessions, their recursive lock, their
// attributes and the per-thread session 0.
//
// Every engine function that takes a session runs under that session's lock
// (Session::acquire), recursively for the holder, so attribute values, error
// information and tables of one session are only touched by one thread at a
// time, and a callback may call back into the engine on the same session.
// Ivi_LockSession keeps the lock beyond one call. The global session map has
// its own mutex, held only to look a handle up.
#pragma once

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string>
#include <thread>
#include <variant>
#include <vector>

#include "IviEngine.h"

namespace cvivi {

using Value = std::variant<ViInt32, ViInt64, ViReal64, std::string, ViBoolean, ViSession, ViAddr>;
using AnyCallback = void (*)();

// One value of an attribute: the whole attribute, or one channel or
// repeated-capability instance of it.
struct Instance {
  Value value;
  bool cacheValid = false;
  bool setByUser = false;      // since the last reset
  bool everSetByUser = false;  // since the session was created
};

struct Attribute {
  ViAttr id = 0;
  std::string name;
  ViInt32 type = 0;  // IVI_VAL_INT32 ...
  ViInt32 flags = 0;
  Value defaultValue;
  std::string repCap;                      // empty: not repeated
  std::set<std::string> allowedInstances;  // empty: every instance
  AnyCallback callbacks[5] = {};           // IVI_CALLBACK_READ ... COMPARE
  IviRangeTablePtr rangeTable = nullptr;
  IviRangeTableCallback rangeTableCallback = nullptr;
  IviRangeTablePtr storedRangeTable = nullptr;
  ViInt32 comparePrecision = 14;
  std::map<std::string, Instance> instances;  // by canonical instance name ("" when not repeated)
  std::vector<std::pair<ViAttr, bool>> invalidations;  // (attribute, same channel only)
};

// A range table made by Ivi_RangeTableNew: the engine owns entries and the
// copies of their command strings.
struct OwnedRangeTable {
  IviRangeTable table{};
  ViInt32 capacity = 0;  // entries before the end entry
  std::vector<IviRangeTableEntry> entries;
  std::vector<std::string> cmdStrings;
};

class Session {
 public:
  explicit Session(ViSession handle) : handle_(handle) {}
  ViSession handle() const { return handle_; }

  // Takes the lock for the calling thread (recursively). Fails with
  // IVI_ERROR_INVALID_SESSION_HANDLE once the session is disposed.
  ViStatus acquire();
  // Releases one level; IVI_ERROR_SESSION_NOT_LOCKED when the caller does
  // not hold the lock.
  ViStatus release();
  // Marks the session disposed and wakes every waiter. The caller holds the
  // lock; afterwards nobody does.
  void markDisposed();

  // State below is guarded by the session lock.
  std::map<ViAttr, Attribute> attributes;
  std::map<std::string, std::deque<std::string>> repCaps;  // by upper-case identifier
  std::deque<std::string> coercionRecords;
  std::deque<std::pair<ViInt32, std::string>> instrErrors;
  bool needToCheckStatus = false;
  std::set<void*> allocations;
  std::map<IviRangeTablePtr, std::unique_ptr<OwnedRangeTable>> rangeTables;
  std::optional<std::string> pendingString;  // Ivi_SetValInStringCallback

 private:
  const ViSession handle_;
  std::mutex mutex_;
  std::condition_variable released_;
  std::thread::id owner_;
  int depth_ = 0;
  bool disposed_ = false;
};

using SessionPtr = std::shared_ptr<Session>;

// The session for `vi`: a live session, the calling thread's session 0 for
// vi == 0, or null.
SessionPtr findSession(ViSession vi);
// Creates and registers a session with a new handle (never 0, never reused
// while the process lives).
SessionPtr createSession();
// Removes `vi` from the map (the caller then marks it disposed).
void unregisterSession(ViSession vi);

// Runs `body(Session&)` under the session lock. Exceptions never leave:
// out of memory gives IVI_ERROR_SYS_RSRC_ALLOC, anything else
// IVI_ERROR_CANNOT_RECOVER.
template <class Body>
ViStatus withSession(ViSession vi, Body&& body) noexcept {
  try {
    SessionPtr s = findSession(vi);
    if (!s) return IVI_ERROR_INVALID_SESSION_HANDLE;
    if (ViStatus st = s->acquire(); st < 0) return st;
    struct Release {
      Session& s;
      ~Release() { s.release(); }
    } release{*s};
    return body(*s);
  } catch (const std::bad_alloc&) {
    return IVI_ERROR_SYS_RSRC_ALLOC;
  } catch (...) {
    return IVI_ERROR_CANNOT_RECOVER;
  }
}

// Runs `body()` with the same exception rule, for functions without a session.
template <class Body>
ViStatus guarded(Body&& body) noexcept {
  try {
    return body();
  } catch (const std::bad_alloc&) {
    return IVI_ERROR_SYS_RSRC_ALLOC;
  } catch (...) {
    return IVI_ERROR_CANNOT_RECOVER;
  }
}

// Text helpers shared by the engine's files.
std::string trim(std::string_view text);
std::string upper(std::string_view text);
bool equalsIgnoreCase(std::string_view a, std::string_view b);
// Splits a comma-separated list into trimmed, non-empty names.
std::vector<std::string> splitList(std::string_view text);
// The IVI string output rule (see IviEngine.h).
ViStatus copyOut(std::string_view text, ViInt32 bufferSize, ViChar* buffer);

// Drops the session's range tables from the index of owned tables.
void forgetRangeTables(Session& s);

// Engine-internal attribute access that bypasses flags and callbacks.
void addInherentAttribute(Session& s, ViAttr id, const char* name, ViInt32 type, Value value,
                          ViInt32 flags);
Value* directValue(Session& s, ViAttr id);
bool directBoolean(Session& s, ViAttr id);

// Error information of the session (session 0 included), under its lock.
void setErrorInfo(Session& s, bool overwrite, ViStatus primary, ViStatus secondary,
                  std::string_view elaboration);
// Records an error of a call that has no session yet on the calling
// thread's session 0 (overwriting), and returns `code`.
ViStatus recordOnSessionZero(ViStatus code, std::string_view elaboration);

}  // namespace cvivi
