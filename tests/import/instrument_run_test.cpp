// The SDR, Sokkia and SET example jobs through a whole run: converted by the
// batch command, computed, and a few coordinates checked against an azimuth
// and a reduced distance worked out here from the raw instrument values.
#include <cmath>
#include <string>

#include "import/converters.h"
#include "tests/import/instrument_test_util.h"

namespace kavu::testing {
namespace {

// The known points of the example jobs.
const Xy kKc01{5000, 3000};
const Xy kKc02{5100, 3050};
const Xy kKc03{4950, 3120};

// A point shot with the circle reading `circle` (degrees) when the
// orientation point was read at `circle0`; slope distance and zenith angle as
// recorded.
Xy Shot(Xy station, Xy orientation, double circle0, double circle, double slope, double zenith) {
  return Polar(station, orientation, circle - circle0,
               slope * std::sin(zenith * std::acos(-1.0) / 180));
}

class InstrumentRun : public InstrumentRunTest {
 protected:
  // Readings go through whole seconds and distances through millimetres.
  InstrumentRun() { tolerance_ = 0.002; }
};

TEST_F(InstrumentRun, SdrExampleComputes) {
  EXPECT_EQ(Run({kExamples / "job-sdr.sdr"}, {"--txt", "--seed", "1"}), kExitOk);
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
  EXPECT_EQ(Run({kExamples / "job-obs.obs"}, {"--txt", "--seed", "1"}), kExitOk);
  const auto points = Coordinates("job-obs.txt");
  EXPECT_EQ(points.size(), 8u);  // the backsight shots KC02 and KC01 too
  ExpectNear(points, "101",
             Shot(kKc01, kKc02, 349.31505118, 15.88010235, 50.00249994, 89.42706130));
  ExpectNear(points, "103",
             Shot(kKc01, kKc02, 349.31505118, 313.28767779, 60.85425211, 88.30500838));
  ExpectNear(points, "105",
             Shot(kKc03, kKc01, 351.11986495, 95.36989765, 50.00022500, 89.82811318));
}

TEST_F(InstrumentRun, SetExampleComputes) {
  EXPECT_EQ(Run({kExamples / "job-set.set"}, {"--txt", "--seed", "1"}), kExitOk);
  const auto points = Coordinates("job-set.txt");
  EXPECT_EQ(points.size(), 8u);  // 103 twice; the orientation shots 0002, 0001
  ExpectNear(points, "102",
             Shot(kKc01, kKc02, 349.31505118, 71.18494882, 63.24586943, 89.81881544));
  // The second shot of 103, from KC02 on KC01 (read at 194.56505118).
  ExpectNear(points, "103",
             Shot(kKc02, kKc01, 194.56505118, 224.30993247, 72.11369079, 90.49260855));
  ExpectNear(points, "106",
             Shot(kKc03, kKc01, 351.11986495, 272.19006753, 36.05970743, 90.87393667));
}

}  // namespace
}  // namespace kavu::testing
