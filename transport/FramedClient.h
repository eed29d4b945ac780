// The client's framing over a pipe: frames up to the contract's 0x10000000
// bytes, read without a whole-frame copy (see TStreamingFramedTransport).
#pragma once

#include <thrift/transport/TBufferTransports.h>

#include <memory>

namespace hsdig::transport {

std::shared_ptr<apache::thrift::transport::TFramedTransport> makeFramedTransport(
    std::shared_ptr<apache::thrift::transport::TTransport> pipe);

}  // namespace hsdig::transport
