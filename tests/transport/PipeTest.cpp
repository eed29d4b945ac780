// Client pipes and accepted connections talking to each other in one process.
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <thrift/transport/TTransportException.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <latch>
#include <memory>
#include <numeric>
#include <string>
#include <thread>
#include <vector>

#include "TransportTestSupport.h"
#include "platform/Syscalls.h"
#include "platform/UniqueFd.h"
#include "transport/FramedClient.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig::transport {
namespace {

using apache::thrift::transport::TTransportException;

std::vector<uint8_t> pattern(size_t size) {
  std::vector<uint8_t> bytes(size);
  for (size_t i = 0; i < size; ++i) bytes[i] = static_cast<uint8_t>(i * 7 + 3);
  return bytes;
}

const uint8_t* bytesOf(const char* text) {
  return reinterpret_cast<const uint8_t*>(text);
}

// Whether `fd` polls readable right now.
bool readableNow(int fd) {
  pollfd entry{fd, POLLIN, 0};
  return ::poll(&entry, 1, 0) == 1;
}

// A raw listening socket at `path`, for servers that misbehave on purpose.
platform::UniqueFd rawListener(const std::string& path, int backlog) {
  platform::UniqueFd fd(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
  EXPECT_EQ(::bind(fd.get(), reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
  EXPECT_EQ(::listen(fd.get(), backlog), 0);
  return fd;
}

template <class F>
void expectTransportError(F&& f, TTransportException::TTransportExceptionType type,
                          const std::string& text) {
  try {
    f();
    ADD_FAILURE() << "no exception; expected \"" << text << "\"";
  } catch (const TTransportException& e) {
    EXPECT_EQ(e.getType(), type) << e.what();
    EXPECT_EQ(std::string(e.what()), text);
  }
}

using PipeTest = test::ConnectedPipeTest;

TEST_F(PipeTest, RoundTripsOfEverySize) {
  connect();
  for (const size_t size :
       {size_t{1}, size_t{1023}, size_t{1024}, size_t{1025}, size_t{65536}, size_t{4} << 20}) {
    SCOPED_TRACE(size);
    const auto sent = pattern(size);
    // The server echoes from its own thread so that large messages never
    // fill both directions at once.
    std::thread echo([&] {
      std::vector<uint8_t> got(size);
      accepted_->readAll(got.data(), static_cast<uint32_t>(size));
      accepted_->write(got.data(), static_cast<uint32_t>(size));
    });
    client_->write(sent.data(), static_cast<uint32_t>(size));
    std::vector<uint8_t> back(size);
    client_->readAll(back.data(), static_cast<uint32_t>(size));
    echo.join();
    EXPECT_EQ(back, sent);
  }
}

TEST_F(PipeTest, ReadsReturnWhatIsThereWithoutWaitingForMore) {
  connect();
  client_->write(bytesOf("0123456789"), 10);
  uint8_t buffer[100] = {};
  uint32_t total = 0;
  while (total < 10) {
    const uint32_t got = accepted_->read(buffer + total, 100);
    ASSERT_GT(got, 0u);
    total += got;
  }
  EXPECT_EQ(std::string(reinterpret_cast<char*>(buffer), 10), "0123456789");

  accepted_->write(bytesOf("abc"), 3);
  uint8_t answer[64];
  uint32_t got = 0;
  while (got < 3) got += client_->read(answer + got, sizeof answer - got);
  EXPECT_EQ(got, 3u);
}

// The server waits on the connection's handle; bytes already in the
// read-ahead must keep it ready although the socket itself has nothing.
TEST_F(PipeTest, WaitHandleIsReadyWhileTheReadAheadHoldsBytes) {
  connect();
  const int handle = accepted_->getNativeWaitHandle();
  ASSERT_GE(handle, 0);
  EXPECT_NE(handle, accepted_->getImpl()->getPipeHandle());
  EXPECT_FALSE(readableNow(handle)) << "nothing sent yet";

  client_->write(bytesOf("0123456789"), 10);
  pollfd entry{handle, POLLIN, 0};
  ASSERT_EQ(::poll(&entry, 1, -1), 1);

  std::string seen;
  for (int i = 0; i < 3; ++i) {
    SCOPED_TRACE(i);
    uint8_t part[3];
    ASSERT_EQ(accepted_->read(part, 3), 3u);
    seen.append(reinterpret_cast<char*>(part), 3);
    EXPECT_TRUE(accepted_->isBufferedDataAvailable());
    EXPECT_FALSE(readableNow(accepted_->getImpl()->getPipeHandle())) << "all bytes pulled in";
    EXPECT_TRUE(readableNow(handle)) << "bytes wait in the read-ahead";
  }
  uint8_t last[3];
  ASSERT_EQ(accepted_->read(last, 3), 1u);
  seen.append(reinterpret_cast<char*>(last), 1);
  EXPECT_EQ(seen, "0123456789");
  EXPECT_FALSE(accepted_->isBufferedDataAvailable());
  EXPECT_FALSE(readableNow(handle)) << "read-ahead empty, nothing in the socket";

  client_.reset();
  ASSERT_EQ(::poll(&entry, 1, -1), 1) << "the end of the stream wakes the waiter";
  EXPECT_EQ(accepted_->read(last, 3), 0u);
}

TEST_F(PipeTest, LargeReadsBypassTheReadAheadAndKeepTheOrder) {
  connect();
  const auto sent = pattern(5000);
  client_->write(sent.data(), 5000);
  std::vector<uint8_t> got(5000);
  ASSERT_EQ(accepted_->read(got.data(), 2), 2u);  // through the read-ahead
  uint32_t have = 2;
  while (have < 5000) {
    const uint32_t n = accepted_->read(got.data() + have, 5000 - have);
    ASSERT_GT(n, 0u);
    have += n;
  }
  EXPECT_EQ(got, sent);
}

TEST_F(PipeTest, AnExpiredReadTimeOutThrowsAndTheConnectionGoesOn) {
  connect();
  client_->setTimeouts(20, 20);
  uint8_t buffer[8];
  expectTransportError([&] { client_->read(buffer, sizeof buffer); },
                       TTransportException::TIMED_OUT, "getOverlappedResultWithTimeout timed out");
  EXPECT_TRUE(test::sawDiagnostic("getOverlappedResultWithTimeout timed out"));
  EXPECT_TRUE(client_->isOpen());

  accepted_->write(bytesOf("late"), 4);
  client_->readAll(buffer, 4);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(buffer), 4), "late");
  client_->write(bytesOf("back"), 4);
  accepted_->readAll(buffer, 4);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(buffer), 4), "back");
}

TEST_F(PipeTest, APeerThatNeverReadsTimesTheWriterOut) {
  connect();
  client_->setTimeouts(-1, 20);
  const auto big = pattern(size_t{64} << 20);
  expectTransportError([&] { client_->write(big.data(), static_cast<uint32_t>(big.size())); },
                       TTransportException::TIMED_OUT, "getOverlappedResultWithTimeout timed out");
}

TEST_F(PipeTest, EndOfStreamOnBothSides) {
  connect();
  uint8_t buffer[4];
  accepted_.reset();  // the server drops the connection
  EXPECT_EQ(client_->read(buffer, 4), 0u);
  expectTransportError([&] { client_->readAll(buffer, 4); }, TTransportException::END_OF_FILE,
                       "No more data to read.");
  // Writing to a peer that has gone fails; the process gets no SIGPIPE.
  expectTransportError(
      [&] {
        for (int i = 0; i < 4; ++i) client_->write(buffer, 4);
      },
      TTransportException::UNKNOWN, "TPipe: write failed");
  EXPECT_TRUE(test::sawDiagnostic("TPipe ::WriteFile errored GLE=errno = 32"));
}

TEST_F(PipeTest, ClientEndOfStreamReachesTheServer) {
  connect();
  client_->write(bytesOf("xy"), 2);
  client_->close();
  uint8_t buffer[8];
  uint32_t got = 0;
  while (got < 2) got += accepted_->read(buffer + got, 1);
  EXPECT_EQ(accepted_->read(buffer, 1), 0u) << "a read-ahead ending with 0 bytes reads as 0";
  EXPECT_EQ(accepted_->read(buffer, 8), 0u);
}

TEST_F(PipeTest, ClosedPipesRefuseReadAndWrite) {
  TPipe pipe(uniqueName());
  uint8_t buffer[1];
  expectTransportError([&] { pipe.read(buffer, 1); }, TTransportException::NOT_OPEN,
                       "Called read on non-open pipe");
  expectTransportError([&] { pipe.write(buffer, 1); }, TTransportException::NOT_OPEN,
                       "Called write on non-open pipe");
  EXPECT_EQ(pipe.getNativeWaitHandle(), -1);
}

TEST_F(PipeTest, OpenFailsAtOnceForMissingAndUnusablePipes) {
  struct Case {
    const char* what;
    std::string name;
    const char* diagnostic;
  };
  const Case cases[] = {
      {"no server", uniqueName("missing"), "TPipe::open ::CreateFile errored GLE=errno = 2"},
      {"remote pipe path", "\\\\host\\pipe\\x", "TPipe::open ::CreateFile errored GLE=errno = 22"},
      {"name too long", std::string(120, 'n'), "TPipe::open ::CreateFile errored GLE=errno = 36"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    TPipe pipe(c.name);
    expectTransportError([&] { pipe.open(); }, TTransportException::NOT_OPEN,
                         "Unable to open pipe");
    EXPECT_FALSE(pipe.isOpen());
    EXPECT_TRUE(test::sawDiagnostic(c.diagnostic));
  }
}

TEST_F(PipeTest, ADeadServersSocketRefusesTheOpen) {
  { auto dead = rawListener(pathOf(uniqueName()), 1); }  // closed: the file stays
  TPipe pipe(uniqueName());
  expectTransportError([&] { pipe.open(); }, TTransportException::NOT_OPEN, "Unable to open pipe");
  EXPECT_TRUE(test::sawDiagnostic("TPipe::open ::CreateFile errored GLE=errno = 111"));
}

// Counts connects that found the backlog full and lets the test wait for one.
std::latch* busySeen = nullptr;
int countingConnect(int fd, const sockaddr* address, socklen_t length) {
  const int rc = ::connect(fd, address, length);
  if (rc != 0 && errno == EAGAIN && busySeen != nullptr) {
    const int saved = errno;
    busySeen->count_down();
    busySeen = nullptr;
    errno = saved;
  }
  return rc;
}

TEST_F(PipeTest, ABusyServerIsWaitedForUntilItHasRoom) {
  // A backlog of 0 holds exactly one pending client.
  auto listener = rawListener(pathOf(uniqueName()), 0);
  TPipe first(uniqueName());
  first.open();

  std::latch busy(1);
  busySeen = &busy;
  platform::sys::ScopedSyscall<&platform::sys::detail::connect_entry> hook(&countingConnect);
  TPipe second(uniqueName());
  std::thread opener([&] { second.open(); });
  busy.wait();  // the second client found the server busy and now waits
  platform::UniqueFd taken(::accept(listener.get(), nullptr, nullptr));
  opener.join();
  EXPECT_TRUE(second.isOpen());
  EXPECT_TRUE(test::diagnostics().empty());
}

TEST_F(PipeTest, ABusyServerThatNeverMakesRoomFailsTheOpen) {
  auto listener = rawListener(pathOf(uniqueName()), 0);
  TPipe first(uniqueName());
  first.open();
  TPipe second(uniqueName());
  ASSERT_EQ(second.getWaitTimeoutMs(), 3000);
  expectTransportError([&] { second.open(); }, TTransportException::NOT_OPEN,
                       "Unable to open pipe");
  EXPECT_TRUE(test::sawDiagnostic("TPipe::open ::CreateFile errored GLE=errno = 11"));
  EXPECT_FALSE(second.isOpen());
}

TEST_F(PipeTest, FramedClientRoundTripAndLimits) {
  // A raw server that answers with hand-made frames.
  auto listener = rawListener(pathOf(uniqueName()), 4);
  struct Case {
    const char* what;
    std::vector<uint8_t> reply;
    TTransportException::TTransportExceptionType type;
    const char* text;
  };
  const Case cases[] = {
      {"length above 0x10000000",
       {0x10, 0x00, 0x00, 0x01},
       TTransportException::CORRUPTED_DATA,
       "Received an oversized frame"},
      {"negative length",
       {0x80, 0x00, 0x00, 0x00},
       TTransportException::UNKNOWN,
       "Frame size has negative value"},
      {"end inside the length",
       {0x00, 0x00},
       TTransportException::END_OF_FILE,
       "No more data to read after partial frame header."},
      {"end inside the payload",
       {0x00, 0x00, 0x00, 0x08, 'a', 'b'},
       TTransportException::END_OF_FILE,
       "No more data to read."},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    auto pipe = std::make_shared<TPipe>(uniqueName());
    auto framed = makeFramedTransport(pipe);
    framed->open();
    platform::UniqueFd peer(::accept(listener.get(), nullptr, nullptr));
    ASSERT_EQ(::write(peer.get(), c.reply.data(), c.reply.size()),
              static_cast<ssize_t>(c.reply.size()));
    peer.reset();
    // The whole payload is asked for: bytes that did arrive are handed out
    // before the end of the stream is noticed.
    uint8_t buffer[16];
    expectTransportError([&] { framed->readAll(buffer, 8); }, c.type, c.text);
  }

  // A whole frame at the limit's edge of a small size goes through.
  auto pipe = std::make_shared<TPipe>(uniqueName());
  auto framed = makeFramedTransport(pipe);
  framed->open();
  platform::UniqueFd peer(::accept(listener.get(), nullptr, nullptr));
  framed->write(bytesOf("hello"), 5);
  framed->flush();
  uint8_t frame[9];
  ASSERT_EQ(::read(peer.get(), frame, 9), 9);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(frame), 9), std::string("\0\0\0\5hello", 9));
  ASSERT_EQ(::write(peer.get(), frame, 9), 9);
  uint8_t back[5];
  framed->readAll(back, 5);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(back), 5), "hello");
  EXPECT_EQ(framed->getConfiguration()->getMaxFrameSize(), 0x10000000);
}

}  // namespace
}  // namespace hsdig::transport
