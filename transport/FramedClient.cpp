#include "transport/FramedClient.h"

#include "contract/TransportConfiguration.h"

namespace hsdig::transport {

std::shared_ptr<apache::thrift::transport::TFramedTransport> makeFramedTransport(
    std::shared_ptr<apache::thrift::transport::TTransport> pipe) {
  return std::make_shared<apache::thrift::transport::TFramedTransport>(
      std::move(pipe), contract::makeTransportConfiguration());
}

}  // namespace hsdig::transport
