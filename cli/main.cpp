// kavu-cli: the batch command. Everything is in RunCli, so tests run the same
// code. The arguments reach RunCli as UTF-8 on every system: on Windows they
// are taken from the wide-character command line, so a path with Vietnamese
// letters survives whatever the machine's ANSI code page.
#include <iostream>
#include <string>
#include <string_view>
#include <vector>

#include "cli/cli.h"

#ifdef _WIN32
#include <io.h>
#include <windows.h>

#include <cstdio>

namespace {

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
  std::vector<std::string> texts;
  for (int i = 1; i < argc; ++i) texts.push_back(Utf8(argv[i]));
  const std::vector<std::string_view> args(texts.begin(), texts.end());
  return kavu::RunCli(args, std::cout, std::cerr, _isatty(_fileno(stderr)) != 0);
}

#else
#include <unistd.h>

int main(int argc, char** argv) {
  std::vector<std::string_view> args;
  for (int i = 1; i < argc; ++i) args.emplace_back(argv[i]);
  return kavu::RunCli(args, std::cout, std::cerr, isatty(STDERR_FILENO) == 1);
}
#endif
