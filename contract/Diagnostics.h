// Diagnostics of the transport and server layers go to Thrift's process-wide
// output (apache::thrift::GlobalOutput). A library inside someone else's
// process must not write to its console, so loading libhsdigRemote.so points
// that output at a sink that discards everything. Tests and tools that want
// to see the lines install their own sink.
#pragma once

namespace hsdig::diagnostics {

using Sink = void (*)(const char* line);

// The default sink: drops the line.
void discard(const char* line);

// Routes every later diagnostic line to `sink`.
void installSink(Sink sink);

}  // namespace hsdig::diagnostics
