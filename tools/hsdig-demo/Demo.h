// The demo job: a session on the simulated digitizer, two signals, one
// acquisition, measurements, a plot, and the error text of a refused call.
#pragma once

#include <cstdio>
#include <string>

namespace hsdig::demo {

struct Options {
  std::string model = "HSD-4";
  double frequencyHz = 1.0e6;
  int width = 72;   // plot columns
  int height = 15;  // plot rows
};

// Runs the job, writing to `out`; returns the process exit status (0, or 1
// when the digitizer refused something the job needs).
int run(const Options& options, std::FILE* out);

}  // namespace hsdig::demo
