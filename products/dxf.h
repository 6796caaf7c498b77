// The drawing exchange file (.dxf): control and detail points with their
// names, for a CAD program.
#pragma once

#include "core/lines.h"
#include "core/survey.h"

namespace kavu {

// The drawing of the run's known points (those it read and its pegs) and
// detail points; labelHeight is the label height on the ground in metres
// (millimetres on paper times the scale denominator / 1000).
void WriteDrawing(TextOut& out, const Survey& survey, double labelHeight);

}  // namespace kavu
