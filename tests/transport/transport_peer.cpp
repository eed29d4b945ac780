// A second process for the transport tests. It prints one line per event on
// its standard output and ends when its standard input closes.
//
//   transport_peer [--as-uid UID] serve FOLDER NAME same|everyone
//       listens on NAME, prints "listening" (or the failure's text), then
//       echoes every connection until the input closes.
//   transport_peer [--as-uid UID] connect FOLDER NAME none|same
//       opens NAME, prints "connected" (or the failure's text), sends "ping",
//       prints what comes back ("pong", or the failure's text).
//
// --as-uid drops to that user (and its group, without supplementary groups)
// before anything else; it needs root.
#include <grp.h>
#include <sys/socket.h>
#include <thrift/transport/TTransportException.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>
#include <exception>
#include <memory>
#include <string>
#include <thread>

#include "contract/Diagnostics.h"
#include "transport/AccessControl.h"
#include "transport/PipeName.h"
#include "transport/TPipe.h"
#include "transport/TPipeServer.h"

using namespace hsdig::transport;

namespace {

void say(const std::string& line) {
  std::printf("%s\n", line.c_str());
  std::fflush(stdout);
}

// Ends the process when the test closes our input.
void exitWhenInputCloses() {
  std::thread([] {
    char c;
    while (::read(0, &c, 1) > 0) {
    }
    std::fflush(stdout);
    ::_exit(0);
  }).detach();
}

int serve(const std::string& name, const std::string& managerName) {
  TSameUserPermissionManager same;
  TPipeServer server(name);
  if (managerName == "same") server.setPermissionManager(&same);
  try {
    server.listen();
  } catch (const std::exception& e) {
    say(e.what());
    return 1;
  }
  say("listening");
  exitWhenInputCloses();
  for (;;) {
    std::shared_ptr<TPipe> client;
    try {
      client = server.acceptPipe();
    } catch (const std::exception& e) {
      say(e.what());
      return 1;
    }
    std::thread([client] {
      uint8_t buffer[4096];
      try {
        for (;;) {
          const uint32_t got = client->read(buffer, sizeof buffer);
          if (got == 0) break;
          if (got == 4 && std::memcmp(buffer, "ping", 4) == 0)
            client->write(reinterpret_cast<const uint8_t*>("pong"), 4);
          else
            client->write(buffer, got);
        }
      } catch (const std::exception&) {
      }
    }).detach();
  }
}

int connect(const std::string& name, const std::string& verifierName) {
  TServerIsSameUserAccessVerifier same;
  TPipe pipe(name);
  if (verifierName == "same") pipe.setAccessVerifier(&same);
  try {
    pipe.open();
  } catch (const std::exception& e) {
    say(e.what());
    return 1;
  }
  say("connected");
  try {
    pipe.write(reinterpret_cast<const uint8_t*>("ping"), 4);
    uint8_t answer[4];
    pipe.readAll(answer, sizeof answer);
    say(std::string(reinterpret_cast<char*>(answer), sizeof answer));
  } catch (const std::exception& e) {
    say(e.what());
    return 1;
  }
  return 0;
}

}  // namespace

int main(int argc, char** argv) {
  hsdig::diagnostics::installSink(&hsdig::diagnostics::discard);
  int next = 1;
  if (argc > 2 && std::strcmp(argv[1], "--as-uid") == 0) {
    const auto uid = static_cast<uid_t>(std::stoul(argv[2]));
    if (::setgroups(0, nullptr) != 0 || ::setgid(uid) != 0 || ::setuid(uid) != 0) {
      say("cannot switch user");
      return 2;
    }
    next = 3;
  }
  if (argc - next != 4) {
    say("usage: transport_peer [--as-uid UID] serve|connect FOLDER NAME MODE");
    return 2;
  }
  const std::string command = argv[next];
  testing::setSocketFolderForTesting(argv[next + 1]);
  if (command == "serve") return serve(argv[next + 2], argv[next + 3]);
  if (command == "connect") return connect(argv[next + 2], argv[next + 3]);
  say("unknown command " + command);
  return 2;
}
