// Shared helpers of the tests: a fresh folder per test, file bytes, and a
// host that records what the run shows and answers as told.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "core/host.h"
#include "core/lines.h"

namespace kavu::testing {

// An empty folder of its own for the running test.
inline std::filesystem::path FreshFolder(const std::string& area = "kavu") {
  const auto* info = ::testing::UnitTest::GetInstance()->current_test_info();
  const std::filesystem::path folder = std::filesystem::path(::testing::TempDir()) / area /
                                       (std::string(info->test_suite_name()) + "." + info->name());
  // Windows refuses to delete a read-only file (a copied data file may be one).
  std::error_code ec;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(folder, ec)) {
    std::filesystem::permissions(entry.path(), std::filesystem::perms::owner_write,
                                 std::filesystem::perm_options::add, ec);
  }
  std::filesystem::remove_all(folder);
  std::filesystem::create_directories(folder);
  return folder;
}

inline std::string FileBytes(const std::filesystem::path& path) {
  return ReadFileBytes(path).value_or("<missing " + path.string() + ">");
}

inline void WriteBytes(const std::filesystem::path& path, const std::string& bytes) {
  TextOut out(path);
  out.Write(bytes);
  out.close();
}

class RecordingHost : public Host {
 public:
  MsgAnswer summaryAnswer = MsgAnswer::Yes;
  std::vector<std::string> messages;
  std::vector<std::string> titles;
  std::string fileBox;
  int kind = -1;
  int beeps = 0;
  int focused = 0;

  MsgAnswer MessageBox(std::string_view text, MsgIcon, MsgButtons buttons) override {
    messages.emplace_back(text);
    return buttons == MsgButtons::YesNo ? summaryAnswer : MsgAnswer::Ok;
  }
  void SetTitle(std::string_view title) override { titles.emplace_back(title); }
  void Beep() override { ++beeps; }
  void SetFileBox(std::string_view text) override { fileBox = text; }
  void FocusFileBox() override { ++focused; }
  void SelectKind(int index) override { kind = index; }
};

}  // namespace kavu::testing
