// Logical names: a small configuration file maps a logical name to a
// resource name, a driver prefix and an option string (format in the
// README). The file is read on every lookup, so edits apply at once; a file
// larger than kMaxFileSize is refused rather than read.
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <sstream>

#include "EngineSession.h"
#include "OptionString.h"

using namespace cvivi;

namespace {

constexpr std::streamoff kMaxFileSize = 1 << 20;
constexpr const char* kDefaultPath = "/etc/cvivi/logical-names.conf";

struct LogicalName {
  std::string name;
  std::string resource;
  std::string driver;
  std::string options;
};

std::string configPath() {
  const char* path = std::getenv("CVIVI_LOGICAL_NAMES");
  return path && *path ? path : kDefaultPath;
}

// Reads every entry. A missing file is an empty configuration.
ViStatus readConfiguration(std::vector<LogicalName>& out, std::string& problem) {
  out.clear();
  const std::string path = configPath();
  std::ifstream in(path, std::ios::binary | std::ios::ate);
  if (!in) return VI_SUCCESS;
  if (in.tellg() > kMaxFileSize) {
    problem = path + ": the file is larger than 1 MiB.";
    return IVI_ERROR_INVALID_CONFIGURATION;
  }
  in.seekg(0);
  std::string line;
  int lineNumber = 0;
  auto fail = [&](const std::string& why) {
    problem = path + ":" + std::to_string(lineNumber) + ": " + why;
    return IVI_ERROR_INVALID_CONFIGURATION;
  };
  while (std::getline(in, line)) {
    ++lineNumber;
    const std::string text = trim(line);
    if (text.empty() || text[0] == '#' || text[0] == ';') continue;
    if (text.front() == '[') {
      if (text.back() != ']') return fail("a section line must end with ']'.");
      LogicalName entry;
      entry.name = trim(std::string_view(text).substr(1, text.size() - 2));
      if (entry.name.empty()) return fail("empty logical name.");
      for (const auto& e : out) {
        if (equalsIgnoreCase(e.name, entry.name)) return fail("logical name given twice.");
      }
      out.push_back(std::move(entry));
      continue;
    }
    const size_t eq = text.find('=');
    if (eq == std::string::npos) return fail("expected Key = Value.");
    if (out.empty()) return fail("a value before the first [LogicalName] line.");
    const std::string key = trim(std::string_view(text).substr(0, eq));
    const std::string value = trim(std::string_view(text).substr(eq + 1));
    if (equalsIgnoreCase(key, "Resource"))
      out.back().resource = value;
    else if (equalsIgnoreCase(key, "Driver"))
      out.back().driver = value;
    else if (equalsIgnoreCase(key, "Options"))
      out.back().options = value;
    else
      return fail("unknown key \"" + key + "\".");
  }
  if (in.bad()) {
    problem = path + ": the file cannot be read.";
    return IVI_ERROR_READING_FILE;
  }
  for (const auto& e : out) {
    if (e.resource.empty()) {
      problem = path + ": logical name \"" + e.name + "\" has no Resource.";
      return IVI_ERROR_INVALID_CONFIGURATION;
    }
  }
  return VI_SUCCESS;
}

ViStatus store(const std::string& text, ViChar* buffer, const char* what) {
  if (text.size() >= IVI_MAX_RESOURCE_BUF_SIZE) {
    return recordOnSessionZero(IVI_ERROR_INVALID_VALUE, std::string("The resolved ") + what +
                                                            " is longer than 255 characters.");
  }
  std::memcpy(buffer, text.c_str(), text.size() + 1);
  return VI_SUCCESS;
}

struct NamesList {
  std::vector<std::string> names;
};
std::mutex g_listsMutex;
std::set<NamesList*>& liveLists() {
  static auto* lists = new std::set<NamesList*>();
  return *lists;
}

}  // namespace

ViStatus Ivi_GetInfoFromResourceName(ViConstString resourceName, ViConstString optionString,
                                     ViChar newResourceName[IVI_MAX_RESOURCE_BUF_SIZE],
                                     ViChar newOptionString[IVI_MAX_RESOURCE_BUF_SIZE],
                                     ViBoolean* isLogicalName) {
  return guarded([&] {
    if (!resourceName || !newResourceName || !newOptionString || !isLogicalName) {
      return recordOnSessionZero(IVI_ERROR_NULL_POINTER, "A parameter is NULL.");
    }
    const std::string resource = trim(resourceName);
    const std::string options = optionString ? optionString : "";
    std::vector<LogicalName> names;
    std::string problem;
    if (ViStatus st = readConfiguration(names, problem); st < 0) {
      return recordOnSessionZero(st, problem);
    }
    for (const auto& entry : names) {
      if (!equalsIgnoreCase(entry.name, resource)) continue;
      std::vector<OptionItem> base, caller;
      if (ViStatus st = splitOptions(entry.options, base, problem); st < 0) {
        return recordOnSessionZero(IVI_ERROR_INVALID_CONFIGURATION,
                                   "Logical name \"" + entry.name + "\": " + problem);
      }
      if (ViStatus st = splitOptions(options, caller, problem); st < 0) {
        return recordOnSessionZero(st, problem);
      }
      // The caller's items override those of the configuration.
      const std::string merged = joinOptions(mergeOptions(base, caller));
      if (ViStatus st = store(entry.resource, newResourceName, "resource name"); st < 0) return st;
      if (ViStatus st = store(merged, newOptionString, "option string"); st < 0) return st;
      *isLogicalName = VI_TRUE;
      return VI_SUCCESS;
    }
    // Not a logical name: the resource name and options pass through.
    if (ViStatus st = store(resourceName, newResourceName, "resource name"); st < 0) return st;
    if (ViStatus st = store(options, newOptionString, "option string"); st < 0) return st;
    *isLogicalName = VI_FALSE;
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetLogicalNamesList(ViConstString driverPrefix, ViInt32* count,
                                 ViAddr* logicalNamesList) {
  if (!count || !logicalNamesList) return IVI_ERROR_NULL_POINTER;
  return guarded([&] {
    std::vector<LogicalName> names;
    std::string problem;
    if (ViStatus st = readConfiguration(names, problem); st < 0) {
      return recordOnSessionZero(st, problem);
    }
    auto list = std::make_unique<NamesList>();
    for (const auto& e : names) {
      if (!driverPrefix || !*driverPrefix || equalsIgnoreCase(e.driver, driverPrefix)) {
        list->names.push_back(e.name);
      }
    }
    *count = static_cast<ViInt32>(list->names.size());
    std::lock_guard lock(g_listsMutex);
    liveLists().insert(list.get());
    *logicalNamesList = list.release();
    return VI_SUCCESS;
  });
}

ViStatus Ivi_GetNthLogicalName(ViAddr logicalNamesList, ViInt32 index, ViInt32 bufferSize,
                               ViChar logicalName[]) {
  std::lock_guard lock(g_listsMutex);
  auto* list = static_cast<NamesList*>(logicalNamesList);
  if (!liveLists().count(list)) return IVI_ERROR_INVALID_PARAMETER;
  if (index < 1 || static_cast<size_t>(index) > list->names.size()) {
    return IVI_ERROR_INVALID_PARAMETER;
  }
  return copyOut(list->names[static_cast<size_t>(index - 1)], bufferSize, logicalName);
}

ViStatus Ivi_DisposeLogicalNamesList(ViAddr logicalNamesList) {
  std::lock_guard lock(g_listsMutex);
  auto* list = static_cast<NamesList*>(logicalNamesList);
  if (!liveLists().erase(list)) return IVI_ERROR_INVALID_PARAMETER;
  delete list;
  return VI_SUCCESS;
}
