#include "session/LanguageAccessor.h"

#include <mutex>

namespace hsdig {
namespace {

std::mutex g_hostQueryMutex;
HostLanguageQuery& hostQuery() {
  static auto* query = new HostLanguageQuery();
  return *query;
}

}  // namespace

void setHostLanguageQuery(HostLanguageQuery query) {
  std::lock_guard lock(g_hostQueryMutex);
  hostQuery() = std::move(query);
}

uint32_t languageFromHostName(std::string_view name) {
  static constexpr std::string_view kNames[] = {"French", "German", "Japanese", "Korean",
                                                "ChineseS"};
  for (uint32_t i = 0; i < std::size(kNames); ++i) {
    if (name == kNames[i]) return i + 1;
  }
  return 0;
}

uint32_t defaultLanguageFromHost(const HostLanguageQuery& query) {
  if (!query) return 0;
  const std::optional<std::string> name = query();
  return name ? languageFromHostName(*name) : 0;
}

SessionRegistry<Session>& sessionRegistry() {
  static auto* registry = new SessionRegistry<Session>();  // lives until the process ends
  return *registry;
}

LanguageAccessor<Session>& languageAccessor() {
  static auto* accessor = [] {
    HostLanguageQuery query;
    {
      std::lock_guard lock(g_hostQueryMutex);
      query = hostQuery();
    }
    return new LanguageAccessor<Session>(sessionRegistry(), defaultLanguageFromHost(query));
  }();
  return *accessor;
}

}  // namespace hsdig
