#include "contract/TBulkStringBinaryProtocol.h"

#include <sys/mman.h>

namespace hsdig::contract {

namespace {

constexpr uintptr_t kHugePageSize = uintptr_t{2} << 20;

// Asks for huge pages over the whole 2 MiB pages inside [data, data + size).
// Only advice: where the kernel offers none, nothing changes.
void adviseHugePages(char* data, size_t size) {
  const auto begin = (reinterpret_cast<uintptr_t>(data) + kHugePageSize - 1) & ~(kHugePageSize - 1);
  const auto end = (reinterpret_cast<uintptr_t>(data) + size) & ~(kHugePageSize - 1);
  if (end > begin) ::madvise(reinterpret_cast<void*>(begin), end - begin, MADV_HUGEPAGE);
}

}  // namespace

TBulkStringBinaryProtocol::TBulkStringBinaryProtocol(
    std::shared_ptr<apache::thrift::transport::TTransport> trans)
    : TBinaryProtocolT(std::move(trans), 0, 0, false, true) {}

uint32_t TBulkStringBinaryProtocol::readStringAnySize(std::string& str) {
  int32_t size = 0;
  const uint32_t header = readI32(size);
  if (size < kBulkStringSize || str.capacity() >= static_cast<size_t>(size)) {
    return header + readStringBody(str, size);
  }
  // Reserved first, advised while still untouched, then filled.
  std::string fresh;
  fresh.reserve(static_cast<size_t>(size));
  adviseHugePages(fresh.data(), static_cast<size_t>(size));
  fresh.resize(static_cast<size_t>(size));
  trans_->readAll(reinterpret_cast<uint8_t*>(fresh.data()), static_cast<uint32_t>(size));
  str.swap(fresh);
  return header + static_cast<uint32_t>(size);
}

}  // namespace hsdig::contract
