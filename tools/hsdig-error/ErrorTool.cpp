#include "tools/hsdig-error/ErrorTool.h"

#include <algorithm>
#include <cerrno>
#include <cinttypes>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <optional>
#include <sstream>

#include "errors/translator/CodeMapping.h"

namespace hsdig::tools {

namespace {

constexpr std::size_t kDescriptionLimit = 16 * 1024 * 1024;

constexpr const char* kUsage =
    "usage: hsdig-error CODE [--lang en|fr|de|jp|ko|ch] [--description FILE]\n"
    "       hsdig-error --list [--lang en|fr|de|jp|ko|ch]\n"
    "       hsdig-error --help\n";

constexpr const char* kHelp =
    "Prints the full text of a status code of the digitizer driver's remote\n"
    "library, in the language asked for (English by default).\n"
    "\n"
    "  CODE               decimal (-1074097833) or hexadecimal (0xBFFA9157)\n"
    "  --lang LANG        en, fr, de, jp, ko or ch\n"
    "  --description FILE a structured error description (JSON) whose details\n"
    "                     are shown after the code's text\n"
    "  --list             every known code with the first line of its text\n"
    "  --help             this text\n"
    "\n"
    "Exit status: 0, or 1 when the code is unknown (its text is still\n"
    "printed), or 2 for bad usage.\n";

std::optional<int> languageOf(const std::string& name) {
  const char* names[] = {"en", "fr", "de", "jp", "ko", "ch"};
  for (int i = 0; i < 6; ++i) {
    if (name == names[i]) return i;
  }
  return std::nullopt;
}

// A status code in decimal or hexadecimal; unsigned 32-bit values wrap.
std::optional<int32_t> codeOf(const std::string& text) {
  if (text.empty()) return std::nullopt;
  bool negative = text[0] == '-';
  std::string digits = negative ? text.substr(1) : text;
  if (digits.empty() || digits[0] == '-' || digits[0] == '+') return std::nullopt;
  char* end = nullptr;
  errno = 0;
  unsigned long long value = std::strtoull(digits.c_str(), &end, 0);
  if (end == digits.c_str() || *end != '\0' || errno == ERANGE) return std::nullopt;
  if (negative) {
    if (value > 2147483648ULL) return std::nullopt;
    return static_cast<int32_t>(-static_cast<int64_t>(value));
  }
  if (value > 0xFFFFFFFFULL) return std::nullopt;
  return static_cast<int32_t>(static_cast<uint32_t>(value));
}

std::optional<std::string> readFile(const std::string& path, std::ostream& err) {
  std::ifstream in(path, std::ios::binary);
  if (!in) {
    err << "hsdig-error: cannot open " << path << "\n";
    return std::nullopt;
  }
  std::string text;
  char buffer[65536];
  while (in.read(buffer, sizeof buffer) || in.gcount() > 0) {
    text.append(buffer, static_cast<std::size_t>(in.gcount()));
    if (text.size() > kDescriptionLimit) {
      err << "hsdig-error: " << path << " is larger than 16 MiB\n";
      return std::nullopt;
    }
  }
  return text;
}

std::string hex(int32_t code) {
  char buffer[16];
  std::snprintf(buffer, sizeof buffer, "0x%08" PRIX32, static_cast<uint32_t>(code));
  return buffer;
}

}  // namespace

int runErrorTool(const std::vector<std::string>& args, std::ostream& out, std::ostream& err,
                 const translator::TranslatorOptions& options) {
  std::optional<int32_t> code;
  std::optional<std::string> descriptionPath;
  int language = 0;
  bool list = false;
  for (std::size_t i = 0; i < args.size(); ++i) {
    const std::string& arg = args[i];
    if (arg == "--help" || arg == "-h") {
      out << kUsage << "\n" << kHelp;
      return kExitOk;
    }
    if (arg == "--list") {
      list = true;
    } else if (arg == "--lang" || arg == "--description") {
      if (i + 1 >= args.size()) {
        err << "hsdig-error: " << arg << " needs a value\n" << kUsage;
        return kExitUsage;
      }
      const std::string& value = args[++i];
      if (arg == "--lang") {
        auto found = languageOf(value);
        if (!found) {
          err << "hsdig-error: unknown language '" << value << "'\n" << kUsage;
          return kExitUsage;
        }
        language = *found;
      } else {
        descriptionPath = value;
      }
    } else if (!code && (arg.empty() || arg[0] != '-' || codeOf(arg))) {
      code = codeOf(arg);
      if (!code) {
        err << "hsdig-error: '" << arg << "' is not a status code\n" << kUsage;
        return kExitUsage;
      }
    } else {
      err << "hsdig-error: unexpected argument '" << arg << "'\n" << kUsage;
      return kExitUsage;
    }
  }
  if (list == code.has_value() || (list && descriptionPath)) {
    err << kUsage;
    return kExitUsage;
  }

  translator::TranslatorSession session(options);
  if (list) {
    // Listed as callers see the codes: mapped, in order of their unsigned value.
    std::vector<std::pair<uint32_t, std::string>> rows;
    for (const auto& [original, text] : session.listStaticDescriptions(language)) {
      rows.emplace_back(static_cast<uint32_t>(translator::cvmxl_mapErrorCode(original)),
                        text.substr(0, text.find('\n')));
    }
    std::sort(rows.begin(), rows.end());
    for (const auto& [reported, firstLine] : rows) {
      auto code = static_cast<int32_t>(reported);
      out << hex(code) << "  " << code << "  " << firstLine << "\n";
    }
    return kExitOk;
  }

  std::string description;
  if (descriptionPath) {
    auto text = readFile(*descriptionPath, err);
    if (!text) return kExitUsage;
    description = std::move(*text);
  }
  bool known = false;
  session.staticDescription(*code, language, &known);
  auto translation = session.render(*code, description, language, translator::kFlagPlain);
  out << translation.text << "\n";
  return (known || *code == 0) ? kExitOk : kExitUnknownCode;
}

}  // namespace hsdig::tools
