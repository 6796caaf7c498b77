// The batch command: one run with the options of the command line.
#pragma once

#include <atomic>
#include <ostream>
#include <span>
#include <string_view>

namespace kavu {

// Exit codes.
inline constexpr int kExitOk = 0;             // completed without data errors
inline constexpr int kExitDataErrors = 1;     // data errors or an unwritable product
inline constexpr int kExitStopped = 2;        // did not start or stopped early
inline constexpr int kExitUsage = 64;         // bad usage
inline constexpr int kExitInterrupted = 130;  // stopped by Ctrl+C: nothing written

// args excludes the program name. Progress goes to err only when
// errIsTerminal. The run stops before its next station once *interrupted
// turns true (set from a signal handler).
int RunCli(std::span<const std::string_view> args, std::ostream& out, std::ostream& err,
           bool errIsTerminal, const std::atomic<bool>* interrupted = nullptr);

}  // namespace kavu
