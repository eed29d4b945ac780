// A served pipe in a private socket folder, and clients that speak to it
// either through the generated client or with raw bytes.
#pragma once

#include <dirent.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <atomic>
#include <condition_variable>
#include <cstdlib>
#include <memory>
#include <mutex>
#include <string>

#include <thrift/protocol/TBinaryProtocol.h>

#include "contract/TransportConfiguration.h"
#include "hsdigEP.h"
#include "server/Server.h"
#include "transport/FramedClient.h"
#include "transport/PipeName.h"
#include "transport/TPipe.h"

namespace hsdig::test {

inline int openDescriptorCount() {
  int count = 0;
  if (DIR* dir = opendir("/proc/self/fd")) {
    while (readdir(dir)) ++count;
    closedir(dir);
  }
  return count;
}

inline int threadCount() {
  int count = 0;
  if (DIR* dir = opendir("/proc/self/task")) {
    while (readdir(dir)) ++count;
    closedir(dir);
  }
  return count;
}

// A one-shot latch.
class Latch {
 public:
  void open() {
    std::lock_guard lock(mutex_);
    open_ = true;
    changed_.notify_all();
  }
  void wait() {
    std::unique_lock lock(mutex_);
    changed_.wait(lock, [&] { return open_; });
  }

 private:
  std::mutex mutex_;
  std::condition_variable changed_;
  bool open_ = false;
};

// A handler whose "abort" blocks until released, and whose "reset" echoes vi.
class GateHandler : public hsdigEPNull {
 public:
  void abort(RetStatus& ret, int32_t vi) override {
    entered.open();
    release.wait();
    ret.code = vi;
  }
  void reset(RetStatus& ret, int32_t vi) override { ret.code = vi; }
  Latch entered;
  Latch release;
};

// A client connection speaking the contract.
struct Client {
  explicit Client(const std::string& pipeName) {
    pipe = std::make_shared<transport::TPipe>(pipeName);
    framed = transport::makeFramedTransport(pipe);
    protocol = contract::makeProtocolFactory()->getProtocol(framed);
    client = std::make_unique<hsdigEPClient>(protocol);
    pipe->open();
  }
  int32_t reset(int32_t vi) {
    RetStatus ret;
    client->reset(ret, vi);
    return ret.code;
  }
  // Raw bytes on the pipe, bypassing the framing.
  void writeRaw(const std::string& bytes) {
    pipe->write(reinterpret_cast<const uint8_t*>(bytes.data()),
                static_cast<uint32_t>(bytes.size()));
  }

  std::shared_ptr<transport::TPipe> pipe;
  std::shared_ptr<apache::thrift::transport::TTransport> framed;
  std::shared_ptr<apache::thrift::protocol::TProtocol> protocol;
  std::unique_ptr<hsdigEPClient> client;
};

class ServerTest : public ::testing::Test {
 protected:
  void SetUp() override {
    char folder[] = "/tmp/hsdig-server-test-XXXXXX";
    ASSERT_NE(mkdtemp(folder), nullptr);
    folder_ = folder;
    transport::testing::setSocketFolderForTesting(folder_);
    pipeName_ = transport::pipeNameForResource(
        ::testing::UnitTest::GetInstance()->current_test_info()->name());
  }
  void TearDown() override {
    transport::testing::setSocketFolderForTesting("");
    rmdir(folder_.c_str());
  }

  std::string folder_;
  std::string pipeName_;
};

}  // namespace hsdig::test
