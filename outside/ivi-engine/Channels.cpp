// Channel and repeated-capability tables. The channel table is the repeated
// capability IVI_REPCAP_CHANNEL; names keep the spelling they were added
// with and are matched without regard to case. Names returned as
// ViConstString stay valid until the session is disposed.
#include "Attributes.h"

using namespace cvivi;

namespace cvivi {

ViStatus resolveRepCapName(Session& s, const std::string& repCap, std::string_view name,
                           std::string& canonical) {
  auto table = s.repCaps.find(upper(repCap));
  if (table == s.repCaps.end()) {
    return equalsIgnoreCase(repCap, IVI_REPCAP_CHANNEL) ? IVI_ERROR_NO_CHANNEL_TABLE
                                                        : IVI_ERROR_UNKNOWN_CHANNEL_NAME;
  }
  const std::string wanted = trim(name);
  for (const auto& n : table->second) {
    if (equalsIgnoreCase(n, wanted)) {
      canonical = n;
      return VI_SUCCESS;
    }
  }
  return IVI_ERROR_UNKNOWN_CHANNEL_NAME;
}

}  // namespace cvivi

namespace {

void updateChannelCount(Session& s) {
  auto it = s.repCaps.find(upper(IVI_REPCAP_CHANNEL));
  if (Value* v = directValue(s, IVI_ATTR_CHANNEL_COUNT)) {
    *v = ViInt32(it == s.repCaps.end() ? 0 : static_cast<ViInt32>(it->second.size()));
  }
}

ViStatus addNames(Session& s, std::string_view repCap, ViConstString names, bool create) {
  const std::string id = trim(repCap);
  if (id.empty()) return IVI_ERROR_INVALID_PARAMETER;
  auto it = s.repCaps.find(upper(id));
  if (create && it != s.repCaps.end()) return IVI_ERROR_ITEM_ALREADY_EXISTS;
  if (!create && it == s.repCaps.end()) {
    return equalsIgnoreCase(id, IVI_REPCAP_CHANNEL) ? IVI_ERROR_NO_CHANNEL_TABLE
                                                    : IVI_ERROR_UNKNOWN_CHANNEL_NAME;
  }
  const auto list = splitList(names ? names : "");
  std::deque<std::string> existing = it == s.repCaps.end() ? std::deque<std::string>{} : it->second;
  for (const auto& n : list) {
    for (const auto& e : existing) {
      if (equalsIgnoreCase(e, n)) return IVI_ERROR_ITEM_ALREADY_EXISTS;
    }
    existing.push_back(n);
  }
  if (it == s.repCaps.end()) {
    s.repCaps.emplace(upper(id), std::move(existing));
  } else {
    // Append one by one: existing elements of the deque keep their address.
    for (size_t i = it->second.size(); i < existing.size(); ++i) it->second.push_back(existing[i]);
  }
  updateChannelCount(s);
  return VI_SUCCESS;
}

ViStatus restrict(ViSession vi, ViAttr attributeId, ViConstString names) {
  return withSession(vi, [&](Session& s) {
    auto it = s.attributes.find(attributeId);
    if (it == s.attributes.end()) return IVI_ERROR_INVALID_ATTRIBUTE;
    Attribute& a = it->second;
    if (a.repCap.empty()) return IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED;
    std::set<std::string> allowed;
    for (const auto& n : splitList(names ? names : "")) {
      std::string canonical;
      if (ViStatus st = resolveRepCapName(s, a.repCap, n, canonical); st < 0) return st;
      allowed.insert(canonical);
    }
    a.allowedInstances = std::move(allowed);
    return VI_SUCCESS;
  });
}

ViStatus validateFor(ViSession vi, ViAttr attributeId, ViConstString name) {
  return withSession(vi, [&](Session& s) {
    Attribute* a = nullptr;
    std::string key;
    return lookupAttribute(s, attributeId, 0, name, a, key);
  });
}

ViStatus indexOf(ViSession vi, std::string_view repCap, ViConstString name, ViInt32* index) {
  if (!index) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    std::string canonical;
    if (ViStatus st = resolveRepCapName(s, std::string(repCap), name ? name : "", canonical);
        st < 0) {
      return st;
    }
    const auto& names = s.repCaps[upper(repCap)];
    for (size_t i = 0; i < names.size(); ++i) {
      if (names[i] == canonical) *index = static_cast<ViInt32>(i + 1);
    }
    return VI_SUCCESS;
  });
}

ViStatus nthName(ViSession vi, std::string_view repCap, ViInt32 index, ViConstString* name) {
  if (!name) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    auto it = s.repCaps.find(upper(repCap));
    if (it == s.repCaps.end()) {
      return equalsIgnoreCase(repCap, IVI_REPCAP_CHANNEL) ? IVI_ERROR_NO_CHANNEL_TABLE
                                                          : IVI_ERROR_UNKNOWN_CHANNEL_NAME;
    }
    if (index < 1 || static_cast<size_t>(index) > it->second.size()) {
      return IVI_ERROR_INVALID_PARAMETER;
    }
    *name = it->second[static_cast<size_t>(index - 1)].c_str();
    return VI_SUCCESS;
  });
}

ViStatus coerceName(ViSession vi, std::string_view repCap, ViConstString name,
                    ViConstString* coerced) {
  if (!coerced) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    std::string canonical;
    if (ViStatus st = resolveRepCapName(s, std::string(repCap), name ? name : "", canonical);
        st < 0) {
      return st;
    }
    for (const auto& n : s.repCaps[upper(repCap)]) {
      if (n == canonical) *coerced = n.c_str();
    }
    return VI_SUCCESS;
  });
}

}  // namespace

ViStatus Ivi_BuildChannelTable(ViSession vi, ViConstString channelList) {
  return withSession(
      vi, [&](Session& s) { return addNames(s, IVI_REPCAP_CHANNEL, channelList, true); });
}
ViStatus Ivi_AddToChannelTable(ViSession vi, ViConstString channelsToAdd) {
  return withSession(
      vi, [&](Session& s) { return addNames(s, IVI_REPCAP_CHANNEL, channelsToAdd, false); });
}
ViStatus Ivi_BuildRepCapTable(ViSession vi, ViConstString repCapIdentifier,
                              ViConstString repCapNames) {
  return withSession(vi, [&](Session& s) {
    return addNames(s, repCapIdentifier ? repCapIdentifier : "", repCapNames, true);
  });
}
ViStatus Ivi_AddToRepCapTable(ViSession vi, ViConstString repCapIdentifier,
                              ViConstString namesToAdd) {
  return withSession(vi, [&](Session& s) {
    return addNames(s, repCapIdentifier ? repCapIdentifier : "", namesToAdd, false);
  });
}
ViStatus Ivi_RestrictAttrToChannels(ViSession vi, ViAttr attributeId, ViConstString channels) {
  return restrict(vi, attributeId, channels);
}
ViStatus Ivi_RestrictAttrToInstances(ViSession vi, ViAttr attributeId, ViConstString instances) {
  return restrict(vi, attributeId, instances);
}
ViStatus Ivi_ValidateAttrForChannel(ViSession vi, ViConstString channelName, ViAttr attributeId) {
  return validateFor(vi, attributeId, channelName);
}
ViStatus Ivi_ValidateAttrForRepCapName(ViSession vi, ViAttr attributeId, ViConstString repCapName) {
  return validateFor(vi, attributeId, repCapName);
}
ViStatus Ivi_CoerceChannelName(ViSession vi, ViConstString channelName,
                               ViConstString* coercedChannelName) {
  return coerceName(vi, IVI_REPCAP_CHANNEL, channelName, coercedChannelName);
}
ViStatus Ivi_GetUserChannelName(ViSession vi, ViConstString channelName,
                                ViConstString* userChannelName) {
  // This engine has no virtual channel names: the user's name is the
  // channel's own.
  return coerceName(vi, IVI_REPCAP_CHANNEL, channelName, userChannelName);
}
ViStatus Ivi_CoerceRepCapName(ViSession vi, ViAttr attributeId, ViConstString repCapName,
                              ViConstString* coercedName) {
  if (!coercedName) return IVI_ERROR_NULL_POINTER;
  return withSession(vi, [&](Session& s) {
    auto it = s.attributes.find(attributeId);
    if (it == s.attributes.end()) return IVI_ERROR_INVALID_ATTRIBUTE;
    if (it->second.repCap.empty()) return IVI_ERROR_CHANNEL_NAME_NOT_ALLOWED;
    return coerceName(vi, it->second.repCap, repCapName, coercedName);
  });
}
ViStatus Ivi_GetChannelIndex(ViSession vi, ViConstString channelName, ViInt32* index) {
  return indexOf(vi, IVI_REPCAP_CHANNEL, channelName, index);
}
ViStatus Ivi_GetRepCapIndex(ViSession vi, ViConstString repCapIdentifier, ViConstString repCapName,
                            ViInt32* index) {
  return indexOf(vi, repCapIdentifier ? repCapIdentifier : "", repCapName, index);
}
ViStatus Ivi_GetNthChannelString(ViSession vi, ViInt32 index, ViConstString* channelName) {
  return nthName(vi, IVI_REPCAP_CHANNEL, index, channelName);
}
ViStatus Ivi_GetNthRepCapName(ViSession vi, ViConstString repCapIdentifier, ViInt32 index,
                              ViConstString* repCapName) {
  return nthName(vi, repCapIdentifier ? repCapIdentifier : "", index, repCapName);
}
