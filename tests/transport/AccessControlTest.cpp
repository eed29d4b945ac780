// Access control between users. The cases with a second user start
// transport_peer as nobody; they need root (CI runs as root) and skip
// otherwise.
#include <sys/stat.h>
#include <thrift/transport/TTransportException.h>
#include <unistd.h>

#include <memory>
#include <string>

#include "TransportTestSupport.h"
#include "transport/AccessControl.h"
#include "transport/TLocalAuthException.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

namespace hsdig::transport {
namespace {

using apache::thrift::transport::TTransportException;

template <class F>
void expectLocalAuthError(F&& f, const std::string& text) {
  try {
    f();
    ADD_FAILURE() << "no exception; expected \"" << text << "\"";
  } catch (const TLocalAuthException& e) {
    EXPECT_EQ(e.getType(), TTransportException::INTERNAL_ERROR);
    EXPECT_EQ(std::string(e.what()), text);
  }
}

class AccessControlTest : public test::TransportTest {};

TEST_F(AccessControlTest, LocalAuthExceptionTexts) {
  EXPECT_STREQ(TLocalAuthException("").what(), "TLocalAuthException");
  EXPECT_STREQ(TLocalAuthException("Server isn't trusted!").what(), "Server isn't trusted!");
  EXPECT_EQ(TLocalAuthException("x").getType(), TTransportException::INTERNAL_ERROR);
}

TEST_F(AccessControlTest, PeersAdmittedByEachManager) {
  TSameUserPermissionManager same;
  TEveryoneIncludingNetworkPermissionManager everyone;
  const uid_t me = ::geteuid();
  struct Case {
    const char* what;
    uid_t peer;
    bool sameAdmits;
  };
  const Case cases[] = {
      {"this user", me, true},
      {"root stands for the system and administrators", 0, true},
      {"another user", me == 4242 ? 4243u : 4242u, false},
  };
  for (const auto& c : cases) {
    SCOPED_TRACE(c.what);
    platform::PeerCredentials peer;
    peer.uid = c.peer;
    EXPECT_EQ(same.admitsPeer(peer), c.sameAdmits || c.peer == me);
    EXPECT_TRUE(everyone.admitsPeer(peer));
  }
  EXPECT_EQ(same.securityAttributes(), 0600u);
  EXPECT_EQ(everyone.securityAttributes(), 0666u);
  EXPECT_EQ(TDoNotCareAccessVerifier().openFlags(), 0u);
  EXPECT_EQ(TServerIsSameUserAccessVerifier().openFlags(), 0x00100000u);
}

TEST_F(AccessControlTest, OwnerCheckOfAMissingFileFails) {
  TMyUserAccountSid me;
  expectLocalAuthError([&] { checkOwnerEqual(me, pathOf("nothing-here")); },
                       "checkOwnerEqual::GetSecurityInfo");
  EXPECT_TRUE(test::sawDiagnostic("checkOwnerEqual::GetSecurityInfo errored WinError=errno = 2"));
}

TEST_F(AccessControlTest, TrustCheckOfANonSocketFails) {
  TMyUserAccountSid me;
  int pipeEnds[2];
  ASSERT_EQ(::pipe(pipeEnds), 0);
  expectLocalAuthError([&] { canHandleOwnerControlTarget(me, pipeEnds[0]); },
                       "canHandleOwnerControlTarget::GetSecurityInfo");
  EXPECT_TRUE(test::sawDiagnostic(
      "canHandleOwnerControlTarget::GetSecurityInfo errored WinError=errno = 88"));
  ::close(pipeEnds[0]);
  ::close(pipeEnds[1]);
}

TEST_F(AccessControlTest, TheTrustVerifierAcceptsAServerOfTheSameUser) {
  TPipeServer server(uniqueName());
  server.listen();
  TServerIsSameUserAccessVerifier verifier;
  TPipe client(uniqueName());
  client.setAccessVerifier(&verifier);
  client.open();
  EXPECT_TRUE(client.isOpen());
}

TEST_F(AccessControlTest, ANameSquattedByAnotherUserFailsTheListen) {
  HSDIG_REQUIRE_ROOT();
  test::Peer squatter({"serve", folder(), uniqueName(), "same"}, test::kOtherUid);
  ASSERT_EQ(squatter.readLine(), "listening");
  struct stat info {};
  ASSERT_EQ(::lstat(pathOf(uniqueName()).c_str(), &info), 0);
  ASSERT_EQ(info.st_uid, static_cast<uid_t>(test::kOtherUid));

  for (const bool sameUser : {true, false}) {
    SCOPED_TRACE(sameUser ? "same-user manager" : "everyone manager");
    TSameUserPermissionManager same;
    TPipeServer server(uniqueName());
    if (sameUser) server.setPermissionManager(&same);
    expectLocalAuthError([&] { server.listen(); },
                         "checkOwnerEqual: Current user is no longer pipe owner!");
    EXPECT_FALSE(server.isOpen());
  }
  // A stale socket of the other user is not replaced either.
  squatter.finish();
  TPipeServer server(uniqueName());
  expectLocalAuthError([&] { server.listen(); },
                       "checkOwnerEqual: Current user is no longer pipe owner!");
  ASSERT_EQ(::lstat(pathOf(uniqueName()).c_str(), &info), 0);
  EXPECT_EQ(info.st_uid, static_cast<uid_t>(test::kOtherUid));
}

TEST_F(AccessControlTest, TheTrustVerifierRefusesAnotherUsersServer) {
  HSDIG_REQUIRE_ROOT();
  test::Peer other({"serve", folder(), uniqueName(), "everyone"}, test::kOtherUid);
  ASSERT_EQ(other.readLine(), "listening");

  TServerIsSameUserAccessVerifier verifier;
  TPipe trusting(uniqueName());
  trusting.setAccessVerifier(&verifier);
  expectLocalAuthError([&] { trusting.open(); }, "Server isn't trusted!");
  EXPECT_FALSE(trusting.isOpen());

  // Without the verifier the same server is reachable.
  TPipe careless(uniqueName());
  careless.open();
  careless.write(reinterpret_cast<const uint8_t*>("ping"), 4);
  uint8_t answer[4];
  careless.readAll(answer, 4);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(answer), 4), "pong");
}

TEST_F(AccessControlTest, AnotherUsersClientTrustsARootServer) {
  HSDIG_REQUIRE_ROOT();
  TPipeServer server(uniqueName());  // everyone manager: the other user may connect
  server.listen();
  test::Peer client({"connect", folder(), uniqueName(), "same"}, test::kOtherUid);
  EXPECT_EQ(client.readLine(), "connected");
  auto accepted = server.acceptPipe();
  uint8_t ping[4];
  accepted->readAll(ping, 4);
  accepted->write(reinterpret_cast<const uint8_t*>("pong"), 4);
  EXPECT_EQ(client.readLine(), "pong");
}

TEST_F(AccessControlTest, TheSameUserServerRefusesAnotherUser) {
  HSDIG_REQUIRE_ROOT();
  TSameUserPermissionManager same;
  TPipeServer server(uniqueName());
  server.setPermissionManager(&same);
  server.listen();
  test::Peer refused({"connect", folder(), uniqueName(), "none"}, test::kOtherUid);
  EXPECT_EQ(refused.readLine(), "Unable to open pipe") << "the file mode keeps the user out";
}

TEST_F(AccessControlTest, TheSameUserServerDropsAnotherUserWhoGotPastTheFileMode) {
  HSDIG_REQUIRE_ROOT();
  TSameUserPermissionManager same;
  TPipeServer server(uniqueName());
  server.setPermissionManager(&same);
  server.listen();
  // The mode is widened behind the server's back; the peer check still holds.
  ASSERT_EQ(::chmod(pathOf(uniqueName()).c_str(), 0666), 0);
  test::Peer intruder({"connect", folder(), uniqueName(), "none"}, test::kOtherUid);
  ASSERT_EQ(intruder.readLine(), "connected");

  TPipe own(uniqueName());
  own.open();
  auto accepted = server.acceptPipe();  // skips the intruder, returns our own client
  own.write(reinterpret_cast<const uint8_t*>("mine"), 4);
  uint8_t got[4];
  accepted->readAll(got, 4);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(got), 4), "mine");
  // Cut off: depending on when the server hung up, the intruder's ping or
  // its wait for the answer fails; it never gets an answer.
  const std::string outcome = intruder.readLine();
  EXPECT_TRUE(outcome == "No more data to read." || outcome == "TPipe: write failed" ||
              outcome == "TPipe: read failed")
      << outcome;
  EXPECT_TRUE(test::sawDiagnostic("TPipeServer refused a client of user 65534"));
}

TEST_F(AccessControlTest, TheEveryoneServerAdmitsAnotherUser) {
  HSDIG_REQUIRE_ROOT();
  TPipeServer server(uniqueName());
  server.listen();
  test::Peer client({"connect", folder(), uniqueName(), "none"}, test::kOtherUid);
  EXPECT_EQ(client.readLine(), "connected");
  auto accepted = server.acceptPipe();
  uint8_t ping[4];
  accepted->readAll(ping, 4);
  EXPECT_EQ(std::string(reinterpret_cast<char*>(ping), 4), "ping");
  accepted->write(reinterpret_cast<const uint8_t*>("pong"), 4);
  EXPECT_EQ(client.readLine(), "pong");
}

}  // namespace
}  // namespace hsdig::transport
