// hsdig-error: the status code lookup for people, as a function that tests
// can call with their own streams.
#pragma once

#include <iosfwd>
#include <string>
#include <vector>

#include "errors/translator/TranslatorSession.h"

namespace hsdig::tools {

inline constexpr int kExitOk = 0;
inline constexpr int kExitUnknownCode = 1;
inline constexpr int kExitUsage = 2;

// Runs the tool with `args` (without the program name). Texts go to `out`,
// usage problems to `err`. Returns the exit status.
int runErrorTool(const std::vector<std::string>& args, std::ostream& out, std::ostream& err,
                 const translator::TranslatorOptions& options = {});

}  // namespace hsdig::tools
