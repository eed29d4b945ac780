#include "errors/translator/SharedFolder.h"

#include <dlfcn.h>

#include <cctype>
#include <cstdlib>
#include <memory>

namespace hsdig::translator {

namespace {

std::string parentOf(const std::string& path) {
  auto slash = path.find_last_of('/');
  if (slash == std::string::npos) return ".";
  if (slash == 0) return "/";
  return path.substr(0, slash);
}

std::string computeSharedFolder() {
  Dl_info info{};
  // The address of this function identifies the binary that contains it.
  if (dladdr(reinterpret_cast<void*>(&computeSharedFolder), &info) == 0 ||
      info.dli_fname == nullptr) {
    return "share/Corvana/Shared";
  }
  std::unique_ptr<char, decltype(&std::free)> real(realpath(info.dli_fname, nullptr), &std::free);
  std::string binary = real ? std::string(real.get()) : std::string(info.dli_fname);
  return parentOf(parentOf(binary)) + "/share/Corvana/Shared";
}

bool isNameChar(char c) {
  return std::isalnum(static_cast<unsigned char>(c)) != 0 || c == '_';
}

}  // namespace

const std::string& installSharedFolder() {
  static const std::string folder = computeSharedFolder();
  return folder;
}

std::string expandPath(std::string_view path, const std::string& sharedFolder) {
  std::string out;
  std::size_t i = 0;
  while (i < path.size()) {
    if (path[i] != '$') {
      out.push_back(path[i++]);
      continue;
    }
    std::size_t end = i + 1;
    while (end < path.size() && isNameChar(path[end])) ++end;
    std::string_view name = path.substr(i + 1, end - i - 1);
    if (name == "_cvShared32Dir" || name == "_cvSharedDir") {
      out += sharedFolder;
    } else {
      out.append(path.substr(i, end - i));
    }
    i = end;
  }
  return out;
}

}  // namespace hsdig::translator
