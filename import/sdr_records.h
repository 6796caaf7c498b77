// Reading SDR-family recordings. The header says how: the width of the point
// identifiers (the job record "10NM", else an "00NM" naming SDR33) and the
// units of the "00NM" record's last six digits (angle unit, distance unit,
// coordinate order, direction of the horizontal circle). Values are turned
// here into what the field book wants: decimal degrees read clockwise,
// metres, X north and Y east.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "import/instrument_common.h"

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

// Columns from..to of a record.
struct Span {
  std::size_t from, to;
  std::string_view Of(std::string_view line) const { return Columns(line, from, to); }
};

// Where the fields stand in the two layouts.
struct SdrLayout {
  int width;                          // identifier columns, 4 or 16
  Span id;                            // point of an "08" record, station of a set-up
  Span x, y, h;                       // coordinates of "08" and set-up records
  Span height;                        // instrument height of a set-up
  Span description;                   // of a set-up
  Span target;                        // backsight of "07", target of "09F1"
  Span circle;                        // circle reading on the backsight of "07"
  Span prism;                         // "03NM"
  Span slope, zenith, reading, note;  // "09F1"
};

inline constexpr SdrLayout kNarrowLayout{4,        {5, 8},   {9, 18},  {19, 28}, {29, 38},
                                         {39, 48}, {49, 65}, {9, 12},  {23, 32}, {5, 14},
                                         {13, 22}, {23, 32}, {33, 42}, {43, 59}};
inline constexpr SdrLayout kWideLayout{16,       {5, 20},   {21, 36}, {37, 52}, {53, 68},
                                       {69, 84}, {85, 100}, {21, 36}, {53, 68}, {5, 20},
                                       {37, 52}, {53, 68},  {69, 84}, {85, 100}};

// The records that hold a point's coordinates: "08KI", "08CO", "08TP" and
// the set-ups "02TP", "02KI".
bool IsCoordinateCode(std::string_view code);
bool IsSetUpCode(std::string_view code);

// The control-point record of a coordinate record under a name: X north and
// Y east as recorded, unless in feet; empty when the name or a coordinate is
// missing (the record would read back wrongly).
std::string KnownPointRecord(std::string_view name, std::string_view record,
                             const SdrLayout& layout, const SdrHeader& header);

// The reading, zenith and horizontal distance of an observation "09F1".
struct Shot {
  double reading = 0;  // clockwise, decimal degrees
  double zenith = 0;
  double distance = 0;  // horizontal, metres
};
Shot ReadShot(std::string_view record, const SdrLayout& layout, const Units& units);

// A name as a converter writes it: the blanks around it dropped (an
// identifier padded to its columns names the same point as the number the
// detail record gives it) and every blank inside turned into "_", so that the
// field book's splitter keeps it one field.
std::string BlankFreeName(std::string_view name);

}  // namespace kavu
