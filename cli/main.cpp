// kavu-cli: the batch command. Everything is in RunCli, so tests run the same
// code. The arguments reach RunCli as UTF-8 on every system: on Windows they
// are taken from the wide-character command line, so a path with Vietnamese
// letters survives whatever the machine's ANSI code page.
//
// Ctrl+C asks the run to stop before its next station, abandoning every
// product it was writing; a second Ctrl+C ends the command at once (a later
// run of the job removes the temporary files left behind).
#include <atomic>
#include <iostream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"

namespace {

// Set by the interrupt only, read by the run: a signal handler can reach no
// other state.
std::atomic<bool> interrupted{false};
static_assert(std::atomic<bool>::is_always_lock_free);

}  // namespace

#ifdef _WIN32
#include <io.h>
#include <windows.h>

#include <cstdio>

namespace {

BOOL WINAPI OnConsoleEvent(DWORD event) {
  if (event != CTRL_C_EVENT && event != CTRL_BREAK_EVENT) return FALSE;
  // The second one goes on to the default handler, which ends the process.
  return interrupted.exchange(true) ? FALSE : TRUE;
}

std::string Utf8(const wchar_t* text) {
  const int size = WideCharToMultiByte(CP_UTF8, 0, text, -1, nullptr, 0, nullptr, nullptr);
  if (size <= 1) return {};
  std::string out(static_cast<std::size_t>(size), '\0');
  WideCharToMultiByte(CP_UTF8, 0, text, -1, out.data(), size, nullptr, nullptr);
  out.pop_back();  // the terminating zero
  return out;
}

}  // namespace

int wmain(int argc, wchar_t** argv) {
  // The summary and the messages are UTF-8 text.
  SetConsoleOutputCP(CP_UTF8);
  SetConsoleCtrlHandler(OnConsoleEvent, TRUE);
  std::vector<std::string> texts;
  for (int i = 1; i < argc; ++i) texts.push_back(Utf8(argv[i]));
  const std::vector<std::string_view> args(texts.begin(), texts.end());
  return kavu::RunCli(args, std::cout, std::cerr, _isatty(_fileno(stderr)) != 0, &interrupted);
}

#else
#include <signal.h>
#include <unistd.h>

namespace {

void OnInterrupt(int) { interrupted.store(true); }

}  // namespace

int main(int argc, char** argv) {
  struct sigaction action {};
  action.sa_handler = OnInterrupt;
  sigemptyset(&action.sa_mask);
  // Used once: the second SIGINT gets the default action and ends the process.
  action.sa_flags = SA_RESETHAND;
  sigaction(SIGINT, &action, nullptr);
  std::vector<std::string_view> args;
  for (int i = 1; i < argc; ++i) args.emplace_back(argv[i]);
  return kavu::RunCli(args, std::cout, std::cerr, isatty(STDERR_FILENO) == 1, &interrupted);
}
#endif
