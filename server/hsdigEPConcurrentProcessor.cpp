#include "server/hsdigEPConcurrentProcessor.h"

#include <exception>

#include <thrift/TApplicationException.h>

#include "hsdigEP_methods.h"
#include "transport/TStreamingFramedTransport.h"

namespace hsdig {

namespace {

using apache::thrift::TApplicationException;
using apache::thrift::protocol::TMessageType;

// The request has been read completely: end the read and hand the worker
// lock back before the handler runs.
void finishRead(CallContext& call) {
  call.iprot->readMessageEnd();
  call.iprot->getTransport()->readEnd();
  call.serverContext->requestRead();
  call.state = CallContext::kIdle;
}

// Writes one reply message under the connection's reply lock. `body` writes
// the record.
template <class Body>
void writeReply(CallContext& call, const std::string& name, TMessageType type, Body&& body) {
  call.serverContext->replyStarting();
  call.state = CallContext::kWritingReply;
  try {
    call.oprot->writeMessageBegin(name, type, call.seqid);
    body(*call.oprot);
    call.oprot->writeMessageEnd();
    call.oprot->getTransport()->writeEnd();
    call.oprot->getTransport()->flush();
  } catch (...) {
    // A reply transport that sends large fields from the result's memory
    // must not keep references to a result that is about to go.
    auto* streaming =
        dynamic_cast<transport::TStreamingFramedTransport*>(call.oprot->getTransport().get());
    if (streaming != nullptr) streaming->discardWrite();
    throw;
  }
  call.serverContext->replyFinished();
  call.state = CallContext::kIdle;
}

void writeException(CallContext& call, const std::string& name,
                    const TApplicationException& exception) {
  writeReply(call, name, apache::thrift::protocol::T_EXCEPTION,
             [&](apache::thrift::protocol::TProtocol& out) { exception.write(&out); });
}

// The process function of method M; one instance per entry of the method table.
template <class M>
void processMethod(CallContext& call, hsdigEPIf* iface) {
  call.methodName = M::wireName;
  typename M::Args args;
  args.read(call.iprot);
  finishRead(call);

  typename M::Result result;
  try {
    M::invoke(*iface, result, args);
  } catch (const std::exception& e) {
    writeException(call, call.methodName,
                   TApplicationException(TApplicationException::UNKNOWN, e.what()));
    return;
  }
  if constexpr (M::hasResult) result.__isset.success = true;
  writeReply(call, call.methodName, apache::thrift::protocol::T_REPLY,
             [&](apache::thrift::protocol::TProtocol& out) { result.write(&out); });
}

void processUnknownMethod(CallContext& call) {
  call.iprot->skip(apache::thrift::protocol::T_STRUCT);
  finishRead(call);
  writeException(call, call.fname,
                 TApplicationException(TApplicationException::UNKNOWN_METHOD,
                                       "Invalid method name: '" + call.fname + "'"));
}

// Tells the server context how far an abandoned call got. Runs on every way
// out of process(); a call that ended cleanly is idle and needs nothing.
class FinishGuard {
 public:
  explicit FinishGuard(CallContext& call) : call_(call) {}
  FinishGuard(const FinishGuard&) = delete;
  FinishGuard& operator=(const FinishGuard&) = delete;
  ~FinishGuard() {
    if (call_.state == CallContext::kReadingRequest) {
      call_.serverContext->callFailed();
      call_.serverContext->requestRead();
    } else if (call_.state == CallContext::kWritingReply) {
      call_.serverContext->callFailed();
      call_.serverContext->replyFinished();
    }
  }

 private:
  CallContext& call_;
};

}  // namespace

hsdigEPConcurrentProcessor::hsdigEPConcurrentProcessor(std::shared_ptr<hsdigEPIf> iface)
    : iface_(std::move(iface)) {
#define HSDIG_REGISTER_METHOD(index, name) \
  processMap_[methods::name::wireName] = &processMethod<methods::name>;
  HSDIG_EP_METHODS(HSDIG_REGISTER_METHOD)
#undef HSDIG_REGISTER_METHOD
}

bool hsdigEPConcurrentProcessor::process(std::shared_ptr<apache::thrift::protocol::TProtocol> in,
                                         std::shared_ptr<apache::thrift::protocol::TProtocol> out,
                                         TConcurrentServerContext* serverContext,
                                         void* connectionContext) {
  CallContext call;
  call.iprot = in.get();
  call.oprot = out.get();
  call.serverContext = serverContext;
  call.connectionContext = connectionContext;
  FinishGuard finish(call);

  serverContext->requestStarting();
  call.state = CallContext::kReadingRequest;
  TMessageType mtype;
  call.iprot->readMessageBegin(call.fname, mtype, call.seqid);
  call.mtype = mtype;
  if (call.mtype != apache::thrift::protocol::T_CALL &&
      call.mtype != apache::thrift::protocol::T_ONEWAY) {
    return false;
  }
  dispatch(call);
  return true;
}

void hsdigEPConcurrentProcessor::dispatch(CallContext& call) {
  auto found = processMap_.find(call.fname);
  if (found != processMap_.end() && found->second != nullptr) {
    found->second(call, iface_.get());
  } else {
    processUnknownMethod(call);
  }
}

std::shared_ptr<TConcurrentProcessor> hsdigEPConcurrentProcessorFactory::getProcessor(
    const apache::thrift::TConnectionInfo& connectionInfo) {
  using ReleaseHandler = apache::thrift::ReleaseHandler<hsdigEPIfFactory>;
  std::shared_ptr<hsdigEPIf> handler(handlerFactory_->getHandler(connectionInfo),
                                     ReleaseHandler(handlerFactory_));
  return std::make_shared<hsdigEPConcurrentProcessor>(handler);
}

}  // namespace hsdig
