#include "errors/conversion/CopyStringOut.h"

#include <cstring>
#include <limits>

#include "errors/conversion/CallError.h"

namespace hsdig {

ViStatus copyStringOut(std::string_view text, ViInt32 bufferSize, ViChar* buffer) {
  // A text that cannot be described by a ViInt32 size is cut to one that can.
  constexpr size_t kLongest = std::numeric_limits<ViInt32>::max() - 1;
  if (text.size() > kLongest) text = text.substr(0, kLongest);
  const ViInt32 needed = static_cast<ViInt32>(text.size() + 1);
  if (bufferSize == 0) return needed;
  if (buffer == nullptr) return kErrorNullPointer;
  if (bufferSize < 0 || bufferSize >= needed) {
    std::memcpy(buffer, text.data(), text.size());
    buffer[text.size()] = '\0';
    return 0;
  }
  std::memcpy(buffer, text.data(), static_cast<size_t>(bufferSize) - 1);
  buffer[bufferSize - 1] = '\0';
  return needed;
}

}  // namespace hsdig
