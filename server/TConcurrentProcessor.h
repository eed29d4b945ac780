// A processor that turns one complete request frame into one handler call
// and one reply, reporting its progress to a TConcurrentServerContext.
#pragma once

#include <memory>

#include <thrift/TProcessor.h>
#include <thrift/protocol/TProtocol.h>

#include "server/CallContext.h"
#include "server/TConcurrentServerContext.h"

namespace hsdig {

class TConcurrentProcessor {
 public:
  virtual ~TConcurrentProcessor() = default;

  // Serves the request held by `in` and writes its answer to `out`. Returns
  // true when the frame was a call or one-way request (whatever its outcome
  // in the handler), false when its message type was anything else; then the
  // body is left unread and the stream is to be treated as corrupt.
  // Transport and protocol failures propagate after the server context has
  // been told of them.
  virtual bool process(std::shared_ptr<apache::thrift::protocol::TProtocol> in,
                       std::shared_ptr<apache::thrift::protocol::TProtocol> out,
                       TConcurrentServerContext* serverContext, void* connectionContext) = 0;

 protected:
  virtual void dispatch(CallContext& call) = 0;
};

class TConcurrentProcessorFactory {
 public:
  virtual ~TConcurrentProcessorFactory() = default;
  // Called once per accepted connection; the processor lives as long as it.
  virtual std::shared_ptr<TConcurrentProcessor> getProcessor(
      const apache::thrift::TConnectionInfo& connectionInfo) = 0;
};

}  // namespace hsdig
