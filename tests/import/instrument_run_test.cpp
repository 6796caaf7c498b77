// The SDR, Sokkia and SET example jobs through a whole run: converted by the
// batch command, computed, and a few coordinates checked against an azimuth
// and a reduced distance worked out here from the raw instrument values. The
// real recordings must run to the end as well.
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

const double kPiHere = std::acos(-1.0);

// The known points of the example jobs.
const Xy kKc01{5000, 3000};
const Xy kKc02{5100, 3050};
const Xy kKc03{4950, 3120};

// A point shot from `station` with the circle reading `circle` (degrees),
// when the orientation point `orientation` was read at `circle0`; slope
// distance and zenith angle as recorded.
Xy Shot(Xy station, Xy orientation, double circle0, double circle, double slope, double zenith) {
  const double az0 = std::atan2(orientation.y - station.y, orientation.x - station.x);
  const double az = az0 + (circle - circle0) * kPiHere / 180;
  const double hd = slope * std::sin(zenith * kPiHere / 180);
  return {station.x + hd * std::cos(az), station.y + hd * std::sin(az)};
}

class InstrumentRun : public ::testing::Test {
 protected:
  void SetUp() override {
    dir_ = fs::temp_directory_path() /
           ("kavu-instrument-" +
            std::string(::testing::UnitTest::GetInstance()->current_test_info()->name()) + "-" +
            std::to_string(::getpid()));
    fs::remove_all(dir_);
    fs::create_directories(dir_);
  }
  void TearDown() override {
    std::error_code ec;
    fs::remove_all(dir_, ec);
  }

  // Copies the file into the folder and runs the batch command on it.
  int Run(const fs::path& file) {
    fs::copy_file(file, dir_ / file.filename());
    const std::vector<std::string> args = {"--txt", "--seed", "1",
                                           (dir_ / file.filename()).string()};
    const std::vector<std::string_view> views(args.begin(), args.end());
    std::ostringstream out, err;
    return RunCli(views, out, err, false);
  }

  // Name -> X, Y of the coordinate text file (the last line of a name wins).
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

void ExpectNear(const std::map<std::string, Xy>& points, const std::string& name, Xy expected) {
  const auto it = points.find(name);
  ASSERT_NE(it, points.end()) << name;
  // Readings go through whole seconds and distances through millimetres.
  EXPECT_NEAR(it->second.x, expected.x, 0.002) << name;
  EXPECT_NEAR(it->second.y, expected.y, 0.002) << name;
}

TEST_F(InstrumentRun, SdrExampleComputes) {
  EXPECT_EQ(Run(kExamples / "job-sdr.sdr"), kExitOk);
  const auto points = Coordinates("job-sdr.txt");
  EXPECT_EQ(points.size(), 6u);
  // 101 is shot before the backsight KC02 (read at 349.315051): turned.
  ExpectNear(points, "101", Shot(kKc01, kKc02, 349.315051, 15.880102, 50.0025, 89.427061));
  // 104 after a prism-height change.
  ExpectNear(points, "104", Shot(kKc01, kKc02, 349.315051, 47.039407, 100.5072, 89.258893));
  // 106 from KC03 on KC01 (read at 351.119865).
  ExpectNear(points, "106", Shot(kKc03, kKc01, 351.119865, 272.190068, 36.0614, 91.032802));
}

TEST_F(InstrumentRun, ObsExampleComputes) {
  EXPECT_EQ(Run(kExamples / "job-obs.obs"), kExitOk);
  const auto points = Coordinates("job-obs.txt");
  EXPECT_EQ(points.size(), 6u);
  ExpectNear(points, "101",
             Shot(kKc01, kKc02, 349.31505118, 15.88010235, 50.00249994, 89.42706130));
  ExpectNear(points, "103",
             Shot(kKc01, kKc02, 349.31505118, 313.28767779, 60.85425211, 88.30500838));
  ExpectNear(points, "105",
             Shot(kKc03, kKc01, 351.11986495, 95.36989765, 50.00022500, 89.82811318));
}

TEST_F(InstrumentRun, SetExampleComputes) {
  EXPECT_EQ(Run(kExamples / "job-set.set"), kExitOk);
  const auto points = Coordinates("job-set.txt");
  EXPECT_EQ(points.size(), 6u);  // 103 is shot from two stations
  ExpectNear(points, "102",
             Shot(kKc01, kKc02, 349.31505118, 71.18494882, 63.24586943, 89.81881544));
  // The second shot of 103, from KC02 on KC01 (read at 194.56505118).
  ExpectNear(points, "103",
             Shot(kKc02, kKc01, 194.56505118, 224.30993247, 72.11369079, 90.49260855));
  ExpectNear(points, "106",
             Shot(kKc03, kKc01, 351.11986495, 272.19006753, 36.05970743, 90.87393667));
}

// The real recordings carry no usable control points: the run ends, reports
// it, and the field book in the folder is exactly the converted one.
TEST_F(InstrumentRun, RealRecordingsRunToTheEnd) {
  const fs::path real(KAVU_REALDATA);
  struct Case {
    const char* file;
    int exit;
  };
  for (const Case& c :
       {Case{"barnes-example.sdr", kExitDataErrors}, Case{"geoeasy-focus6-1.sdr", kExitDataErrors},
        Case{"geoeasy-20151125.obs", kExitDataErrors},
        Case{"geoeasy-20151130.set", kExitDataErrors},
        Case{"tops-sokkia_sdr33.set", kExitStopped}}) {
    EXPECT_EQ(Run(real / c.file), c.exit) << c.file;
  }
  const auto raw = [&](const char* name) { return ReadFileBytes(real / name).value_or(""); };
  EXPECT_EQ(ReadFileBytes(dir_ / "barnes-example.asc"), ConvertSdr(raw("barnes-example.sdr"), 1));
  EXPECT_EQ(ReadFileBytes(dir_ / "geoeasy-20151125.asc"),
            ConvertObs(raw("geoeasy-20151125.obs"), 2));
  EXPECT_EQ(ReadFileBytes(dir_ / "geoeasy-20151130.asc"), ConvertSet(raw("geoeasy-20151130.set")));
}

}  // namespace
}  // namespace kavu
