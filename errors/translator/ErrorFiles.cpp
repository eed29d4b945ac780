#include "errors/translator/ErrorFiles.h"

#include <dirent.h>
#include <strings.h>
#include <sys/stat.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

namespace hsdig::translator {

namespace {

constexpr std::size_t kLineLimit = 1024;

struct FileCloser {
  void operator()(std::FILE* f) const { std::fclose(f); }
};
using File = std::unique_ptr<std::FILE, FileCloser>;

struct DirCloser {
  void operator()(DIR* d) const { closedir(d); }
};
using Dir = std::unique_ptr<DIR, DirCloser>;

std::string_view trim(std::string_view s) {
  const char* space = " \t\r\n";
  auto first = s.find_first_not_of(space);
  if (first == std::string_view::npos) return {};
  auto last = s.find_last_not_of(space);
  return s.substr(first, last - first + 1);
}

bool startsWithNoCase(std::string_view s, std::string_view prefix) {
  return s.size() >= prefix.size() && strncasecmp(s.data(), prefix.data(), prefix.size()) == 0;
}

bool equalsNoCase(std::string_view s, std::string_view other) {
  return s.size() == other.size() && startsWithNoCase(s, other);
}

// Reads lines as a 1024-character line buffer does: a longer line arrives
// in pieces. The line ending is removed.
class LineReader {
 public:
  explicit LineReader(std::FILE* f) : f_(f) {}
  bool next(std::string& line) {
    char buffer[kLineLimit];
    if (std::fgets(buffer, sizeof buffer, f_) == nullptr) return false;
    line.assign(buffer);
    while (!line.empty() && (line.back() == '\n' || line.back() == '\r')) line.pop_back();
    return true;
  }
  bool failed() const { return std::ferror(f_) != 0; }

 private:
  std::FILE* f_;
};

// The code of an error section heading, or nothing when `line` is not one.
std::optional<int32_t> sectionCode(std::string_view line) {
  constexpr std::string_view kOpen = "<cverror code=";
  if (!startsWithNoCase(line, kOpen) || line.size() <= kOpen.size()) return std::nullopt;
  char quote = line[kOpen.size()];
  if (quote != '"' && quote != '\'') return std::nullopt;
  std::string digits(line.substr(kOpen.size() + 1));
  const char* start = digits.c_str();
  char* end = nullptr;
  errno = 0;
  long long value = std::strtoll(start, &end, 0);
  if (end == start || errno == ERANGE) return std::nullopt;
  return static_cast<int32_t>(static_cast<uint32_t>(value));
}

bool hasExplanationExtension(std::string_view name) {
  auto dot = name.rfind('.');
  if (dot == std::string_view::npos) return false;
  auto ext = name.substr(dot + 1);
  return equalsNoCase(ext, "txt") || equalsNoCase(ext, "err");
}

}  // namespace

ErrorFileLookup searchErrorFile(const std::string& path, int32_t code) {
  ErrorFileLookup result;
  File file(std::fopen(path.c_str(), "r"));
  if (!file) {
    result.failure = kCouldNotOpenFile;
    return result;
  }
  LineReader reader(file.get());
  std::string line;
  if (!reader.next(line) || !startsWithNoCase(line, "<?xml version=\"1.0\"") ||
      !reader.next(line) || !equalsNoCase(trim(line), "<cvdocument>")) {
    result.failure = kCouldNotRead;
    return result;
  }
  while (reader.next(line)) {
    std::string_view heading = trim(line);
    if (heading.empty()) continue;
    if (equalsNoCase(heading, "</cvdocument>")) return result;
    if (equalsNoCase(heading, "<cvcomment>")) {
      bool closed = false;
      while (!closed && reader.next(line)) closed = equalsNoCase(trim(line), "</cvcomment>");
      if (!closed) {
        result.failure = kCouldNotRead;
        return result;
      }
      continue;
    }
    auto sectionOf = sectionCode(heading);
    if (!sectionOf) {
      result.failure = kBadSectionHeading;
      return result;
    }
    std::string description;
    bool closed = false;
    bool first = true;
    while (reader.next(line)) {
      std::string_view body = trim(line);
      if (equalsNoCase(body, "</cverror>")) {
        closed = true;
        break;
      }
      if (startsWithNoCase(body, "<cverror") || equalsNoCase(body, "</cvdocument>")) break;
      if (!first) description.push_back('\n');
      description.append(line);
      first = false;
    }
    if (!closed) {
      result.failure = kMissingEnd;
      return result;
    }
    if (*sectionOf == code) {
      result.text = std::move(description);
      return result;
    }
  }
  // The file ended without "</cvdocument>".
  result.failure = kCouldNotRead;
  return result;
}

ErrorFileLookup searchErrorFolder(const std::string& folder, int32_t code) {
  ErrorFileLookup result;
  Dir dir(opendir(folder.c_str()));
  if (!dir) {
    if (errno != ENOENT && errno != ENOTDIR) result.failure = kOpenDirFailed;
    return result;
  }
  std::vector<std::string> names;
  while (dirent* entry = readdir(dir.get())) {
    if (hasExplanationExtension(entry->d_name)) names.emplace_back(entry->d_name);
  }
  std::sort(names.begin(), names.end());
  for (const auto& name : names) {
    std::string path = folder + "/" + name;
    struct stat info {};
    if (stat(path.c_str(), &info) != 0 && lstat(path.c_str(), &info) != 0) {
      if (result.failure.empty()) result.failure = kFileInfoFailed;
      continue;
    }
    if (S_ISDIR(info.st_mode)) continue;
    ErrorFileLookup one = searchErrorFile(path, code);
    if (one.text) {
      result.text = std::move(one.text);
      return result;
    }
    if (result.failure.empty()) result.failure = std::move(one.failure);
  }
  return result;
}

}  // namespace hsdig::translator
