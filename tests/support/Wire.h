// Helpers for tests that build and read hsdigEP messages in memory.
#pragma once

#include <memory>
#include <string>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/transport/TBufferTransports.h>

#include "contract/TransportConfiguration.h"

namespace hsdig::test {

using apache::thrift::protocol::TBinaryProtocol;
using apache::thrift::transport::TMemoryBuffer;

// A memory buffer with the contract's limits and a binary protocol over it,
// built by the contract's protocol factory (strict write, lenient read).
struct MemoryWire {
  std::shared_ptr<TMemoryBuffer> buffer =
      std::make_shared<TMemoryBuffer>(contract::makeTransportConfiguration());
  std::shared_ptr<apache::thrift::protocol::TProtocol> protocol =
      contract::makeProtocolFactory()->getProtocol(buffer);

  std::string bytes() const { return buffer->getBufferAsString(); }
  void load(const std::string& data) {
    buffer->resetBuffer();
    buffer->write(reinterpret_cast<const uint8_t*>(data.data()),
                  static_cast<uint32_t>(data.size()));
  }
};

// Serializes a record with the contract's protocol.
template <class Record>
std::string serialize(const Record& record) {
  MemoryWire wire;
  record.write(wire.protocol.get());
  return wire.bytes();
}

// Reads a record back from bytes; throws what the reader throws.
template <class Record>
Record deserialize(const std::string& bytes) {
  MemoryWire wire;
  wire.load(bytes);
  Record record;
  record.read(wire.protocol.get());
  return record;
}

}  // namespace hsdig::test
