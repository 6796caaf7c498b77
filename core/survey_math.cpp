#include "core/survey_math.h"

#include <cmath>

#include "core/numbers.h"

namespace kavu {
namespace {

// The packed angle split as the office has always decoded it: integer
// division and remainder work on the angle rounded to a whole number; the
// degrees are not yet reduced below 360.
AngleParts SplitPacked(double packed) {
  const double whole = RoundEvenWhole(packed);
  AngleParts parts;
  parts.do1 = std::trunc(whole / 10000);
  // The remainder of a whole number below 2^53 is that of its integer.
  const double minutesAndSeconds =
      std::fabs(whole) < 9007199254740992.0
          ? static_cast<double>(static_cast<std::int64_t>(whole) % 10000)
          : std::fmod(whole, 10000);
  parts.phut = static_cast<std::int16_t>(std::trunc(minutesAndSeconds / 100));
  parts.giay = RoundEven((packed / 100 - std::trunc(whole / 100)) * 100.00001, 1);
  return parts;
}

}  // namespace

DecodedAngle DecodePacked(double packed) {
  DecodedAngle angle;
  if (packed < 0) {
    angle.negative = true;
    packed = std::fabs(packed);
  }
  angle.parts = SplitPacked(packed);
  if (angle.parts.do1 >= 360) {
    angle.degreesOver = true;
    angle.parts.do1 = std::fmod(angle.parts.do1, 360);
  }
  angle.minutesOver = angle.parts.phut >= 60;
  angle.secondsOver = angle.parts.giay >= 60;
  angle.degrees = (angle.parts.do1 + angle.parts.phut / 60.0) + angle.parts.giay / 3600;
  return angle;
}

double Radians(double degrees) { return degrees * kPi / 180; }

Bearing BearingBetween(double xFrom, double yFrom, double xTo, double yTo) {
  const double dx = xTo - xFrom;
  const double dy = yTo - yFrom;
  float theta;
  if (dx > 0) {
    theta = static_cast<float>(std::atan(dy / dx));
  } else if (dx < 0) {
    theta = static_cast<float>(std::atan(dy / dx) + kPi);
  } else {
    theta = static_cast<float>(dy >= 0 ? kPi / 2 : kPi / 2 + kPi);
  }
  Bearing bearing;
  bearing.azimuth = static_cast<double>(theta) * 180 / kPi;
  if (bearing.azimuth < 0) bearing.azimuth += 360;
  if (bearing.azimuth >= 360) bearing.azimuth -= 360;
  bearing.distance = std::sqrt(dx * dx + dy * dy);
  return bearing;
}

Radiated Radiate(double x, double y, double backBearing, double readingDegrees, double distance) {
  // The azimuth is held in single precision at every step.
  float a = static_cast<float>((backBearing + readingDegrees) - 180);
  if (a < 0) a = static_cast<float>(a + 360.0);
  if (a >= 360) a = static_cast<float>(a - 360.0);
  a = static_cast<float>(a * kPi / 180.0000001);
  return {RoundEven(x + std::cos(static_cast<double>(a)) * distance, 3),
          RoundEven(y + std::sin(static_cast<double>(a)) * distance, 3)};
}

double PointHeight(double stationHeight, double zenithDegrees, double distance,
                   double instrumentHeight, double prismHeight) {
  const double rise = std::tan(Radians(90 - zenithDegrees)) * distance;
  return stationHeight + rise + instrumentHeight - prismHeight;
}

double CheckResidual(double readingDegrees, double checkBearing, double backBearing) {
  double expected = checkBearing - backBearing;
  if (expected >= 360) expected -= 360;
  if (expected < 0) expected += 360;
  return readingDegrees - expected;
}

}  // namespace kavu
