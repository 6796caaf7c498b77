// The run's own reports and text products.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/lines.h"
#include "core/survey.h"

namespace kavu {

// The error report (.err): its head, then each message, an error set off by
// an empty line.
void WriteErrorReport(TextOut& out, const Survey& survey);
// For each line of the error report as WriteErrorReport lays it out, the
// field-book line of the record it concerns (0 for the head, the empty lines
// and a message about no record). A message that holds a line break takes a
// line of the report for each of its lines, as a text window shows them.
std::vector<std::uint32_t> ErrorReportBookLines(const Survey& survey);
void WriteStationListingHeader(TextOut& out);
// The station listing's line for each computed station: station, orientation,
// azimuth from the orientation point, orientation distance, first and last
// detail point.
void WriteStationListing(TextOut& out, const Survey& survey);
// An orientation distance in its 8 columns, as the listing and the field
// sketch show it.
std::string OrientationDistanceText(double distance);

// The products after the station loop: the control-point listing (.kc, and
// the head of the TRIDO book and the .td1), ended by an empty line; the
// records of each computed station under its station and orientation lines,
// as they were read (the TRIDO book) or as their coordinates (.td1); the
// coordinate text file (.txt) with heights to decimals.
void WriteControlListing(TextOut& out, const Survey& survey);
void WriteStationRecords(TextOut& out, const Survey& survey, bool coordinates);
void WriteCoordinateText(TextOut& out, const Survey& survey, int decimals);

// A line of the control-point listing (.kc and the head of the TRIDO book and
// .td1), and a detail point's line of the coordinate listing (.td1), appended.
std::string ControlListingLine(const Survey& survey, const ControlListing& entry);
void AppendCoordinateListingLine(std::string& out, const Survey& survey,
                                 const ComputedPoint& point);

// A line of the coordinate text file for a computed detail point, appended.
void AppendCoordinateTextLine(std::string& out, const Survey& survey, const ComputedPoint& point,
                              int decimals);

}  // namespace kavu
