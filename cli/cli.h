// The batch command: one run with the options of the command line.
#pragma once

#include <ostream>
#include <span>
#include <string_view>

namespace kavu {

// Exit codes.
inline constexpr int kExitOk = 0;          // completed without data errors
inline constexpr int kExitDataErrors = 1;  // data errors or an unwritable product
inline constexpr int kExitStopped = 2;     // did not start or stopped early
inline constexpr int kExitUsage = 64;      // bad usage

// args excludes the program name. Progress goes to err only when
// errIsTerminal.
int RunCli(std::span<const std::string_view> args, std::ostream& out, std::ostream& err,
           bool errIsTerminal);

}  // namespace kavu
