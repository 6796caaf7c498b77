// Instrument files turned into field books. Each converter takes the
// instrument file's bytes and returns the field book's bytes (TCVN3, CR LF)
// with the lines the run's error report gets about the file itself.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kavu {

struct Conversion {
  std::string book;
  std::vector<std::string> report;
};

// SDR field books: kind 1 (.sdr) and kind 7 (.gre), 4-character identifiers
// unless the file declares 16.
Conversion ConvertSdr(std::string_view content, int kind);
// Sokkia field books (.obs), kind 2: 16-character identifiers unless the file
// declares 4.
Conversion ConvertObs(std::string_view content, int kind);
// SET files (.set).
Conversion ConvertSet(std::string_view content);
// Topcom keyword files (.idx).
Conversion ConvertIdx(std::string_view content);
// Topcom 226 column files (.tcm).
Conversion ConvertTcm(std::string_view content);

}  // namespace kavu
