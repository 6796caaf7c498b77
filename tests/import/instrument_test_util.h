// Reading and writing the test data of the instrument converters, and a batch
// run of an instrument file with the coordinates it computed.
#pragma once

#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "tests/cli/cli_support.h"

namespace kavu::testing {

// A record of a column file: its code, then texts placed at their columns
// (from 1).
inline std::string Rec(std::string code, std::vector<std::pair<std::size_t, std::string>> fields) {
  for (const auto& [column, text] : fields) {
    if (code.size() < column - 1) code.resize(column - 1, ' ');
    code.replace(column - 1, text.size(), text);
  }
  return code + "\r\n";
}

inline std::string TestData(const std::string& relative) {
  return FileBytes(std::filesystem::path(KAVU_TEST_DATA) / "import" / relative);
}

struct Xy {
  double x = 0, y = 0;
};

// The point `reading` degrees clockwise from the orientation point, seen from
// the station, at a horizontal distance.
inline Xy Polar(Xy station, Xy orientation, double reading, double distance) {
  const double pi = std::acos(-1.0);
  const double az =
      std::atan2(orientation.y - station.y, orientation.x - station.x) + reading * pi / 180;
  return {station.x + distance * std::cos(az), station.y + distance * std::sin(az)};
}

// Batch runs in a folder of their own, and the coordinates they wrote.
class InstrumentRunTest : public ::testing::Test {
 protected:
  // Copies the file into the folder and runs the batch command on it.
  int Run(const std::filesystem::path& file, std::vector<std::string> args) {
    std::filesystem::copy_file(file, dir_ / file.filename());
    args.push_back((dir_ / file.filename()).string());
    return Cli(args).code;
  }

  // Name -> X, Y of the coordinate text file (the last line of a name wins).
  std::map<std::string, Xy> Coordinates(const std::string& name) const {
    std::map<std::string, Xy> points;
    for (std::string line : ReadLines(dir_ / name).value_or(std::vector<std::string>())) {
      line = Trim(line);
      const std::vector<std::string> f = SplitFields(line);
      if (f.size() >= 3) points[f[0]] = {Val(f[1]), Val(f[2])};
    }
    return points;
  }

  void ExpectNear(const std::map<std::string, Xy>& points, const std::string& name, Xy expected,
                  double tolerance = 0.001) const {
    const auto it = points.find(name);
    ASSERT_NE(it, points.end()) << name;
    EXPECT_NEAR(it->second.x, expected.x, tolerance) << name;
    EXPECT_NEAR(it->second.y, expected.y, tolerance) << name;
  }

  const std::filesystem::path dir_ = FreshFolder("kavu-instrument");
};

}  // namespace kavu::testing
