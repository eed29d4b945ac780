#include "transport/FramedClient.h"

#include "contract/TransportConfiguration.h"
#include "transport/TStreamingFramedTransport.h"

namespace hsdig::transport {

std::shared_ptr<apache::thrift::transport::TFramedTransport> makeFramedTransport(
    std::shared_ptr<apache::thrift::transport::TTransport> pipe) {
  return std::make_shared<TStreamingFramedTransport>(std::move(pipe),
                                                     contract::makeTransportConfiguration());
}

}  // namespace hsdig::transport
