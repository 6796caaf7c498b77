// Instrument files turned into field books. Each converter takes the
// instrument file's bytes and returns the field book's bytes (TCVN3, CR LF).
#pragma once

#include <string>
#include <string_view>

namespace kavu {

// SDR field books: kind 1 (.sdr) and kind 7 (.gre).
std::string ConvertSdr(std::string_view content, int kind);
// Sokkia field books (.obs), kind 2.
std::string ConvertObs(std::string_view content, int kind);
// SET files (.set).
std::string ConvertSet(std::string_view content);
// Topcom keyword files (.idx).
std::string ConvertIdx(std::string_view content);
// Topcom 226 column files (.tcm).
std::string ConvertTcm(std::string_view content);

}  // namespace kavu
