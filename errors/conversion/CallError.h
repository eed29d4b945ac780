// What the server reported for one call of the client: the RetStatus of a
// failed or warning reply. Call-local; code 0 means none.
#pragma once

#include <cstdint>
#include <string>

namespace hsdig {

struct CallError {
  int32_t code = 0;
  std::string text;
};

// The secondary error every client export stores with a failure, so that
// hsdigRemote_GetError knows the elaboration is the server's own text.
// Call frame, session open and close, and hsdigRemote_GetError:
inline constexpr int32_t kSecondaryErrorCallFrame = static_cast<int32_t>(0xBFFA9182);
// The fetch and read family, coefficient queries, revision query, self test:
inline constexpr int32_t kSecondaryErrorFetch = static_cast<int32_t>(0xBFFA40BA);

// Status codes of the error exports themselves.
inline constexpr int32_t kErrorNullPointer = static_cast<int32_t>(0xBFFA0058);
inline constexpr int32_t kErrorInvalidParameter = static_cast<int32_t>(0xBFFA000F);
inline constexpr int32_t kErrorOutOfMemory = -52000;
inline constexpr int32_t kErrorInternal = -52003;

}  // namespace hsdig
