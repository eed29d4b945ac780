#include "TransportTestSupport.h"

#include <dirent.h>
#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <mutex>

#include "contract/Diagnostics.h"
#include "transport/PipeName.h"

extern char** environ;

namespace hsdig::transport::test {

namespace {

std::mutex& sinkMutex() {
  static std::mutex mutex;
  return mutex;
}
std::vector<std::string>& captured() {
  static std::vector<std::string> lines;
  return lines;
}
void capture(const char* line) {
  std::lock_guard lock(sinkMutex());
  captured().emplace_back(line);
}

std::string peerProgram() {
  return std::filesystem::read_symlink("/proc/self/exe").parent_path() / "transport_peer";
}

}  // namespace

int openDescriptorCount() {
  int count = 0;
  DIR* dir = ::opendir("/proc/self/fd");
  if (dir == nullptr) return -1;
  while (dirent* entry = ::readdir(dir))
    if (entry->d_name[0] != '.') ++count;
  ::closedir(dir);
  return count - 1;  // the directory stream's own descriptor
}

std::vector<std::string> diagnostics() {
  std::lock_guard lock(sinkMutex());
  return captured();
}

bool sawDiagnostic(const std::string& line) {
  for (const auto& seen : diagnostics())
    if (seen == line) return true;
  return false;
}

bool canSwitchUser() {
  return ::geteuid() == 0;
}

void TransportTest::SetUp() {
  descriptorsBefore_ = openDescriptorCount();
  {
    std::lock_guard lock(sinkMutex());
    captured().clear();
  }
  diagnostics::installSink(&capture);
  char pattern[] = "/tmp/hsdig-transport-test-XXXXXX";
  ASSERT_NE(::mkdtemp(pattern), nullptr);
  root_ = pattern;
  // Peers that run as another user must reach the socket folder.
  ASSERT_EQ(::chmod(root_.c_str(), 0755), 0);
  socketFolder_ = root_ + "/pipes";
  ASSERT_EQ(ensureSocketFolder(socketFolder_), 0);
  testing::setSocketFolderForTesting(socketFolder_);
}

void TransportTest::TearDown() {
  testing::setSocketFolderForTesting("");
  diagnostics::installSink(&diagnostics::discard);
  std::error_code ignored;
  std::filesystem::remove_all(root_, ignored);
  EXPECT_EQ(openDescriptorCount(), descriptorsBefore_) << "descriptors leaked";
}

std::string TransportTest::uniqueName(const std::string& tag) const {
  // The folder is this test's own; the process id keeps names apart where a
  // test uses the machine-wide folder.
  return "pipe" + tag + "_" + std::to_string(::getpid());
}

Peer::Peer(const std::vector<std::string>& args, int asUid) {
  int in[2], out[2];
  if (::pipe2(in, O_CLOEXEC) != 0 || ::pipe2(out, O_CLOEXEC) != 0) std::abort();
  std::vector<std::string> all{peerProgram()};
  if (asUid >= 0) {
    all.emplace_back("--as-uid");
    all.emplace_back(std::to_string(asUid));
  }
  all.insert(all.end(), args.begin(), args.end());
  std::vector<char*> argv;
  for (auto& arg : all) argv.push_back(arg.data());
  argv.push_back(nullptr);

  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, in[0], 0);
  posix_spawn_file_actions_adddup2(&actions, out[1], 1);
  const int rc = posix_spawn(&pid_, argv[0], &actions, nullptr, argv.data(), environ);
  posix_spawn_file_actions_destroy(&actions);
  ::close(in[0]);
  ::close(out[1]);
  toPeer_ = in[1];
  fromPeer_ = out[0];
  if (rc != 0) {
    ADD_FAILURE() << "cannot start " << argv[0] << ": errno " << rc;
    pid_ = -1;
  }
}

Peer::~Peer() {
  finish();
}

std::string Peer::readLine() {
  for (;;) {
    const auto newline = pending_.find('\n');
    if (newline != std::string::npos) {
      std::string line = pending_.substr(0, newline);
      pending_.erase(0, newline + 1);
      return line;
    }
    char chunk[256];
    const ssize_t got = ::read(fromPeer_, chunk, sizeof chunk);
    if (got < 0 && errno == EINTR) continue;
    if (got <= 0) return std::exchange(pending_, std::string());
    pending_.append(chunk, static_cast<size_t>(got));
  }
}

void Peer::writeLine(const std::string& line) {
  const std::string text = line + "\n";
  if (::write(toPeer_, text.data(), text.size()) != static_cast<ssize_t>(text.size()))
    ADD_FAILURE() << "peer input closed";
}

int Peer::kill(int signal) {
  if (pid_ > 0) ::kill(pid_, signal);
  return finish();
}

int Peer::finish() {
  if (toPeer_ >= 0) ::close(std::exchange(toPeer_, -1));
  int status = -1;
  if (pid_ > 0) {
    while (::waitpid(pid_, &status, 0) < 0 && errno == EINTR) {
    }
    pid_ = -1;
  }
  if (fromPeer_ >= 0) ::close(std::exchange(fromPeer_, -1));
  return status;
}

}  // namespace hsdig::transport::test
