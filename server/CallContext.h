// The state of one call inside the dispatcher, kept on its stack so that the
// server context can be told exactly how far a failed call got.
#pragma once

#include <cstdint>
#include <string>

#include <thrift/protocol/TProtocol.h>

#include "server/TConcurrentServerContext.h"

namespace hsdig {

struct CallContext {
  enum State : int32_t {
    kIdle = 100,            // nothing half done
    kReadingRequest = 101,  // header and arguments being read
    kWritingReply = 102,    // reply being written
  };

  int32_t seqid = 0;
  std::string fname;
  int32_t mtype = 3;  // no header read yet
  int32_t state = kIdle;
  apache::thrift::protocol::TProtocol* iprot = nullptr;
  apache::thrift::protocol::TProtocol* oprot = nullptr;
  TConcurrentServerContext* serverContext = nullptr;
  void* connectionContext = nullptr;
  const char* methodName = nullptr;
};

}  // namespace hsdig
