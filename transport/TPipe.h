// One end of a pipe connection, as a Thrift transport.
//
// A client makes a TPipe from a pipe name and opens it; a server's accept
// makes a TPipe around each connection it accepts (already open). Reads
// return what is there (at least one byte, or 0 at the end of the stream);
// the library's readAll turns a 0 into END_OF_FILE "No more data to read.".
//
// Threads: one thread reads at a time and one writes at a time; the two may
// overlap. open and close must not overlap reads or writes.
#pragma once

#include <thrift/TConfiguration.h>
#include <thrift/transport/TVirtualTransport.h>

#include <cstdint>
#include <memory>
#include <string>

#include "platform/UniqueFd.h"
#include "transport/AccessControl.h"
#include "transport/PipeName.h"
#include "transport/TPipeImpl.h"

namespace hsdig::transport {

class TPipe : public apache::thrift::transport::TVirtualTransport<TPipe> {
 public:
  static constexpr int32_t kDefaultWaitTimeoutMs = 3000;

  // A client pipe for `pipeName` (a bare name, "\\.\pipe\NAME" or an absolute
  // path; see PipeName.h), closed until open(). A null configuration means
  // the contract's (frames up to 256 MiB).
  explicit TPipe(const std::string& pipeName,
                 std::shared_ptr<apache::thrift::TConfiguration> config = nullptr);
  // An accepted connection around the connected socket `connection`; open at
  // once. Throws like TWaitableNamedPipeImpl's constructor.
  explicit TPipe(platform::UniqueFd connection,
                 std::shared_ptr<apache::thrift::TConfiguration> config = nullptr);
  ~TPipe() override;

  bool isOpen() const override { return impl_ != nullptr; }

  // Connects a client pipe; does nothing when already open. A server whose
  // backlog is full is waited for up to the wait time-out (3000 ms). Every
  // failure to connect reports "TPipe::open ::CreateFile errored GLE=" and
  // throws TTransportException NOT_OPEN "Unable to open pipe"; a server the
  // verifier does not trust throws TLocalAuthException "Server isn't
  // trusted!". A failed open leaves the pipe closed.
  void open() override;
  // Drops the connection.
  void close() override;

  uint32_t read(uint8_t* buffer, uint32_t length);
  void write(const uint8_t* buffer, uint32_t length);

  // Installs the verifier that open() consults (borrowed; it must outlive
  // the pipe). nullptr restores the default, which trusts every server.
  void setAccessVerifier(const TPureAccessVerifier* verifier);
  // The read and write time-outs of an open pipe (see TPipeImpl).
  void setTimeouts(int32_t readTimeoutMs, int32_t writeTimeoutMs);
  int32_t getWaitTimeoutMs() const { return waitTimeoutMs_; }
  // Below 1: a busy server fails the open at once.
  void setWaitTimeoutMs(int32_t waitTimeoutMs) { waitTimeoutMs_ = waitTimeoutMs; }

  // The socket path of a client pipe (empty for an accepted connection).
  const std::string& getPipename() const { return path_.path; }
  std::shared_ptr<TPipeImpl> getImpl() const { return impl_; }
  // What a server waits on for this connection (see TWaitableNamedPipeImpl);
  // -1 when closed or for a client pipe.
  int getNativeWaitHandle() const { return impl_ ? impl_->getNativeWaitHandle() : -1; }
  bool isBufferedDataAvailable() const { return impl_ && impl_->isBufferedDataAvailable(); }
  // The socket itself; -1 when closed. It polls readable only for bytes the
  // kernel holds, not for those already in the read-ahead.
  int getPipeHandle() const { return impl_ ? impl_->getPipeHandle() : -1; }

 private:
  std::shared_ptr<TPipeImpl> impl_;
  PipePath path_;
  int32_t waitTimeoutMs_ = kDefaultWaitTimeoutMs;
  TDoNotCareAccessVerifier defaultVerifier_;
  const TPureAccessVerifier* verifier_ = &defaultVerifier_;
};

}  // namespace hsdig::transport
