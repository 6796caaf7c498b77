// The surveying mathematics of a station, as functions of the numbers they
// read: decoding a packed angle, the bearing and distance between two known
// points, the radiation of a detail point and its height, the residual of a
// check sight. The run's record routines call them and report what they find.
// The azimuths are held in single precision, as the office's tables were made,
// and pi has the 15 digits every angle of the field book was converted with.
#pragma once

#include <cstdint>

#include "core/angles.h"

namespace kavu {

// A packed angle DDDMMSS[.s] decoded: its parts, its value in decimal degrees
// (degrees of 360 and more taken modulo 360), and what was wrong with it.
struct DecodedAngle {
  AngleParts parts;
  double degrees = 0;
  bool negative = false;         // the sign was dropped
  bool degreesOver = false;      // 360 or more
  bool minutesOver = false;      // 60 or more
  bool secondsOver = false;      // 60 or more
};
DecodedAngle DecodePacked(double packed);

// In radians, with the field book's pi.
double Radians(double degrees);

// The bearing (azimuth, degrees clockwise from the northing axis) from one
// point to another, and the distance between them.
struct Bearing {
  double azimuth = 0;
  double distance = 0;
};
Bearing BearingBetween(double xFrom, double yFrom, double xTo, double yTo);

// A detail point radiated from the station at (x, y): its horizontal reading
// (degrees) is turned from the orientation, whose bearing to the station is
// backBearing; the coordinates are rounded to the millimetre, ties to even.
struct Radiated {
  double x = 0, y = 0;
};
Radiated Radiate(double x, double y, double backBearing, double readingDegrees, double distance);

// The height of a detail point from the station's height, the zenith angle
// (degrees), the horizontal distance, and the instrument and prism heights.
double PointHeight(double stationHeight, double zenithDegrees, double distance,
                   double instrumentHeight, double prismHeight);

// A check sight's residual: the reading it should have given (the bearing from
// the check point to the station turned from the orientation's back bearing,
// held to 0-360) taken from the reading it gave.
double CheckResidual(double readingDegrees, double checkBearing, double backBearing);

}  // namespace kavu
