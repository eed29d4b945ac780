// Failures of system calls, made to happen on purpose through the platform's
// system-call table, and a real descriptor limit.
#include <sys/resource.h>
#include <thrift/concurrency/Exception.h>
#include <thrift/transport/TTransportException.h>

#include <fcntl.h>

#include <atomic>
#include <cerrno>
#include <functional>
#include <memory>
#include <string>
#include <thread>

#include "TransportTestSupport.h"
#include "platform/Syscalls.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig::transport {
namespace {

namespace sys = platform::sys;
using apache::thrift::transport::TTransportException;

// Failure plans: the next `count` calls of one entry fail with `error`.
struct Plan {
  std::atomic<int> count{0};
  std::atomic<int> error{0};
  std::atomic<int> seen{0};
  std::atomic<int> skip{0};  // calls that pass before the failures start
  bool take() {
    int pass = skip.load();
    while (pass > 0)
      if (skip.compare_exchange_weak(pass, pass - 1)) return false;
    int left = count.load();
    while (left > 0)
      if (count.compare_exchange_weak(left, left - 1)) {
        seen.fetch_add(1);
        errno = error.load();
        return true;
      }
    return false;
  }
  void arm(int times, int err, int after = 0) {
    error = err;
    seen = 0;
    skip = after;
    count = times;
  }
};

Plan recvPlan, sendPlan, pollPlan, connectPlan, acceptPlan, socketPlan, eventfdPlan;

ssize_t failingRecv(int fd, void* b, size_t n, int f) {
  return recvPlan.take() ? -1 : ::recv(fd, b, n, f);
}
ssize_t failingSend(int fd, const void* b, size_t n, int f) {
  return sendPlan.take() ? -1 : ::send(fd, b, n, f);
}
int failingPoll(pollfd* p, nfds_t n, int t) {
  return pollPlan.take() ? -1 : ::poll(p, n, t);
}
int failingConnect(int fd, const sockaddr* a, socklen_t l) {
  return connectPlan.take() ? -1 : ::connect(fd, a, l);
}
int failingAccept(int fd, sockaddr* a, socklen_t* l, int f) {
  return acceptPlan.take() ? -1 : ::accept4(fd, a, l, f);
}
int failingSocket(int d, int t, int p) {
  return socketPlan.take() ? -1 : ::socket(d, t, p);
}
int failingEventfd(unsigned v, int f) {
  return eventfdPlan.take() ? -1 : ::eventfd(v, f);
}

std::string errorOf(const std::function<void()>& f) {
  try {
    f();
  } catch (const std::exception& e) {
    return e.what();
  }
  return "no exception";
}

class FaultTest : public test::ConnectedPipeTest {
 protected:
  sys::ScopedSyscall<&sys::detail::recv_entry> recvHook_{&failingRecv};
  sys::ScopedSyscall<&sys::detail::send_entry> sendHook_{&failingSend};
  sys::ScopedSyscall<&sys::detail::poll_entry> pollHook_{&failingPoll};
  sys::ScopedSyscall<&sys::detail::connect_entry> connectHook_{&failingConnect};
  sys::ScopedSyscall<&sys::detail::accept4_entry> acceptHook_{&failingAccept};
  sys::ScopedSyscall<&sys::detail::socket_entry> socketHook_{&failingSocket};
  sys::ScopedSyscall<&sys::detail::eventfd_entry> eventfdHook_{&failingEventfd};
};

TEST_F(FaultTest, InterruptedCallsAreResumed) {
  connect();
  client_->setTimeouts(60000, 60000);
  const uint8_t data[4] = {1, 2, 3, 4};
  uint8_t got[4] = {};

  sendPlan.arm(2, EINTR);
  client_->write(data, 4);
  EXPECT_EQ(sendPlan.seen, 2);

  recvPlan.arm(2, EINTR);
  accepted_->readAll(got, 4);
  EXPECT_EQ(recvPlan.seen, 2);

  // An interrupted timed wait goes on waiting for the data.
  std::thread late([&] { accepted_->write(data, 4); });
  pollPlan.arm(1, EINTR);
  client_->readAll(got, 4);
  late.join();
  EXPECT_EQ(got[3], 4);

  client_.reset();
  connectPlan.arm(1, EINTR);
  TPipe again(uniqueName());
  again.open();
  EXPECT_EQ(connectPlan.seen, 1);
  EXPECT_TRUE(again.isOpen());
  EXPECT_TRUE(test::diagnostics().empty());
}

TEST_F(FaultTest, FailedReadsWritesAndWaitsThrowTheirKinds) {
  connect();
  uint8_t buffer[8];
  struct Case {
    const char* what;
    Plan* plan;
    int error;
    std::function<void()> call;
    std::string text;
    std::string diagnostic;
  };
  const Case cases[] = {
      {"client read", &recvPlan, ECONNRESET, [&] { client_->read(buffer, 8); },
       "TPipe: read failed", "TPipe ::ReadFile errored GLE=errno = 104"},
      {"server read-ahead", &recvPlan, ECONNRESET, [&] { accepted_->read(buffer, 8); },
       "TPipe: ReadFile failed", "TPipe ::ReadFile errored GLE=errno = 104"},
      {"client write", &sendPlan, ENOBUFS, [&] { client_->write(buffer, 8); },
       "TPipe: write failed", "TPipe ::WriteFile errored GLE=errno = 105"},
      {"server blocking wait", &pollPlan, ENOMEM, [&] { accepted_->read(buffer, 8); },
       "TPipe: GetOverlappedResult failed", "TPipe ::GetOverlappedResult errored GLE=errno = 12"},
      {"client timed wait", &pollPlan, ENOMEM,
       [&] {
         client_->setTimeouts(60000, 60000);
         client_->read(buffer, 8);
       },
       "getOverlappedResultWithTimeout failed",
       "getOverlappedResultWithTimeout errored GLE=errno = 12"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    c.plan->arm(1, c.error);
    try {
      c.call();
      ADD_FAILURE() << "no exception";
    } catch (const TTransportException& e) {
      EXPECT_EQ(e.getType(), TTransportException::UNKNOWN);
      EXPECT_EQ(std::string(e.what()), c.text);
    }
    EXPECT_TRUE(test::sawDiagnostic(c.diagnostic));
    c.plan->arm(0, 0);
  }
  // The connection survives injected failures: bytes still pass both ways.
  client_->write(reinterpret_cast<const uint8_t*>("ok"), 2);
  accepted_->readAll(buffer, 2);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(buffer), 2), "ok");
}

TEST_F(FaultTest, DescriptorShortagesFailWithTheirKindsAndLeakNothing) {
  server_ = std::make_unique<TPipeServer>(uniqueName());
  server_->listen();

  socketPlan.arm(1, EMFILE);
  TPipe client(uniqueName());
  EXPECT_EQ(errorOf([&] { client.open(); }), "Unable to open pipe");
  EXPECT_TRUE(test::sawDiagnostic("TPipe::open ::CreateFile errored GLE=errno = 24"));
  EXPECT_FALSE(client.isOpen());

  // The accepted connection cannot get its wait handle.
  client.open();
  eventfdPlan.arm(1, EMFILE);
  try {
    server_->acceptPipe();
    ADD_FAILURE() << "no exception";
  } catch (const apache::thrift::concurrency::SystemResourceException& e) {
    EXPECT_STREQ(e.what(), "CreateEvent failed");
  }
  EXPECT_TRUE(test::sawDiagnostic("TManualResetEvent unable to create event, GLE=errno = 24"));
  uint8_t byte;
  EXPECT_EQ(client.read(&byte, 1), 0u) << "the connection that could not be set up is closed";

  // accept itself runs out of descriptors.
  TPipe second(uniqueName());
  second.open();
  acceptPlan.arm(1, EMFILE);
  EXPECT_EQ(errorOf([&] { server_->acceptPipe(); }), "TPipeServer: client connection failed");
  EXPECT_TRUE(test::sawDiagnostic("TPipeServer ConnectNamedPipe GLE=errno = 24"));
  // The client stayed in the backlog and is served by the next accept.
  auto accepted = server_->acceptPipe();
  second.write(reinterpret_cast<const uint8_t*>("!"), 1);
  accepted->readAll(&byte, 1);
  EXPECT_EQ(byte, '!');

  // Taking in the next client fails after this one was accepted.
  TPipe third(uniqueName());
  third.open();
  acceptPlan.arm(1, EPROTO, /*after=*/1);
  EXPECT_EQ(errorOf([&] { server_->acceptPipe(); }), " TPipeServer ConnectNamedPipe failed");
  EXPECT_TRUE(test::sawDiagnostic("TPipeServer ConnectNamedPipe failed, GLE=errno = 71"));
  EXPECT_EQ(third.read(&byte, 1), 0u) << "the client accepted first is not leaked";

  // The server cannot create its wait handle: listen fails, nothing is left.
  TPipeServer other(uniqueName("other"));
  eventfdPlan.arm(1, ENFILE);
  EXPECT_EQ(errorOf([&] { other.listen(); }), "CreateEvent failed");
  EXPECT_FALSE(other.isOpen());
  EXPECT_NE(::access(pathOf(uniqueName("other")).c_str(), F_OK), 0)
      << "the socket file of the failed listen is removed";
}

TEST_F(FaultTest, ARealDescriptorLimitFailsOpenAndListen) {
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
  GTEST_SKIP() << "the sanitizer runtime needs descriptors of its own to check memory; the "
                  "injected descriptor shortages above cover this build";
#endif
  server_ = std::make_unique<TPipeServer>(uniqueName());
  server_->listen();
  rlimit saved{};
  ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &saved), 0);
  rlimit tight = saved;
  // The limit is the lowest free descriptor number: every descriptor in use
  // stays valid, no new one can be made.
  tight.rlim_cur = 0;
  while (::fcntl(static_cast<int>(tight.rlim_cur), F_GETFD) != -1) ++tight.rlim_cur;
  ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &tight), 0);
  TPipe client(uniqueName());
  const std::string openError = errorOf([&] { client.open(); });
  TPipeServer other(uniqueName("other"));
  const std::string listenError = errorOf([&] { other.listen(); });
  ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &saved), 0);

  EXPECT_EQ(openError, "Unable to open pipe");
  EXPECT_EQ(listenError, "TCreateNamedPipe() failed: errno = 24");
  EXPECT_TRUE(test::sawDiagnostic("TPipe::open ::CreateFile errored GLE=errno = 24"));
}

}  // namespace
}  // namespace hsdig::transport
