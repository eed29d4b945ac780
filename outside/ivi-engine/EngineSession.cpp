// Sessions, their lock, session 0 and the small text helpers.
#include "EngineSession.h"

#include <algorithm>
#include <cctype>
#include <cstring>

namespace cvivi {
namespace {

std::mutex g_mapMutex;
std::map<ViSession, SessionPtr>& sessionMap() {
  static auto* map = new std::map<ViSession, SessionPtr>();  // outlives every caller
  return *map;
}
ViSession g_nextHandle = 1;  // guarded by g_mapMutex

// Session 0 belongs to the calling thread: a failed open or a close records
// its error there, and concurrent threads do not overwrite each other's.
SessionPtr& threadSessionZero() {
  thread_local SessionPtr zero;
  if (!zero) {
    zero = std::make_shared<Session>(0);
    addInherentAttribute(*zero, IVI_ATTR_PRIMARY_ERROR, "IVI_ATTR_PRIMARY_ERROR", IVI_VAL_INT32,
                         ViInt32{0}, 0);
    addInherentAttribute(*zero, IVI_ATTR_SECONDARY_ERROR, "IVI_ATTR_SECONDARY_ERROR", IVI_VAL_INT32,
                         ViInt32{0}, 0);
    addInherentAttribute(*zero, IVI_ATTR_ERROR_ELABORATION, "IVI_ATTR_ERROR_ELABORATION",
                         IVI_VAL_STRING, std::string(), 0);
  }
  return zero;
}

}  // namespace

ViStatus Session::acquire() {
  std::unique_lock lock(mutex_);
  const auto self = std::this_thread::get_id();
  released_.wait(lock, [&] { return disposed_ || depth_ == 0 || owner_ == self; });
  if (disposed_) return IVI_ERROR_INVALID_SESSION_HANDLE;
  owner_ = self;
  ++depth_;
  return VI_SUCCESS;
}

ViStatus Session::release() {
  std::lock_guard lock(mutex_);
  if (depth_ == 0 || owner_ != std::this_thread::get_id()) return IVI_ERROR_SESSION_NOT_LOCKED;
  if (--depth_ == 0) {
    owner_ = std::thread::id();
    released_.notify_all();
  }
  return VI_SUCCESS;
}

void Session::markDisposed() {
  std::lock_guard lock(mutex_);
  disposed_ = true;
  depth_ = 0;
  owner_ = std::thread::id();
  released_.notify_all();
}

SessionPtr findSession(ViSession vi) {
  if (vi == 0) return threadSessionZero();
  std::lock_guard lock(g_mapMutex);
  auto it = sessionMap().find(vi);
  return it == sessionMap().end() ? nullptr : it->second;
}

SessionPtr createSession() {
  std::lock_guard lock(g_mapMutex);
  auto& map = sessionMap();
  ViSession handle = g_nextHandle;
  while (handle == 0 || map.count(handle)) ++handle;
  g_nextHandle = handle + 1;
  auto s = std::make_shared<Session>(handle);
  map.emplace(handle, s);
  return s;
}

void unregisterSession(ViSession vi) {
  std::lock_guard lock(g_mapMutex);
  sessionMap().erase(vi);
}

std::string trim(std::string_view text) {
  const char* ws = " \t\r\n";
  const auto b = text.find_first_not_of(ws);
  if (b == std::string_view::npos) return {};
  const auto e = text.find_last_not_of(ws);
  return std::string(text.substr(b, e - b + 1));
}

std::string upper(std::string_view text) {
  std::string out(text);
  for (char& c : out) c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
  return out;
}

bool equalsIgnoreCase(std::string_view a, std::string_view b) {
  return a.size() == b.size() && upper(a) == upper(b);
}

std::vector<std::string> splitList(std::string_view text) {
  std::vector<std::string> out;
  size_t pos = 0;
  while (pos <= text.size()) {
    size_t comma = text.find(',', pos);
    if (comma == std::string_view::npos) comma = text.size();
    std::string item = trim(text.substr(pos, comma - pos));
    if (!item.empty()) out.push_back(std::move(item));
    pos = comma + 1;
  }
  return out;
}

ViStatus copyOut(std::string_view text, ViInt32 bufferSize, ViChar* buffer) {
  const auto needed = static_cast<ViInt32>(std::min<size_t>(text.size() + 1, 0x7fffffff));
  if (bufferSize == 0) return needed;
  if (!buffer) return IVI_ERROR_NULL_POINTER;
  if (bufferSize < 0) return IVI_ERROR_INVALID_PARAMETER;
  if (bufferSize >= needed) {
    std::memcpy(buffer, text.data(), text.size());
    buffer[text.size()] = '\0';
    return VI_SUCCESS;
  }
  std::memcpy(buffer, text.data(), static_cast<size_t>(bufferSize - 1));
  buffer[bufferSize - 1] = '\0';
  return needed;
}

void addInherentAttribute(Session& s, ViAttr id, const char* name, ViInt32 type, Value value,
                          ViInt32 flags) {
  Attribute a;
  a.id = id;
  a.name = name;
  a.type = type;
  a.flags = flags | IVI_VAL_ALWAYS_CACHE;
  a.defaultValue = value;
  a.instances[""] = Instance{std::move(value), true, false, false};
  s.attributes[id] = std::move(a);
}

Value* directValue(Session& s, ViAttr id) {
  auto it = s.attributes.find(id);
  if (it == s.attributes.end()) return nullptr;
  auto inst = it->second.instances.try_emplace("", Instance{it->second.defaultValue}).first;
  return &inst->second.value;
}

bool directBoolean(Session& s, ViAttr id) {
  Value* v = directValue(s, id);
  return v && std::holds_alternative<ViBoolean>(*v) && std::get<ViBoolean>(*v) != VI_FALSE;
}

void setErrorInfo(Session& s, bool overwrite, ViStatus primary, ViStatus secondary,
                  std::string_view elaboration) {
  Value* p = directValue(s, IVI_ATTR_PRIMARY_ERROR);
  Value* sec = directValue(s, IVI_ATTR_SECONDARY_ERROR);
  Value* el = directValue(s, IVI_ATTR_ERROR_ELABORATION);
  if (!p || !sec || !el) return;
  const ViStatus held = std::get<ViInt32>(*p);
  // Without overwrite, the first error stays: only an empty record or a
  // warning followed by an error is replaced.
  const bool replace = overwrite || (held == 0 && primary != 0) || (held > 0 && primary < 0);
  if (!replace) return;
  *p = ViInt32{primary};
  *sec = ViInt32{secondary};
  *el = std::string(elaboration);
}

ViStatus recordOnSessionZero(ViStatus code, std::string_view elaboration) {
  withSession(0, [&](Session& s) {
    setErrorInfo(s, true, code, 0, elaboration);
    return VI_SUCCESS;
  });
  return code;
}

}  // namespace cvivi
