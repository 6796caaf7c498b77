// The run's own reports and text products.
#pragma once

#include <string>

#include "core/state.h"

namespace kavu {

// The error report (.err): its head, then each message, an error set off by
// an empty line.
void WriteErrorReport(TextOut& out, const Survey& survey);
void WriteStationListingHeader(TextOut& out);
// The station listing's line for each computed station: station, orientation,
// azimuth from the orientation point, orientation distance, first and last
// detail point.
void WriteStationListing(TextOut& out, const Survey& survey);
// An orientation distance in its 8 columns, as the listing and the field
// sketch show it.
std::string OrientationDistanceText(double distance);

// True when the product at path would replace a file the run reads: it is
// then named in st.unwritable and must be passed over.
bool ProductOverInput(RunState& st, const std::string& path);

// The products after the station loop: .kc, the regenerated field book with
// its .td1, the .txt. Unwritable ones are added to st.unwritable.
void WriteTextProducts(RunState& st);

// A line of the control-point listing (.kc and the head of the TRIDO book and
// .td1), and a detail point's line of the coordinate listing (.td1), appended.
std::string ControlListingLine(const Survey& survey, const ControlListing& entry);
void AppendCoordinateListingLine(std::string& out, const Survey& survey,
                                 const ComputedPoint& point);

// A line of the coordinate text file for a computed detail point, appended.
void AppendCoordinateTextLine(std::string& out, const Survey& survey, const ComputedPoint& point,
                              int decimals);

}  // namespace kavu
