// Helpers of the product tests: a fresh output folder and the expected files.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "core/lines.h"

namespace kavu::testing {

// An empty folder of its own for one test.
inline std::filesystem::path FreshFolder() {
  const auto* info = ::testing::UnitTest::GetInstance()->current_test_info();
  const std::filesystem::path folder = std::filesystem::path(::testing::TempDir()) /
                                       "kavu_products" /
                                       (std::string(info->test_suite_name()) + "." + info->name());
  std::filesystem::remove_all(folder);
  std::filesystem::create_directories(folder);
  return folder;
}

inline std::string FileBytes(const std::filesystem::path& path) {
  return ReadFileBytes(path).value_or("<missing " + path.string() + ">");
}

inline std::string Expected(const std::string& name) {
  return FileBytes(std::filesystem::path(KAVU_TEST_DATA) / "products" / name);
}

}  // namespace kavu::testing
