// Running the batch command in the tests: in process, or as the executable
// itself (so that main's wiring and the process's limits count too).
#pragma once

#if !defined(_WIN32)
#include <sys/wait.h>  // the executable runs through a POSIX shell
#endif

#include <cstdlib>
#include <filesystem>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"
#include "tests/support.h"

namespace kavu::testing {

struct Outcome {
  int code = -1;
  std::string out, err;
};

inline Outcome Cli(const std::vector<std::string>& args, bool terminal = false) {
  const std::vector<std::string_view> views(args.begin(), args.end());
  std::ostringstream out, err;
  const int code = RunCli(views, out, err, terminal);
  return {code, out.str(), err.str()};
}

inline std::string Quote(const std::string& s) {
  std::string q = "'";
  for (char c : s) q += c == '\'' ? std::string("'\\''") : std::string(1, c);
  return q + "'";
}

#if !defined(_WIN32)
// The executable with its output kept in dir; `shell` runs first in the same
// shell (limits for the process, say).
inline Outcome Exe(const std::vector<std::string>& args, const std::filesystem::path& dir,
                   const std::string& shell = "") {
  std::string command = shell + "exec " + Quote(KAVU_CLI_EXE);
  for (const std::string& a : args) command += " " + Quote(a);
  command +=
      " </dev/null >" + Quote((dir / "stdout").string()) + " 2>" + Quote((dir / "stderr").string());
  const int status = std::system(command.c_str());
  return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, FileBytes(dir / "stdout"),
          FileBytes(dir / "stderr")};
}
#endif

}  // namespace kavu::testing
