#include "contract/TransportConfiguration.h"

namespace hsdig::contract {

std::shared_ptr<apache::thrift::TConfiguration> makeTransportConfiguration() {
  return std::make_shared<apache::thrift::TConfiguration>(kMaxFrameSize, kMaxFrameSize,
                                                          kRecursionLimit);
}

std::shared_ptr<apache::thrift::protocol::TBinaryProtocolFactory> makeProtocolFactory() {
  return std::make_shared<apache::thrift::protocol::TBinaryProtocolFactory>(
      /*string_size_limit=*/0, /*container_size_limit=*/0, /*strict_read=*/false,
      /*strict_write=*/true);
}

}  // namespace hsdig::contract
