// Looking up a station or orientation point among the known and computed
// points.
#pragma once

#include "core/state.h"

namespace kavu {

// TimToaDoDiem: looks up TenKC; sets n, X, Y, Z, StX, StY, StZ; reports
// conflicting duplicates and a name not found; records the lines of the control-point listing.
void TimToaDoDiem(RunState& st);

// A line of the control-point listing: "TR " + name + X + " " + Y
// (+ " " + H), with one space after a name that fills its 12 columns.
std::string ControlLine(const std::string& name12, const std::string& x11, const std::string& y10,
                        const std::string* z10);

}  // namespace kavu
