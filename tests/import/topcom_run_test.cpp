// The Topcom example jobs and the real keyword file through a whole run:
// converted, computed, and a few coordinates checked against an azimuth and
// distance worked out here from the control points.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cmath>
#include <filesystem>
#include <map>
#include <sstream>
#include <string>
#include <vector>

#include "cli/cli.h"
#include "core/lines.h"
#include "core/numbers.h"
#include "core/text.h"
#include "import/converters.h"

namespace kavu {
namespace {

namespace fs = std::filesystem;

struct Xy {
  double x = 0, y = 0;
};

class TopcomRun : public ::testing::Test {
 protected:
  void SetUp() override {
    dir_ = fs::temp_directory_path() /
           ("kavu-topcom-" +
            std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()) + "-" +
            std::to_string(::getpid()));
    fs::remove_all(dir_);
    fs::create_directories(dir_);
  }
  void TearDown() override {
    std::error_code ec;
    fs::remove_all(dir_, ec);
  }

  // Copies the files into the folder and runs the batch command on the first.
  int Run(const std::vector<fs::path>& files, const std::vector<std::string>& options) {
    for (const fs::path& file : files) fs::copy_file(file, dir_ / file.filename());
    std::vector<std::string> args = options;
    args.push_back((dir_ / files.front().filename()).string());
    const std::vector<std::string_view> views(args.begin(), args.end());
    std::ostringstream out, err;
    return RunCli(views, out, err, false);
  }

  // Name -> X, Y of the coordinate text file.
  std::map<std::string, Xy> Coordinates(const std::string& name) {
    std::map<std::string, Xy> points;
    for (std::string line : ReadLines(dir_ / name).value_or(std::vector<std::string>())) {
      line = Trim(line);
      const std::vector<std::string> f = SplitFields(line);
      if (f.size() >= 3) points[f[0]] = {Val(f[1]), Val(f[2])};
    }
    return points;
  }

  fs::path dir_;
};

const fs::path kExamples = fs::path(KAVU_EXAMPLES) / "instruments";

// Station, orientation point, reading to the point (degrees from the
// orientation point), horizontal distance.
Xy Polar(Xy station, Xy orientation, double reading, double distance) {
  const double pi = std::acos(-1.0);
  const double az0 = std::atan2(orientation.y - station.y, orientation.x - station.x);
  const double az = az0 + reading * pi / 180;
  return {station.x + distance * std::cos(az), station.y + distance * std::sin(az)};
}

void ExpectNear(const std::map<std::string, Xy>& points, const std::string& name, Xy expected) {
  const auto it = points.find(name);
  ASSERT_NE(it, points.end()) << name;
  EXPECT_NEAR(it->second.x, expected.x, 0.001) << name;
  EXPECT_NEAR(it->second.y, expected.y, 0.001) << name;
}

const Xy kGps01{2341520.412, 585310.227};
const Xy kGps02{2341688.905, 585402.618};
const Xy kGps03{2341605.330, 585561.774};
const Xy kGps04{2341432.118, 585498.501};

TEST_F(TopcomRun, KeywordExampleComputes) {
  EXPECT_EQ(Run({kExamples / "job-idx.idx", kExamples / "job-idx-tcm-control.txt"},
                {"--txt", "--control-file", (dir_ / "job-idx-tcm-control.txt").string()}),
            kExitOk);
  const auto points = Coordinates("job-idx.txt");
  EXPECT_EQ(points.size(), 16u);  // 14 points and the two orientation points
  // 101 from GPS01 on GPS02: Hz 187.633516, slope 84.578 at Vz 89.199928.
  ExpectNear(
      points, "101",
      Polar(kGps01, kGps02, 187.633516, 84.578 * std::sin(89.199928 * std::acos(-1.0) / 180)));
  // 113 from GPS04 on GPS03: 215 57 52 (whole seconds), 89.659 reduced.
  ExpectNear(points, "113", Polar(kGps04, kGps03, 215 + 57 / 60.0 + 52 / 3600.0, 89.659));
}

TEST_F(TopcomRun, Topcom226ExampleComputes) {
  EXPECT_EQ(Run({kExamples / "job-tcm.tcm", kExamples / "job-idx-tcm-control.txt"},
                {"--txt", "--control-file", (dir_ / "job-idx-tcm-control.txt").string()}),
            kExitOk);
  const auto points = Coordinates("job-tcm.txt");
  EXPECT_EQ(points.size(), 9u);  // the peg and the orientation sights are not detail points
  // 202 from GPS03 on GPS04 (circle 0 there): 160 00 37, 87.580.
  ExpectNear(points, "202", Polar(kGps03, kGps04, 160 + 37 / 3600.0, 87.580));
  // 205 from GPS01, circle 0 00 02 on GPS04: 293 25 37 - 2" = 293 25 35.
  ExpectNear(points, "205", Polar(kGps01, kGps04, 293 + 25 / 60.0 + 35 / 3600.0, 42.866));
  // 210 from GPS02 on GPS01: 6 37 17, 99.812.
  ExpectNear(points, "210", Polar(kGps02, kGps01, 6 + 37 / 60.0 + 17 / 3600.0, 99.812));
}

// Without its control points the real file cannot be computed; the run must
// still end, report it, and leave the converted field book as converted.
TEST_F(TopcomRun, RealKeywordFileRunsToTheEnd) {
  const fs::path real = fs::path(KAVU_REALDATA) / "geoeasy-test.idx";
  EXPECT_EQ(Run({real}, {"--txt"}), kExitDataErrors);
  EXPECT_EQ(ReadFileBytes(dir_ / "geoeasy-test.asc"), ConvertIdx(*ReadFileBytes(real)));
}

}  // namespace
}  // namespace kavu
