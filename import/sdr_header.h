// What the header of an SDR-family recording says about how to read it: the
// width of its point identifiers (the job record "10NM", else an "00NM"
// naming SDR33) and the units of the "00NM" record's last six digits (angle
// unit, distance unit, coordinate order, direction of the horizontal circle).
// Values are turned here into what the field book wants: decimal degrees
// read clockwise, metres, X north and Y east.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kavu {

// The line the run's error report gets for a declaration the program cannot
// honour: the message and the declaring record, trimmed.
std::string UnreadableDeclaration(std::string_view record);

// Angles and lengths of a recording turned into degrees and metres.
struct Units {
  double degrees_per_unit = 1;  // gon 0.9, mil 360/6400
  double metres_per_unit = 1;   // feet 0.3048
  bool counter_clockwise = false;

  double Angle(double value) const { return value * degrees_per_unit; }
  // A horizontal circle reading, clockwise and within [0, 360).
  double Reading(double value) const;
  double Length(double value) const { return value * metres_per_unit; }
  // A length text as recorded, or rewritten with the mask "0.000" when it
  // is in feet; an empty text stays empty.
  std::string LengthText(std::string_view text) const;
};

struct SdrHeader {
  int width = 4;  // columns of a point identifier: 4 or 16
  Units units;
  bool east_north = false;          // coordinates recorded east first
  std::vector<std::string> report;  // declarations not understood
};

// Reads the header records of a recording; width_default holds when the
// file does not declare its width.
SdrHeader ReadSdrHeader(const std::vector<std::string>& lines, int width_default);

// A name as a converter writes it: every blank inside becomes "_", so that
// the field book's splitter keeps it one field.
std::string BlankFreeName(std::string_view name);

}  // namespace kavu
