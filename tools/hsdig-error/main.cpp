#include <iostream>
#include <string>
#include <vector>

#include "tools/hsdig-error/ErrorTool.h"

int main(int argc, char** argv) {
  std::vector<std::string> args(argv + 1, argv + argc);
  return hsdig::tools::runErrorTool(args, std::cout, std::cerr);
}
