// Reading the test data of the instrument converters.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <string_view>

#include "core/lines.h"

namespace kavu::testing {

inline std::string DataFile(const std::string& dir, const std::string& relative) {
  const auto bytes = ReadFileBytes(dir + "/" + relative);
  EXPECT_TRUE(bytes.has_value()) << "missing " << dir << "/" << relative;
  return bytes.value_or(std::string());
}

inline std::string TestData(const std::string& relative) {
  return DataFile(KAVU_TEST_DATA "/import", relative);
}
inline std::string RealData(const std::string& name) { return DataFile(KAVU_REALDATA, name); }
inline std::string Example(const std::string& name) {
  return DataFile(KAVU_EXAMPLES "/instruments", name);
}

// Lines of a field book that begin with the given text.
inline int CountStarting(std::string_view book, std::string_view prefix) {
  int count = 0;
  for (const std::string& line : SplitLines(book)) count += line.starts_with(prefix) ? 1 : 0;
  return count;
}

inline int CountLines(std::string_view book) { return static_cast<int>(SplitLines(book).size()); }

// Every line of a field book ends in CR LF and there is no stray CR or LF.
inline bool AllLinesCrLf(std::string_view book) {
  std::size_t pos = 0;
  while (pos < book.size()) {
    const std::size_t cr = book.find_first_of("\r\n", pos);
    if (cr == std::string_view::npos || book.substr(cr, 2) != "\r\n") return false;
    pos = cr + 2;
  }
  return true;
}

}  // namespace kavu::testing
