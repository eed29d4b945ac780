// The 4-byte big-endian length that starts every frame on the pipe.
#pragma once

#include <cstdint>

namespace hsdig::transport {

inline constexpr uint32_t kFrameLengthSize = 4;

inline uint32_t decodeFrameLength(const uint8_t* bytes) {
  return (uint32_t{bytes[0]} << 24) | (uint32_t{bytes[1]} << 16) | (uint32_t{bytes[2]} << 8) |
         bytes[3];
}

inline void encodeFrameLength(uint8_t* bytes, uint32_t length) {
  bytes[0] = static_cast<uint8_t>(length >> 24);
  bytes[1] = static_cast<uint8_t>(length >> 16);
  bytes[2] = static_cast<uint8_t>(length >> 8);
  bytes[3] = static_cast<uint8_t>(length);
}

}  // namespace hsdig::transport
