// Diagnostic lines for Thrift's process-wide output (apache::thrift::
// GlobalOutput), whose sink the host controls and which discards by default.
#pragma once

#include <string>

namespace hsdig::platform {

// The perror style of this system: the fixed text followed directly by
// "errno = " and the decimal error number, e.g. "TPipe ::ReadFile errored
// GLE=errno = 104".
std::string errnoText(const char* text, int error);

// Writes `text` as one diagnostic line.
void reportLine(const char* text);

// Writes errnoText(text, error) as one diagnostic line.
void reportErrno(const char* text, int error);

}  // namespace hsdig::platform
