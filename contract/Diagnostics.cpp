#include "contract/Diagnostics.h"

#include <thrift/Thrift.h>

namespace hsdig::diagnostics {

void discard(const char*) {}

void installSink(Sink sink) {
  apache::thrift::GlobalOutput.setOutputFunction(sink);
}

namespace {
// Runs when the shared object is loaded (the object file is linked whole);
// Thrift's own output object is constructed earlier, in libthrift.
[[maybe_unused]] const bool kDiscardByDefault = (installSink(&discard), true);
}  // namespace

}  // namespace hsdig::diagnostics
