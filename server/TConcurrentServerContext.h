// The per-call hooks through which the dispatcher tells the server how far a
// call has got. The server releases its worker lock when the request has been
// read, and serializes replies on one connection between replyStarting and
// replyFinished.
//
// Order for one call: requestStarting, requestRead, then (when a reply is
// written) replyStarting, replyFinished. A call abandoned while its request
// was being read gets callFailed then requestRead; one abandoned while its
// reply was being written gets callFailed then replyFinished.
#pragma once

namespace hsdig {

class TConcurrentServerContext {
 public:
  virtual ~TConcurrentServerContext() = default;
  virtual void requestStarting() = 0;
  virtual void requestRead() = 0;
  virtual void replyStarting() = 0;
  virtual void replyFinished() = 0;
  virtual void callFailed() = 0;
};

}  // namespace hsdig
