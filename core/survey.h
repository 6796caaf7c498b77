// The typed result of a computation run: what the run found, in numbers, for
// every product writer and for anything that shows the survey (a map, a
// summary). Names and texts are TCVN3 bytes as in the field book; names are
// trimmed and at most 12 characters. Coordinates are metres, X north and
// Y east, rounded as the products write them (3 decimals).
//
// A survey of a million points must fit in little memory: a point's texts
// (its record line, and the name, code and note within it) and the report's
// lines are not strings of their own but places in the survey's texts, the
// field book's bytes as read followed by the texts the run made.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kavu {

// A known point as its texts stand in the field book or the control file:
// name, X, Y, H (empty without a height, or with heights off).
using KnownPoint = std::array<std::string, 4>;

// A point with coordinates: a control point, a station or a check point.
struct SurveyPoint {
  std::string name;
  double x = 0, y = 0;
  std::optional<double> h;  // when the point has a height and heights are on
};

// The field sketch's texts of a station, as the looked-up coordinates stand.
struct SketchTexts {
  std::string stationX, stationY, stationZ;
  std::string orientationX, orientationY, orientationZ;
  std::string checkName;          // the check record's point in its 12 columns, or blank
  std::string checkX, checkY;     // the check point's coordinates, empty when not found
  double orientationReading = 0;  // the orientation reading drawn for the form, degrees
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
  SketchTexts sketch = {};  // only when the field sketch is ticked
};

enum class PointKind : std::uint8_t { Detail, Peg };

// A detail point or an auxiliary peg that was computed.
struct ComputedPoint {
  double x = 0, y = 0;
  double z = 0;  // the height as computed, unrounded (also with heights off)
  // Where its record line stands in the survey's texts, fields set off by
  // single spaces, up to the line end that follows it there.
  // (The bit fields share one type, so that every compiler packs them into
  // one word.)
  std::uint64_t record : 61 = 0;
  std::uint64_t peg : 1 = 0;
  // Whether the coordinate listing (.td1) gives it a line: a detail point
  // whose record has no words after the prism height, or descriptive words.
  std::uint64_t listed : 1 = 0;
  // A detail point whose sixth field is descriptive words: its code, and its
  // note after them.
  std::uint64_t words : 1 = 0;
  std::uint32_t line = 0;     // field-book line of its record (from 1)
  std::uint32_t station = 0;  // index into Survey::stations

  PointKind kind() const { return peg != 0 ? PointKind::Peg : PointKind::Detail; }
  void SetKind(PointKind kind) { peg = kind == PointKind::Peg ? 1 : 0; }
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

// One message of the error report, in run order: "Diem " + a point's name in
// 12 columns + one of the point messages, or a line as it stands among the
// made texts (its size in 4 bytes, the point it names, then the line).
struct ReportEntry {
  std::uint64_t at : 56 = 0;      // where the point's name stands in the survey's texts
  std::uint64_t message : 7 = 0;  // 1 + the index of its point message, 0 for a line as it stands
  // An error counted in the summary (set off by an empty line in the error
  // report); false for a line that goes with the one before it.
  std::uint64_t counted : 1 = 1;
  std::uint32_t size = 0;  // the size of the point's name
  std::uint32_t line = 0;  // field-book line of the record it concerns, 0 when none
};

// A report line about a point: "Diem " + its name in 12 columns (a longer
// name whole) + the message, appended to out.
void AppendPointLine(std::string& out, std::string_view name, std::string_view message);

struct Survey {
  std::string book;                  // the field book's bytes as the run read them
  std::string made;                  // the texts the run made, placed after the book's
  std::vector<SurveyPoint> control;  // the known points the run used, in first-use order
  // Every known point of the run as its texts stand: the ones it read, then
  // the pegs it set out (known points for the rest of the run, their texts
  // as the products write them).
  std::vector<KnownPoint> known;
  std::size_t knownRead = 0;                   // how many of `known` the run read
  std::vector<StationResult> stations;         // in field-book order
  std::vector<ComputedPoint> points;           // detail points and pegs, in field-book order
  std::vector<ReportEntry> report;             // error-report messages, in run order
  std::vector<ControlListing> controlListing;  // in run order

  // The text of `size` bytes at `at` of the survey's texts.
  std::string_view Text(std::uint64_t at, std::size_t size) const;
  // Keeps a text made by the run; where it stands.
  std::uint64_t Keep(std::string_view text);

  std::string_view Record(const ComputedPoint& point) const;
  // Keeps a record line among the made texts, followed by its line end.
  std::uint64_t KeepRecord(std::string_view record);
  // A point's name, code and note within its record line, found at once.
  struct PointTexts {
    std::string_view name, code, note;
    std::string_view prism;  // the prism height as its record gives it
  };
  PointTexts Texts(const ComputedPoint& point) const;
  std::string_view Name(const ComputedPoint& point) const { return Texts(point).name; }
  std::string_view Code(const ComputedPoint& point) const { return Texts(point).code; }
  std::string_view Note(const ComputedPoint& point) const { return Texts(point).note; }
  double Prism(const ComputedPoint& point) const;  // the prism height of its record

  // The point a report line names (trimmed, empty when none) and the line.
  std::string_view Point(const ReportEntry& entry) const { return Text(entry.at, entry.size); }
  void AppendText(std::string& out, const ReportEntry& entry) const;
  std::string TextOf(const ReportEntry& entry) const;

  // Adds a computed point whose record line is `record` (kept among the
  // made texts), for a survey put together by hand.
  ComputedPoint& AddPoint(std::string_view record, PointKind kind, double x, double y);
  // Adds a report line as it stands, naming point.
  void AddReport(std::string_view text, std::string_view point, std::size_t line,
                 bool counted = true);
};

}  // namespace kavu
