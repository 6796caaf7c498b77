// The expected files of the product tests.
#pragma once

#include <filesystem>
#include <string>

#include "support.h"

namespace kavu::testing {

inline std::string Expected(const std::string& name) {
  return FileBytes(std::filesystem::path(KAVU_TEST_DATA) / "products" / name);
}

}  // namespace kavu::testing
