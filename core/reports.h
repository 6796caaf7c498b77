// The run's own reports and text products.
#pragma once

#include <string>

#include "core/state.h"

namespace kavu {

void WriteErrorReportHeader(TextOut& out);
void WriteStationListingHeader(TextOut& out);

// True when the product at path would replace a file the run reads: it is
// then named in st.unwritable and must be passed over.
bool ProductOverInput(RunState& st, const std::string& path);

// The products after the station loop: .kc, the regenerated field book with
// its .td1, the .txt. Unwritable ones are added to st.unwritable.
void WriteTextProducts(RunState& st);

// A line of the coordinate text file for computed point k (from 0).
std::string CoordinateTextLine(const RunState& st, int k, int decimals);

}  // namespace kavu
