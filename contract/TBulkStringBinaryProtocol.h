// The contract's binary protocol for the end that receives large strings
// (waveform data of many megabytes).
//
// A string of at least kBulkStringSize bytes that does not fit the memory the
// destination already has is received into fresh memory the kernel may back
// with huge pages: touching a new 128 MiB string page by page costs several
// times more than the copy into it, with huge pages a fraction. Everything
// else, the bytes read and the checks included, is the contract's binary
// protocol (no size limits, strict reading off, strict writing on).
#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include <thrift/protocol/TBinaryProtocol.h>

namespace hsdig::contract {

class TBulkStringBinaryProtocol : public apache::thrift::protocol::TBinaryProtocol {
 public:
  static constexpr int32_t kBulkStringSize = 4 << 20;

  explicit TBulkStringBinaryProtocol(std::shared_ptr<apache::thrift::transport::TTransport> trans);

  // Both the calls through TProtocol and the direct ones come here.
  uint32_t readString(std::string& str) { return readStringAnySize(str); }
  uint32_t readBinary(std::string& str) { return readStringAnySize(str); }
  uint32_t readString_virt(std::string& str) override { return readStringAnySize(str); }
  uint32_t readBinary_virt(std::string& str) override { return readStringAnySize(str); }

 private:
  uint32_t readStringAnySize(std::string& str);
};

}  // namespace hsdig::contract
