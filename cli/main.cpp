// kavu-cli: the batch command. Everything is in RunCli, so tests run the same
// code.
#include <unistd.h>

#include <iostream>
#include <string_view>
#include <vector>

#include "cli/cli.h"

int main(int argc, char** argv) {
  std::vector<std::string_view> args;
  for (int i = 1; i < argc; ++i) args.emplace_back(argv[i]);
  return kavu::RunCli(args, std::cout, std::cerr, isatty(STDERR_FILENO) == 1);
}
