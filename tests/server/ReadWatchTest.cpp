// One connection's frame reading, driven step by step over a socket pair:
// pipelined frames, frames that grow the buffer, frames in pieces, and a
// client that stops in the middle of a frame.
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "contract/TransportConfiguration.h"
#include "platform/Syscalls.h"
#include "server/FrameBuilder.h"
#include "server/ServerFixture.h"
#include "server/ServerReadWatch.h"
#include "server/hsdigEPConcurrentProcessor.h"

namespace hsdig {
namespace {

std::atomic<int> receives{0};
ssize_t countingRecv(int fd, void* buffer, size_t length, int flags) {
  ++receives;
  return ::recv(fd, buffer, length, flags);
}

class ReadWatch : public ::testing::Test {
 protected:
  void SetUp() override {
    int fds[2];
    ASSERT_EQ(::socketpair(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0, fds), 0);
    peer_ = fds[1];
    auto connection = std::make_shared<transport::TPipe>(platform::UniqueFd(fds[0]));
    auto config = contract::makeTransportConfiguration();
    auto input = std::make_shared<apache::thrift::transport::TMemoryBuffer>(config);
    auto protocols = contract::makeProtocolFactory();
    auto output = protocols->getProtocol(transport::makeFramedTransport(connection));
    auto processor = std::make_shared<hsdigEPConcurrentProcessor>(handler_);
    watch_ = std::make_shared<ServerReadWatch>(*server_, nullptr, protocols->getProtocol(input),
                                               output, input, connection, processor,
                                               TConcurrentServer::kMaxFrameSize);
    controller_ = std::make_shared<ServerReadWatch::Controller>(multi_, 2);
    UniqueGuard guard(multi_.waitLock());
    multi_.addIOTask(controller_, guard);
    multi_.addIOTask(watch_, guard);
    watch_->setWorker(&multi_, controller_.get());
  }
  void TearDown() override {
    UniqueGuard guard(multi_.waitLock());
    multi_.shutdown(guard);
    ::close(peer_);
  }

  // Sends from another thread, so that a frame larger than the socket's
  // buffer can arrive while the watch reads.
  void sendInBackground(const std::string& bytes) {
    sender_ = std::thread([this, bytes] {
      size_t sent = 0;
      while (sent < bytes.size()) {
        pollfd writable{peer_, POLLOUT, 0};
        ::poll(&writable, 1, -1);
        ssize_t n = ::send(peer_, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
        if (n > 0) sent += static_cast<size_t>(n);
      }
    });
  }
  void send(const std::string& bytes) {
    sendInBackground(bytes);
    sender_.join();
  }
  // Whether the worker would call the watch now: its handle is ready or a
  // whole frame is buffered.
  bool wouldBeCalled() {
    pollfd ready{watch_->getWaitHandle(), POLLIN, 0};
    return watch_->isReady() || ::poll(&ready, 1, 0) > 0;
  }
  // Waits until the worker would call the watch, then calls it as the
  // leader does.
  void serveOnce() {
    pollfd ready{watch_->getWaitHandle(), POLLIN, 0};
    if (!watch_->isReady()) ::poll(&ready, 1, -1);
    UniqueGuard guard(multi_.waitLock());
    watch_->process(guard);
  }
  // The codes of the replies that have arrived, without waiting.
  std::vector<int32_t> replies() {
    std::vector<int32_t> codes;
    std::string bytes;
    char chunk[4096];
    for (;;) {
      ssize_t n = ::recv(peer_, chunk, sizeof chunk, MSG_DONTWAIT);
      if (n <= 0) break;
      bytes.append(chunk, static_cast<size_t>(n));
    }
    return test::resetReplyCodes(bytes);
  }

  std::shared_ptr<test::GateHandler> handler_ = std::make_shared<test::GateHandler>();
  std::unique_ptr<TConcurrentServer> server_ =
      std::make_unique<TConcurrentServer>(nullptr, nullptr, contract::makeProtocolFactory());
  SingleTaskThreadPool pool_;
  ServerReadWatch::MultiTask multi_{pool_};
  std::shared_ptr<ServerReadWatch::Controller> controller_;
  std::shared_ptr<ServerReadWatch> watch_;
  int peer_ = -1;
  std::thread sender_;
};

TEST_F(ReadWatch, SecondPipelinedFrameIsServedWithoutAnotherRead) {
  send(test::resetFrame(1, 11) + test::resetFrame(2, 22));
  serveOnce();
  EXPECT_EQ(replies(), std::vector<int32_t>{11});
  EXPECT_TRUE(watch_->isReady());

  platform::sys::ScopedSyscall<&platform::sys::detail::recv_entry> hook(&countingRecv);
  receives = 0;
  serveOnce();
  EXPECT_EQ(receives.load(), 0);
  EXPECT_EQ(replies(), std::vector<int32_t>{22});
  EXPECT_FALSE(watch_->isReady());
}

TEST_F(ReadWatch, FramesLargerThanTheBufferGrowIt) {
  for (uint32_t size : {1020u, 1024u, 5000u, (2u << 20), 100u}) {
    SCOPED_TRACE(size);
    sendInBackground(test::resetFrame(1, static_cast<int32_t>(size), size));
    // A large frame arrives over several wake-ups, as the worker would see it.
    std::vector<int32_t> got;
    while (got.empty()) {
      serveOnce();
      got = replies();
    }
    sender_.join();
    EXPECT_EQ(got, std::vector<int32_t>{static_cast<int32_t>(size)});
  }
  EXPECT_FALSE(watch_->isReady());
}

TEST_F(ReadWatch, FrameInPiecesIsServedWhenComplete) {
  const std::string frame = test::resetFrame(1, 5);
  send(frame.substr(0, 2));
  serveOnce();
  send(frame.substr(2, 5));
  serveOnce();
  EXPECT_FALSE(wouldBeCalled());
  EXPECT_TRUE(replies().empty());
  send(frame.substr(7));
  serveOnce();
  EXPECT_EQ(replies(), std::vector<int32_t>{5});
}

TEST_F(ReadWatch, ClientThatStopsInTheMiddleOfAFrameBlocksNobody) {
  const std::string frame = test::resetFrame(1, 5, 3000);
  send(frame.substr(0, 1500));
  // The call takes what is there and returns although the frame is not
  // complete; the worker then has no reason to call again.
  serveOnce();
  EXPECT_FALSE(wouldBeCalled());
  EXPECT_TRUE(replies().empty());
  send(frame.substr(1500));
  serveOnce();
  EXPECT_EQ(replies(), std::vector<int32_t>{5});
}

}  // namespace
}  // namespace hsdig
