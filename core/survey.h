// The typed result of a computation run: what the run found, in numbers, for
// every product writer and for anything that shows the survey (a map, a
// summary). Names and texts are TCVN3 bytes as in the field book; names are
// trimmed and at most 12 characters. Coordinates are metres, X north and
// Y east, rounded as the products write them (3 decimals).
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace kavu {

// A point with coordinates: a control point, a station or a check point.
struct SurveyPoint {
  std::string name;
  double x = 0, y = 0;
  std::optional<double> h;  // when the point has a height and heights are on
};

// A station that was computed.
struct StationResult {
  SurveyPoint station;
  SurveyPoint orientation;              // the orientation point (backsight)
  double bearing = 0;                   // azimuth station -> orientation, degrees
  double orientationDistance = 0;       // from the coordinates, metres
  std::optional<SurveyPoint> check;     // the check point of a check record
  std::optional<double> checkResidual;  // check sight minus computed angle, degrees
  std::size_t line = 0;                 // field-book line of the station record (from 1)
  std::string instrumentHeight = {};    // the station record's instrument height, as it stands
  double backBearing = 0;               // azimuth orientation -> station, degrees, as computed
  // The station's last check record as the peg file repeats it: "DKD2", the
  // check point, the reading (made up from the computed angle when none was
  // recorded), the distance; empty without one.
  std::string checkRecord = {};
};

enum class PointKind { Detail, Peg };

// A detail point or an auxiliary peg that was computed.
struct ComputedPoint {
  std::string name;
  double x = 0, y = 0;
  std::optional<double> h;  // when heights are on
  std::string code, note;
  PointKind kind = PointKind::Detail;
  std::size_t station = 0;  // index into Survey::stations
  std::size_t line = 0;     // field-book line of its record (from 1)
  double z = 0;             // the height as computed, unrounded (also with heights off)
  double prism = 0;         // the prism height of its record
  std::string record = {};  // its record line, fields set off by single spaces
  // Whether the coordinate listing (.td1) gives it a line: a detail point
  // whose record has no words after the prism height, or descriptive words.
  bool listed = false;
};

// A line of the control-point listing that heads the .kc, the TRIDO book and
// the .td1: a known point looked up by the run, or a point of this run (a peg,
// or a detail point looked up as "DKC" + its name).
struct ControlListing {
  std::string name;                  // the name as looked up, trimmed
  std::optional<std::size_t> point;  // index into Survey::points for a point of this run
  std::string x, y, z;               // a known point's coordinates as their texts stand
  bool height = false;               // whether the line gives the height
};

// One message of the error report, in run order.
struct ReportEntry {
  std::string text;      // the message line as the error report holds it
  std::string point;     // the point the line names ("Diem " + name ...), trimmed, or empty
  std::size_t line = 0;  // field-book line of the record it concerns, 0 when none
  // An error counted in the summary (set off by an empty line in the error
  // report); false for a line that goes with the one before it.
  bool counted = true;
};

struct Survey {
  std::vector<SurveyPoint> control;            // the known points the run used, in first-use order
  std::vector<StationResult> stations;         // in field-book order
  std::vector<ComputedPoint> points;           // detail points and pegs, in field-book order
  std::vector<ReportEntry> report;             // error-report messages, in run order
  std::vector<ControlListing> controlListing;  // in run order
};

}  // namespace kavu
