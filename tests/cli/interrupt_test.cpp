// Ctrl+C in the batch command: the run stops before its next station, writes
// nothing, keeps every product of the earlier run byte for byte, leaves no
// temporary file and exits 130 with the message on stderr.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <filesystem>
#include <map>
#include <string>
#include <thread>

#include "cli/cli.h"
#include "core/lines.h"
#include "core/messages.h"
#include "tests/cli/cli_support.h"
#include "tests/generated_book.h"
#include "tests/support.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;
using testing::Cli;
using testing::FileBytes;

std::map<std::string, std::string> Files(const fs::path& root) {
  std::map<std::string, std::string> files;
  for (const auto& entry : fs::recursive_directory_iterator(root)) {
    if (entry.is_regular_file()) {
      files[entry.path().lexically_relative(root).string()] = FileBytes(entry.path());
    }
  }
  return files;
}

bool WritingProducts(const fs::path& folder) {
  for (const auto& entry : fs::directory_iterator(folder)) {
    if (entry.path().string().ends_with(kTempSuffix)) return true;
  }
  return false;
}

TEST(Interrupt, CtrlCStopsTheRunAndKeepsTheEarlierProducts) {
  const fs::path root = testing::FreshFolder() / "job";
  const fs::path data = root / "data";
  fs::create_directories(data);
  const std::string book = (data / "job1.asc").string();
  fs::copy_file(fs::path(KAVU_EXAMPLES) / "job1.asc", book);
  ASSERT_EQ(Cli({"--all", "--seed", "1", book}).code, kExitOk);
  // The same job grown large enough that its station loop is still at work
  // when the interrupt comes.
  testing::WriteBytes(book, testing::GeneratedFieldBook(400, 100));
  const auto before = Files(root);

  const std::string out = (root.parent_path() / "stdout").string();
  const std::string err = (root.parent_path() / "stderr").string();
  const pid_t child = fork();
  ASSERT_GE(child, 0);
  if (child == 0) {
    if (std::freopen(out.c_str(), "w", stdout) && std::freopen(err.c_str(), "w", stderr)) {
      execl(KAVU_CLI_EXE, KAVU_CLI_EXE, "--all", book.c_str(), nullptr);
    }
    _exit(127);
  }

  // Once the run writes its temporary files, its handler is in place.
  int status = 0;
  while (!WritingProducts(data)) {
    ASSERT_EQ(waitpid(child, &status, WNOHANG), 0) << "the run ended before the interrupt";
    std::this_thread::sleep_for(std::chrono::milliseconds(2));
  }
  ASSERT_EQ(kill(child, SIGINT), 0);
  ASSERT_EQ(waitpid(child, &status, 0), child);

  ASSERT_TRUE(WIFEXITED(status)) << "ended by signal " << WTERMSIG(status);
  EXPECT_EQ(WEXITSTATUS(status), kExitInterrupted);
  EXPECT_EQ(FileBytes(out), "");
  EXPECT_EQ(FileBytes(err), std::string(msg::kRunCancelled) + "\n");
  const auto after = Files(root);
  EXPECT_EQ(after.size(), before.size());  // nothing new, no temporary file, no lock
  for (const auto& [name, bytes] : before) {
    const auto it = after.find(name);
    ASSERT_NE(it, after.end()) << name << " is gone";
    EXPECT_TRUE(it->second == bytes) << name << " changed";
  }
}

}  // namespace
}  // namespace kavu
