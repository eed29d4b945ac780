// Hand-made request frames and reply parsing for the server tests.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/transport/TBufferTransports.h>

#include "contract/TransportConfiguration.h"
#include "hsdigEP.h"

namespace hsdig::test {

// One framed "reset" request, optionally padded by an unknown string field so
// that the payload has exactly `payloadSize` bytes.
inline std::string resetFrame(int32_t seqid, int32_t vi, uint32_t payloadSize = 0) {
  auto build = [&](uint32_t padding) {
    auto buffer = std::make_shared<apache::thrift::transport::TMemoryBuffer>();
    auto out = contract::makeProtocolFactory()->getProtocol(buffer);
    out->writeMessageBegin("reset", apache::thrift::protocol::T_CALL, seqid);
    out->writeStructBegin("hsdigEP_reset_pargs");
    out->writeFieldBegin("vi", apache::thrift::protocol::T_I32, 1);
    out->writeI32(vi);
    if (padding > 0) {
      out->writeFieldBegin("pad", apache::thrift::protocol::T_STRING, 99);
      out->writeString(std::string(padding, 'p'));
    }
    out->writeFieldStop();
    out->writeStructEnd();
    out->writeMessageEnd();
    return buffer->getBufferAsString();
  };
  std::string payload = build(0);
  if (payloadSize > payload.size()) {
    // The padding field costs 7 bytes of header besides its content.
    payload = build(payloadSize - static_cast<uint32_t>(payload.size()) - 7);
  }
  uint32_t n = static_cast<uint32_t>(payload.size());
  std::string frame{static_cast<char>(n >> 24), static_cast<char>(n >> 16),
                    static_cast<char>(n >> 8), static_cast<char>(n)};
  return frame + payload;
}

// The status codes of the complete "reset" replies framed in `bytes`.
inline std::vector<int32_t> resetReplyCodes(const std::string& bytes) {
  std::vector<int32_t> codes;
  size_t at = 0;
  while (bytes.size() - at >= 4) {
    const auto* p = reinterpret_cast<const uint8_t*>(bytes.data() + at);
    uint32_t size = (uint32_t{p[0]} << 24) | (uint32_t{p[1]} << 16) | (uint32_t{p[2]} << 8) | p[3];
    if (bytes.size() - at - 4 < size) break;
    auto buffer = std::make_shared<apache::thrift::transport::TMemoryBuffer>(
        const_cast<uint8_t*>(p + 4), size);
    auto in = contract::makeProtocolFactory()->getProtocol(buffer);
    std::string name;
    apache::thrift::protocol::TMessageType type;
    int32_t seqid;
    in->readMessageBegin(name, type, seqid);
    hsdigEP_reset_result result;
    result.read(in.get());
    codes.push_back(result.success.code);
    at += 4 + size;
  }
  return codes;
}

}  // namespace hsdig::test
