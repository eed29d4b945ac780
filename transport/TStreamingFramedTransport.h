// The framed transport of both ends of a pipe: the same frames as the
// library's TFramedTransport (a 4-byte big-endian length, then the payload),
// without its two whole-frame copies.
//
// Reading: the frame is not gathered into a buffer of its own size first.
// Bytes come through a small read-ahead; a read of at least kDirectSize bytes
// that the read-ahead cannot satisfy receives straight into the caller's
// memory (a large string lands in the string itself). A read never crosses
// the end of the current frame; the next read starts the next frame. The
// size checks and their exception texts are the library's: a negative size
// "Frame size has negative value", a size above the limit "Received an
// oversized frame", the end of the stream inside a header "No more data to
// read after partial frame header.". The end of the stream between frames
// reads as 0 bytes.
//
// Writing with direct writes enabled: a write of at least kDirectSize bytes
// is not copied; the transport keeps a reference to the caller's bytes and
// sends them from there at flush. Such bytes must stay valid and unchanged
// until the next flush or discardWrite; a caller that abandons a message
// calls discardWrite before the bytes go away. Without direct writes every
// write is copied, as in the library's transport.
//
// Threads: one thread reads and one thread writes at a time.
#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <vector>

#include <thrift/transport/TBufferTransports.h>

namespace hsdig::transport {

class TStreamingFramedTransport : public apache::thrift::transport::TFramedTransport {
 public:
  static constexpr uint32_t kReadAheadSize = 16 * 1024;
  static constexpr uint32_t kDirectSize = 64 * 1024;

  enum class DirectWrites { kOff, kOn };

  // `bufReclaimThreshold`: a write buffer that grew beyond it is given back
  // after the flush that sent it.
  TStreamingFramedTransport(std::shared_ptr<apache::thrift::transport::TTransport> transport,
                            std::shared_ptr<apache::thrift::TConfiguration> config,
                            DirectWrites directWrites = DirectWrites::kOff,
                            uint32_t bufReclaimThreshold = 1 << 20);

  uint32_t readSlow(uint8_t* buf, uint32_t len) override;
  const uint8_t* borrowSlow(uint8_t* buf, uint32_t* len) override;
  uint32_t readEnd() override;
  bool peek() override;

  void writeSlow(const uint8_t* buf, uint32_t len) override;
  uint32_t writeEnd() override;
  void flush() override;
  // Drops the message being written (buffered bytes and references).
  void discardWrite();

  // The size of the last frame flushed, its 4 length bytes included; reading
  // it resets it to 0. Any thread may take it.
  uint64_t takeLastFlushedFrameBytes() noexcept { return lastFlushedFrameBytes_.exchange(0); }

 private:
  // One piece of the frame being written: bytes of the write buffer (from
  // `offset`) or the caller's own bytes (`external`).
  struct Piece {
    const uint8_t* external;
    uint32_t offset;
    uint32_t length;
  };

  // Reads the next frame's length. False at the end of the stream before
  // any byte of it.
  bool beginFrame();
  // Moves the read-ahead bytes that belong to the current frame into the
  // readable window.
  void openWindow();
  // Reads at most kReadAheadSize bytes; false at the end of the stream.
  bool fillReadAhead();
  uint32_t bufferedWriteBytes() const { return static_cast<uint32_t>(wBase_ - wBuf_.get()); }
  // Ends the run of buffered bytes that the next external piece follows.
  void closeBufferedPiece();
  void resetWrite();

  const bool directWrites_;
  std::unique_ptr<uint8_t[]> readAhead_;
  uint32_t readPos_ = 0;     // read-ahead bytes before this are in the window or consumed
  uint32_t readEnd_ = 0;     // read-ahead bytes up to here are valid
  uint32_t frameLeft_ = 0;   // payload bytes of the current frame not yet in the window
  uint64_t frameBytes_ = 0;  // the current frame's payload size
  std::vector<Piece> pieces_;
  uint32_t pieceStart_ = 0;  // offset in the write buffer where the open run starts
  uint64_t externalBytes_ = 0;
  std::atomic<uint64_t> lastFlushedFrameBytes_{0};
};

}  // namespace hsdig::transport
