// hsdig-demo: the main job on the simulated digitizer.
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include "Demo.h"

namespace {

void usage(std::FILE* out) {
  std::fprintf(out,
               "usage: hsdig-demo [--model HSD-1|HSD-2|HSD-4|HSD-8] [--frequency HZ]\n"
               "Opens the simulated digitizer, acquires a sine and a square wave, prints\n"
               "their measurements and a plot, and shows the error text of a refused call.\n");
}

}  // namespace

int main(int argc, char** argv) {
  hsdig::demo::Options options;
  for (int i = 1; i < argc; ++i) {
    const std::string arg = argv[i];
    if (arg == "--help" || arg == "-h") {
      usage(stdout);
      return 0;
    }
    if (arg == "--model" && i + 1 < argc) {
      options.model = argv[++i];
    } else if (arg == "--frequency" && i + 1 < argc) {
      char* end = nullptr;
      options.frequencyHz = std::strtod(argv[++i], &end);
      if (*end != '\0' || !(options.frequencyHz > 0)) {
        std::fprintf(stderr, "hsdig-demo: bad frequency '%s'\n", argv[i]);
        return 2;
      }
    } else {
      std::fprintf(stderr, "hsdig-demo: unknown argument '%s'\n", arg.c_str());
      usage(stderr);
      return 2;
    }
  }
  return hsdig::demo::run(options, stdout);
}
