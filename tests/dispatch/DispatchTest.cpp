// The dispatcher over in-memory frames: routing by wire name, replies and
// exception replies, header forms, and the order of the server-context hooks.
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <vector>

#include <thrift/TApplicationException.h>
#include <thrift/transport/TVirtualTransport.h>

#include "hsdigEP_methods.h"
#include "server/ConcurrentProcessorEventHandler.h"
#include "server/hsdigEPConcurrentProcessor.h"
#include "support/Wire.h"

namespace hsdig {
namespace {

using apache::thrift::TApplicationException;
using apache::thrift::protocol::TMessageType;
using apache::thrift::protocol::TProtocol;
using apache::thrift::transport::TTransportException;
using test::MemoryWire;

// Records the hooks in the order they come.
class RecordingContext : public TConcurrentServerContext {
 public:
  void requestStarting() override { events.push_back("requestStarting"); }
  void requestRead() override { events.push_back("requestRead"); }
  void replyStarting() override { events.push_back("replyStarting"); }
  void replyFinished() override { events.push_back("replyFinished"); }
  void callFailed() override { events.push_back("callFailed"); }
  std::vector<std::string> events;
};

// A handler with observable behaviour for a few methods; the rest answer
// with default records.
class TestHandler : public hsdigEPNull {
 public:
  void registerClientSession(RetRegisterClientSession& ret, const std::string& devGUID,
                             int32_t processID) override {
    lastGuid = devGUID;
    ret.clientID = processID + 1;
    ret.status.code = 0;
  }
  void configureVertical(RetStatus& ret, const Nulls_hsdig_ConfigureVertical& nulls, int32_t vi,
                         const std::string& channelList, double range, double offset,
                         int32_t coupling, double probeAttenuation, int16_t enabled) override {
    seenVertical = {nulls.channelList, vi,     channelList, range, offset, coupling,
                    probeAttenuation,  enabled};
    ret.code = 1;
    ret.localizedTextDescription = "coerced";
  }
  void abort(RetStatus&, int32_t) override { throw std::runtime_error("driver gone"); }
  void commit(RetStatus&, int32_t) override { throw 42; }  // outside the standard family

  struct Vertical {
    bool nullChannelList;
    int32_t vi;
    std::string channelList;
    double range, offset;
    int32_t coupling;
    double probeAttenuation;
    int16_t enabled;
  };
  std::string lastGuid;
  Vertical seenVertical{};
};

// Appends one request message to `wire`.
template <class Args>
void writeRequest(MemoryWire& wire, const std::string& name, TMessageType type, int32_t seqid,
                  const Args& args) {
  wire.protocol->writeMessageBegin(name, type, seqid);
  args.write(wire.protocol.get());
  wire.protocol->writeMessageEnd();
}

struct Reply {
  std::string name;
  TMessageType type;
  int32_t seqid;
};

Reply readHeader(MemoryWire& wire) {
  Reply r;
  wire.protocol->readMessageBegin(r.name, r.type, r.seqid);
  return r;
}

class Dispatch : public ::testing::Test {
 protected:
  bool process() { return processor.process(in.protocol, out.protocol, &context, nullptr); }

  std::shared_ptr<TestHandler> handler = std::make_shared<TestHandler>();
  hsdigEPConcurrentProcessor processor{handler};
  MemoryWire in, out;
  RecordingContext context;
};

TEST_F(Dispatch, RoutesByWireNameAndPassesArgumentsInIdOrder) {
  methods::configureVertical::Args args;
  args.nulls.channelList = true;
  args.vi = 5;
  args.channelList = "0,1";
  args.range = 2.0;
  args.offset = -0.5;
  args.coupling = 1;
  args.probeAttenuation = 10.0;
  args.enabled = 1;
  writeRequest(in, "configureVertical", apache::thrift::protocol::T_CALL, 11, args);

  EXPECT_TRUE(process());
  const auto& seen = handler->seenVertical;
  EXPECT_TRUE(seen.nullChannelList);
  EXPECT_EQ(seen.vi, 5);
  EXPECT_EQ(seen.channelList, "0,1");
  EXPECT_EQ(seen.range, 2.0);
  EXPECT_EQ(seen.offset, -0.5);
  EXPECT_EQ(seen.coupling, 1);
  EXPECT_EQ(seen.probeAttenuation, 10.0);
  EXPECT_EQ(seen.enabled, 1);

  Reply reply = readHeader(out);
  EXPECT_EQ(reply.name, "configureVertical");
  EXPECT_EQ(reply.type, apache::thrift::protocol::T_REPLY);
  EXPECT_EQ(reply.seqid, 11);
  methods::configureVertical::Result result;
  result.read(out.protocol.get());
  EXPECT_TRUE(result.__isset.success);
  EXPECT_EQ(result.success.code, 1);
  EXPECT_EQ(result.success.localizedTextDescription, "coerced");
  EXPECT_EQ(context.events, (std::vector<std::string>{"requestStarting", "requestRead",
                                                      "replyStarting", "replyFinished"}));
}

TEST_F(Dispatch, SequenceIdIsEchoedOnRepliesAndExceptionReplies) {
  struct Case {
    const char* name;
    int32_t seqid;
    TMessageType expected;
  };
  const Case cases[] = {
      {"pingServer", 7, apache::thrift::protocol::T_REPLY},
      {"abort", -3, apache::thrift::protocol::T_EXCEPTION},
      {"noSuchMethod", 0x7fffffff, apache::thrift::protocol::T_EXCEPTION},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.name);
    MemoryWire request, reply;
    writeRequest(request, c.name, apache::thrift::protocol::T_CALL, c.seqid,
                 hsdigEP_abort_args());  // an argument record the method may not expect
    RecordingContext ctx;
    EXPECT_TRUE(processor.process(request.protocol, reply.protocol, &ctx, nullptr));
    Reply r = readHeader(reply);
    EXPECT_EQ(r.seqid, c.seqid);
    EXPECT_EQ(r.type, c.expected);
    EXPECT_EQ(r.name, c.name);
  }
}

TEST_F(Dispatch, OldFormHeaderIsAcceptedAndAnsweredInStrictForm) {
  // Old form: method name, then the type as a byte, then the sequence id.
  in.protocol->writeString("pingServer");
  in.protocol->writeByte(apache::thrift::protocol::T_CALL);
  in.protocol->writeI32(9);
  hsdigEP_pingServer_pargs().write(in.protocol.get());

  EXPECT_TRUE(process());
  std::string bytes = out.bytes();
  ASSERT_GE(bytes.size(), 4u);
  EXPECT_EQ(bytes.substr(0, 4), std::string("\x80\x01\x00\x02", 4));
  Reply r = readHeader(out);
  EXPECT_EQ(r.name, "pingServer");
  EXPECT_EQ(r.seqid, 9);
}

TEST_F(Dispatch, UnknownMethodGetsOneExceptionReplyAndTheStreamGoesOn) {
  // An unknown method with a non-trivial argument record, then a valid call,
  // in one stream.
  methods::registerClientSession::Args reg;
  reg.devGUID = "HSDIG_20.0_1";
  reg.processID = 41;
  writeRequest(in, "x", apache::thrift::protocol::T_CALL, 1, reg);
  writeRequest(in, "registerClientSession", apache::thrift::protocol::T_CALL, 2, reg);

  EXPECT_TRUE(process());
  Reply first = readHeader(out);
  EXPECT_EQ(first.type, apache::thrift::protocol::T_EXCEPTION);
  EXPECT_EQ(first.name, "x");
  TApplicationException x;
  x.read(out.protocol.get());
  out.protocol->readMessageEnd();
  EXPECT_EQ(x.getType(), TApplicationException::UNKNOWN_METHOD);
  EXPECT_STREQ(x.what(), "Invalid method name: 'x'");
  EXPECT_EQ(out.buffer->available_read(), 0u) << "exactly one reply";

  EXPECT_TRUE(process());
  Reply second = readHeader(out);
  EXPECT_EQ(second.type, apache::thrift::protocol::T_REPLY);
  EXPECT_EQ(second.seqid, 2);
  methods::registerClientSession::Result result;
  result.read(out.protocol.get());
  EXPECT_EQ(result.success.clientID, 42);
  EXPECT_EQ(handler->lastGuid, "HSDIG_20.0_1");
}

TEST_F(Dispatch, OneWayRequestIsProcessedLikeACall) {
  methods::registerClientSession::Args reg;
  reg.devGUID = "g";
  reg.processID = 1;
  writeRequest(in, "registerClientSession", apache::thrift::protocol::T_ONEWAY, 4, reg);
  EXPECT_TRUE(process());
  Reply r = readHeader(out);
  EXPECT_EQ(r.type, apache::thrift::protocol::T_REPLY);
  EXPECT_EQ(r.seqid, 4);
}

TEST_F(Dispatch, ReplyTypedRequestIsRefusedWithTheWorkerLockStillHeld) {
  writeRequest(in, "pingServer", apache::thrift::protocol::T_REPLY, 5, hsdigEP_pingServer_pargs());
  std::mutex workerLock, connectionLock;
  UniqueGuard guard(workerLock);
  ConcurrentProcessorEventHandler serverContext(guard, connectionLock);

  EXPECT_FALSE(processor.process(in.protocol, out.protocol, &serverContext, nullptr));
  EXPECT_TRUE(guard.owns_lock());
  EXPECT_FALSE(serverContext.released());
  EXPECT_TRUE(serverContext.keep());
  EXPECT_EQ(out.buffer->available_read(), 0u) << "no reply";
  EXPECT_TRUE(connectionLock.try_lock());
  connectionLock.unlock();
}

TEST_F(Dispatch, NormalCallHandsTheWorkerLockBackBeforeTheHandlerRuns) {
  std::mutex workerLock, connectionLock;
  UniqueGuard guard(workerLock);
  ConcurrentProcessorEventHandler serverContext(guard, connectionLock);

  // The handler checks, while it runs, that the worker lock is free.
  struct LockProbe : hsdigEPNull {
    std::mutex* lock = nullptr;
    bool wasFree = false;
    void pingServer() override {
      wasFree = lock->try_lock();
      if (wasFree) lock->unlock();
    }
  };
  auto probe = std::make_shared<LockProbe>();
  probe->lock = &workerLock;
  hsdigEPConcurrentProcessor probing(probe);
  writeRequest(in, "pingServer", apache::thrift::protocol::T_CALL, 1, hsdigEP_pingServer_pargs());

  EXPECT_TRUE(probing.process(in.protocol, out.protocol, &serverContext, nullptr));
  EXPECT_TRUE(probe->wasFree);
  EXPECT_TRUE(serverContext.released());
  EXPECT_FALSE(guard.owns_lock());
  EXPECT_TRUE(connectionLock.try_lock()) << "reply lock released after the reply";
  connectionLock.unlock();
}

TEST_F(Dispatch, StandardExceptionFromTheHandlerBecomesATypeZeroReply) {
  methods::abort::Args args;
  args.vi = 3;
  writeRequest(in, "abort", apache::thrift::protocol::T_CALL, 21, args);
  EXPECT_TRUE(process());
  Reply r = readHeader(out);
  EXPECT_EQ(r.name, "abort");
  EXPECT_EQ(r.type, apache::thrift::protocol::T_EXCEPTION);
  EXPECT_EQ(r.seqid, 21);
  TApplicationException x;
  x.read(out.protocol.get());
  EXPECT_EQ(x.getType(), TApplicationException::UNKNOWN);
  EXPECT_STREQ(x.what(), "driver gone");
  EXPECT_EQ(context.events, (std::vector<std::string>{"requestStarting", "requestRead",
                                                      "replyStarting", "replyFinished"}));
}

TEST_F(Dispatch, ExceptionOutsideTheStandardFamilyPropagates) {
  methods::commit::Args args;
  args.vi = 3;
  writeRequest(in, "commit", apache::thrift::protocol::T_CALL, 1, args);
  EXPECT_THROW(process(), int);
  EXPECT_EQ(out.buffer->available_read(), 0u);
  EXPECT_EQ(context.events, (std::vector<std::string>{"requestStarting", "requestRead"}));
}

TEST_F(Dispatch, PingIsAnsweredWithAnEmptyResultRecord) {
  writeRequest(in, "pingServer", apache::thrift::protocol::T_CALL, 1, hsdigEP_pingServer_pargs());
  EXPECT_TRUE(process());
  readHeader(out);
  // The result record: a struct with nothing but the stop byte.
  EXPECT_EQ(out.buffer->available_read(), 1u);
  EXPECT_EQ(out.bytes().back(), '\0');
}

TEST_F(Dispatch, FailedReadTellsTheContextBeforeTheRequestIsCountedRead) {
  methods::registerClientSession::Args reg;
  reg.devGUID = std::string(100, 'g');
  reg.processID = 1;
  writeRequest(in, "registerClientSession", apache::thrift::protocol::T_CALL, 1, reg);
  std::string truncated = in.bytes().substr(0, 40);
  in.load(truncated);

  EXPECT_THROW(process(), TTransportException);
  EXPECT_EQ(context.events,
            (std::vector<std::string>{"requestStarting", "callFailed", "requestRead"}));
  EXPECT_EQ(out.buffer->available_read(), 0u);
}

// An output transport whose flush fails, as a peer that went away would.
class BrokenOutput : public apache::thrift::transport::TVirtualTransport<BrokenOutput> {
 public:
  void write(const uint8_t*, uint32_t) {}
  void flush() override { throw TTransportException(TTransportException::NOT_OPEN, "peer closed"); }
};

TEST_F(Dispatch, FailedWriteTellsTheContextAndReleasesTheReplyLock) {
  writeRequest(in, "pingServer", apache::thrift::protocol::T_CALL, 1, hsdigEP_pingServer_pargs());
  auto broken = contract::makeProtocolFactory()->getProtocol(std::make_shared<BrokenOutput>());
  std::mutex workerLock, connectionLock;
  UniqueGuard guard(workerLock);
  ConcurrentProcessorEventHandler serverContext(guard, connectionLock);

  EXPECT_THROW(processor.process(in.protocol, broken, &context, nullptr), TTransportException);
  EXPECT_EQ(context.events,
            (std::vector<std::string>{"requestStarting", "requestRead", "replyStarting",
                                      "callFailed", "replyFinished"}));

  MemoryWire again;
  writeRequest(again, "pingServer", apache::thrift::protocol::T_CALL, 1,
               hsdigEP_pingServer_pargs());
  EXPECT_THROW(processor.process(again.protocol, broken, &serverContext, nullptr),
               TTransportException);
  EXPECT_TRUE(serverContext.released());
  EXPECT_TRUE(connectionLock.try_lock()) << "the reply lock is not left locked";
  connectionLock.unlock();
}

TEST_F(Dispatch, UnknownExtraFieldInTheArgumentsIsSkipped) {
  in.protocol->writeMessageBegin("registerClientSession", apache::thrift::protocol::T_CALL, 3);
  in.protocol->writeStructBegin("hsdigEP_registerClientSession_pargs");
  in.protocol->writeFieldBegin("devGUID", apache::thrift::protocol::T_STRING, 1);
  in.protocol->writeString("guid");
  in.protocol->writeFieldBegin("future", apache::thrift::protocol::T_STRUCT, 9);
  in.protocol->writeStructBegin("F");
  in.protocol->writeFieldBegin("l", apache::thrift::protocol::T_LIST, 1);
  in.protocol->writeListBegin(apache::thrift::protocol::T_I64, 2);
  in.protocol->writeI64(1);
  in.protocol->writeI64(2);
  in.protocol->writeListEnd();
  in.protocol->writeFieldStop();
  in.protocol->writeStructEnd();
  in.protocol->writeFieldBegin("processID", apache::thrift::protocol::T_I32, 2);
  in.protocol->writeI32(99);
  in.protocol->writeFieldStop();
  in.protocol->writeStructEnd();
  in.protocol->writeMessageEnd();

  EXPECT_TRUE(process());
  Reply r = readHeader(out);
  EXPECT_EQ(r.type, apache::thrift::protocol::T_REPLY);
  methods::registerClientSession::Result result;
  result.read(out.protocol.get());
  EXPECT_EQ(result.success.clientID, 100);
  EXPECT_EQ(handler->lastGuid, "guid");
}

TEST(DispatchTable, ProcessMapHoldsEveryWireName) {
  hsdigEPConcurrentProcessor processor(std::make_shared<hsdigEPNull>());
  const auto& map = processor.processMap();
  EXPECT_EQ(map.size(), 98u);
  for (auto name : methods::kWireNames) {
    SCOPED_TRACE(std::string(name));
    auto found = map.find(std::string(name));
    ASSERT_NE(found, map.end());
    EXPECT_NE(found->second, nullptr);
  }
}

TEST(DispatchTable, EveryMethodAnswersUnderItsOwnName) {
  // Each method, sent with an empty argument record, is answered by a reply
  // under its own wire name: no table entry is wired to another method.
  hsdigEPConcurrentProcessor processor(std::make_shared<hsdigEPNull>());
  int32_t seqid = 0;
  for (auto name : methods::kWireNames) {
    SCOPED_TRACE(std::string(name));
    MemoryWire in, out;
    writeRequest(in, std::string(name), apache::thrift::protocol::T_CALL, ++seqid,
                 hsdigEP_pingServer_pargs());
    RecordingContext ctx;
    ASSERT_TRUE(processor.process(in.protocol, out.protocol, &ctx, nullptr));
    Reply r = readHeader(out);
    EXPECT_EQ(r.name, name);
    EXPECT_EQ(r.type, apache::thrift::protocol::T_REPLY);
    EXPECT_EQ(r.seqid, seqid);
  }
}

// Counts handler hand-outs and returns.
class CountingHandlerFactory : public hsdigEPIfFactory {
 public:
  hsdigEPIf* getHandler(const apache::thrift::TConnectionInfo&) override {
    ++handedOut;
    return &handler;
  }
  void releaseHandler(hsdigEPIf* h) override {
    EXPECT_EQ(h, &handler);
    ++released;
  }
  hsdigEPNull handler;
  int handedOut = 0;
  int released = 0;
};

TEST(DispatchFactory, ProcessorReturnsItsHandlerThroughTheFactory) {
  auto handlers = std::make_shared<CountingHandlerFactory>();
  hsdigEPConcurrentProcessorFactory factory(handlers);
  apache::thrift::TConnectionInfo info;
  {
    auto a = factory.getProcessor(info);
    auto b = factory.getProcessor(info);
    EXPECT_NE(a, b);
    EXPECT_EQ(handlers->handedOut, 2);
    EXPECT_EQ(handlers->released, 0);
  }
  EXPECT_EQ(handlers->released, 2);

  // The singleton factory hands out one shared handler and ignores releases.
  auto shared = std::make_shared<hsdigEPNull>();
  hsdigEPConcurrentProcessorFactory singleton(std::make_shared<hsdigEPIfSingletonFactory>(shared));
  { auto p = singleton.getProcessor(info); }
  EXPECT_EQ(shared.use_count(), 2);  // ours and the singleton factory's
}

}  // namespace
}  // namespace hsdig
