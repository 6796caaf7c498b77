// A field book as large as a test needs, generated: `stations` set-ups along
// a line of control points, each with `points` detail points, a peg and a
// check sight on the next station.
#pragma once

#include <string>

namespace kavu::testing {

inline std::string GeneratedFieldBook(int stations, int points) {
  std::string book;
  for (int k = 0; k <= stations; ++k) {
    book += "TR K" + std::to_string(k) + " " + std::to_string(1000 + 100 * k) + " 5000 10\r\n";
  }
  for (int k = 1; k <= stations; ++k) {
    book += "TR K" + std::to_string(k) + " 1.5\r\nDKD K" + std::to_string(k - 1) + "\r\n";
    for (int p = 0; p < points; ++p) {
      book += std::to_string(k) + "-" + std::to_string(p) + " " +
              std::to_string((p * 7919) % 3600000) + " " + std::to_string(5 + p % 150) +
              ".125 0893000 1.5 N\r\n";
    }
    book += "C" + std::to_string(k) + " 1800000 20 900000 1.5 CP" + std::to_string(k) + "\r\n";
    book += "T" + std::to_string(k) + " 0 100 900000 1.5 K" + std::to_string(k + 1) + " KT\r\n";
  }
  return book;
}

}  // namespace kavu::testing
