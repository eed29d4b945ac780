// One connection of a worker: assembles request frames from the pipe and
// hands each complete frame to the connection's processor.
//
// Frame reading is an explicit state machine (kReadingLength, kReadingPayload,
// kFrameHandedOver). The frame buffer starts at 1024 bytes and grows to fit a
// frame of up to kMaxFrameSize payload bytes; a larger length ends the
// connection. A whole frame is decoded in place through a memory buffer that
// points into the frame buffer. When the bytes after a frame already hold the
// next whole frame, isReady() lets the worker serve it without a wait.
//
// A process call never blocks the worker on a slow client: it reads once
// when woken, and reads again for the payload only when more bytes are
// already waiting.
#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <mutex>
#include <vector>

#include <thrift/protocol/TProtocol.h>
#include <thrift/server/TServer.h>
#include <thrift/transport/TBufferTransports.h>

#include "server/HandleWaitPolicy.h"
#include "server/IOMultiTask.h"
#include "server/IOTaskController.h"
#include "server/TConcurrentProcessor.h"
#include "transport/TPipe.h"
#include "transport/TStreamingFramedTransport.h"

namespace hsdig {

class TConcurrentServer;

class ServerReadWatch : public IOTask, public std::enable_shared_from_this<ServerReadWatch> {
 public:
  using MultiTask = IOMultiTask<PollWaitPolicy>;
  using Controller = IOTaskController<PollWaitPolicy>;

  enum ReadState : int32_t {
    kReadingLength = 1000,
    kReadingPayload = 1001,
    kFrameHandedOver = 1002,
  };
  static constexpr uint32_t kInitialBufferSize = 1024;
  // A frame buffer grown beyond this is given back once it is drained.
  static constexpr uint32_t kShrinkThreshold = 1 << 20;
  // After a request or reply frame of at least this size, the allocator is
  // asked to give its free memory back: the handler's large result has just
  // been freed, and without this the allocator keeps it resident.
  static constexpr uint64_t kTrimAfterFrameBytes = 1 << 20;

  ServerReadWatch(TConcurrentServer& server,
                  std::shared_ptr<apache::thrift::server::TServerEventHandler> eventHandler,
                  std::shared_ptr<apache::thrift::protocol::TProtocol> inputProtocol,
                  std::shared_ptr<apache::thrift::protocol::TProtocol> outputProtocol,
                  std::shared_ptr<apache::thrift::transport::TMemoryBuffer> inputBuffer,
                  std::shared_ptr<transport::TPipe> connection,
                  std::shared_ptr<TConcurrentProcessor> processor, uint32_t maxFrameSize);
  ~ServerReadWatch() override;

  int getWaitHandle() override;
  void process(UniqueGuard& guard) override;
  // A whole frame waits in the frame buffer, or bytes wait in the pipe's
  // read-ahead (which the socket's readiness does not show).
  bool isReady() override { return nextFrameComplete_ || connection_->isBufferedDataAvailable(); }

  // The worker that holds this connection (set while it is being placed).
  void setWorker(MultiTask* multiTask, Controller* controller) {
    multiTask_ = multiTask;
    controller_ = controller;
  }

 private:
  // Advances the frame state machine; true when a whole frame is in place.
  bool readFrame();
  void readMore();
  bool moreBytesWaiting() const;
  void giveBackMemoryAfterLargeFrames();

  TConcurrentServer& server_;
  std::shared_ptr<apache::thrift::server::TServerEventHandler> eventHandler_;
  std::shared_ptr<apache::thrift::protocol::TProtocol> inputProtocol_;
  std::shared_ptr<apache::thrift::protocol::TProtocol> outputProtocol_;
  std::shared_ptr<apache::thrift::transport::TMemoryBuffer> inputBuffer_;
  std::shared_ptr<transport::TPipe> connection_;
  std::shared_ptr<TConcurrentProcessor> processor_;
  // The reply transport when it reports its frame sizes, else null.
  transport::TStreamingFramedTransport* replyTransport_ = nullptr;
  void* connectionContext_ = nullptr;
  MultiTask* multiTask_ = nullptr;
  Controller* controller_ = nullptr;
  std::mutex connectionLock_;
  // Set once by whichever failure path removes the connection first.
  std::atomic<bool> dying_{false};
  const uint32_t maxFrameSize_;
  // Frame state; touched only by the leader holding the worker's wait lock.
  uint32_t frameSize_ = 0;
  uint32_t bytesBuffered_ = 0;
  bool nextFrameComplete_ = false;
  int32_t readState_ = kReadingLength;
  std::vector<uint8_t> frameBuffer_;
};

}  // namespace hsdig
