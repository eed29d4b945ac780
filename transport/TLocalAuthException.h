// The failure of an access-control check or of building one.
#pragma once

#include <thrift/transport/TTransportException.h>

#include <string>

namespace hsdig::transport {

// A TTransportException of kind INTERNAL_ERROR whose text is the message
// given, or "TLocalAuthException" when that is empty.
class TLocalAuthException : public apache::thrift::transport::TTransportException {
 public:
  explicit TLocalAuthException(const std::string& message)
      : TTransportException(INTERNAL_ERROR, message.empty() ? "TLocalAuthException" : message) {}
};

}  // namespace hsdig::transport
