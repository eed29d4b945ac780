// The client's framing over a pipe: the library's framed transport with the
// contract's limits (frames up to 0x10000000 bytes).
#pragma once

#include <thrift/transport/TBufferTransports.h>

#include <memory>

namespace hsdig::transport {

std::shared_ptr<apache::thrift::transport::TFramedTransport> makeFramedTransport(
    std::shared_ptr<apache::thrift::transport::TTransport> pipe);

}  // namespace hsdig::transport
