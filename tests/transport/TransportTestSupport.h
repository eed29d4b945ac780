// Shared fixture and helpers of the transport tests.
//
// Every test gets its own socket folder (so tests run side by side), a
// capturing diagnostic sink, and a check that it leaves no descriptor open.
// Helper processes (transport_peer) are started with pipes on their standard
// input and output; a test talks to them line by line.
#pragma once

#include <gtest/gtest.h>
#include <sys/types.h>

#include <memory>
#include <string>
#include <vector>

#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig::transport::test {

// Number of descriptors this process has open.
int openDescriptorCount();

// Lines written to the diagnostic output since the fixture started.
std::vector<std::string> diagnostics();
bool sawDiagnostic(const std::string& line);

class TransportTest : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  // The socket folder of this test (already created, mode 1777).
  const std::string& folder() const { return socketFolder_; }
  // A pipe name unique to this test; `tag` tells names of one test apart.
  std::string uniqueName(const std::string& tag = "") const;
  // The socket path of `name`.
  std::string pathOf(const std::string& name) const { return socketFolder_ + "/" + name; }

 private:
  std::string root_;
  std::string socketFolder_;
  int descriptorsBefore_ = 0;
};

// A TransportTest with one connection: a listening server, an open client
// and the server's end of it, made by connect().
class ConnectedPipeTest : public TransportTest {
 protected:
  void connect() {
    server_ = std::make_unique<transport::TPipeServer>(uniqueName());
    server_->listen();
    client_ = std::make_unique<transport::TPipe>(uniqueName());
    client_->open();
    accepted_ = server_->acceptPipe();
  }
  void TearDown() override {
    accepted_.reset();
    client_.reset();
    server_.reset();
    TransportTest::TearDown();
  }

  std::unique_ptr<transport::TPipeServer> server_;
  std::unique_ptr<transport::TPipe> client_;
  std::shared_ptr<transport::TPipe> accepted_;
};

// A running transport_peer. The destructor closes its input (which ends a
// serving peer), and reaps it.
class Peer {
 public:
  // Starts transport_peer with `args`; with `asUid` >= 0 the peer drops to
  // that user before doing anything else.
  explicit Peer(const std::vector<std::string>& args, int asUid = -1);
  ~Peer();
  Peer(const Peer&) = delete;
  Peer& operator=(const Peer&) = delete;

  // The next line the peer printed (without the newline); "" at its end.
  std::string readLine();
  void writeLine(const std::string& line);
  // Sends `signal` and reaps the peer; returns its wait status.
  int kill(int signal);
  // Closes the peer's input and reaps it; returns its wait status.
  int finish();

 private:
  pid_t pid_ = -1;
  int toPeer_ = -1;
  int fromPeer_ = -1;
  std::string pending_;
};

// The user id tests use as "another user" (nobody).
inline constexpr int kOtherUid = 65534;

// True when this process may start peers as another user.
bool canSwitchUser();

}  // namespace hsdig::transport::test

// Skips the current test unless it runs as root.
#define HSDIG_REQUIRE_ROOT()                                                             \
  do {                                                                                   \
    if (!::hsdig::transport::test::canSwitchUser())                                      \
      GTEST_SKIP() << "needs root to start a peer as another user (nobody); CI runs as " \
                      "root";                                                            \
  } while (0)
