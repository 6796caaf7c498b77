#include "core/survey_math.h"

#include <gtest/gtest.h>

#include <cmath>
#include <vector>

namespace kavu {
namespace {

// Packed angles with what is wrong with them; the degrees of 360 and more
// taken modulo 360, a fraction of a second kept to its tenth.
TEST(SurveyMath, DecodesPackedAnglesAndTheirFaults) {
  struct Case {
    double packed, degrees;
    bool negative, degreesOver, minutesOver, secondsOver;
  };
  const std::vector<Case> cases = {
      {1234530, 123.0 + 45.0 / 60 + 30.0 / 3600, false, false, false, false},
      {900000, 90, false, false, false, false},
      {1234530.5, 123.0 + 45.0 / 60 + 30.5 / 3600, false, false, false, false},
      {-900000, 90, true, false, false, false},
      {3615000, 1 + 50.0 / 60, false, true, false, false},
      {1236000, 124, false, false, true, false},
      {1234561, 123.0 + 45.0 / 60 + 61.0 / 3600, false, false, false, true},
      {0, 0, false, false, false, false},
  };
  for (const Case& c : cases) {
    const DecodedAngle angle = DecodePacked(c.packed);
    EXPECT_NEAR(angle.degrees, c.degrees, 1e-9) << c.packed;
    EXPECT_EQ(angle.negative, c.negative) << c.packed;
    EXPECT_EQ(angle.degreesOver, c.degreesOver) << c.packed;
    EXPECT_EQ(angle.minutesOver, c.minutesOver) << c.packed;
    EXPECT_EQ(angle.secondsOver, c.secondsOver) << c.packed;
  }
  EXPECT_EQ(Radians(180), 3.14159265358979);
}

// The station at (1000, 1000) oriented on a point 100 m south of it: the
// orientation's bearing to the station is 0, a reading of 90 turns west.
// Quarter turns come out a few millionths of a degree off (single precision).
TEST(SurveyMath, RadiatesFromTheOrientationsBackBearing) {
  const Bearing back = BearingBetween(900, 1000, 1000, 1000);
  EXPECT_EQ(back.azimuth, 0);
  EXPECT_EQ(back.distance, 100);
  struct Case {
    double reading, distance, x, y;
  };
  for (const Case& c : std::vector<Case>{{90, 10, 1000, 990},
                                         {180, 10, 1010, 1000},
                                         {270, 25.5, 1000, 1025.5},
                                         {0, 10, 990, 1000},
                                         {45, std::sqrt(2.0) * 10, 990, 990}}) {
    const Radiated p = Radiate(1000, 1000, back.azimuth, c.reading, c.distance);
    EXPECT_EQ(p.x, c.x) << c.reading;
    EXPECT_EQ(p.y, c.y) << c.reading;
  }
  // Millimetres, ties to even.
  EXPECT_EQ(Radiate(0, 0.0005, 0, 180, 0).y, 0);
  EXPECT_EQ(Radiate(0, 0.0015, 0, 180, 0).y, 0.002);
  EXPECT_NEAR(BearingBetween(1000, 1000, 1000, 1100).azimuth, 90.0000025, 1e-7);
  EXPECT_NEAR(BearingBetween(1000, 1000, 900, 900).azimuth, 224.999996, 1e-6);
}

TEST(SurveyMath, HeightsAndCheckResiduals) {
  // Level sight: the station's height plus the instrument's less the prism's.
  EXPECT_NEAR(PointHeight(10, 90, 50, 1.5, 1.7), 9.8, 1e-12);
  // 45 degrees up over 20 m rises 20 m.
  EXPECT_NEAR(PointHeight(10, 45, 20, 1.5, 1.5), 30, 1e-9);
  EXPECT_NEAR(PointHeight(10, 100, 100, 0, 0), 10 - std::tan(10 * 3.14159265358979 / 180) * 100,
              1e-9);
  // The reading expected on the check point is its bearing turned from the
  // orientation's, held to 0-360.
  EXPECT_EQ(CheckResidual(270, 270, 0), 0);
  EXPECT_EQ(CheckResidual(90, 0, 270), 0);
  EXPECT_EQ(CheckResidual(10, 350, 0), -340);
  EXPECT_EQ(CheckResidual(100, 90, 350), 0);
}

}  // namespace
}  // namespace kavu
