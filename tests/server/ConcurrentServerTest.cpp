// The concurrent pipe server with real sockets: concurrency across
// connections, placement on workers, framing edge cases, connection deaths,
// stopping, and the growth and retirement of worker threads.
#include <poll.h>

#include <map>
#include <semaphore>
#include <thread>
#include <vector>

#include <thrift/transport/TBufferTransports.h>
#include <thrift/transport/TTransportException.h>

#include "contract/Diagnostics.h"
#include "hsdigEP_methods.h"
#include "platform/Syscalls.h"
#include "server/FrameBuilder.h"
#include "server/ServerFixture.h"
#include "server/hsdigEPConcurrentProcessor.h"
#include "transport/TPipeServer.h"

namespace hsdig {
namespace {

using test::Client;
using test::GateHandler;
using test::resetFrame;

// Waits until `condition` holds. No time limit: the test runner's own
// time-out catches a condition that never comes.
template <class Condition>
void eventually(Condition condition) {
  while (!condition()) std::this_thread::sleep_for(std::chrono::milliseconds(1));
}

std::mutex diagnosticsMutex;
std::vector<std::string> diagnosticLines;
void captureDiagnostic(const char* line) {
  std::lock_guard lock(diagnosticsMutex);
  diagnosticLines.emplace_back(line);
}
bool sawDiagnostic(const std::string& start) {
  std::lock_guard lock(diagnosticsMutex);
  for (const auto& line : diagnosticLines) {
    if (line.rfind(start, 0) == 0) return true;
  }
  return false;
}

class ConcurrentServer : public test::ServerTest {
 protected:
  void SetUp() override {
    ServerTest::SetUp();
    diagnostics::installSink(&captureDiagnostic);
    // Runtimes that start helper threads on the first thread creation (the
    // thread sanitizer does) have done so before the baseline is taken.
    std::thread([] {}).join();
    fdsBefore_ = test::openDescriptorCount();
    threadsBefore_ = test::threadCount();
  }
  void TearDown() override {
    if (server_) server_->stop();
    server_.reset();
    // Every descriptor and thread of the server is gone after stop.
    EXPECT_EQ(test::openDescriptorCount(), fdsBefore_);
    // A joined thread may linger in /proc for a moment after its join, in
    // this test's baseline as at its end; a thread that never ends keeps
    // this wait, and the test, from finishing.
    eventually([&] { return test::threadCount() <= threadsBefore_; });
    diagnostics::installSink(&diagnostics::discard);
    ServerTest::TearDown();
  }
  void start() { server_ = std::make_unique<Server>(pipeName_, handler_); }
  std::shared_ptr<TConcurrentServer> concurrent() { return server_->concurrentServer(); }

  std::shared_ptr<GateHandler> handler_ = std::make_shared<GateHandler>();
  std::unique_ptr<Server> server_;
  int fdsBefore_ = 0;
  int threadsBefore_ = 0;
};

TEST_F(ConcurrentServer, SlowHandlerOnOneConnectionDoesNotDelayTheOthers) {
  start();
  Client slow(pipeName_), quick(pipeName_);
  std::thread caller([&] {
    RetStatus ret;
    slow.client->abort(ret, 7);
    EXPECT_EQ(ret.code, 7);
  });
  handler_->entered.wait();
  // Both connections live on the one worker; the blocked handler holds none
  // of its locks.
  EXPECT_EQ(concurrent()->workerCount(), 1u);
  for (int vi = 1; vi <= 20; ++vi) EXPECT_EQ(quick.reset(vi), vi);
  handler_->release.open();
  caller.join();
}

// A handler whose abort blocks until the test lets it go, any number of times.
class RepeatedGateHandler : public hsdigEPNull {
 public:
  void abort(RetStatus& ret, int32_t vi) override {
    entered.release();
    released.acquire();
    ret.code = vi;
  }
  void reset(RetStatus& ret, int32_t vi) override { ret.code = vi; }
  std::counting_semaphore<> entered{0};
  std::counting_semaphore<> released{0};
};

TEST_F(ConcurrentServer, EveryRequestThatOutlastsTheStandbyDelayGivesUpTheLead) {
  auto handler = std::make_shared<RepeatedGateHandler>();
  server_ = std::make_unique<Server>(pipeName_, handler);
  Client slow(pipeName_), quick(pipeName_);
  for (int round = 0; round < 200; ++round) {
    std::thread caller([&] {
      RetStatus ret;
      slow.client->abort(ret, round);
      EXPECT_EQ(ret.code, round);
    });
    handler->entered.acquire();
    // Answered only once a follower has taken the lead from the blocked
    // request; a hand-off that left no timer armed would hang here.
    EXPECT_EQ(quick.reset(round), round);
    handler->released.release();
    caller.join();
    // Short requests between the rounds: hand-offs that find the timer
    // armed, expired or idle.
    for (int k = 0; k < round % 4; ++k) EXPECT_EQ(quick.reset(k), k);
  }
}

TEST_F(ConcurrentServer, ConnectionsReadyAtOnceAreAllServedWhileOthersLeave) {
  start();
  for (int round = 0; round < 10; ++round) {
    std::vector<std::unique_ptr<Client>> clients;
    for (int c = 0; c < 40; ++c) clients.push_back(std::make_unique<Client>(pipeName_));
    // Every request is on its way before any is answered, so one wait finds
    // many connections ready; every third client leaves at once, changing
    // the task list while those found ready are being served.
    for (int c = 0; c < 40; ++c) clients[c]->client->send_reset(round * 100 + c);
    for (int c = 0; c < 40; c += 3) clients[c].reset();
    for (int c = 0; c < 40; ++c) {
      if (!clients[c]) continue;
      RetStatus ret;
      clients[c]->client->recv_reset(ret);
      EXPECT_EQ(ret.code, round * 100 + c);
    }
  }
}

TEST_F(ConcurrentServer, SixtyThirdConnectionOpensASecondWorker) {
  start();
  std::vector<std::unique_ptr<Client>> clients;
  for (int i = 0; i < 62; ++i) {
    clients.push_back(std::make_unique<Client>(pipeName_));
    ASSERT_EQ(clients.back()->reset(i), i);
  }
  EXPECT_EQ(concurrent()->workerCount(), 1u);
  EXPECT_EQ(concurrent()->workerTaskCount(0), 64) << "controller, accept task, 62 connections";

  clients.push_back(std::make_unique<Client>(pipeName_));
  EXPECT_EQ(clients.back()->reset(62), 62);
  EXPECT_EQ(concurrent()->workerCount(), 2u);
  EXPECT_EQ(concurrent()->workerTaskCount(1), 2) << "controller and the 63rd connection";
  EXPECT_GE(concurrent()->workerThreadCount(1), 3u);
  for (int i = 0; i < 63; ++i) EXPECT_EQ(clients[i]->reset(1000 + i), 1000 + i);
}

TEST_F(ConcurrentServer, TwoFramesInOneWriteAreBothAnswered) {
  start();
  Client client(pipeName_);
  client.writeRaw(resetFrame(1, 11) + resetFrame(2, 22));
  // The second request may be served while the first is still in its
  // handler, so the replies may come in either order; callers match them by
  // sequence id.
  std::map<int32_t, int32_t> codeBySeqid;
  for (int i = 0; i < 2; ++i) {
    std::string name;
    apache::thrift::protocol::TMessageType type;
    int32_t seqid = 0;
    client.protocol->readMessageBegin(name, type, seqid);
    hsdigEP_reset_presult result;
    RetStatus ret;
    result.success = &ret;
    result.read(client.protocol.get());
    client.protocol->readMessageEnd();
    client.protocol->getTransport()->readEnd();
    EXPECT_EQ(type, apache::thrift::protocol::T_REPLY);
    codeBySeqid[seqid] = ret.code;
  }
  EXPECT_EQ(codeBySeqid, (std::map<int32_t, int32_t>{{1, 11}, {2, 22}}));
}

TEST_F(ConcurrentServer, FramesThatOutgrowTheBufferAreServed) {
  start();
  Client client(pipeName_);
  for (uint32_t size : {1020u, 1024u, 1025u, 70000u, 1024u}) {
    SCOPED_TRACE(size);
    std::string frame = resetFrame(3, static_cast<int32_t>(size), size);
    ASSERT_EQ(frame.size(), 4 + size);
    client.writeRaw(frame);
    RetStatus ret;
    client.client->recv_reset(ret);
    EXPECT_EQ(ret.code, static_cast<int32_t>(size));
  }
}

TEST_F(ConcurrentServer, GiantFrameEndsThatConnectionOnly) {
  start();
  Client giant(pipeName_), other(pipeName_);
  ASSERT_EQ(other.reset(1), 1);
  giant.writeRaw(std::string("\x10\x00\x00\x01", 4));  // 0x10000001 bytes announced
  RetStatus ret;
  EXPECT_THROW(giant.client->recv_reset(ret), apache::thrift::transport::TTransportException);
  EXPECT_TRUE(sawDiagnostic("Giant frame requested."));
  EXPECT_EQ(other.reset(2), 2);
  eventually([&] { return concurrent()->workerTaskCount(0) == 3; });
}

TEST_F(ConcurrentServer, ConnectionDeathsCostOnlyThatConnection) {
  start();
  Client survivor(pipeName_);
  {
    SCOPED_TRACE("between requests");
    Client leaving(pipeName_);
    ASSERT_EQ(leaving.reset(1), 1);
  }
  eventually([&] { return concurrent()->workerTaskCount(0) == 3; });
  EXPECT_EQ(survivor.reset(2), 2);
  {
    SCOPED_TRACE("in the middle of a frame");
    Client leaving(pipeName_);
    ASSERT_EQ(leaving.reset(3), 3);
    leaving.writeRaw(resetFrame(4, 4).substr(0, 9));
  }
  eventually([&] { return concurrent()->workerTaskCount(0) == 3; });
  EXPECT_EQ(survivor.reset(5), 5);
  {
    SCOPED_TRACE("while its reply is being written");
    auto leaving = std::make_unique<Client>(pipeName_);
    leaving->client->send_abort(9);
    handler_->entered.wait();
    leaving.reset();  // gone before the handler answers
    handler_->release.open();
  }
  eventually([&] { return concurrent()->workerTaskCount(0) == 3; });
  EXPECT_EQ(survivor.reset(6), 6);
  EXPECT_TRUE(sawDiagnostic("ServerReadWatch read failed.  Killing connection."));
}

TEST_F(ConcurrentServer, StopWhileARequestRunsEndsEveryThreadAfterIt) {
  start();
  Client blocked(pipeName_), idle(pipeName_);
  ASSERT_EQ(idle.reset(1), 1);
  std::thread caller([&] {
    RetStatus ret;
    blocked.client->abort(ret, 3);
    EXPECT_EQ(ret.code, 3) << "the running request still gets its answer";
  });
  handler_->entered.wait();
  std::thread stopper([&] { server_->stop(); });
  handler_->release.open();
  stopper.join();
  caller.join();
  EXPECT_EQ(server_->concurrentServer(), nullptr);
  RetStatus ret;
  EXPECT_THROW(idle.client->reset(ret, 2), apache::thrift::transport::TTransportException);
}

TEST_F(ConcurrentServer, ServeAfterStopFails) {
  auto pipeServer = std::make_shared<transport::TPipeServer>(pipeName_);
  auto factory = std::make_shared<hsdigEPConcurrentProcessorFactory>(
      std::make_shared<hsdigEPIfSingletonFactory>(handler_));
  TConcurrentServer server(pipeServer, factory, contract::makeProtocolFactory());
  server.stop();
  try {
    server.serve();
    FAIL() << "serve after stop succeeded";
  } catch (const apache::thrift::transport::TTransportException& e) {
    EXPECT_EQ(e.getType(), apache::thrift::transport::TTransportException::NOT_OPEN);
    EXPECT_STREQ(e.what(), "Server closed very early");
  }
}

TEST_F(ConcurrentServer, PoolRetiresIdleThreadsAndGrowsUnderLoad) {
  auto pipeServer = std::make_shared<transport::TPipeServer>(pipeName_);
  auto factory = std::make_shared<hsdigEPConcurrentProcessorFactory>(
      std::make_shared<hsdigEPIfSingletonFactory>(handler_));
  auto server =
      std::make_shared<TConcurrentServer>(pipeServer, factory, contract::makeProtocolFactory());
  server->setIdleWaitMsForTest(20);
  server->serve();

  // Idle leaders retire while two or more others wait, down to two threads.
  eventually([&] { return server->workerThreadCount(0) == 2; });

  // Two requests held in the handler: each new leader that finds nobody
  // waiting behind it starts another thread, so a third client is served.
  Client a(pipeName_), b(pipeName_), c(pipeName_);
  std::thread ta([&] {
    RetStatus r;
    a.client->abort(r, 1);
  });
  handler_->entered.wait();
  b.client->send_abort(2);
  eventually([&] { return server->workerThreadCount(0) >= 3; });
  EXPECT_EQ(c.reset(5), 5);
  handler_->release.open();
  ta.join();
  RetStatus r;
  b.client->recv_abort(r);
  EXPECT_EQ(r.code, 2);
  server->stop();
  server->join();
}

// Fails the server's multi-handle waits once; single-descriptor polls (the
// clients' and the read watch's probes) pass through.
std::atomic<int> failuresLeft{0};
int pollFailingOnce(pollfd* fds, nfds_t count, int timeout) {
  if (count >= 2 && failuresLeft.fetch_sub(1) > 0) {
    errno = ENOMEM;
    return -1;
  }
  return ::poll(fds, count, timeout);
}

TEST_F(ConcurrentServer, AFailedWaitEndsOneThreadAndTheServerGoesOn) {
  start();
  Client client(pipeName_);
  ASSERT_EQ(client.reset(1), 1);
  {
    platform::sys::ScopedSyscall<&platform::sys::detail::poll_entry> hook(&pollFailingOnce);
    failuresLeft = 1;
    Client wakesTheLeader(pipeName_);  // the accept wakes the leader's wait
    EXPECT_EQ(wakesTheLeader.reset(2), 2);
    eventually([] { return failuresLeft.load() <= 0; });
  }
  EXPECT_TRUE(sawDiagnostic("SelectPolicy<TPipeServer>::wait_for_multiple() "));
  EXPECT_EQ(client.reset(3), 3);
}

}  // namespace
}  // namespace hsdig
