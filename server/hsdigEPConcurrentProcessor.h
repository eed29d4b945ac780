// The dispatcher of the service hsdigEP.
//
// One processor per connection, all over one shared handler. `processMap`
// holds the 98 wire names in declaration order, each with the process
// function generated from the method table (contract/hsdigEP_methods.h).
// A process function reads the argument record, hands the worker lock back
// through the server context, calls the handler operation without any lock,
// and writes the reply under the connection's reply lock. A standard
// exception escaping the handler becomes an exception reply of type 0 with
// its text; an unknown wire name an exception reply of type 1.
#pragma once

#include <map>
#include <memory>
#include <string>

#include "hsdigEP.h"
#include "server/TConcurrentProcessor.h"

namespace hsdig {

class hsdigEPConcurrentProcessor : public TConcurrentProcessor {
 public:
  using ProcessFunction = void (*)(CallContext& call, hsdigEPIf* iface);
  using ProcessMap = std::map<std::string, ProcessFunction>;

  explicit hsdigEPConcurrentProcessor(std::shared_ptr<hsdigEPIf> iface);

  bool process(std::shared_ptr<apache::thrift::protocol::TProtocol> in,
               std::shared_ptr<apache::thrift::protocol::TProtocol> out,
               TConcurrentServerContext* serverContext, void* connectionContext) override;

  const ProcessMap& processMap() const noexcept { return processMap_; }

 protected:
  void dispatch(CallContext& call) override;

 private:
  ProcessMap processMap_;
  std::shared_ptr<hsdigEPIf> iface_;
};

class hsdigEPConcurrentProcessorFactory : public TConcurrentProcessorFactory {
 public:
  explicit hsdigEPConcurrentProcessorFactory(std::shared_ptr<hsdigEPIfFactory> handlerFactory)
      : handlerFactory_(std::move(handlerFactory)) {}

  // A new processor over a handler from the handler factory; the handler goes
  // back through the factory's releaseHandler when the processor is dropped.
  std::shared_ptr<TConcurrentProcessor> getProcessor(
      const apache::thrift::TConnectionInfo& connectionInfo) override;

 private:
  std::shared_ptr<hsdigEPIfFactory> handlerFactory_;
};

}  // namespace hsdig
