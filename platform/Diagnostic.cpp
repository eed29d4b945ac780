#include "platform/Diagnostic.h"

#include <thrift/Thrift.h>

namespace hsdig::platform {

std::string errnoText(const char* text, int error) {
  return std::string(text) + "errno = " + std::to_string(error);
}

void reportLine(const char* text) {
  apache::thrift::GlobalOutput(text);
}

void reportErrno(const char* text, int error) {
  apache::thrift::GlobalOutput(errnoText(text, error).c_str());
}

}  // namespace hsdig::platform
