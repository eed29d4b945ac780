#include "transport/TStreamingFramedTransport.h"

#include <algorithm>
#include <cstring>
#include <limits>

#include <thrift/transport/TTransportException.h>

#include "transport/FrameLength.h"

namespace hsdig::transport {

using apache::thrift::transport::TTransportException;

namespace {

constexpr uint32_t kHeaderSize = kFrameLengthSize;

}  // namespace

TStreamingFramedTransport::TStreamingFramedTransport(
    std::shared_ptr<apache::thrift::transport::TTransport> transport,
    std::shared_ptr<apache::thrift::TConfiguration> config, DirectWrites directWrites,
    uint32_t bufReclaimThreshold)
    : TFramedTransport(std::move(transport), static_cast<uint32_t>(DEFAULT_BUFFER_SIZE),
                       bufReclaimThreshold, std::move(config)),
      directWrites_(directWrites == DirectWrites::kOn),
      readAhead_(new uint8_t[kReadAheadSize]) {}

// ---------------------------------------------------------------------------
// Reading

bool TStreamingFramedTransport::fillReadAhead() {
  readPos_ = readEnd_ = 0;
  readEnd_ = transport_->read(readAhead_.get(), kReadAheadSize);
  return readEnd_ > 0;
}

bool TStreamingFramedTransport::beginFrame() {
  uint8_t header[kHeaderSize];
  uint32_t got = 0;
  while (got < kHeaderSize) {
    if (readPos_ == readEnd_ && !fillReadAhead()) {
      if (got == 0) return false;
      throw TTransportException(TTransportException::END_OF_FILE,
                                "No more data to read after partial frame header.");
    }
    const uint32_t take = std::min(kHeaderSize - got, readEnd_ - readPos_);
    std::memcpy(header + got, readAhead_.get() + readPos_, take);
    readPos_ += take;
    got += take;
  }
  const auto size = static_cast<int32_t>(decodeFrameLength(header));
  if (size < 0) throw TTransportException("Frame size has negative value");
  if (size > static_cast<int64_t>(maxFrameSize_)) {
    throw TTransportException(TTransportException::CORRUPTED_DATA, "Received an oversized frame");
  }
  frameLeft_ = static_cast<uint32_t>(size);
  frameBytes_ = frameLeft_;
  resetConsumedMessageSize();
  return true;
}

void TStreamingFramedTransport::openWindow() {
  const uint32_t count = std::min(readEnd_ - readPos_, frameLeft_);
  setReadBuffer(readAhead_.get() + readPos_, count);
  readPos_ += count;
  frameLeft_ -= count;
}

uint32_t TStreamingFramedTransport::readSlow(uint8_t* buf, uint32_t len) {
  const auto have = static_cast<uint32_t>(rBound_ - rBase_);
  if (have > 0) {
    // The rest of the window; the caller asks again for what is missing.
    std::memcpy(buf, rBase_, have);
    rBase_ = rBound_;
    return have;
  }
  while (frameLeft_ == 0) {
    if (!beginFrame()) return 0;
  }
  if (readPos_ == readEnd_) {
    if (len >= kDirectSize) {
      const uint32_t got = transport_->read(buf, std::min(len, frameLeft_));
      if (got == 0)
        throw TTransportException(TTransportException::END_OF_FILE, "No more data to read.");
      frameLeft_ -= got;
      return got;
    }
    if (!fillReadAhead()) {
      throw TTransportException(TTransportException::END_OF_FILE, "No more data to read.");
    }
  }
  openWindow();
  const uint32_t give = std::min(len, static_cast<uint32_t>(rBound_ - rBase_));
  std::memcpy(buf, rBase_, give);
  rBase_ += give;
  return give;
}

const uint8_t* TStreamingFramedTransport::borrowSlow(uint8_t*, uint32_t*) {
  // Like the library's transport: a borrow is only served from the window.
  return nullptr;
}

uint32_t TStreamingFramedTransport::readEnd() {
  resetConsumedMessageSize();
  return static_cast<uint32_t>(frameBytes_ + kHeaderSize);
}

bool TStreamingFramedTransport::peek() {
  return rBase_ < rBound_ || readPos_ < readEnd_ || transport_->peek();
}

// ---------------------------------------------------------------------------
// Writing

void TStreamingFramedTransport::closeBufferedPiece() {
  const uint32_t end = bufferedWriteBytes();
  if (end > pieceStart_) pieces_.push_back(Piece{nullptr, pieceStart_, end - pieceStart_});
  pieceStart_ = end;
}

void TStreamingFramedTransport::writeSlow(const uint8_t* buf, uint32_t len) {
  if (directWrites_ && len >= kDirectSize) {
    closeBufferedPiece();
    pieces_.push_back(Piece{buf, 0, len});
    externalBytes_ += len;
    return;
  }
  TFramedTransport::writeSlow(buf, len);
}

uint32_t TStreamingFramedTransport::writeEnd() {
  const uint64_t bytes = bufferedWriteBytes() + externalBytes_;
  return static_cast<uint32_t>(std::min<uint64_t>(bytes, std::numeric_limits<uint32_t>::max()));
}

void TStreamingFramedTransport::resetWrite() {
  pieces_.clear();
  pieceStart_ = 0;
  externalBytes_ = 0;
  wBase_ = wBuf_.get() + kHeaderSize;
}

void TStreamingFramedTransport::discardWrite() {
  resetWrite();
}

void TStreamingFramedTransport::flush() {
  if (pieces_.empty()) {
    lastFlushedFrameBytes_ = bufferedWriteBytes();
    TFramedTransport::flush();
    return;
  }
  closeBufferedPiece();
  const uint64_t payload = bufferedWriteBytes() - kHeaderSize + externalBytes_;
  if (payload > static_cast<uint64_t>(std::numeric_limits<int32_t>::max())) {
    resetWrite();
    throw TTransportException(TTransportException::BAD_ARGS,
                              "Attempted to write over 2 GB to TFramedTransport.");
  }
  encodeFrameLength(wBuf_.get(), static_cast<uint32_t>(payload));
  // The state is reset before the writes, as the library's flush does, so a
  // failed write leaves a clean transport; the buffered bytes stay in place
  // until the next write.
  std::vector<Piece> pieces;
  pieces.swap(pieces_);
  const uint8_t* base = wBuf_.get();
  resetWrite();
  for (const Piece& piece : pieces) {
    transport_->write(piece.external != nullptr ? piece.external : base + piece.offset,
                      piece.length);
  }
  transport_->flush();
  lastFlushedFrameBytes_ = payload + kHeaderSize;
  if (wBufSize_ > bufReclaimThresh_) {
    wBufSize_ = DEFAULT_BUFFER_SIZE;
    wBuf_.reset(new uint8_t[wBufSize_]);
    setWriteBuffer(wBuf_.get(), wBufSize_);
    wBase_ = wBuf_.get() + kHeaderSize;
  }
}

}  // namespace hsdig::transport
