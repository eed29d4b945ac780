#include "server/ServerReadWatch.h"

#include <malloc.h>
#include <poll.h>

#include <algorithm>
#include <cstring>

#include <thrift/protocol/TProtocolException.h>
#include <thrift/transport/TTransportException.h>

#include "platform/Diagnostic.h"
#include "platform/Syscalls.h"
#include "server/ConcurrentProcessorEventHandler.h"
#include "transport/FrameLength.h"

namespace hsdig {

using apache::thrift::protocol::TProtocolException;
using apache::thrift::transport::TTransportException;

ServerReadWatch::ServerReadWatch(
    TConcurrentServer& server,
    std::shared_ptr<apache::thrift::server::TServerEventHandler> eventHandler,
    std::shared_ptr<apache::thrift::protocol::TProtocol> inputProtocol,
    std::shared_ptr<apache::thrift::protocol::TProtocol> outputProtocol,
    std::shared_ptr<apache::thrift::transport::TMemoryBuffer> inputBuffer,
    std::shared_ptr<transport::TPipe> connection, std::shared_ptr<TConcurrentProcessor> processor,
    uint32_t maxFrameSize)
    : server_(server),
      eventHandler_(std::move(eventHandler)),
      inputProtocol_(std::move(inputProtocol)),
      outputProtocol_(std::move(outputProtocol)),
      inputBuffer_(std::move(inputBuffer)),
      connection_(std::move(connection)),
      processor_(std::move(processor)),
      maxFrameSize_(maxFrameSize),
      frameBuffer_(kInitialBufferSize, 0) {
  if (outputProtocol_) {
    replyTransport_ =
        dynamic_cast<transport::TStreamingFramedTransport*>(outputProtocol_->getTransport().get());
  }
  if (eventHandler_) {
    connectionContext_ = eventHandler_->createContext(inputProtocol_, outputProtocol_);
  }
}

ServerReadWatch::~ServerReadWatch() {
  if (eventHandler_) {
    eventHandler_->deleteContext(connectionContext_, inputProtocol_, outputProtocol_);
  }
}

int ServerReadWatch::getWaitHandle() {
  // The socket itself: polling it costs less than polling the pipe's own
  // wait handle, and bytes already in the read-ahead count through isReady.
  return connection_->isOpen() ? connection_->getPipeHandle() : -1;
}

bool ServerReadWatch::moreBytesWaiting() const {
  if (connection_->isBufferedDataAvailable()) return true;
  pollfd probe{connection_->getPipeHandle(), POLLIN, 0};
  return probe.fd >= 0 && platform::sys::poll(&probe, 1, 0) > 0;
}

void ServerReadWatch::giveBackMemoryAfterLargeFrames() {
  // The result (and the request's arguments) are gone by now. Large blocks
  // the allocator mapped on its own are already unmapped; what it carved
  // from its heaps stays resident until trimmed.
  ::malloc_trim(0);
}

void ServerReadWatch::readMore() {
  const uint32_t room = static_cast<uint32_t>(frameBuffer_.size()) - bytesBuffered_;
  if (room == 0) return;
  const uint32_t got = connection_->read(frameBuffer_.data() + bytesBuffered_, room);
  if (got == 0) {
    throw TTransportException(TTransportException::END_OF_FILE, "No more data to read.");
  }
  bytesBuffered_ += got;
}

bool ServerReadWatch::readFrame() {
  if (readState_ == kFrameHandedOver) {
    nextFrameComplete_ = false;
    const uint32_t used = 4 + frameSize_;
    std::memmove(frameBuffer_.data(), frameBuffer_.data() + used, bytesBuffered_ - used);
    bytesBuffered_ -= used;
    readState_ = kReadingLength;
    // A connection that once sent a large request does not keep its buffer.
    if (frameBuffer_.size() > kShrinkThreshold && bytesBuffered_ <= kInitialBufferSize) {
      std::vector<uint8_t> small(kInitialBufferSize, 0);
      std::memcpy(small.data(), frameBuffer_.data(), bytesBuffered_);
      frameBuffer_.swap(small);
    }
  }
  bool readThisCall = false;
  if (readState_ == kReadingLength) {
    if (bytesBuffered_ < 4) {
      readMore();
      readThisCall = true;
      if (bytesBuffered_ < 4) return false;
    }
    const uint8_t* p = frameBuffer_.data();
    frameSize_ = transport::decodeFrameLength(p);
    if (uint64_t{4} + frameSize_ > frameBuffer_.size()) {
      if (frameSize_ > maxFrameSize_) {
        platform::reportLine("Giant frame requested.");
        throw TProtocolException(TProtocolException::SIZE_LIMIT, "Giant frame\n");
      }
      frameBuffer_.resize(4 + size_t{frameSize_}, 0);
    }
    readState_ = kReadingPayload;
  }
  // kReadingPayload
  if (bytesBuffered_ - 4 < frameSize_) {
    // One read per call when woken for it; a second one only when it cannot
    // block, so a client that stops in the middle of a frame holds up nobody.
    if (!readThisCall || moreBytesWaiting()) readMore();
    if (bytesBuffered_ - 4 < frameSize_) return false;
  }
  const uint64_t afterFrame = uint64_t{4} + frameSize_;
  if (afterFrame + 4 < bytesBuffered_) {
    const uint8_t* n = frameBuffer_.data() + afterFrame;
    const uint64_t nextSize = transport::decodeFrameLength(n);
    nextFrameComplete_ = afterFrame + 4 + nextSize <= bytesBuffered_;
  }
  inputBuffer_->resetBuffer(frameBuffer_.data() + 4, frameSize_,
                            apache::thrift::transport::TMemoryBuffer::OBSERVE);
  readState_ = kFrameHandedOver;
  return true;
}

void ServerReadWatch::process(UniqueGuard& guard) {
  // Keeps this task alive through a removal that happens inside the call.
  std::shared_ptr<ServerReadWatch> self = shared_from_this();
  if (dying_.load()) {
    // Removal is on its way; the worker's controller runs it first.
    if (guard.owns_lock()) guard.unlock();
    return;
  }
  ConcurrentProcessorEventHandler serverContext(guard, connectionLock_, multiTask_);
  try {
    if (!readFrame()) {
      if (guard.owns_lock()) guard.unlock();
      return;
    }
    if (eventHandler_) eventHandler_->processContext(connectionContext_, connection_);
    const uint64_t requestBytes = uint64_t{4} + frameSize_;
    if (processor_->process(inputProtocol_, outputProtocol_, &serverContext, connectionContext_)) {
      const uint64_t replyBytes =
          replyTransport_ ? replyTransport_->takeLastFlushedFrameBytes() : 0;
      if (std::max(requestBytes, replyBytes) >= kTrimAfterFrameBytes)
        giveBackMemoryAfterLargeFrames();
      return;
    }
    platform::reportLine("ServerReadWatch: Stream header is corrupt.");
    throw TProtocolException(TProtocolException::INVALID_DATA, "Corrupt stream\n");
  } catch (...) {
    if (serverContext.released()) {
      platform::reportLine(
          "ServerReadWatch: Either the callback, or the output caused an exception.  "
          "Scheduling a connection death");
      if (!dying_.exchange(true)) controller_->scheduleRemoval(this);
    } else {
      platform::reportLine("ServerReadWatch read failed.  Killing connection.");
      // A connection is removed, and its room given back, exactly once: a
      // request of the same connection that fails in another thread may
      // already have scheduled the removal.
      if (!dying_.exchange(true)) {
        multiTask_->removeAtLastIndex(guard);
        if (guard.owns_lock()) guard.unlock();
        controller_->releaseRoom();
      } else if (guard.owns_lock()) {
        guard.unlock();
      }
    }
  }
}

}  // namespace hsdig
