// Validation and writing of attribute values, shared by the attribute
// functions, the Configure functions and the configuration import.
#pragma once

#include <string>
#include <variant>
#include <vector>

#include "Digitizer.h"

namespace hsdig::sim {

using Value = std::variant<ViInt32, ViInt64, ViReal64, ViBoolean, ViSession, std::string>;

ViInt32 iviTypeOf(const Value& v);
std::string describeValue(const Value& v);
// Fails with VALUE_OUT_OF_RANGE (or INVALID_TRIGGER_SOURCE for sources and
// terminals) unless `v` is acceptable for `a` on this model.
void validateValue(const Digitizer& d, const AttributeInfo& a, const Value& v);
// Writes through the engine with the given option flags.
void writeValue(ViSession vi, const char* channel, ViAttr id, const Value& v, ViInt32 flags);

struct Change {
  ViAttr id;
  Value value;
};
// Validates every change for every channel first, then writes them as the
// user's settings; so a rejected argument leaves the configuration as it was.
// `channels` empty: session attributes.
void applyChanges(Digitizer& d, const std::vector<int>& channels,
                  const std::vector<Change>& changes);

// Sources and terminals.
bool isChannelName(const Digitizer& d, const std::string& s);
bool validTriggerSource(const Digitizer& d, const std::string& s, ViInt32 triggerType);
bool validTerminal(const std::string& s);

// Fails with NULL_POINTER naming the argument.
void requirePointer(const void* p, const char* name);
// The IVI string output rule; returns the status to return.
ViStatus copyString(const std::string& text, ViInt32 bufferSize, ViChar* buffer, const char* name);

}  // namespace hsdig::sim
