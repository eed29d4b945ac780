// The server side: socket files, accept, the listen event, interrupt and
// close, and what happens to names of dead and live servers.
#include <poll.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <thrift/transport/TTransportException.h>
#include <unistd.h>

#include <cerrno>
#include <fstream>
#include <latch>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "TransportTestSupport.h"
#include "transport/TLocalAuthException.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig::transport {
namespace {

using apache::thrift::transport::TTransportException;

bool readableNow(int fd) {
  pollfd entry{fd, POLLIN, 0};
  return ::poll(&entry, 1, 0) == 1;
}

void waitReadable(int fd) {
  pollfd entry{fd, POLLIN, 0};
  ASSERT_EQ(::poll(&entry, 1, -1), 1);
}

// Sends `text` from one end and checks it arrives at the other.
void expectPassage(TPipe& from, TPipe& to, const std::string& text) {
  from.write(reinterpret_cast<const uint8_t*>(text.data()), static_cast<uint32_t>(text.size()));
  std::string got(text.size(), '\0');
  to.readAll(reinterpret_cast<uint8_t*>(got.data()), static_cast<uint32_t>(got.size()));
  EXPECT_EQ(got, text);
}

template <class F>
std::string transportErrorOf(F&& f) {
  try {
    f();
  } catch (const TTransportException& e) {
    return e.what();
  }
  return "no exception";
}

struct stat statOf(const std::string& path) {
  struct stat info {};
  EXPECT_EQ(::lstat(path.c_str(), &info), 0) << path;
  return info;
}

class PipeServerTest : public test::TransportTest {};

TEST_F(PipeServerTest, SocketFilesCarryTheManagersModeAndLeaveWithTheServer) {
  struct Case {
    const char* what;
    bool sameUser;
    mode_t mode;
  };
  const Case cases[] = {{"same-user manager", true, 0600},
                        {"everyone manager (default)", false, 0666}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    const std::string name = uniqueName(c.sameUser ? "same" : "every");
    TSameUserPermissionManager same;
    // A restrictive umask must not narrow the everyone mode, and a lax one
    // must not widen the same-user mode.
    const mode_t saved = ::umask(c.sameUser ? 0 : 077);
    {
      TPipeServer server(name);
      if (c.sameUser) server.setPermissionManager(&same);
      EXPECT_FALSE(server.isOpen());
      EXPECT_EQ(server.getNativeWaitHandle(), -1);
      server.listen();
      ::umask(saved);
      EXPECT_TRUE(server.isOpen());
      const struct stat info = statOf(pathOf(name));
      EXPECT_TRUE(S_ISSOCK(info.st_mode));
      EXPECT_EQ(info.st_mode & 07777, c.mode);
      EXPECT_EQ(info.st_uid, ::geteuid());
      server.listen();  // a second listen keeps the first socket
      EXPECT_EQ(statOf(pathOf(name)).st_ino, info.st_ino);
    }
    EXPECT_NE(::access(pathOf(name).c_str(), F_OK), 0) << "the server removed its socket";
  }
}

TEST_F(PipeServerTest, TheListenEventFollowsPendingAndCachedClients) {
  TPipeServer server(uniqueName());
  server.listen();
  const int handle = server.getNativeWaitHandle();
  ASSERT_GE(handle, 0);
  EXPECT_FALSE(readableNow(handle)) << "nobody has connected";

  TPipe first(uniqueName()), second(uniqueName());
  first.open();
  waitReadable(handle);
  second.open();

  auto a = server.acceptPipe();
  // The second client was already there: it is taken in ahead and the event
  // stays set, so the next accept returns at once.
  EXPECT_TRUE(readableNow(handle));
  auto b = server.acceptPipe();
  EXPECT_FALSE(readableNow(handle));
  expectPassage(first, *a, "to the first");
  expectPassage(second, *b, "to the second");
  expectPassage(*b, second, "back to the second");
  expectPassage(*a, first, "back to the first");
}

TEST_F(PipeServerTest, AClientAlreadyWaitingAtListenIsServedThroughTheCache) {
  // The socket exists (listen), a client connects, and only then does the
  // server take its first look: accept must return that client at once.
  TPipeServer server(uniqueName());
  server.listen();
  TPipe client(uniqueName());
  client.open();
  auto accepted = server.acceptPipe();
  expectPassage(client, *accepted, "early");
}

TEST_F(PipeServerTest, InterruptFailsTheWaitingAcceptAndWakesTheWaiter) {
  TPipeServer server(uniqueName());
  server.listen();
  std::string failure;
  std::thread acceptor([&] { failure = transportErrorOf([&] { server.acceptPipe(); }); });
  server.interrupt();
  acceptor.join();
  EXPECT_EQ(failure, "TPipeServer: client connection failed");
  EXPECT_TRUE(test::sawDiagnostic("TPipeServer ConnectNamedPipe GLE=errno = 125"));
  EXPECT_TRUE(readableNow(server.getNativeWaitHandle()));
  // Interrupted for good: later accepts fail too, even with a client pending.
  TPipe late(uniqueName());
  late.open();
  EXPECT_EQ(transportErrorOf([&] { server.acceptPipe(); }),
            "TPipeServer: client connection failed");
}

TEST_F(PipeServerTest, AcceptOnAClosedServerFails) {
  TPipeServer server(uniqueName());
  EXPECT_EQ(transportErrorOf([&] { server.acceptPipe(); }),
            "TNamedPipeServer: someone called accept on a closed pipe server");
  server.listen();
  auto impl = server.getImpl();
  server.close();
  EXPECT_FALSE(server.isOpen());
  EXPECT_EQ(transportErrorOf([&] { impl->acceptImpl(); }),
            "TNamedPipeServer: someone called accept on a closed pipe server");
  EXPECT_NE(::access(pathOf(uniqueName()).c_str(), F_OK), 0);
}

TEST_F(PipeServerTest, TheLibrarysAcceptHandsOutPipes) {
  TPipeServer server(uniqueName());
  server.listen();
  TPipe client(uniqueName());
  client.open();
  auto transport = server.accept();
  auto pipe = std::dynamic_pointer_cast<TPipe>(transport);
  ASSERT_NE(pipe, nullptr);
  EXPECT_TRUE(pipe->isOpen());
  expectPassage(client, *pipe, "through accept()");
}

TEST_F(PipeServerTest, ASecondListenOnALiveNameFailsAndTheFirstServesOn) {
  TPipeServer first(uniqueName());
  first.listen();
  const ino_t inode = statOf(pathOf(uniqueName())).st_ino;
  {
    TPipeServer second(uniqueName());
    EXPECT_EQ(transportErrorOf([&] { second.listen(); }), "TCreateNamedPipe() failed: errno = 98");
    EXPECT_TRUE(test::sawDiagnostic("TPipeServer::TCreateNamedPipe() GLE=errno = 98"));
    EXPECT_FALSE(second.isOpen());
  }
  EXPECT_EQ(statOf(pathOf(uniqueName())).st_ino, inode) << "the name was not stolen";
  // The probe of the second listen reached the first as a client that hung
  // up at once; it reads as an ended stream.
  auto probe = first.acceptPipe();
  uint8_t byte;
  EXPECT_EQ(probe->read(&byte, 1), 0u);
  TPipe client(uniqueName());
  client.open();
  auto accepted = first.acceptPipe();
  expectPassage(client, *accepted, "still serving");
}

TEST_F(PipeServerTest, ASecondListenOnAnotherProcesssLiveNameFails) {
  test::Peer peer({"serve", folder(), uniqueName(), "same"});
  ASSERT_EQ(peer.readLine(), "listening");
  TPipeServer server(uniqueName());
  EXPECT_EQ(transportErrorOf([&] { server.listen(); }), "TCreateNamedPipe() failed: errno = 98");
  test::Peer client({"connect", folder(), uniqueName(), "same"});
  EXPECT_EQ(client.readLine(), "connected");
  EXPECT_EQ(client.readLine(), "pong") << "the first server still answers";
}

TEST_F(PipeServerTest, AStaleSocketOfAKilledServerIsReplaced) {
  {
    test::Peer peer({"serve", folder(), uniqueName(), "same"});
    ASSERT_EQ(peer.readLine(), "listening");
    const int status = peer.kill(SIGKILL);
    ASSERT_TRUE(WIFSIGNALED(status));
  }
  // The file outlived its server: connecting to it is refused.
  ASSERT_EQ(::access(pathOf(uniqueName()).c_str(), F_OK), 0);
  TPipe refused(uniqueName());
  EXPECT_THROW(refused.open(), TTransportException);
  TPipeServer server(uniqueName());
  server.listen();
  TPipe client(uniqueName());
  client.open();
  auto accepted = server.acceptPipe();
  expectPassage(client, *accepted, "new server");
}

TEST_F(PipeServerTest, ServersRacingForAStaleNameLeaveExactlyOneWinner) {
  {
    test::Peer peer({"serve", folder(), uniqueName(), "same"});
    ASSERT_EQ(peer.readLine(), "listening");
    peer.kill(SIGKILL);
  }
  constexpr int kServers = 6;
  std::vector<std::unique_ptr<TPipeServer>> servers;
  for (int i = 0; i < kServers; ++i) servers.push_back(std::make_unique<TPipeServer>(uniqueName()));
  std::vector<std::string> outcomes(kServers);
  std::latch start(kServers);
  std::vector<std::thread> threads;
  for (int i = 0; i < kServers; ++i)
    threads.emplace_back([&, i] {
      start.arrive_and_wait();
      outcomes[i] = transportErrorOf([&] { servers[i]->listen(); });
    });
  for (auto& thread : threads) thread.join();

  int winner = -1;
  for (int i = 0; i < kServers; ++i) {
    SCOPED_TRACE(i);
    if (outcomes[i] == "no exception") {
      EXPECT_EQ(winner, -1) << "two servers hold one name";
      winner = i;
    } else {
      EXPECT_EQ(outcomes[i], "TCreateNamedPipe() failed: errno = 98");
    }
  }
  ASSERT_NE(winner, -1);
  // The losers' probes reached the winner as clients that hung up at once.
  TPipe client(uniqueName());
  client.open();
  const std::string text = "to the winner";
  client.write(reinterpret_cast<const uint8_t*>(text.data()), static_cast<uint32_t>(text.size()));
  for (;;) {
    auto accepted = servers[winner]->acceptPipe();
    uint8_t first;
    if (accepted->read(&first, 1) == 0) continue;  // a probe
    EXPECT_EQ(first, 't');
    break;
  }
}

TEST_F(PipeServerTest, ANameTakenByAnotherKindOfFileIsLeftAlone) {
  const std::string path = pathOf(uniqueName());
  std::ofstream(path) << "not a socket";
  TPipeServer server(uniqueName());
  EXPECT_EQ(transportErrorOf([&] { server.listen(); }), "TCreateNamedPipe() failed: errno = 98");
  std::ifstream kept(path);
  std::string text;
  std::getline(kept, text);
  EXPECT_EQ(text, "not a socket");
}

TEST_F(PipeServerTest, CloseNeverRemovesASocketFileThatIsNotItsOwn) {
  const std::string path = pathOf(uniqueName());
  TPipeServer server(uniqueName());
  server.listen();
  // Someone else's file now stands at the name.
  ASSERT_EQ(::unlink(path.c_str()), 0);
  std::ofstream(path) << "someone else's";
  server.close();
  EXPECT_EQ(::access(path.c_str(), F_OK), 0);
}

TEST_F(PipeServerTest, UnusablePathsFailTheListen) {
  struct Case {
    const char* what;
    std::string name;
    const char* text;
  };
  const Case cases[] = {
      {"remote pipe path", "\\\\host\\pipe\\x", "TCreateNamedPipe() failed: errno = 22"},
      {"name too long", std::string(120, 'n'), "TCreateNamedPipe() failed: errno = 36"},
      {"folder that does not exist", "/nonexistent-hsdig-folder/x",
       "TCreateNamedPipe() failed: errno = 2"},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    TPipeServer server(c.name);
    EXPECT_EQ(transportErrorOf([&] { server.listen(); }), c.text);
    EXPECT_FALSE(server.isOpen());
  }
}

TEST_F(PipeServerTest, TheMachineWideFolderIsCreatedOnDemand) {
  // Uses the real folder, with a name no other test uses.
  testing::setSocketFolderForTesting("");
  const std::string name = uniqueName("machine_wide");
  {
    TPipeServer server(name);
    server.listen();
    const struct stat folder = statOf("/tmp/.hsdig-pipes");
    EXPECT_TRUE(S_ISDIR(folder.st_mode));
    EXPECT_NE(folder.st_mode & S_ISVTX, 0u);
    TPipe client("\\\\.\\pipe\\" + name);
    client.open();
    auto accepted = server.acceptPipe();
    expectPassage(client, *accepted, "machine-wide");
  }
  ::unlink(("/tmp/.hsdig-pipes/" + name + ".lock").c_str());
  EXPECT_NE(::access(("/tmp/.hsdig-pipes/" + name).c_str(), F_OK), 0);
}

}  // namespace
}  // namespace hsdig::transport
