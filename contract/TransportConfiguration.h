// Limits of the hsdigEP wire, shared by the client and the server.
//
// A message travels in one frame of at most kMaxFrameSize payload bytes, and
// within that frame no string or container has a limit of its own. Thrift's
// TConfiguration defaults (100 MiB messages, 16,384,000-byte frames) are
// tighter, so every transport and protocol of the contract is built over
// makeTransportConfiguration(). Nesting of records is limited to
// kRecursionLimit levels; the deepest record of the contract nests three.
#pragma once

#include <thrift/TConfiguration.h>
#include <thrift/protocol/TBinaryProtocol.h>

#include <cstdint>
#include <memory>

namespace hsdig::contract {

inline constexpr int32_t kMaxFrameSize = 0x10000000;
inline constexpr int kRecursionLimit = 64;

// A configuration allowing frames and messages of kMaxFrameSize bytes and
// nesting to kRecursionLimit. Transports keep a count of the bytes of the
// current message against it: whoever reuses a transport for several
// messages resets that count per message (resetConsumedMessageSize).
std::shared_ptr<apache::thrift::TConfiguration> makeTransportConfiguration();

// The binary protocol factory of the contract: no string or container size
// limit, strict reading off (both header forms are accepted) and strict
// writing on (the strict form is always written).
std::shared_ptr<apache::thrift::protocol::TBinaryProtocolFactory> makeProtocolFactory();

}  // namespace hsdig::contract
